#include "query/StateTable.h"

#include "monitor/TickGrid.h"
#include "query/StateColumns.h"
#include "query/TickWalk.h"
#include "query/TimelineTables.h"
#include "timeline/Timeline.h"

#include <chrono>
#include <utility>

namespace pallax {

namespace {

class StateRows final : public Rows {
public:
    /// `walk` is where the rows that were asked for last have ended, and becomes where these end: a
    /// join asks for the rows at one time after the other.
    StateRows(Timeline& timeline, const RowBounds& bounds, const PacketRange& range,
              const StateColumns& columns, std::unique_ptr<TickWalk>& walk)
        : _bounds(bounds), _range(range), _columns(columns), _home(walk),
          _keeps(range.last - range.first < kMostPacketsToKeep) {
        if (range.first > range.last) {
            return;
        }
        _walk = std::move(_home);
        const TimelineKeyFrame& from = *timeline.keyFrames().atOrBefore(range.first - 1);
        if (!_walk || !_walk->reaches(range.first, bounds.leastTime) ||
            _walk->packet() < from.packet) {
            _walk = std::make_unique<TickWalk>(timeline, from);
        }
        _kept = _walk->kept().size();
        for (const Stretch& stretch : timeline.stretches()) {
            _lastStretch = stretch.firstPacket <= range.last ? stretch.firstPacket : _lastStretch;
        }
    }
    ~StateRows() override {
        if (_walk && !_walk->hasEnded()) {
            _home = std::move(_walk);
        }
    }
    StateRows(const StateRows&) = delete;
    StateRows& operator=(const StateRows&) = delete;

    bool next() override {
        if (!_walk) {
            return false;
        }
        while (_place < _kept) {
            if (shows(_walk->kept()[_place++])) {
                return true;
            }
        }
        if (!std::exchange(_hasSeenCurrent, true) && showsCurrent()) {
            return true;
        }
        while (goesOn()) {
            if (showsCurrent()) {
                return true;
            }
        }
        return false;
    }

    std::int64_t number(std::int64_t /*place*/) const override {
        return static_cast<std::int64_t>(_shown->packet);
    }
    void give(std::size_t column, ColumnValue& value) const override {
        const StateMoment moment{_shown->tick.time, _shown->packet, _shown->tick.number};
        _columns.give(column, moment, _shown->values, value);
    }

private:
    /// Of a longer range, no tick is kept, because keeping takes as long as reading some packets.
    static constexpr std::uint64_t kMostPacketsToKeep = 10'000;

    bool showsCurrent() {
        const TickWalk::State* const current = _walk->current();
        _isShowingCurrent = current != nullptr && shows(*current);
        return _isShowingCurrent;
    }
    bool goesOn() { return !isPast() && _walk->next(_range, _isShowingCurrent && _keeps); }
    /// Whether no further tick can be one of the rows. Time may step back between stretches.
    bool isPast() const {
        const TickWalk::State* const current = _walk->current();
        return current != nullptr && (current->packet >= _range.last ||
                                      (current->packet >= _lastStretch &&
                                       microseconds(current->tick.time) > _bounds.mostTime));
    }
    bool shows(const TickWalk::State& state) {
        const std::int64_t time = microseconds(state.tick.time);
        const bool isRow = state.packet >= _range.first && state.packet <= _range.last &&
                           time >= _bounds.leastTime && time <= _bounds.mostTime;
        _shown = isRow ? &state : _shown;
        return isRow;
    }

    RowBounds _bounds;
    PacketRange _range;
    const StateColumns& _columns;
    std::unique_ptr<TickWalk>& _home;
    bool _keeps;
    std::unique_ptr<TickWalk> _walk; ///< null: there are no rows
    std::size_t _kept = 0;           ///< how many were there at first
    std::size_t _place = 0;          ///< among these
    std::uint64_t _lastStretch = 0;  ///< first packet of the range's last stretch of time
    bool _hasSeenCurrent = false;
    bool _isShowingCurrent = false;
    const TickWalk::State* _shown = nullptr;
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
        return std::make_unique<StateRows>(_timeline, bounds, ticksIn(bounds), _columns, _walk);
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
    std::unique_ptr<TickWalk> _walk; ///< where the rows that were asked for last have ended
};

} // namespace

std::unique_ptr<QueryTable> stateTable(Timeline& timeline) {
    return std::make_unique<StateTable>(timeline);
}

} // namespace pallax
