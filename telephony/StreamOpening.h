#pragma once

#include "host/HostError.h"
#include "host/Recording.h"
#include "telephony/Relay.h"
#include "text/Result.h"

#include <chrono>
#include <functional>
#include <memory>
#include <string>

namespace pallax {

/// How a live stream is opened, which takes until its header has come.
struct StreamOpening {
    using Opened = Result<std::unique_ptr<Recording>, HostError>;

    std::function<Opened()> open;
    /// Hears, as one sentence, that the header lets wait for itself (on another thread, for the
    /// caller's waits), and that it has come after all.
    std::function<void(const std::string& sentence)> report;
    std::chrono::milliseconds patience = Relay::kStall;
};

/// What `open` gives. It returns when that does; a stream that never begins is reported meanwhile.
StreamOpening::Opened openStream(const StreamOpening& opening);

} // namespace pallax
