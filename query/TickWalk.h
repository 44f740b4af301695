#pragma once

#include "monitor/TickGrid.h"
#include "packets/PacketJournal.h"
#include "timeline/CurrentValues.h"
#include "timeline/Replay.h"

#include <cstdint>
#include <deque>
#include <limits>
#include <memory>
#include <optional>

namespace pallax {

class Timeline;
struct PacketRange;
struct TimelineKeyFrame;

/// The display ticks of a recording that have new data, with the values at each, one after the
/// other. Ticks can be kept, because a join asks for some of them again.
class TickWalk {
public:
    struct State {
        TickGrid::Tick tick{0, {}};
        std::uint64_t packet = 0; ///< the latest before the tick
        CurrentValues values;
    };

    /// Before the first tick after a key frame.
    TickWalk(Timeline& timeline, const TimelineKeyFrame& from);

    /// The tick where the walk stands; null before the first and after the last.
    const State* current() const { return _isAtTick ? &_now : nullptr; }
    /// Goes on to the next tick and may keep the current one. False if there is none.
    bool next(const PacketRange& range, bool keepsCurrent);
    const std::deque<State>& kept() const { return _kept; }
    /// The display at the tick where the walk stands. Valid until the next step.
    PropertyList display() const { return _replay->displayAt(_now.tick.time); }

    /// Whether each tick after packets from `packet` on and from `time` on (in microseconds) is
    /// kept, is the current one, or comes later.
    bool reaches(std::uint64_t packet, std::int64_t time) const {
        return packet > _from && (packet > _lostPacket || time > _lostTime);
    }
    /// The latest packet that was read.
    std::uint64_t packet() const { return _replay->packet(); }
    bool hasEnded() const { return _hasEnded; }

private:
    static constexpr std::size_t kMostKept = 64;

    void leave(bool keeps);
    void lose(const State& state);
    bool stopsAt(const TickGrid::Tick& tick);

    Timeline& _timeline;
    std::unique_ptr<Replay> _replay;
    std::unique_ptr<PacketReader> _reader;
    std::optional<JournalPacket> _held; ///< comes after the current tick
    TickGrid _grid;
    State _now;
    bool _isAtTick = false;
    bool _hasEnded = false;
    std::deque<State> _kept;
    std::uint64_t _from;           ///< packet of the key frame
    std::uint64_t _lostPacket = 0; ///< of the latest tick that was passed and not kept
    std::int64_t _lostTime = std::numeric_limits<std::int64_t>::min(); ///< greatest of such ticks
};

} // namespace pallax
