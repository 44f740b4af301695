#include "report/StoredTicks.h"

#include "fields/CellFields.h"
#include "fields/EventFields.h"
#include "fields/StatusFields.h"
#include "monitor/TickGrid.h"
#include "packets/StampSequence.h"
#include "report/ReportBuilder.h"
#include "store/RecordingMeasurements.h"

#include <algorithm>
#include <chrono>
#include <set>
#include <string_view>
#include <utility>

namespace pallax {

namespace {

using std::chrono::milliseconds;

using Names = std::set<std::string_view>;

void addCells(Names& names, std::string_view technology) {
    const auto addAll = [&names](const auto& fields) {
        for (const StatusField& each : fields) {
            names.insert(each.field);
        }
    };
    for (const StatusCellFields& cell : statusCells()) {
        if (cell.technology != technology) {
            continue;
        }
        addAll(cell.fields);
        names.insert(cell.only.field);
        for (const StatusList& list : cell.lists) {
            addAll(list.identity);
            names.insert({list.level, list.only.field});
        }
    }
    for (const CellFields& cell : cellFields()) {
        if (cell.technology == technology && cell.role == CellRole::Detected) {
            names.insert({cell.code, cell.channel});
        }
    }
}

/// What a status, and so a report, is made of.
Names fieldsOfReport(std::string_view technology) {
    Names names;
    addCells(names, technology);
    for (const StatusNetworkFields& each : statusNetworks()) {
        if (each.technology == technology) {
            names.insert({each.name, each.mcc, each.mnc, each.code, each.simName, each.simNetwork});
        }
    }
    for (const EventFields& each : eventFields()) {
        if (each.technology == technology) {
            names.insert(each.fields.begin(), each.fields.end());
        }
    }
    return names;
}

/// Of milliseconds after the start, of which a file may have any.
Time storedTime(const StoredTicks::Recording& recording, std::int64_t after) {
    const auto most =
        std::chrono::floor<milliseconds>(recording.last - recording.first + TickGrid::kInterval);
    return recording.first + milliseconds(std::clamp<std::int64_t>(after, 0, most.count()));
}

} // namespace

StoredTicks::StoredTicks(StoredRecordings& store, FieldTable& fields, EntryTable& entries)
    : _store(store), _fields(fields), _entries(entries), _values(fields, entries) {
    for (const std::string_view name : fieldsOfReport(fields.technology())) {
        if (const auto field = fields.named(name)) {
            _wanted.push_back(*field);
            _names.emplace_back(name);
        }
    }
}

void StoredTicks::walk(const Recording& recording, const Take& take) {
    read(recording);
    for (auto from = _held.begin(); from != _held.end();) {
        // The clock was set back where a later packet has an earlier time.
        Time latest = from->start;
        const auto to = std::find_if(from, _held.end(), [&latest](const Held& held) {
            const bool isBack = held.start < latest - StampSequence::kMostJitter;
            latest = std::max(latest, held.start);
            return isBack;
        });
        std::stable_sort(
            from, to, [](const Held& one, const Held& other) { return one.start < other.start; });
        walkStretch(
            {from, to},
            from->start + (_isOfPackets ? TickGrid::kInterval : std::chrono::nanoseconds(0)), take);
        from = to;
    }
}

void StoredTicks::read(const Recording& recording) {
    _held.clear();
    _isOfPackets = recording.loaded.every == wordOf(Resolution::Packet);
    _store.values(recording.loaded, _names, [&](std::size_t place, StoredValue value) {
        _held.push_back(heldOf(_wanted[place], recording, std::move(value)));
    });
    std::stable_sort(_held.begin(), _held.end(),
                     [](const Held& one, const Held& other) { return one.packet < other.packet; });
}

StoredTicks::Held StoredTicks::heldOf(FieldIndex field, const Recording& recording,
                                      StoredValue value) {
    Held held{field,
              0,
              kNoEntry,
              storedTime(recording, value.start),
              storedTime(recording, value.end),
              value.packet,
              {}};
    if (value.entry) {
        held.list = listOf(field);
        held.entry = _entries.entry(held.list, kNoEntry, *value.entry);
    }
    held.end = std::max(held.end, held.start);
    held.value.shown = PropertyList(std::move(value.text));
    held.value.number = value.number.value_or(held.value.number);
    held.value.raw = value.raw;
    return held;
}

/// The fields of a list have the same name up to the last word.
ListId StoredTicks::listOf(FieldIndex field) {
    const std::string& name = _fields[field].name;
    return _entries.list(std::string_view(name).substr(0, name.rfind('.')), "", 0);
}

void StoredTicks::walkStretch(const Range& stretch, Time tick, const Take& take) {
    auto [next, past] = stretch;
    const std::uint64_t packet = next->packet;
    const Time end = std::max_element(next, past, [](const Held& one, const Held& other) {
                         return one.end < other.end;
                     })->end;
    _current.clear();
    for (; tick <= end; tick += TickGrid::kInterval) {
        for (; next != past && next->start <= tick; ++next) {
            _current[{next->entry, next->field}] = &*next;
        }
        std::erase_if(_current, [tick](const auto& each) { return each.second->end < tick; });
        // Those of the last tick, at which all end, have no time of their own.
        const bool goesOn = std::any_of(_current.begin(), _current.end(), [tick](const auto& each) {
            return each.second->end > tick;
        });
        std::erase_if(_current, [tick, goesOn](const auto& each) {
            return goesOn && each.second->end == tick;
        });
        if (!_current.empty()) {
            show(tick);
            take(tick, _values, packet);
        } else if (next != past) { // on the grid, little before what comes next
            constexpr std::chrono::nanoseconds kLeast{1};
            tick += (next->start - tick - kLeast) / TickGrid::kInterval * TickGrid::kInterval;
        }
    }
}

/// At its tick, where what was read too long ago is left out. The values of packets hold until the
/// next one, so the one that came last tells most, as long as no other comes.
Time StoredTicks::readAt(const Held& held, Time tick) const {
    return _isOfPackets ? std::max(held.start, tick - ReportBuilder::kKnownFor) : tick;
}

void StoredTicks::show(Time tick) {
    _values.beginReplacing(tick);
    EntryValues entry;
    ListId list = 0;
    for (const auto& [key, held] : _current) {
        FieldValue value = held->value;
        value.read = readAt(*held, tick);
        if (held->entry == kNoEntry) {
            _values.replace(held->field, std::move(value));
            continue;
        }
        if (held->entry != entry.entry && entry.entry != kNoEntry) {
            _values.replace(list, std::exchange(entry, {}));
        }
        entry.entry = held->entry;
        list = held->list;
        entry.values.emplace_back(held->field, std::move(value));
    }
    if (entry.entry != kNoEntry) {
        _values.replace(list, std::move(entry));
    }
}

} // namespace pallax
