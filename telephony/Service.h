#pragma once

#include "sources/Source.h"
#include "telephony/ControlMessages.h"
#include "telephony/PacketPlayer.h"

#include <chrono>
#include <functional>
#include <optional>
#include <string>
#include <vector>

namespace pallax {

/// The options of a telephony service.
struct ServiceOptions {
    static constexpr std::chrono::seconds kRelayPatience{10};

    Source source; ///< not the service's modem; a stream is played once, to the first channel
    PlayOptions play = {};
    std::string controlPortName = std::string(kTelephonyControlPort);
    /// The source is a live stream: every client gets it live, and the service ends with it.
    bool relay = false;
    /// How long a relayed stream waits for its first client.
    std::chrono::nanoseconds relayPatience = kRelayPatience;
    /// Every client sets its own pace and loses nothing, at any speed.
    bool lossless = false;
    std::string name = {}; ///< empty: it has none
};

/// "1.5", "max": a speed as in the options.
std::string speedText(double speed);
/// Nothing unless the text is a positive number or "max".
std::optional<double> parseSpeed(const std::string& text);

/// Runs the service until SIGINT or SIGTERM, or the regular end of the relayed stream, then returns
/// 0. On failure, prints a sentence on standard error and returns 1. `ready`, if any, is called
/// once clients can connect.
int runService(const ServiceOptions& options, const std::function<void()>& ready = {});

/// Prints the status of the running service with this name, or of the one without a name. If there
/// is none, prints a sentence on standard error and returns 1.
int printServiceStatus(const std::string& name);
/// Prints the names of the running services that have one, a line each. On failure, prints a
/// sentence on standard error and returns 1.
int printServiceList();

} // namespace pallax
