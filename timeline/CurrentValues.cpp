#include "timeline/CurrentValues.h"

#include "plist/DeepCopy.h"

#include <algorithm>

namespace pallax {

namespace {

double numberOf(const SampleValue& value) {
    if (const DisplayNumber* number = value.number()) {
        return number->isReal() ? number->real() : static_cast<double>(number->integer());
    }
    const NumberText* text = value.numberText();
    return text != nullptr ? text->number : NAN;
}

bool shows(const FieldValue& value, const SampleValue& sampled) {
    if (const DisplayNumber* number = sampled.number()) {
        const DisplayNumber* held = value.shown.displayNumber();
        return held != nullptr && held->sameNumberAndFormat(*number);
    }
    const Text* text = value.shown.text();
    return sampled.object() == nullptr && text != nullptr && text->view() == sampled.words();
}

bool isEmptied(const EntryValues& entry, std::size_t held) {
    return held == 0 && entry.values.empty();
}

} // namespace

const FieldValue* EntryValues::value(FieldIndex field) const {
    const auto found = std::find_if(values.begin(), values.end(),
                                    [field](const auto& each) { return each.first == field; });
    return found != values.end() ? &found->second : nullptr;
}

void CurrentValues::clear() {
    _values.clear();
    _lists.clear();
    _places.clear();
    _known.clear();
    _open.clear();
}

void CurrentValues::take(const CurrentValues& other) {
    Listener* const listener = _listener;
    *this = other;
    _listener = listener;
}

void CurrentValues::beginReplacing(Time time) {
    _time = time;
    std::fill(_values.begin(), _values.end(), FieldValue());
    for (List& list : _lists) {
        list.count = 0;
    }
}

void CurrentValues::replace(FieldIndex field, FieldValue value) {
    if (field >= _values.size()) {
        _values.resize(_fields->size());
    }
    _values[field] = std::move(value);
}

void CurrentValues::replace(ListId id, EntryValues entry) {
    List& list = _lists[placeOf(id, kNone)];
    if (list.count == list.slots.size()) {
        list.slots.emplace_back();
    }
    Slot& slot = list.slots[list.count++];
    slot.known = entry.entry;
    slot.held = std::move(entry);
}

const FieldValue* CurrentValues::value(std::string_view fieldName) const {
    const auto field = _fields->named(fieldName);
    return field ? value(*field) : nullptr;
}

const CurrentValues::Slot* CurrentValues::slotAt(std::size_t list,
                                                 std::span<const std::size_t> places) const {
    const List& searched = _lists[list];
    const auto outerPlaces = places.first(places.size() - 1);
    if (outerPlaces.empty() != (searched.outer == kNone)) {
        return nullptr;
    }
    EntryId outer = kNoEntry;
    if (searched.outer != kNone) {
        const Slot* const around = slotAt(searched.outer, outerPlaces);
        if (around == nullptr) {
            return nullptr;
        }
        outer = around->held.entry;
    }
    std::size_t place = 0;
    for (std::size_t index = 0; index < searched.count; ++index) {
        const Slot& slot = searched.slots[index];
        if (slot.outer == outer && place++ == places.back()) {
            return &slot;
        }
    }
    return nullptr;
}

const EntryValues* CurrentValues::entryAt(FieldIndex field,
                                          std::span<const std::size_t> places) const {
    const auto hasField = [field](const Slot& slot) { return slot.held.value(field) != nullptr; };
    for (std::size_t list = 0; list < _lists.size() && !places.empty(); ++list) {
        const auto begin = _lists[list].slots.begin();
        if (std::any_of(begin, begin + static_cast<std::ptrdiff_t>(_lists[list].count), hasField)) {
            const Slot* const slot = slotAt(list, places);
            return slot != nullptr ? &slot->held : nullptr;
        }
    }
    return nullptr;
}

std::size_t CurrentValues::bytes() const {
    std::size_t bytes = sizeof(CurrentValues);
    for (const FieldValue& value : _values) {
        bytes += sizeof(value) - sizeof(value.shown) + memoryOf(value.shown);
    }
    for (const List& list : _lists) {
        for (const Slot& slot : list.slots) {
            bytes += sizeof(Slot);
            for (const auto& [field, value] : slot.held.values) {
                bytes +=
                    sizeof(value) - sizeof(value.shown) + sizeof(field) + memoryOf(value.shown);
            }
        }
    }
    return bytes;
}

void CurrentValues::store(FieldValue& target, const Sample& sample) const {
    sample.value.showIn(target.shown);
    target.number = numberOf(sample.value);
    target.raw = sample.raw;
    target.read = _time;
}

void CurrentValues::sample(const Sample& sample) {
    if (!_open.empty()) {
        return sampleInEntry(_open.back(), sample);
    }
    for (const FieldIndex field : _fields->of(sample)) {
        if (field >= _values.size()) {
            _values.resize(_fields->size());
        }
        FieldValue& value = _values[field];
        store(value, sample);
        if (_listener != nullptr) {
            _listener->valueRead(field, kNoEntry, value);
        }
    }
}

void CurrentValues::sampleInEntry(Open& open, const Sample& sample) {
    if (!open.isInEntry) {
        return;
    }
    std::vector<std::pair<FieldIndex, FieldValue>>& values = open.slot->held.values;
    for (const FieldIndex field : _fields->of(sample)) {
        auto next = values.begin() + static_cast<std::ptrdiff_t>(open.held++);
        if (next == values.end()) {
            next = values.emplace(next, field, FieldValue());
            open.isAnother = true;
        }
        auto& [heldField, value] = *next;
        if (heldField != field || (_fields->identifies(field) && !shows(value, sample.value))) {
            open.isAnother = true;
        }
        heldField = field;
        store(value, sample);
    }
}

void CurrentValues::keyRemoved(std::string_view key) {
    for (const FieldIndex field : _fields->underKey(_section, key)) {
        if (field < _values.size() && !_values[field].isEmpty()) {
            _values[field] = {};
            if (_listener != nullptr) {
                _listener->valueRemoved(field);
            }
        }
    }
    const auto list = _places.find(_entries->list(_section, key, 0));
    if (list != _places.end()) {
        empty(list->second);
    }
}

std::size_t CurrentValues::placeOf(ListId id, std::size_t outer) {
    const auto [found, isNew] = _places.emplace(id, _lists.size());
    if (isNew) {
        _lists.push_back({id, outer, {}, 0});
    }
    return found->second;
}

/// Empties a list and the lists in it.
void CurrentValues::empty(std::size_t place) {
    _lists[place].count = 0;
    if (_listener != nullptr) {
        _listener->listReplaced(_lists[place].id);
    }
    for (std::size_t inner = place + 1; _hasInnerLists && inner < _lists.size(); ++inner) {
        if (_lists[inner].outer == place) {
            empty(inner);
        }
    }
}

std::size_t CurrentValues::placeOf(const SampleList& list, std::size_t outer) {
    for (const Known& known : _known) {
        if (list.layout != nullptr && known.layout == list.layout && known.outer == outer &&
            known.section == _section.data()) {
            return known.place;
        }
    }
    const ListId outerId = outer != kNone ? _lists[outer].id : 0;
    const std::size_t place = placeOf(_entries->list(_section, list.key, outerId), outer);
    if (list.layout != nullptr) {
        _known.push_back({list.layout, _section.data(), outer, place});
    }
    return place;
}

void CurrentValues::beginList(const SampleList& list) {
    Open open;
    if (_open.empty()) {
        open.list = placeOf(list, kNone);
        empty(open.list);
    } else {
        Open& around = _open.back();
        _hasInnerLists = true;
        if (around.isInEntry && !around.isIdentified) {
            identify(around);
        }
        open.list = placeOf(list, around.list);
        open.outer = around.isInEntry ? around.slot->held.entry : around.outer;
    }
    _open.push_back(open);
}

void CurrentValues::endList() {
    _open.pop_back();
}

void CurrentValues::beginEntry(std::size_t index, std::int64_t name) {
    Open& open = _open.back();
    List& list = _lists[open.list];
    if (list.count == list.slots.size()) {
        list.slots.emplace_back();
    }
    open.index = index;
    open.name = name;
    open.held = 0;
    open.isInEntry = true;
    open.isIdentified = false;
    open.slot = &list.slots[list.count];
    const Slot& slot = *open.slot;
    open.isAnother = slot.known == kNoEntry || slot.outer != open.outer || slot.index != index ||
                     slot.name != name;
}

void CurrentValues::endEntry() {
    Open& open = _open.back();
    Slot& slot = *open.slot;
    if (slot.held.values.size() > open.held) {
        slot.held.values.resize(open.held);
        open.isAnother = true;
    }
    open.isInEntry = false;
    if (isEmptied(slot.held, open.held)) {
        slot.known = kNoEntry;
        return; // nothing is shown of it
    }
    if (!open.isIdentified) {
        identify(open);
    }
    ++_lists[open.list].count;
    if (_listener != nullptr) {
        _listener->entryRead(slot.held);
    }
}

void CurrentValues::identify(Open& open) {
    Slot& slot = *open.slot;
    if (open.isAnother) {
        slot.known = identified(open, slot);
        slot.outer = open.outer;
        slot.index = open.index;
        slot.name = open.name;
    }
    slot.held.entry = slot.known;
    open.isIdentified = true;
    const List& list = _lists[open.list];
    std::size_t time = 1;
    for (std::size_t index = 0; index < list.count; ++index) {
        time += list.slots[index].known == slot.known ? 1 : 0;
    }
    if (time > 1) {
        slot.held.entry = _entries->again(slot.known, time);
    }
}

EntryId CurrentValues::identified(const Open& open, const Slot& slot) {
    const ListId list = _lists[open.list].id;
    const auto numbers = numbersOf(open, slot);
    EntryId entry = numbers ? _entries->entry(*numbers) : kNoEntry;
    if (entry == kNoEntry) {
        entry = _entries->entry(list, open.outer, identityOf(open, slot));
        if (numbers && entry != EntryTable::kOthers) {
            _entries->note(*numbers, entry);
        }
    }
    return entry;
}

/// The identity, if it consists of a few whole numbers.
std::optional<EntryTable::Numbers> CurrentValues::numbersOf(const Open& open,
                                                            const Slot& slot) const {
    EntryTable::Numbers numbers;
    numbers.list = _lists[open.list].id;
    numbers.outer = open.outer;
    for (std::size_t index = 0; index < open.held; ++index) {
        const auto& [field, value] = slot.held.values[index];
        if (!_fields->identifies(field)) {
            continue;
        }
        const DisplayNumber* number = value.shown.displayNumber();
        if (number == nullptr || number->isReal() || numbers.count == numbers.values.size()) {
            return std::nullopt;
        }
        numbers.fields.at(numbers.count) = field;
        numbers.values.at(numbers.count) = number->integer();
        numbers.formats.at(numbers.count++) = &number->format();
    }
    return numbers.count != 0 ? std::optional(numbers) : std::nullopt;
}

std::string CurrentValues::identityOf(const Open& open, const Slot& slot) const {
    std::string identity;
    for (std::size_t index = 0; index < open.held; ++index) {
        const auto& [field, value] = slot.held.values[index];
        const FieldInfo& info = (*_fields)[field];
        if (!info.identity.empty() && info.identity.front() == kEntryName) {
            return "PN " + std::to_string(open.name);
        }
        if (info.identifies) {
            identity.append(identity.empty() ? "" : ", ");
            identity.append(info.key).append(info.key.empty() ? "" : " ").append(value.text());
        }
    }
    return identity.empty() ? "#" + std::to_string(open.index + 1) : identity;
}

} // namespace pallax
