#pragma once

#include "console/ExitStatus.h"
#include "decoding/RecordingDecoder.h"
#include "knowledge/Networks.h"
#include "knowledge/Quality.h"
#include "text/TimeText.h"

#include <functional>
#include <optional>
#include <string>

namespace pallax {

class Clock;
class Output;
struct RecordedTechnology;

/// `pallax status`: the radio in a few lines.
struct StatusOptions {
    std::string recording; ///< or a saved snapshot
    /// The technology of the recording, overriding its link type.
    const RecordedTechnology* technology = nullptr;
    std::optional<TimeText> at; ///< nothing: the end
    std::string profile{kDefaultProfile};
    bool json = false;
};

class StatusCommand {
public:
    struct Environment {
        const DecoderEnvironment& decoder;
        const NetworkNames& names;
        const QualityProfile& profile;
        const Clock& zone;                                       ///< for local times
        std::function<void(const std::string& sentence)> report; ///< gets one for the user
    };

    StatusCommand(const StatusOptions& options, const Environment& environment)
        : _options(options), _environment(environment) {}

    ExitStatus run(Output& output);

private:
    const StatusOptions& _options;
    const Environment& _environment;
};

/// `StatusCommand`, wired to this machine. TemplateFailure, OutputClosed and OutputFailure leave.
ExitStatus runStatus(const StatusOptions& options);

} // namespace pallax
