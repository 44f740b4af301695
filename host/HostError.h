#pragma once

#include <string>

namespace pallax {

/// Why something of the host could not be had: one clear sentence for the user, without a newline.
struct HostError {
    std::string sentence;
};

} // namespace pallax
