#pragma once

#include "cli/Options.h"

#include <string>

namespace pallax {

/// What the service should do: play, simulate, relay, watch a modem or print its status, exactly
/// one of them.
struct ServiceRequest {
    ServiceOptions options;
    bool status = false;
};

void addService(CLI::App& app, ServiceRequest& request);

/// The options of the service, or an error.
ParsedOptions serviceOptions(const ServiceRequest& request);

} // namespace pallax
