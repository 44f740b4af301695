#pragma once

#include "cli/Options.h"

#include <string>

namespace pallax {

/// What the service should do: play, simulate, relay, watch a modem, print its status or list those
/// that run, exactly one of them.
struct ServiceRequest {
    ServiceOptions options;
    bool status = false;
    bool list = false;
};

void addService(CLI::App& app, ServiceRequest& request);

/// The options of the service, or an error.
ParsedOptions serviceOptions(const ServiceRequest& request);

} // namespace pallax
