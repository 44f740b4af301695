#include "telephony/Service.h"

#include "host/AsioMainQueue.h"
#include "host/Complaint.h"
#include "host/Descriptor.h"
#include "host/Interruption.h"
#include "host/SocketMessagePorts.h"
#include "telephony/RecordingSource.h"
#include "telephony/Relay.h"
#include "telephony/ServiceStatus.h"
#include "telephony/SimulatedSource.h"
#include "telephony/StreamOpening.h"
#include "telephony/StreamSource.h"
#include "telephony/TelephonyServer.h"
#include "text/Format.h"

#include <array>
#include <cerrno>
#include <charconv>
#include <cmath>
#include <csignal>
#include <cstdio>
#include <fcntl.h>
#include <memory>
#include <sys/file.h>

namespace pallax {

namespace {

constexpr std::string_view kAsFastAsTakenText = "max";

/// The service's technology, and its sources, one for each channel.
struct Program {
    std::string technology;
    PacketSourceFactory makeSource;
    std::shared_ptr<Relay> relay; ///< null unless the source is a live stream
    Descriptor reading{};         ///< keeps recorders from replacing the recording being played
};

/// A recording that is still being written is played anyway.
Descriptor lockForReading(const std::string& path) {
    Descriptor file(::open(path.c_str(), O_RDONLY | O_CLOEXEC | O_NONBLOCK));
    (void)::flock(file.number(), LOCK_SH | LOCK_NB);
    return file;
}

Result<std::unique_ptr<PacketSource>, HostError> takeOnce(std::unique_ptr<PacketSource>& stream,
                                                          const std::string& name) {
    if (stream == nullptr) {
        return HostError{formatText("%@ is already being played.", {name})};
    }
    return std::move(stream);
}

/// Fails at once if no channel could play it. `relayEnded` is called after a live stream's end.
Result<Program, HostError> programOf(const ServiceOptions& options, AsioMainQueue& queue,
                                     std::function<void(bool isOrderly)> relayEnded) {
    if (options.simulation) {
        const SimulationOptions simulation = *options.simulation;
        return Program{std::string(simulation.technology->identifier),
                       [simulation]() -> Result<std::unique_ptr<PacketSource>, HostError> {
                           return std::unique_ptr<PacketSource>(
                               std::make_unique<SimulatedSource>(simulation));
                       },
                       nullptr};
    }
    const auto open = [&options] {
        return openKnownRecording({options.recording, options.inputName, complain});
    };
    auto recording = options.relay ? openStream({open, complain}) : open();
    if (!recording) {
        return recording.error();
    }
    Program program;
    program.technology = (*recording)->technology()->identifier;
    if (!(*recording)->isStream()) {
        program.makeSource = [path = options.recording] { return RecordingSource::open(path); };
        program.reading = lockForReading(options.recording);
        return program;
    }
    const auto stream = std::make_shared<std::unique_ptr<PacketSource>>(
        std::make_unique<StreamSource>(queue, std::move(recording).value()));
    if (!options.relay) {
        const std::string path = options.recording == "-" ? "Standard input" : options.recording;
        const std::string name = options.inputName.empty() ? path : options.inputName;
        program.makeSource = [stream, name] { return takeOnce(*stream, name); };
        return program;
    }
    Relay::Setup relay{queue, queue, std::move(*stream), complain, std::move(relayEnded)};
    relay.patience = options.relayPatience;
    program.relay = std::make_shared<Relay>(std::move(relay));
    program.makeSource = [relay =
                              program.relay]() -> Result<std::unique_ptr<PacketSource>, HostError> {
        return relay->source();
    };
    return program;
}

/// The buffering and the pace of the channels.
TelephonyServer::Setup serverSetup(const ServiceOptions& options, AsioMainQueue& queue,
                                   SocketMessagePorts& ports, const Program& program) {
    TelephonyServer::Setup setup{queue,        ports,   options.controlPortName, program.makeSource,
                                 options.play, complain};
    setup.technology = program.technology;
    if (options.relay) {
        setup.options.speed = PlayOptions::kAsFastAsTaken; // the stream sets the pace
        setup.options.live = true;
    }
    const bool clientSetsPace = std::isinf(options.play.speed) && !options.relay;
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
    const auto program = programOf(options, queue, [&](bool isOrderly) {
        status = isOrderly ? 0 : 1;
        lastWords.begin(*server);
    });
    if (!program) {
        complain(program.error().sentence);
        return 1;
    }
    queue.onSignal({SIGINT, SIGTERM, SIGHUP}, [&queue](int /*signal*/) { queue.stop(); });
    auto started = TelephonyServer::start(serverSetup(options, queue, ports, *program));
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
    auto directory = SocketDirectory::open();
    if (!directory) {
        complain(directory.error().sentence);
        return 1;
    }
    return serve(options, ready, std::move(directory).value());
}

int printServiceStatus() {
    auto directory = SocketDirectory::open();
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
    const std::string text = statusText(*status);
    const bool isPrinted =
        std::fwrite(text.data(), 1, text.size(), stdout) == text.size() && std::fflush(stdout) == 0;
    if (isPrinted || errno == EPIPE) { // a reader that has gone has seen enough
        return 0;
    }
    complain("Standard output cannot be written.");
    return 1;
}

} // namespace pallax
