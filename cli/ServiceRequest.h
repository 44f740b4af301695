#pragma once

#include "cli/Options.h"

#include <string>

namespace pallax {

/// What the service is to do, one of them.
struct ServiceRequest {
    ServiceOptions options;
    std::string relayed; ///< a stream; empty where none is asked for
    bool status = false;
};

void addService(CLI::App& app, ServiceRequest& request);

/// What to run, or why it cannot be.
ParsedOptions serviceOptions(const ServiceRequest& request);

} // namespace pallax
