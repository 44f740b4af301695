#pragma once

#include "host/PortFrame.h"
#include "packets/StampSequence.h"
#include "sources/CodeFilter.h"
#include "sources/PacketSource.h"
#include "text/Date.h"

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
    bool loop = false;  ///< restarts at the end, with source times that keep increasing
    /// The receiver's tick interval; a last clock frame reaches the next tick.
    std::chrono::nanoseconds displayInterval = std::chrono::seconds(2);
    /// The source is a live stream: its stamps set neither the pace nor the receiver's ticks.
    bool live = false;
};

/// Plays a source into a sink at the pace of the stamps. The player drops nothing: it sends one
/// chunk at a time, so a sink that waits for its receiver slows the player down.
///
/// Every packet carries its source time, and may come a few milliseconds late. The first packet's
/// time is sent before everything else, even if that packet is not wanted. While no packet is due,
/// the current time is sent at least every half second. After the last packet come the time of the
/// next display tick and End. When the stamps step back, playing continues at once. A remark about
/// an odd stamp precedes its packet, wanted or not.
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
        /// Called once when the source has another technology, after what came before has gone to
        /// the sink; nothing more is played.
        std::function<void()> technologyChanged = [] {};
    };

    /// The references in the setup must outlive the player.
    explicit PacketPlayer(Setup setup);

    /// Starts, or changes the filter for the following packets.
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
    void tellNewTechnology();
    void tellRunningTime();
    FrameHeader headerOf(FrameKind kind, std::optional<Time> time) const;
    void writeClock(Time time);
    void writeRemark(const StampRemark& remark);
    std::chrono::nanoseconds wallDelayUntil(Time time) const;
    Time nextTick() const;
    std::function<void()> guarded(void (PacketPlayer::*member)());

    Setup _setup;
    std::optional<CodeFilter> _filter;
    std::optional<PacketSource::Packet> _packet; // read, not yet sent; its time is shifted
    std::uint32_t _packetNumber = 0;             // its number in the source, from 1
    StampSequence _stamps;                       // of the packets, shifted
    std::chrono::nanoseconds _shift{0};          // of the stamps in this round
    bool _newRound = true;
    bool _toldOutOfRange = false;
    bool _sourceEnded = false;
    std::chrono::steady_clock::time_point _started; // the current stretch of stamps
    std::shared_ptr<PacketPlayer*> _alive;          // held weakly by blocks
};

} // namespace pallax
