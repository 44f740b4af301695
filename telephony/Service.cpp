#include "telephony/Service.h"

#include "host/AsioMainQueue.h"
#include "host/Complaint.h"
#include "host/Interruption.h"
#include "host/SocketMessagePorts.h"
#include "sources/SourceFactory.h"
#include "telephony/NamedServices.h"
#include "telephony/ServiceStatus.h"
#include "telephony/TelephonyServer.h"

#include <array>
#include <cerrno>
#include <charconv>
#include <cmath>
#include <csignal>
#include <cstdio>
#include <memory>

namespace pallax {

namespace {

constexpr std::string_view kAsFastAsTakenText = "max";

/// The buffering and the pace of the channels.
TelephonyServer::Setup serverSetup(const ServiceOptions& options, AsioMainQueue& queue,
                                   SocketMessagePorts& ports, const OpenSource& source) {
    TelephonyServer::Setup setup{queue,        ports,   options.controlPortName, source.makeReader,
                                 options.play, complain};
    setup.technology = source.technology;
    const bool isLive = options.relay || pallax::isLive(options.source);
    if (isLive) {
        setup.options.speed = PlayOptions::kAsFastAsTaken; // the source sets the pace
        setup.options.live = true;
    }
    const bool clientSetsPace = std::isinf(options.play.speed) && !isLive;
    if (!options.lossless && !clientSetsPace) {
        setup.mostWaiting = TelephonyServer::kMostWaiting;
    }
    return setup;
}

/// Stops the queue once the clients have received the end and left, or have not read for too long:
/// a client that loses the service drops what it has not yet processed. No new clients are served,
/// so the next service can start as soon as a client has received the end.
class LastWords {
public:
    explicit LastWords(AsioMainQueue& queue) : _queue(queue) {}

    void begin(TelephonyServer& server) {
        server.stopListening();
        _looks = _queue.scheduleRepeating(kLook, [this, &server] {
            const std::size_t untaken = server.untaken();
            _waited = untaken < _untaken ? kLook : _waited + kLook;
            _waitedAtAll += kLook;
            _untaken = untaken;
            const bool haveAllGone = server.channelCount() == 0;
            if (haveAllGone || _waited >= kPatience || _waitedAtAll >= kMostPatience) {
                _queue.stop();
            }
        });
    }

private:
    static constexpr std::chrono::milliseconds kLook{20};
    static constexpr std::chrono::milliseconds kPatience{2000}; // without any reading
    static constexpr std::chrono::milliseconds kMostPatience{30000};

    AsioMainQueue& _queue;
    std::unique_ptr<RepeatingTimer> _looks;
    std::chrono::milliseconds _waited{0}; // since the last reading
    std::chrono::milliseconds _waitedAtAll{0};
    std::size_t _untaken = 0;
};

int serve(const ServiceOptions& options, const std::function<void()>& ready,
          SocketDirectory directory) {
    directory.removeStaleSockets();
    const Interruption interruption; // for messages that are not read
    AsioMainQueue queue;
    SocketMessagePorts ports(queue, std::move(directory));
    LastWords lastWords(queue);
    std::unique_ptr<TelephonyServer> server;
    int status = 0;
    SourceSurroundings surroundings{queue, complain};
    if (options.relay) {
        surroundings.relaying = {options.relayPatience, [&](bool isOrderly) {
                                     status = isOrderly ? 0 : 1;
                                     lastWords.begin(*server);
                                 }};
    }
    const auto source = openSource(options.source, std::move(surroundings));
    if (!source) {
        complain(source.error().sentence);
        return 1;
    }
    queue.onSignal({SIGINT, SIGTERM, SIGHUP}, [&queue](int /*signal*/) { queue.stop(); });
    auto started = TelephonyServer::start(serverSetup(options, queue, ports, *source));
    if (!started) {
        complain(started.error().sentence);
        return 1;
    }
    server = std::move(started).value();
    if (ready) {
        ready();
    }
    queue.run();
    return status;
}

/// Prints on standard output.
int print(const std::string& text) {
    const bool isPrinted =
        std::fwrite(text.data(), 1, text.size(), stdout) == text.size() && std::fflush(stdout) == 0;
    if (isPrinted || errno == EPIPE) { // a reader that has gone has seen enough
        return 0;
    }
    complain("Standard output cannot be written.");
    return 1;
}

} // namespace

std::string speedText(double speed) {
    if (std::isinf(speed)) {
        return std::string(kAsFastAsTakenText);
    }
    std::array<char, 32> text{}; // the shortest exact form needs up to 24
    const auto result = std::to_chars(text.data(), text.data() + text.size(), speed);
    return {text.data(), result.ptr};
}

std::optional<double> parseSpeed(const std::string& text) {
    if (text == kAsFastAsTakenText) {
        return PlayOptions::kAsFastAsTaken;
    }
    double speed = 0;
    const char* end = text.data() + text.size();
    const auto result = std::from_chars(text.data(), end, speed);
    constexpr double kLeast = 1e-6; // one second in eleven days
    const bool whole = result.ec == std::errc() && result.ptr == end;
    return whole && std::isfinite(speed) && speed >= kLeast ? std::optional(speed) : std::nullopt;
}

int runService(const ServiceOptions& options, const std::function<void()>& ready) {
    auto directory = SocketDirectory::open(options.name);
    if (!directory) {
        complain(directory.error().sentence);
        return 1;
    }
    return serve(options, ready, std::move(directory).value());
}

int printServiceStatus(const std::string& name) {
    auto directory = SocketDirectory::open(name);
    if (!directory) {
        complain(directory.error().sentence);
        return 1;
    }
    AsioMainQueue queue;
    SocketMessagePorts ports(queue, std::move(directory).value());
    const auto status = askStatus(ports, std::string(kTelephonyControlPort));
    if (!status) {
        complain(status.error().sentence);
        return 1;
    }
    return print(statusText(*status));
}

int printServiceList() {
    std::string text;
    for (const std::string& name : runningServices()) {
        text += name + '\n';
    }
    return print(text);
}

} // namespace pallax
