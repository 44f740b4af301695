#include "telephony/Service.h"

#include "host/AsioMainQueue.h"
#include "host/SocketMessagePorts.h"
#include "telephony/RecordingSource.h"
#include "telephony/StreamSource.h"
#include "telephony/TelephonyServer.h"
#include "telephony/simulator/SimulatedSource.h"

#include <array>
#include <charconv>
#include <cmath>
#include <csignal>
#include <cstdio>
#include <memory>

namespace pallax {

namespace {

constexpr std::string_view kAsFastAsTakenText = "max";

void complain(const std::string& sentence) {
    (void)std::fprintf(stderr, "pallax: %s\n", sentence.c_str());
}

/// A factory of sources; fails at once for what no channel could play.
Result<PacketSourceFactory, HostError> sourceFactory(const ServiceOptions& options,
                                                     AsioMainQueue& queue) {
    if (options.simulation) {
        return PacketSourceFactory(
            [simulation =
                 *options.simulation]() -> Result<std::unique_ptr<PacketSource>, HostError> {
                return std::unique_ptr<PacketSource>(std::make_unique<SimulatedSource>(simulation));
            });
    }
    const std::string& path = options.recording;
    auto recording = openKnownRecording(path);
    if (!recording) {
        return recording.error();
    }
    if (path != "-") {
        return PacketSourceFactory([path] { return RecordingSource::open(path); });
    }
    const auto stream = std::make_shared<std::unique_ptr<Recording>>(std::move(recording).value());
    return PacketSourceFactory(
        [stream, &queue]() -> Result<std::unique_ptr<PacketSource>, HostError> {
            if (*stream == nullptr) {
                return HostError{"Standard input is already being played."};
            }
            return std::unique_ptr<PacketSource>(
                std::make_unique<StreamSource>(queue, std::move(*stream)));
        });
}

int serve(const ServiceOptions& options, const std::function<void()>& ready,
          SocketDirectory directory) {
    AsioMainQueue queue;
    SocketMessagePorts ports(queue, std::move(directory));
    auto factory = sourceFactory(options, queue);
    if (!factory) {
        complain(factory.error().sentence);
        return 1;
    }
    queue.onSignal({SIGINT, SIGTERM}, [&queue](int /*signal*/) { queue.stop(); });
    auto server = TelephonyServer::start({queue, ports, options.controlPortName,
                                          std::move(factory).value(), options.play, complain});
    if (!server) {
        complain(server.error().sentence);
        return 1;
    }
    if (ready) {
        ready();
    }
    queue.run();
    return 0;
}

} // namespace

std::string speedText(double speed) {
    if (std::isinf(speed)) {
        return std::string(kAsFastAsTakenText);
    }
    std::array<char, 32> text{}; // the shortest form that reads back the same needs 24
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
    const bool whole = result.ec == std::errc() && result.ptr == end;
    return whole && std::isfinite(speed) && speed > 0 ? std::optional(speed) : std::nullopt;
}

int runService(const ServiceOptions& options, const std::function<void()>& ready) {
    auto directory = SocketDirectory::open();
    if (!directory) {
        complain(directory.error().sentence);
        return 1;
    }
    return serve(options, ready, std::move(directory).value());
}

} // namespace pallax
