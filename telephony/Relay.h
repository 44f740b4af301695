#pragma once

#include "telephony/PacketSource.h"

#include <chrono>
#include <cstdint>
#include <functional>
#include <memory>
#include <optional>
#include <string>
#include <vector>

namespace pallax {

class MainQueue;
class RepeatingTimer;
class TimerScheduler;

/// Hands a live stream on to any number of log channels: each packet goes, when it comes, to the
/// sources that have begun. At first the stream waits for its first source, for a while. From then
/// on it is taken whether anybody listens or not, so that the stream's writer never waits. A stall,
/// the end and a stream that breaks off are told apart.
class Relay {
public:
    using SteadyNow = std::function<std::chrono::steady_clock::time_point()>;

    /// A stream that gives nothing for so long has stalled.
    static constexpr std::chrono::seconds kStall{10};

    struct Setup {
        MainQueue& queue;
        TimerScheduler& timers;
        std::unique_ptr<PacketSource> stream;
        /// Hears, as one sentence, how the stream fares.
        std::function<void(const std::string& sentence)> report;
        /// Called once after the stream's end; `isOrderly` when that lay between two packets.
        std::function<void(bool isOrderly)> ended;
        SteadyNow steadyNow = std::chrono::steady_clock::now;
        /// How long the stream waits for its first source to begin.
        std::chrono::nanoseconds patience{0};
    };

    /// What the setup refers to outlives the relay.
    explicit Relay(Setup setup);
    ~Relay();
    Relay(const Relay&) = delete;
    Relay& operator=(const Relay&) = delete;

    /// A source of what comes from its first `next` on. It may outlive the relay, and ends then.
    std::unique_ptr<PacketSource> source();

private:
    struct Feed;
    class Source;

    void begin();
    void step();
    void handOn(const PacketSource::Packet& packet);
    void finish();
    void look();
    /// A block that does it while the relay lives.
    std::function<void()> guarded(void (Relay::*member)());
    /// The feeds whose sources live.
    std::vector<std::shared_ptr<Feed>> feeds();

    Setup _setup;
    std::string _technology;
    std::vector<std::weak_ptr<Feed>> _feeds;
    std::uint64_t _packets = 0;
    bool _isWaiting = true; // for the first source
    std::chrono::steady_clock::time_point _heard;
    bool _stalled = false;
    bool _ended = false;
    std::unique_ptr<RepeatingTimer> _looks;
    std::shared_ptr<Relay*> _alive; // blocks hold it weakly
};

} // namespace pallax
