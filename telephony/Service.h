#pragma once

#include "telephony/ControlMessages.h"
#include "telephony/PacketPlayer.h"
#include "telephony/simulator/Simulation.h"

#include <functional>
#include <optional>
#include <string>
#include <vector>

namespace pallax {

/// What the telephony service is to serve.
struct ServiceOptions {
    std::string recording; ///< path, "-" for standard input (played once, to the first channel)
    PlayOptions play;
    std::string controlPortName = std::string(kTelephonyControlPort);
    std::optional<SimulationOptions> simulation = {}; ///< instead of a recording
};

/// "1.5", "max": how options say a speed.
std::string speedText(double speed);
/// Nothing for what is no positive number and not "max".
std::optional<double> parseSpeed(const std::string& text);

/// Runs the service until SIGINT or SIGTERM, then returns 0. A failure is one sentence on
/// standard error and the result 1. `ready`, if any, is called once clients can connect.
int runService(const ServiceOptions& options, const std::function<void()>& ready = {});

} // namespace pallax
