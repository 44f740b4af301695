#pragma once

#include "host/Descriptor.h"
#include "host/HostError.h"
#include "text/Result.h"

#include <cstdint>
#include <string>

namespace pallax {

/// A socket that clients of the network, or of this machine alone, can connect to.
struct Listener {
    Descriptor socket;
    std::string address;
    std::uint16_t port = 0;
    bool isLoopback = false; ///< only this machine can connect

    /// `address` is one in numbers (127.0.0.1, ::1, 0.0.0.0); port 0 takes one that is free.
    static Result<Listener, HostError> at(const std::string& address, std::uint16_t port);
};

} // namespace pallax
