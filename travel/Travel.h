#pragma once

#include "query/Functions.h"
#include "text/TimeText.h"
#include "timeline/Moment.h"
#include "timeline/Search.h"

#include <chrono>
#include <cstdint>
#include <functional>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace pallax {

/// Which instant of a timeline a screen shows: the present, or an earlier or later one that is held
/// or plays on. The present goes on meanwhile.
class Travel {
public:
    struct Surroundings {
        /// Null while there is none.
        std::function<Timeline*()> timeline;
        /// The latest instant that the source has reached.
        std::function<std::uint64_t()> present;
        /// The time of the present.
        std::function<Time()> now;
        /// Measures how long an instant has been shown while time plays on.
        std::function<std::chrono::steady_clock::time_point()> steadyNow;
        ZoneRule zone;
        QueryKnowledge knowledge = {};
        /// Told of long searches; false stops one.
        SearchProgress progress = {};
    };
    /// Why something could not be done, as a sentence; nothing if it was done.
    using Refusal = std::optional<std::string>;

    enum class Direction { Back, Forward };

    explicit Travel(Surroundings surroundings) : _surroundings(std::move(surroundings)) {}

    /// Whether another instant than the present is shown.
    bool isAway() const { return _instant.has_value(); }
    bool isPlaying() const { return _playing.has_value(); }
    /// What is shown.
    Moment moment() const;

    /// Holds what is shown; if it is held, plays on from there.
    Refusal holdOrPlay();
    /// A display tick, an event, or a length of time from the shown instant. Holds there.
    Refusal stepTick(Direction direction);
    Refusal stepEvent(Direction direction);
    Refusal stepTime(std::chrono::nanoseconds distance);
    Refusal toStart();
    /// To the present or, from there, to the end of what is known.
    Refusal toEnd();
    Refusal toInstant(std::uint64_t instant);
    /// Where a share of the time from the earliest to the latest instant has passed.
    Refusal toShare(double share);
    /// To a time ("14:03") or where a condition becomes true next ("rrc_state = 'CELL_DCH'").
    Refusal goTo(std::string_view text);
    /// Where the latest condition becomes true next, or became true before.
    Refusal findAgain(Direction direction);
    /// How many conditions the user has gone to.
    std::size_t conditions() const { return _conditions; }
    /// Shows the present.
    void release();
    /// Forgets all instants: the timeline is another one.
    void reset();

    /// Marks the shown instant.
    Refusal mark();
    std::optional<std::uint64_t> marked() const { return _marked; }

    /// Plays twice or half as fast.
    void faster();
    void slower();
    /// "2x", "1/4x".
    std::string speedText() const;
    /// While time plays: shows what it has reached. False if that is what was shown before.
    bool playOn();

    /// The local time of an instant: "22:14:06"; empty if the packets are gone.
    std::string clock(std::uint64_t instant) const;
    /// The time of the shown instant; nothing if there is no packet.
    std::optional<Time> time() const;
    /// "held, 12 s behind", "playing 2x, 3 min ahead"; empty at the present.
    std::string words() const;
    /// Where an instant lies between the earliest and the latest, from 0 to 1.
    double shareOf(std::uint64_t instant) const;

private:
    /// From when on time plays, and where.
    struct Playing {
        std::chrono::steady_clock::time_point since;
        Time from;
    };

    /// The timeline, if it has a packet.
    Timeline* timeline() const;
    std::uint64_t shown() const;
    void hold(std::uint64_t instant);
    Refusal goToTime(const TimeText& text);
    Refusal findFrom(Direction direction);
    void setSpeed(int exponent);
    Time playedTo() const;
    void skipPause(std::uint64_t before, Time reached);

    Surroundings _surroundings;
    std::optional<std::uint64_t> _instant; ///< nothing: the present
    std::optional<Playing> _playing;
    int _speed = 0; ///< a power of two
    std::optional<std::uint64_t> _marked;
    std::string _condition; ///< the latest
    std::size_t _conditions = 0;
};

} // namespace pallax
