#include "query/CellFinder.h"

#include "fields/Measures.h"

#include <algorithm>
#include <charconv>

namespace pallax {

namespace {

/// More cells than a phone can meet. Further ones are left out, so that records of any content
/// need a bounded memory.
constexpr std::size_t kMostCells = 65536;

std::string_view groupOf(std::string_view field) {
    return field.substr(0, field.rfind('.'));
}

/// The field of the level in the same section or list; empty if there is none.
std::string_view levelBeside(const CellFields& cell) {
    const Measure measure = cellTermsOf(cell.system).level;
    for (const MeasuredField& each : measuredFields()) {
        if (each.measure == measure && groupOf(each.name) == groupOf(cell.code)) {
            return each.name;
        }
    }
    return {};
}

/// "PN 23" has 23.
FieldValue numberInName(const std::string& words) {
    const std::string digits = words.substr(words.find(' ') + 1);
    std::int64_t number = 0;
    FieldValue value;
    if (std::from_chars(digits.data(), digits.data() + digits.size(), number).ec == std::errc()) {
        value.shown = PropertyList::integer(number);
        value.number = static_cast<double>(number);
    }
    return value;
}

/// Whether the value is one of a cell: "Invalid Value" of a number is not.
bool names(const FieldInfo& field, const FieldValue& value) {
    return !value.isEmpty() && (field.kind != FieldInfo::Kind::Number || !std::isnan(value.number));
}

} // namespace

CellFinder::CellFinder(const FieldTable& fieldTable, const EntryTable& entries)
    : _fields(fieldTable), _entries(entries) {
    for (const CellFields& fields : cellFields()) {
        if (_fields.named(fields.code)) {
            addRule(fields);
        }
    }
}

CellFinder::Slot CellFinder::slotOf(std::string_view field) {
    const auto index = _fields.named(field);
    if (!index) {
        return kNone;
    }
    _slots.resize(std::max<std::size_t>(_slots.size(), *index + std::size_t{1}), kNone);
    if (_slots[*index] == kNone) {
        _slots[*index] = _watched.size();
        _watched.push_back({*index});
    }
    return _slots[*index];
}

void CellFinder::addRule(const CellFields& fields) {
    Rule rule;
    rule.fields = &fields;
    rule.code = slotOf(fields.code);
    rule.channel = slotOf(fields.channel);
    rule.networkColour = slotOf(fields.networkColour);
    rule.level = slotOf(levelBeside(fields));
    rule.isChannelBeside = groupOf(fields.channel) == groupOf(fields.code);
    const auto& identity = _fields[_watched[rule.code].field].identity;
    rule.isNamedByEntry = !identity.empty() && identity.front() == kEntryName;
    for (const std::string_view part : fields.area) {
        rule.area.push_back(slotOf(part));
    }
    _rules.push_back(std::move(rule));
}

void CellFinder::take(const std::vector<SampleReader::Item>& items) {
    for (auto begin = items.begin(); begin != items.end();) {
        const auto end = std::find_if(begin, items.end(), [&](const SampleReader::Item& item) {
            return item.packet != begin->packet;
        });
        if (std::any_of(begin, end, [this](const auto& item) { return isWatched(item.field); })) {
            takePacket({begin, end});
        }
        begin = end;
    }
}

void CellFinder::takePacket(std::span<const SampleReader::Item> items) {
    // The values outside lists come first: one can be the channel of a list's cells.
    for (const SampleReader::Item& item : items) {
        if (item.entry == kNoEntry && isWatched(item.field)) {
            Watched& watched = _watched[_slots[item.field]];
            watched.latest = item.value;
            watched.now = &item.value;
        }
    }
    takeRules(items.front(), kNoEntry);
    for (std::size_t from = 0; from < items.size();) {
        const SampleReader::Item& first = items[from];
        std::size_t to = from;
        // Entries without a number of their own begin again with their first field.
        do {
            if (first.entry != kNoEntry && isWatched(items[to].field)) {
                _watched[_slots[items[to].field]].now = &items[to].value;
            }
            ++to;
        } while (to < items.size() && items[to].entry == first.entry &&
                 (first.entry == kNoEntry || items[to].field != first.field));
        if (first.entry != kNoEntry) {
            takeRules(first, first.entry);
        }
        from = to;
    }
}

/// Takes the values that were read now, and forgets that they were.
void CellFinder::takeRules(const SampleReader::Item& item, EntryId entry) {
    for (const Rule& rule : _rules) {
        if (isNamedNow(rule)) {
            note(rule, item, entry);
        }
    }
    for (Watched& watched : _watched) {
        watched.now = nullptr;
    }
}

bool CellFinder::isReadNow(Slot slot) const {
    return slot != kNone && _watched[slot].now != nullptr &&
           names(_fields[_watched[slot].field], *_watched[slot].now);
}

bool CellFinder::isNamedNow(const Rule& rule) const {
    // A cell of GSM is known by its channel before its code has been read.
    const bool needsCode = rule.fields->system != RadioSystem::Gsm;
    return rule.isChannelBeside ? isReadNow(rule.channel) && (!needsCode || isReadNow(rule.code))
                                : isReadNow(rule.code);
}

FieldValue CellFinder::valueOf(Slot slot) const {
    return isReadNow(slot) ? *_watched[slot].now : FieldValue();
}

FieldValue CellFinder::codeOf(const Rule& rule, EntryId entry) const {
    if (rule.isNamedByEntry) {
        return numberInName(_entries.words(entry));
    }
    FieldValue code = valueOf(rule.code);
    const FieldValue colour = valueOf(rule.networkColour);
    if (!code.isEmpty() && !colour.isEmpty()) {
        constexpr std::int64_t kColours = 8;
        code.number += static_cast<double>(kColours) * colour.number;
        code.shown = PropertyList::integer(static_cast<std::int64_t>(code.number));
    }
    return code;
}

FieldValue CellFinder::channelOf(const Rule& rule) const {
    if (rule.channel == kNone || rule.isChannelBeside) {
        return valueOf(rule.channel);
    }
    return _watched[rule.channel].latest;
}

/// "PCI 275, EARFCN 1850". Numbers are compared, so that records which name the same cell in
/// different fields name one cell.
std::string CellFinder::identityOf(const Rule& rule, const FieldValue& code,
                                   const FieldValue& channel) const {
    std::string identity;
    const auto add = [&identity](std::string_view name, const FieldValue& value) {
        if (!value.isEmpty()) {
            identity.append(identity.empty() ? "" : ", ").append(name).append(" ");
            identity.append(std::isnan(value.number)
                                ? value.text()
                                : std::to_string(static_cast<std::int64_t>(value.number)));
        }
    };
    const CellTerms terms = cellTermsOf(rule.fields->system);
    const bool hasKeys = !rule.area.empty();
    add(hasKeys ? _fields[_watched[rule.code].field].key : terms.code, code);
    for (const Slot slot : rule.area) {
        add(_fields[_watched[slot].field].key, valueOf(slot));
    }
    add(terms.channel, channel);
    return identity;
}

void CellFinder::note(const Rule& rule, const SampleReader::Item& item, EntryId entry) {
    FieldValue code = codeOf(rule, entry);
    FieldValue channel = channelOf(rule);
    std::string identity = identityOf(rule, code, channel);
    std::string key = identity;
    key.append(1, '\n').append(wordOf(rule.fields->role)).append(nameOf(rule.fields->system));
    auto place = _places.find(key);
    if (place == _places.end()) {
        if (_found.size() >= kMostCells) {
            return;
        }
        place = _places.emplace(std::move(key), _found.size()).first;
        FoundCell cell;
        cell.role = rule.fields->role;
        cell.system = rule.fields->system;
        cell.identity = std::move(identity);
        cell.code = std::move(code);
        cell.channel = std::move(channel);
        cell.first = item.time;
        cell.packet = item.packet;
        _found.push_back(std::move(cell));
    }
    if (rule.fields->role == CellRole::Serving) {
        _serving = place->second;
    }
    FoundCell& cell = _found[place->second];
    cell.last = item.time;
    ++cell.readings;
    if (isReadNow(rule.level)) {
        const double level = _watched[rule.level].now->number;
        cell.best = cell.hasLevel ? std::max(cell.best, level) : level;
        cell.hasLevel = true;
        cell.latest = level;
    }
}

} // namespace pallax
