#pragma once

#include "LogGenerator/Records/Layout.h"
#include "LogGenerator/Records/Sample.h"
#include "LogGenerator/Records/Subpackets.h"
#include "plist/PropertyList.h"
#include "text/Format.h"

#include <algorithm>
#include <optional>
#include <span>
#include <string>
#include <string_view>

namespace pallax {

/// Reads a record according to its layout and gives the samples to a sink. It is a template because
/// the display takes samples several times as fast when the compiler sees both sides.
template <class Sink>
class LayoutReader {
public:
    /// `first` is the number of the first row. `sink` and `memory` must outlive the reader.
    LayoutReader(Sink& sink, RecordMemory& memory, FieldId first)
        : _sink(sink), _memory(memory), _next(first) {}

    /// Reads a record that the layout accepts.
    void read(const CodeLayout& code, const LogRecord& record) {
        _place.record = record;
        for (const std::string_view key : code.removes) {
            _sink.keyRemoved(key);
        }
        if (code.emptiesList) {
            _sink.beginList({});
            _sink.endList();
        }
        if (code.listPart != nullptr) {
            return readListPart(code);
        }
        readIn(record, code.fields, code.lists);
        for (const SubpacketLayout& subpacket : code.subpackets) {
            readSubpacket(subpacket);
        }
    }

    /// Reads the fields and lists of a part of the record, such as a subpacket.
    void readIn(const LogRecord& place, std::span<const Field> fields,
                std::span<const ListLayout> lists) {
        readFields(place, fields);
        for (const ListLayout& list : lists) {
            readList(list, place);
        }
    }

private:
    void give(const Field& field, FieldId id, std::optional<std::int64_t> raw,
              const SampleValue& value) {
        _sink.sample({id, field, raw, value});
    }

    void readSubpacket(const SubpacketLayout& subpacket) {
        if (subpacket.fields.empty() && subpacket.lists.empty()) {
            return;
        }
        if (const auto place = findSubpacket(_place.record, subpacket.id)) {
            readIn(*place, subpacket.fields, subpacket.lists);
        } else {
            _next += static_cast<FieldId>(rowCount(subpacket));
        }
    }

    void readFields(const LogRecord& place, std::span<const Field> fields) {
        FieldId id = _next;
        for (const Field& field : fields) {
            if (field.condition == nullptr || allows(field, id, place)) {
                if (field.computation == nullptr) {
                    const std::int64_t raw = place.read(*field.position);
                    give(field, id, raw, field.conversion.valueOf(raw));
                } else {
                    compute(field, id, place);
                }
            }
            ++id;
        }
        _next = id;
    }

    // The next two are not inlined, because they are rare and would slow the loop down.

    /// Whether the field's condition holds. If not, gives what is shown instead.
    [[gnu::noinline]] bool allows(const Field& field, FieldId id, const LogRecord& place) {
        const std::int64_t number = numberOf(*field.condition, place);
        const bool holds = field.condition->holdsFor(number);
        if (!holds) {
            giveOtherwise(field, id, number);
        }
        return holds;
    }

    [[gnu::noinline]] void compute(const Field& field, FieldId id, const LogRecord& place) {
        _place.here = place;
        _place.memory = &_memory;
        const PropertyList value = field.computation->compute(_place);
        if (const DisplayNumber* number = value.displayNumber()) {
            give(field, id, std::nullopt, SampleValue(*number));
        } else if (!value.isNull()) {
            give(field, id, std::nullopt, SampleValue::object(value));
        }
    }

    std::int64_t numberOf(const Condition& condition, const LogRecord& place) const {
        if (!condition.subpacket) {
            return place.read(condition.position);
        }
        const auto other = findSubpacket(_place.record, *condition.subpacket);
        return other ? other->read(condition.position) : 0;
    }

    void giveOtherwise(const Field& field, FieldId id, std::int64_t number) {
        const std::string_view otherwise = field.condition->otherwise;
        if (otherwise.find('%') != std::string_view::npos) {
            // A text, because the number in it is not the row's number.
            const std::string text = formatText(otherwise, {number});
            give(field, id, std::nullopt, SampleValue::text(text));
        } else if (!otherwise.empty()) {
            give(field, id, std::nullopt, SampleValue::label(otherwise));
        }
    }

    void readList(const ListLayout& list, const LogRecord& place) {
        const FieldId first = _next;
        const std::size_t count = list.countIn(place);
        const bool isKept = list.staysWithoutEntries && count == 0;
        if (!isKept && (list.isShown || Sink::kTakesHidden)) {
            readEntries(list, place, count, first);
        }
        _next = first + static_cast<FieldId>(list.fields.size());
        if (!list.lists.empty()) {
            _next += static_cast<FieldId>(rowCount(list.lists));
        }
    }

    void readEntries(const ListLayout& list, const LogRecord& place, std::size_t count,
                     FieldId first) {
        const EntryList entries = list.entriesIn(place, count);
        const std::size_t whole = list.seemsToFit(place, count) ? entries.wholeCount() : 0;
        _sink.beginList({list.key, &list, whole});
        if (whole > 0) {
            readEach(list, place, entries, whole, first);
        }
        _sink.endList();
    }

