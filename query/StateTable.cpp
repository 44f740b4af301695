#include "query/StateTable.h"

#include "monitor/TickGrid.h"
#include "query/TimelineTables.h"
#include "timeline/Timeline.h"

#include <algorithm>
#include <chrono>
#include <map>
#include <utility>

namespace pallax {

namespace {

/// SQLite has no more columns by default, and each field takes two.
constexpr std::size_t kMostFields = 900;

/// The ticks and the values at them, decoded from a key frame on.
class StateRows final : public Rows {
public:
    enum Place : std::size_t { kTime, kPacket, kTick, kFirstField };

    StateRows(Timeline& timeline, const PacketRange& range, const std::vector<FieldIndex>& fields)
        : _timeline(timeline), _range(range), _fields(fields),
          _values(timeline.fieldTable(), timeline.entryTable()) {
        if (range.first > range.last) {
            return;
        }
        const TimelineKeyFrame& from = *timeline.keyFrames().atOrBefore(range.first - 1);
        _values.take(from.values);
        _grid = from.grid;
        _shown = from.ticks.empty() ? 0 : from.ticks.back().packet;
        _replay = timeline.replayAt(from.packet);
        _reader = timeline.journal().reader(from.packet + 1);
    }

    bool next() override {
        while (_replay) {
            if (_held) {
                _replay->update(*std::exchange(_held, std::nullopt), &_values);
            }
            _held = _reader->next();
            if (!_held || _held->number > _timeline.packets()) {
                _held.reset();
                return end();
            }
            const auto passed = _grid.passedBefore(_held->time);
            if (passed && show(*passed)) {
                return true;
            }
            if (_shown >= _range.last) {
                _replay.reset();
            }
        }
        return false;
    }

    void give(std::size_t column, ColumnValue& value) const override {
        switch (column) {
        case kTime:
            return value.integer(microseconds(_tick.time));
        case kPacket:
            return value.integer(static_cast<std::int64_t>(_shown));
        case kTick:
            return value.integer(static_cast<std::int64_t>(_tick.number));
        default:
            break;
        }
        const std::size_t place = column - kFirstField;
        const FieldIndex field = _fields[place % _fields.size()];
        const FieldValue* held = _values.value(field);
        if (held == nullptr) {
            return;
        }
        if (place < _fields.size()) {
            return giveTyped(_timeline.fields()[field], *held, value);
        }
        value.real(std::chrono::duration<double>(_tick.time - held->read).count());
    }

private:
    /// The tick after the last packet, if it has new data.
    bool end() {
        const bool isShown = _replay->packet() > 0 && show(_grid.next());
        _replay.reset();
        return isShown;
    }
    /// Whether the tick has new data and belongs to the rows.
    bool show(const TickGrid::Tick& tick) {
        const std::uint64_t packet = _replay->packet();
        if (packet <= _shown) {
            return false;
        }
        _tick = tick;
        _shown = packet;
        return packet >= _range.first && packet <= _range.last;
    }

    Timeline& _timeline;
    PacketRange _range;
    const std::vector<FieldIndex>& _fields;
    std::unique_ptr<Replay> _replay; ///< null after the last row
    std::unique_ptr<PacketReader> _reader;
    std::optional<JournalPacket> _held; ///< comes after the current tick
    CurrentValues _values;
    TickGrid _grid;
    TickGrid::Tick _tick{0, {}};
    std::uint64_t _shown = 0; ///< the last packet before the current tick
};

class StateTable final : public QueryTable {
public:
    explicit StateTable(Timeline& timeline)
        : _timeline(timeline), _columns{{"time", "INTEGER", Column::Role::TimeStamp},
                                        {"packet", "INTEGER", Column::Role::PacketNumber},
                                        {"tick", "INTEGER"}} {
        const FieldTable& fields = timeline.fields();
        std::map<std::string, int> uses;
        for (FieldIndex index = 0; index < fields.size(); ++index) {
            if (!fields[index].isInList && _fields.size() < kMostFields) {
                _fields.push_back(index);
                ++uses[lastWordOf(fields[index].name)];
            }
        }
        std::vector<std::string> names;
        for (const FieldIndex index : _fields) {
            const std::string& name = fields[index].name;
            const std::string word = lastWordOf(name);
            const bool isPlain =
                uses[word] == 1 && word != "time" && word != "packet" && word != "tick";
            names.push_back(isPlain ? word : withoutTechnology(name));
            _columns.push_back({names.back(), ""});
        }
        for (const std::string& name : names) {
            _columns.push_back({name + "_age", "REAL", Column::Role::Plain, true});
        }
    }

    const std::vector<Column>& columns() const override { return _columns; }
    double expectedRows() const override {
        constexpr double kPacketsPerTick = 100;
        return static_cast<double>(_timeline.packets()) / kPacketsPerTick;
    }
    std::unique_ptr<Rows> rows(const RowBounds& bounds) override {
        return std::make_unique<StateRows>(_timeline, ticksIn(bounds), _fields);
    }

private:
    static std::string withoutTechnology(const std::string& name) {
        std::string rest = name.substr(name.find('.') + 1);
        std::replace(rest.begin(), rest.end(), '.', '_');
        return rest;
    }
    /// A tick is later than its packets, at most by the interval.
    PacketRange ticksIn(RowBounds bounds) const {
        constexpr std::int64_t kInterval =
            std::chrono::duration_cast<std::chrono::microseconds>(TickGrid::kInterval).count();
        const std::int64_t least = std::numeric_limits<std::int64_t>::min();
        bounds.leastTime =
            bounds.leastTime > least + kInterval ? bounds.leastTime - kInterval : least;
        return packetsIn(_timeline, bounds);
    }

    Timeline& _timeline;
    std::vector<FieldIndex> _fields;
    std::vector<Column> _columns;
};

} // namespace

std::unique_ptr<QueryTable> stateTable(Timeline& timeline) {
    return std::make_unique<StateTable>(timeline);
}

} // namespace pallax
