#pragma once

#include "host/PortFrame.h"
#include "telephony/CodeFilter.h"
#include "telephony/PacketSource.h"
#include "text/Date.h"
#include "timeline/StampSequence.h"

#include <chrono>
#include <functional>
#include <limits>
#include <memory>
#include <optional>
#include <string>

namespace pallax {

class MainQueue;
class PacketSink;

struct PlayOptions {
    static constexpr double kAsFastAsTaken = std::numeric_limits<double>::infinity();

    double speed = 1.0; ///< positive; 2 plays in half the time
    bool loop = false;  ///< begins again at the end, with ever later source times
    /// The receiver's display ticks, which a last clock frame is to reach.
    std::chrono::nanoseconds displayInterval = std::chrono::seconds(2);
    /// The source is a live stream, whose stamps set neither the pace nor the receiver's ticks.
    bool live = false;
};

/// Plays a source into a sink with the source's own timing. The player drops nothing: one chunk is
/// under way at a time, so a sink that waits for its receiver slows the player.
///
/// Every packet goes with its source time. The first packet's time goes ahead of all, even when
/// that packet is not wanted; while nothing is due, the running time goes at least every half
/// second; after the last packet comes the time of the next display tick, then End. Where the
/// stamps step back, playing goes on at once from there. Odd stamps are remarked on, ahead of their
/// packets, wanted or not.
class PacketPlayer {
public:
    using SteadyNow = std::function<std::chrono::steady_clock::time_point()>;

    static constexpr std::chrono::milliseconds kClockInterval{500};

    struct Setup {
        MainQueue& queue;
        PacketSource& source;
        PacketSink& sink;
        PlayOptions options;
        /// Called once at the end, with the source's failure or an empty text.
        std::function<void(const std::string& failure)> ended;
        SteadyNow steadyNow = std::chrono::steady_clock::now;
    };

    /// What the setup refers to outlives the player.
    explicit PacketPlayer(Setup setup);

    /// Starts, or, while it plays, takes the new filter for what comes.
    void play(CodeFilter filter);

private:
    enum class Progress { Go, Wait };
    void step();
    Progress fetch();
    Progress waitUntilDue(Time time);
    Progress startRound();
    void followStamp();
    void sendPacket();
    void finish();
    void flushThen(void (PacketPlayer::*next)());
    void tellEnd();
    void tellRunningTime();
    FrameHeader headerOf(FrameKind kind, std::optional<Time> time) const;
    void writeClock(Time time);
    void writeRemark(const StampRemark& remark);
    std::chrono::nanoseconds wallDelayUntil(Time time) const;
    Time nextTick() const;
    std::function<void()> guarded(void (PacketPlayer::*member)());

    Setup _setup;
    std::optional<CodeFilter> _filter;
    std::optional<PacketSource::Packet> _packet; // fetched, not yet sent; its time is shifted
    std::uint32_t _packetNumber = 0;             // of that packet in the source, from 1
    StampSequence _stamps;                       // of the packets, shifted
    std::chrono::nanoseconds _shift{0};          // of this round's stamps
    bool _newRound = true;
    bool _toldOutOfRange = false;
    bool _sourceEnded = false;
    std::chrono::steady_clock::time_point _started; // the present stretch of stamps
    std::shared_ptr<PacketPlayer*> _alive;          // blocks hold it weakly
};

} // namespace pallax
