#pragma once

#include "host/HostError.h"
#include "host/Recording.h"
#include "sources/Relay.h"
#include "text/Result.h"

#include <chrono>
#include <functional>
#include <memory>
#include <string>

namespace pallax {

/// Opens a live stream, which takes until its header has arrived.
struct StreamOpening {
    using Opened = Result<std::unique_ptr<Recording>, HostError>;

    std::function<Opened()> open;
    /// Receives a sentence when the header is late (on another thread, because the caller is
    /// blocked), and when it has arrived after all.
    std::function<void(const std::string& sentence)> report;
    std::chrono::milliseconds patience = Relay::kStall;
};

/// Returns the result of `open`, when it returns; reports a stream that does not start.
StreamOpening::Opened openStream(const StreamOpening& opening);

} // namespace pallax
