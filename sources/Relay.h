#pragma once

#include "sources/PacketSource.h"

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

/// Distributes a live stream to any number of log channels: each packet goes at once to all started
/// sources. The stream first waits for its first source, for a limited time. From then on it is
/// read even without sources, so its writer never waits. Stalls, a regular end and a truncated or
/// corrupt stream are reported separately.
class Relay {
public:
    using SteadyNow = std::function<std::chrono::steady_clock::time_point()>;

    /// A stream that is silent for this long has stalled.
    static constexpr std::chrono::seconds kStall{10};

    struct Setup {
        MainQueue& queue;
        TimerScheduler& timers;
        std::unique_ptr<PacketSource> stream;
        /// Receives a sentence for each change of the stream's state.
        std::function<void(const std::string& sentence)> report;
        /// Called once after the stream's end; `isOrderly` if it was between two packets.
        std::function<void(bool isOrderly)> ended;
        SteadyNow steadyNow = std::chrono::steady_clock::now;
        /// How long the stream waits for its first source to start.
        std::chrono::nanoseconds patience{0};
    };

    /// The references in the setup must outlive the relay.
    explicit Relay(Setup setup);
    ~Relay();
    Relay(const Relay&) = delete;
    Relay& operator=(const Relay&) = delete;

    /// A source of the packets from its first `next` on. It may outlive the relay, which ends it.
    std::unique_ptr<PacketSource> source();

private:
    struct Feed;
    class Source;

    void begin();
    void step();
    void handOn(const PacketSource::Packet& packet);
    void finish();
    void look();
    /// A block that calls the member unless the relay has been destroyed.
    std::function<void()> guarded(void (Relay::*member)());
    /// The feeds of the living sources.
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
    std::shared_ptr<Relay*> _alive; // held weakly by blocks
};

} // namespace pallax
