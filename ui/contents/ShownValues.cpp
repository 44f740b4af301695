#include "ui/contents/ShownValues.h"

#include <algorithm>

namespace pallax {

namespace {

std::string keyOfLeaf(const LeafName& leaf) {
    return leaf.field + "\n" + leaf.entry;
}

} // namespace

void ShownValues::forget() {
    _moment = {};
    _values = nullptr;
    _earlier.reset();
    _isChosen = false;
    _readings.clear();
    _curves.clear();
}

void ShownValues::update() {
    const Moment moment = _source.moment();
    _time = _source.time();
    Timeline* const timeline = moment.timeline;
    const bool isSame = timeline == _moment.timeline && moment.instant == _moment.instant;
    if (!isSame) {
        forget();
    }
    _moment = moment;
    if (timeline == nullptr) {
        _values = _source.values();
    } else if (moment.instant >= timeline->packets()) {
        _values = &timeline->latestValues();
    } else if (moment.instant < timeline->firstInstant()) {
        _values = nullptr; // the journal no longer has it
    } else {
        if (!_earlier) {
            _earlier = timeline->valuesAt(moment.instant);
        }
        _values = &*_earlier;
        _time.now = timeOf(*timeline, moment.instant).value_or(_time.now);
    }
}

std::optional<std::chrono::nanoseconds> ShownValues::ageAt(std::string_view path) const {
    const auto leaf = _values != nullptr ? leafAt(*_values, path) : std::nullopt;
    const auto value = leaf ? valueOf(*_values, *leaf) : std::nullopt;
    return value ? std::optional<std::chrono::nanoseconds>(
                       std::max<std::chrono::nanoseconds>(_time.now - value->value.read, {}))
                 : std::nullopt;
}

const Reading* ShownValues::reading(const LeafName& leaf, const LeafValue& value) {
    if (_moment.timeline == nullptr) {
        return nullptr;
    }
    const auto [found, isNew] = _readings.try_emplace(keyOfLeaf(leaf));
    if (isNew) {
        found->second =
            readingAt(*_moment.timeline, value.field, value.value.read, _moment.instant);
    }
    return found->second ? &*found->second : nullptr;
}

const CurveWindow& ShownValues::choose(std::optional<std::chrono::seconds> span) {
    if (!_isChosen || span != _span) {
        _span = span;
        _isChosen = true;
        _curves.clear();
        _window = _moment.timeline != nullptr
                      ? windowUntil(*_moment.timeline, _moment.instant, span)
                      : CurveWindow();
    }
    return _window;
}

const Curve& ShownValues::curve(const LeafName& leaf, std::size_t count) {
    const auto [found, isNew] = _curves.try_emplace(keyOfLeaf(leaf) + "\n" + std::to_string(count));
    if (isNew && _moment.timeline != nullptr && leaf.inner.empty()) {
        const auto field = _moment.timeline->fields().named(leaf.field);
        const auto entry = field ? entryOf(*field, leaf) : std::nullopt;
        if (entry) {
            found->second = readCurve(*_moment.timeline, *field, *entry, _window, count);
        }
    }
    return found->second;
}

/// Also of an entry that has left its list.
std::optional<EntryId> ShownValues::entryOf(FieldIndex field, const LeafName& leaf) const {
    if (leaf.entry.empty()) {
        return kNoEntry;
    }
    for (const EntryId entry : _moment.timeline->series().entriesOf(field)) {
        if (_moment.timeline->entries().words(entry) == leaf.entry) {
            return entry;
        }
    }
    return std::nullopt;
}

std::vector<CurveEvent> ShownValues::events() const {
    std::vector<CurveEvent> shown;
    if (_moment.timeline == nullptr) {
        return shown;
    }
    for (const Event& event : _moment.timeline->events()) {
        if (event.packet >= _window.firstPacket && event.packet <= _window.lastPacket) {
            shown.push_back({event.time, event.words});
        }
    }
    return shown;
}

} // namespace pallax
