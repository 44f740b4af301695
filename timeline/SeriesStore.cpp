#include "timeline/SeriesStore.h"

#include <algorithm>
#include <utility>

namespace pallax {

namespace {

SeriesValue lesser(const SeriesValue& a, const SeriesValue& b) {
    return !b.isNumber() || (a.isNumber() && a.number() <= b.number()) ? a : b;
}

SeriesValue greater(const SeriesValue& a, const SeriesValue& b) {
    return !b.isNumber() || (a.isNumber() && a.number() >= b.number()) ? a : b;
}

SeriesValue numberOnly(const SeriesValue& value) {
    return value.isNumber() ? value : SeriesValue();
}

} // namespace

void Bucket::add(const SeriesValue& value) {
    add(Bucket{0, 0, {}, value, numberOnly(value), numberOnly(value), value});
}

void Bucket::add(const Bucket& later) {
    if (later.isEmpty()) {
        return;
    }
    first = isEmpty() ? later.first : first;
    least = lesser(least, later.least);
    most = greater(most, later.most);
    last = later.last;
}

SeriesTexts::SeriesTexts() {
    _texts.emplace_back(); // 0: no text
    _texts.emplace_back("…");
}

std::uint32_t SeriesTexts::numberOf(std::string_view text) {
    constexpr std::uint32_t kOthers = 1;
    const auto found = _numbers.find(text);
    if (found != _numbers.end()) {
        return found->second;
    }
    if (_texts.size() >= kMostTexts || _bytes + text.size() > kMostBytes) {
        return kOthers;
    }
    _bytes += text.size();
    const auto number = static_cast<std::uint32_t>(_texts.size());
    _texts.emplace_back(text);
    _numbers.emplace(_texts.back(), number);
    return number;
}

SeriesValue SeriesStore::valueOf(const FieldValue& value) {
    if (!std::isnan(value.number)) {
        return SeriesValue::ofNumber(value.number);
    }
    const Text* text = value.shown.text();
    return SeriesValue::ofText(text != nullptr ? _texts.numberOf(text->view())
                                               : _texts.numberOf(value.text()));
}

void SeriesStore::beginPacket(std::uint64_t number, Time time) {
    while ((number - 1) >> _shift >= _limits.cells) {
        halveCells();
    }
    while (_runCount > _limits.runs) {
        const std::size_t before = _runCount;
        halveCells();
        // Many short series, which larger cells hardly make shorter, must not become more.
        _isFull = _isFull || _runCount > before / 4 * 3;
    }
    _cell = static_cast<std::uint32_t>((number - 1) >> _shift);
    while (_times.size() <= _cell) {
        _times.push_back(time);
    }
}

void SeriesStore::add(FieldIndex field, EntryId entry, const FieldValue& value) {
    if (Series* const series = seriesOf(field, entry)) {
        add(*series, value);
    }
}

void SeriesStore::add(const EntryValues& entry) {
    std::size_t place = 0;
    for (const auto& [field, value] : entry.values) {
        // The fields of an entry nearly always come in the order of the time before.
        if (entry.entry < _ofEntries.size() && place < _ofEntries[entry.entry].size() &&
            _ofEntries[entry.entry][place].field == field) {
            add(_ofEntries[entry.entry][place], value);
        } else {
            add(field, entry.entry, value);
        }
        ++place;
    }
}

void SeriesStore::add(Series& series, const FieldValue& value) {
    if (!std::isnan(value.number)) {
        return add(series, SeriesValue::ofNumber(value.number));
    }
    const Text* text = value.shown.text();
    if (text != nullptr && !series.runs.empty()) {
        const SeriesValue latest = series.runs.back().last;
        if (latest.text() != 0 && _texts.text(latest.text()) == text->view()) {
            return add(series, latest); // most texts repeat: no lookup
        }
    }
    add(series, valueOf(value));
}

const SeriesStore::Series* SeriesStore::find(FieldIndex field, EntryId entry) const {
    if (entry == kNoEntry) {
        return field < _plain.size() && !_plain[field].runs.empty() ? &_plain[field] : nullptr;
    }
    if (entry >= _ofEntries.size()) {
        return nullptr;
    }
    for (const Series& each : _ofEntries[entry]) { // there are only a few
        if (each.field == field) {
            return &each;
        }
    }
    return nullptr;
}

SeriesStore::Series* SeriesStore::seriesOf(FieldIndex field, EntryId entry) {
    if (const Series* found = find(field, entry)) {
        return const_cast<Series*>(found); // NOLINT(cppcoreguidelines-pro-type-const-cast): ours
    }
    if (_isFull || _count >= _limits.series || entry == EntryTable::kOthers) {
        _isFull = true;
        return nullptr;
    }
    ++_count;
    if (entry != kNoEntry) {
        _ofEntries.resize(std::max(_ofEntries.size(), entry + std::size_t{1}));
        return &_ofEntries[entry].emplace_back(Series{field, {}});
    }
    _plain.resize(std::max(_plain.size(), field + std::size_t{1}));
    _plain[field].field = field;
    return &_plain[field];
}

void SeriesStore::add(Series& series, const SeriesValue& value) {
    std::vector<Run>& runs = series.runs;
    if (!runs.empty() && runs.back().to == _cell && runs.back().last == value) {
        return; // it is in the run already
    }
    const SeriesValue number = numberOnly(value);
    const Run alone{_cell, _cell, value, number, number, value};
    if (runs.empty() || runs.back().to < _cell) {
        if (!runs.empty() && runs.back().to + 1 == _cell && runs.back().isConstant() &&
            runs.back().last == value) {
            runs.back().to = _cell;
            return;
        }
        runs.push_back(alone);
        ++_runCount;
        return;
    }
    if (runs.back().from < runs.back().to) {
        Run own = runs.back();
        --runs.back().to;
        own.from = _cell;
        runs.push_back(own);
        ++_runCount;
    }
    Run& run = runs.back();
    run.least = lesser(run.least, number);
    run.most = greater(run.most, number);
    run.last = value;
}

/// Appends a run, whose first cell may be the last one of the run before.
void SeriesStore::appendMerged(std::vector<Run>& runs, Run run) {
    if (!runs.empty() && runs.back().to == run.from) {
        Run shared = runs.back();
        shared.from = shared.to;
        if (runs.back().from == runs.back().to) {
            runs.pop_back();
        } else {
            --runs.back().to;
        }
        shared.least = lesser(shared.least, run.least);
        shared.most = greater(shared.most, run.most);
        shared.last = run.last;
        appendMerged(runs, shared);
        if (run.from == run.to) {
            return;
        }
        ++run.from;
    }
    if (!runs.empty() && runs.back().isConstant() && run.isConstant() &&
        runs.back().last == run.first && runs.back().to + 1 == run.from) {
        runs.back().to = run.to;
        return;
    }
    runs.push_back(run);
}

void SeriesStore::halveCells() {
    ++_shift;
    _runCount = 0;
    std::vector<Run> merged;
    for (Series& series : _plain) {
        halveCells(series, merged);
    }
    for (std::vector<Series>& ofEntry : _ofEntries) {
        for (Series& series : ofEntry) {
            halveCells(series, merged);
        }
    }
    for (std::size_t cell = 0; cell < _times.size(); cell += 2) {
        _times[cell / 2] = _times[cell];
    }
    _times.resize((_times.size() + 1) / 2);
}

void SeriesStore::halveCells(Series& series, std::vector<Run>& merged) {
    merged.clear();
    for (Run run : series.runs) {
        run.from /= 2;
        run.to /= 2;
        appendMerged(merged, run);
    }
    series.runs.assign(merged.begin(), merged.end());
    _runCount += merged.size();
}

Time SeriesStore::cellTime(std::uint64_t packet) const {
    const auto cell = static_cast<std::size_t>((packet - 1) >> _shift);
    return _times.empty() ? Time() : _times[std::min(cell, _times.size() - 1)];
}

std::vector<Bucket> SeriesStore::buckets(FieldIndex field, EntryId entry,
                                         const std::vector<std::uint64_t>& borders) const {
    std::vector<Bucket> buckets;
    for (std::size_t index = 0; index + 1 < borders.size(); ++index) {
        buckets.push_back({borders[index], borders[index + 1], cellTime(borders[index])});
    }
    const Series* series = find(field, entry);
    if (series == nullptr) {
        return buckets;
    }
    auto bucket = buckets.begin();
    for (const Run& run : series->runs) {
        const std::uint64_t from = (std::uint64_t{run.from} << _shift) + 1;
        const std::uint64_t to = ((std::uint64_t{run.to} + 1) << _shift) + 1;
        while (bucket != buckets.end() && bucket->to <= from) {
            ++bucket;
        }
        for (auto each = bucket; each != buckets.end() && each->from < to; ++each) {
            each->add(Bucket{0, 0, {}, run.first, run.least, run.most, run.last});
        }
    }
    return buckets;
}

std::vector<EntryId> SeriesStore::entriesOf(FieldIndex field) const {
    std::vector<EntryId> entries;
    for (EntryId entry = 1; entry < _ofEntries.size(); ++entry) {
        if (find(field, entry) != nullptr) {
            entries.push_back(entry);
        }
    }
    return entries;
}

} // namespace pallax
