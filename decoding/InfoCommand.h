#pragma once

#include "console/ExitStatus.h"
#include "decoding/RecordingSummary.h"
#include "host/Recording.h"
#include "host/RecordingParts.h"
#include "platform/Clock.h"

#include <functional>
#include <map>
#include <string>
#include <string_view>
#include <vector>

namespace pallax {

class Output;
class Resources;
struct Snapshot;

/// `pallax info`: what recordings hold.
struct InfoOptions {
    std::vector<std::string> files;
    bool json = false;
};

class InfoCommand {
public:
    struct Environment {
        const Resources& resources;
        const Clock& zone; ///< for local times
        std::function<Recording::OpenResult(const std::string& path)> open;
        std::function<void(std::string_view sentence)> report; ///< gets one for the user
    };

    InfoCommand(const InfoOptions& options, const Environment& environment)
        : _options(options), _environment(environment) {}

    /// Describes one file after the other, the numbered parts of a recording as one; each is
    /// written before the next is opened. A file that cannot be read further is described up to
    /// there.
    ExitStatus run(Output& output);

private:
    ExitStatus describe(const PartPaths& parts, Output& output);
    ExitStatus describe(Recording& recording, Output& output);
    void describe(const Snapshot& snapshot, const std::string& name, Output& output);
    void separate(Output& output);
    /// Null for an unknown technology.
    const RecordingSummary::Codes* codesOf(const RecordedTechnology* technology);

    InfoOptions _options;
    Environment _environment;
    std::map<const RecordedTechnology*, RecordingSummary::Codes> _codes;
    bool _isFirst = true;
};

/// `pallax info`, wired to this machine. TemplateFailure, OutputClosed and OutputFailure leave.
ExitStatus runInfo(const InfoOptions& options);

} // namespace pallax
