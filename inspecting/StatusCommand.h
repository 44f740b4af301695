#pragma once

#include "console/ExitStatus.h"
#include "decoding/RecordingDecoder.h"
#include "host/BoundedJournal.h"
#include "knowledge/Networks.h"
#include "knowledge/Quality.h"
#include "text/Result.h"
#include "text/TimeText.h"

#include <chrono>
#include <functional>
#include <memory>
#include <optional>
#include <string>

namespace pallax {

class Clock;
class LiveSession;
class Output;
class ViewedFile;
struct NotSeen;
struct RecordedTechnology;

/// `pallax status`: the radio in a few lines.
struct StatusOptions {
    std::optional<std::string> recording; ///< or a saved snapshot; nothing: the live modem
    /// How long the live modem is received.
    std::chrono::nanoseconds duration = std::chrono::seconds(5);
    /// The technology of the recording, overriding its link type.
    const RecordedTechnology* technology = nullptr;
    std::optional<TimeText> at; ///< nothing: the end
    std::string profile{kDefaultProfile};
    bool json = false;
    std::string service = {}; ///< of the live modem; empty: the one without a name
};

class StatusCommand {
public:
    struct Environment {
        const DecoderEnvironment& decoder;
        const NetworkNames& names;
        const QualityProfile& profile;
        const Clock& zone;                                       ///< for local times
        std::function<void(const std::string& sentence)> report; ///< gets one for the user
        BoundedJournal::Limits journal = {};                     ///< for recordings that are kept
    };

    StatusCommand(const StatusOptions& options, const Environment& environment)
        : _options(options), _environment(environment) {}

    ExitStatus run(Output& output);
    /// Of the live modem, when its packets have been received.
    ExitStatus runOn(LiveSession& session, Output& output);

private:
    ExitStatus show(const Result<std::unique_ptr<ViewedFile>, NotSeen>& file, Output& output);

    const StatusOptions& _options;
    const Environment& _environment;
};

/// `StatusCommand`, wired to this machine. TemplateFailure, OutputClosed and OutputFailure leave.
ExitStatus runStatus(const StatusOptions& options);

} // namespace pallax
