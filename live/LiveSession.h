#pragma once

#include "decoding/RequiredTemplates.h"
#include "host/BuildBundle.h"
#include "host/SocketDirectory.h"
#include "link/Settings.h"
#include "live/LiveTimeline.h"

#include <chrono>
#include <functional>
#include <memory>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace pallax {

/// The live channel of this machine as a timeline.
class LiveSession {
public:
    static constexpr std::string_view kNoPacket = "No packet has come from the live modem.";

    struct Setup {
        const Settings& settings;
        const RecordedTechnology* wanted = nullptr; ///< as for PacketReceiver
        std::optional<std::chrono::nanoseconds> duration = {};
        std::function<void(Timeline& timeline)> indexed = [](Timeline&) {}; ///< as for LiveTimeline
    };

    /// The settings must outlive the session.
    explicit LiveSession(Setup setup);

    /// Receives packets until a signal, the end of the source or of the duration, a fatal record,
    /// or a failure, whose sentence it returns. Says on standard error what it waits for.
    /// TemplateFailure and exceptions of the functions pass through. Call it once.
    std::optional<std::string> run();

    /// Null if no packet has come.
    Timeline* timeline() { return _timeline ? _timeline->timeline() : nullptr; }
    /// Sentences about what is missing; empty if all is well.
    std::vector<std::string> notes() const {
        return _timeline ? _timeline->notes() : std::vector<std::string>();
    }

private:
    std::optional<std::string> receive(SocketDirectory directory);

    Setup _setup;
    RequiredTemplates _resources;
    BuildBundle _bundle;
    std::unique_ptr<LiveTimeline> _timeline;
};

} // namespace pallax
