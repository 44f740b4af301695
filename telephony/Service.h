#pragma once

#include "simulator/Simulation.h"
#include "telephony/ControlMessages.h"
#include "telephony/PacketPlayer.h"

#include <chrono>
#include <functional>
#include <optional>
#include <string>
#include <vector>

namespace pallax {

/// What the telephony service is to serve.
struct ServiceOptions {
    static constexpr std::chrono::seconds kRelayPatience{10};

    /// Path, "-" for standard input; a stream is played once, to the first channel.
    std::string recording;
    std::string inputName = {}; ///< what sentences call standard input; empty: that
    PlayOptions play;
    std::string controlPortName = std::string(kTelephonyControlPort);
    /// The recording is a live stream: it goes on to every client as it comes, and the service
    /// ends with it.
    bool relay = false;
    /// How long what is relayed waits for its first client.
    std::chrono::nanoseconds relayPatience = kRelayPatience;
    /// Every client sets its own pace and loses nothing, whatever the speed.
    bool lossless = false;
    std::optional<SimulationOptions> simulation = {}; ///< instead of a recording
};

/// "1.5", "max": how options say a speed.
std::string speedText(double speed);
/// Nothing for what is no positive number and not "max".
std::optional<double> parseSpeed(const std::string& text);

/// Runs the service until SIGINT or SIGTERM, or the orderly end of what it relays, then returns 0.
/// A failure is one sentence on standard error and the result 1. `ready`, if any, is called once
/// clients can connect.
int runService(const ServiceOptions& options, const std::function<void()>& ready = {});

/// Prints what the running service says of itself. Without one, a sentence on standard error and
/// the result 1.
int printServiceStatus();

} // namespace pallax
