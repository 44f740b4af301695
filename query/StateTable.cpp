#include "query/StateTable.h"

#include "monitor/TickGrid.h"
#include "query/StateColumns.h"
#include "query/TimelineTables.h"
#include "timeline/Timeline.h"

#include <chrono>
#include <utility>

namespace pallax {

namespace {

/// The ticks and the values at them, decoded from a key frame on.
class StateRows final : public Rows {
public:
    /// `near` is a key frame close to the rows that were asked for last, and becomes one close to
    /// these: a join asks for the rows at one time after the other.
    StateRows(Timeline& timeline, const PacketRange& range, const StateColumns& columns,
              std::optional<TimelineKeyFrame>& near)
        : _timeline(timeline), _range(range), _columns(columns), _near(near),
          _values(timeline.fieldTable(), timeline.entryTable()) {
        if (range.first > range.last) {
            return;
        }
        const TimelineKeyFrame& kept = *timeline.keyFrames().atOrBefore(range.first - 1);
        const bool isNearer = near && near->packet < range.first && near->packet > kept.packet;
        const TimelineKeyFrame& from = isNearer ? *near : kept;
        _values.take(from.values);
        _grid = from.grid;
        _shown = from.ticks.empty() ? 0 : from.ticks.back().packet;
        _noteFrom = std::max(range.first, from.packet + kNoteEvery);
        _replay = timeline.replayFrom(from);
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
            _range.noteRead(_held->number);
            if (_held->number == _noteFrom) {
                note();
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

    std::int64_t number(std::int64_t /*place*/) const override {
        return static_cast<std::int64_t>(_shown);
    }
    void give(std::size_t column, ColumnValue& value) const override {
        _columns.give(column, {_tick.time, _shown, _tick.number}, _values, value);
    }

private:
    /// A key frame takes as long as reading so many packets.
    static constexpr std::uint64_t kNoteEvery = 128;

    void note() {
        std::vector<ShownTick> ticks;
        if (_shown != 0) {
            ticks.push_back({_tick, _shown});
        }
        _near = TimelineKeyFrame{
            _replay->packet(), _replay->keyFrame(), _values, _grid, std::move(ticks), {}};
    }
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
    const StateColumns& _columns;
    std::optional<TimelineKeyFrame>& _near;
    std::uint64_t _noteFrom = 0;     ///< the packet before which it is taken
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
    explicit StateTable(Timeline& timeline) : _timeline(timeline), _columns(timeline.fields()) {}

    const std::vector<Column>& columns() const override { return _columns.columns(); }
    double expectedRows() const override {
        constexpr double kPacketsPerTick = 100;
        return static_cast<double>(_timeline.packets()) / kPacketsPerTick;
    }
    std::unique_ptr<Rows> rows(const RowBounds& bounds) override {
        return std::make_unique<StateRows>(_timeline, ticksIn(bounds), _columns, _near);
    }

private:
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
    StateColumns _columns;
    std::optional<TimelineKeyFrame> _near;
};

} // namespace

std::unique_ptr<QueryTable> stateTable(Timeline& timeline) {
    return std::make_unique<StateTable>(timeline);
}

} // namespace pallax