    void readEach(const ListLayout& list, const LogRecord& place, const EntryList& entries,
                  std::size_t whole, FieldId first) {
        // Not an optional: the compiler warns that its content may be uninitialized.
        const EntryList companions =
            list.companion ? EntryList(place, list.companion->layoutIn(place), entries.count())
                           : EntryList({}, {}, 0);
        const bool mayBeLonger = hasLongerEntries(list);
        for (std::size_t index = 0; index < whole; ++index) {
            const LogRecord entry = entries.at(index);
            if (list.only != nullptr && !list.only->holdsIn(entry)) {
                continue;
            }
            if (list.companion) {
                if (!companions.isWhole(index)) {
                    break; // an entry needs its companion
                }
                _place.companion = companions.at(index);
            }
            if (mayBeLonger && !holdsItsFields(list, entry)) {
                break;
            }
            _place.around = place;
            _next = first;
            _sink.beginEntry(index, list.entryName ? entry.read(*list.entryName) : 0);
            readFields(entry, list.fields);
            for (const ListLayout& inner : list.lists) {
                readList(inner, entry);
            }
            _sink.endEntry();
        }
    }

    /// Whether a field that depends on a condition may lie after the bytes that make an entry
    /// whole.
    static bool hasLongerEntries(const ListLayout& list) {
        return std::any_of(list.fields.begin(), list.fields.end(), [&list](const Field& field) {
            return field.condition != nullptr && field.position &&
                   endOf(*field.position) > list.entries.layout.bytesRead;
        });
    }
    static std::size_t endOf(const Position& position) {
        const Extent extent = extentOf(position);
        return extent.byte + extent.length;
    }
    /// Entries for which a condition holds may be longer than the others.
    static bool holdsItsFields(const ListLayout& list, const LogRecord& entry) {
        for (const Field& field : list.fields) {
            if (field.condition == nullptr || !field.position) {
                continue;
            }
            if (!entry.has(endOf(*field.position)) && field.condition->holdsIn(entry)) {
                return false;
            }
        }
        return true;
    }

    void readListPart(const CodeLayout& code) {
        const ListPart& part = *code.listPart;
        const bool isEntries = part.isEntries();
        const std::optional<PropertyList> list = part.parse(_place.record);
        if (!list) {
            if (part.kind == ListPart::Kind::CellEntries) {
                _sink.beginList({});
                _sink.endList();
            }
            return;
        }
        if (part.kind == ListPart::Kind::Keys) {
            return readKeys(list->dictionary(), code.fields);
        }
        const ArrayRef elements = list->array();
        if (elements == nullptr && part.kind == ListPart::Kind::Elements) {
            return;
        }
        if (isEntries) {
            _sink.beginList({{}, nullptr, elements != nullptr ? elements->size() : 0});
        }
        if (elements != nullptr) {
            readElements(part, *elements, code.fields);
        }
        if (isEntries) {
            _sink.endList();
        }
    }

    void readElements(const ListPart& part, const Array& elements, std::span<const Field> fields) {
        const FieldId first = _next;
        std::size_t index = 0;
        for (const PropertyList& element : elements) {
            if (part.kind == ListPart::Kind::Elements) {
                _sink.beginEntry(index++, 0);
                give(fields.front(), first, std::nullopt, SampleValue::object(element));
                _sink.endEntry();
            } else if (part.looksFor(element)) {
                if (part.isEntries()) {
                    _sink.beginEntry(index++, 0);
                }
                readCell(*element.dictionary(), fields);
                if (part.isEntries()) {
                    _sink.endEntry();
                } else if (part.kind == ListPart::Kind::FirstCell) {
                    return;
                }
            }
        }
    }

    void readKeys(const DictionaryRef& keys, std::span<const Field> fields) {
        FieldId id = _next;
        for (const Field& field : fields) {
            const PropertyList* value = keys != nullptr ? keys->find(field.listKey) : nullptr;
            if (value != nullptr) {
                give(field, id, std::nullopt, SampleValue::object(*value));
            }
            ++id;
        }
    }

    void readCell(const Dictionary& cell, std::span<const Field> fields) {
        FieldId id = _next;
        for (const Field& field : fields) {
            const PropertyList* value = cell.find(field.listKey);
            const auto number = value != nullptr ? value->int32() : std::nullopt;
            if (number) {
                const std::int64_t raw = lowBits(*number, field.listBits);
                give(field, id, raw, field.conversion.valueOf(raw));
            } else if (!field.failure.empty()) {
                systemLog(LogPriority::Error, "%s", field.failure);
            }
            ++id;
        }
    }

    static std::int64_t lowBits(std::int32_t number, unsigned bits) {
        constexpr unsigned kLevelBits = 16;
        return bits == kLevelBits ? static_cast<std::int16_t>(number) : number;
    }

    Sink& _sink;
    RecordMemory& _memory;
    FieldId _next;
    Place _place;
};

} // namespace pallax
