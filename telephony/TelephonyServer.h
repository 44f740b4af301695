#pragma once

#include "host/HostError.h"
#include "sources/PacketSource.h"
#include "telephony/ControlMessages.h"
#include "telephony/PacketPlayer.h"
#include "telephony/ServiceStatus.h"
#include "text/Bytes.h"
#include "text/Result.h"

#include <chrono>
#include <cstddef>
#include <functional>
#include <map>
#include <memory>
#include <optional>
#include <string>

namespace pallax {

class AsioMainQueue;
class LocalMessagePort;
class RepeatingTimer;
class ServedChannel;
class SocketMessagePorts;
class TimerScheduler;

/// The stand-in telephony service: a control port on which clients request log channels, and the
/// channels, each with its own source and port. Destruction ends all of them.
class TelephonyServer {
public:
    using SteadyNow = std::function<std::chrono::steady_clock::time_point()>;

    /// The bytes that may wait for a slow client if packets are paced.
    static constexpr std::size_t kMostWaiting = std::size_t{1} << 20U;

    /// The maximum number of channels. For one more, the oldest channel that was never started is
    /// closed; if all have started, the client is refused.
    static constexpr std::size_t kMostChannels = 64;

    /// How long a channel may stay unstarted before it is closed.
    static constexpr std::chrono::seconds kMostIdle{10};

    struct Setup {
        AsioMainQueue& queue;
        SocketMessagePorts& ports;
        std::string controlPortName = std::string(kTelephonyControlPort);
        PacketSourceFactory makeSource;
        PlayOptions options;
        /// Receives a sentence for each problem with a source or a client while serving.
        std::function<void(const std::string& sentence)> report;
        /// The technology of the sources, for the status.
        std::string technology = {};
        /// See SocketSink; nothing: clients set their own pace and lose nothing.
        std::optional<std::size_t> mostWaiting = std::nullopt;
        SteadyNow steadyNow = std::chrono::steady_clock::now;
        TimerScheduler* timers = nullptr; ///< null: the queue's
    };

    /// Fails if the control port cannot be created, or a living service has this name.
    static Result<std::unique_ptr<TelephonyServer>, HostError> start(Setup setup);
    ~TelephonyServer();
    TelephonyServer(const TelephonyServer&) = delete;
    TelephonyServer& operator=(const TelephonyServer&) = delete;

    /// Releases the control port, so another service can take it; the channels stay.
    void stopListening() { _control.reset(); }
    std::size_t channelCount() const { return _channels.size(); }
    /// Bytes sent that their clients have not read yet.
    std::size_t untaken() const;
    ServiceStatus status() const;

private:
    struct Channel {
        std::unique_ptr<ServedChannel> served;
        std::chrono::steady_clock::time_point opened;
    };
    using Channels = std::map<int, Channel>; // by number, so the oldest first

    explicit TelephonyServer(Setup setup);
    std::optional<ByteBuffer> answer(Bytes request);
    bool isOwnPort(const std::string& name) const;
    LogChannel createLogChannel(const std::string& localPortName);
    void removeChannel(int number);
    void closeIdle();
    /// False if there are too many channels and none can be closed.
    bool makeRoom();
    void close(Channels::iterator idle);
    void report(const std::string& sentence) const;

    Setup _setup;
    std::unique_ptr<LocalMessagePort> _control;
    Channels _channels;
    int _latestNumber = 0;
    std::chrono::steady_clock::time_point _started;
    std::int64_t _sentBefore = 0;    // to clients that have left
    std::int64_t _droppedBefore = 0; // likewise
    std::unique_ptr<RepeatingTimer> _looks;
};

} // namespace pallax
