#pragma once

#include "console/ExitStatus.h"
#include "decoding/RecordingDecoder.h"
#include "inspecting/ViewedFile.h"
#include "overview/Differences.h"

#include <functional>
#include <optional>
#include <string>
#include <vector>

namespace pallax {

class Clock;
class Output;
struct RecordedTechnology;

/// `pallax diff`: what differs between two moments.
struct DiffOptions {
    std::string before; ///< FILE or FILE@TIME
    std::string after;
    /// The technology of the recordings, overriding their link types.
    const RecordedTechnology* technology = nullptr;
    std::vector<std::string> select; ///< names of fields, or patterns; empty: all
    bool all = false;                ///< also running and hidden fields
    bool json = false;
};

class DiffCommand {
public:
    struct Environment {
        const DecoderEnvironment& decoder;
        const Clock& zone;                                       ///< for local times
        std::function<void(const std::string& sentence)> report; ///< gets one for the user
    };

    DiffCommand(const DiffOptions& options, const Environment& environment)
        : _options(options), _environment(environment) {}

    /// Success: nothing differs. Failure: something does, and is written.
    ExitStatus run(Output& output);

private:
    /// A file, and a time if one is given.
    struct Side {
        std::string path;
        std::optional<std::string> time;
    };

    static Side sideOf(const std::string& argument);
    ExitStatus compare(ViewedFile& before, const std::optional<TimeText>& from, ViewedFile& after,
                       const std::optional<TimeText>& to, Output& output);
    std::optional<std::string> unknownField(const CurrentValues& one,
                                            const CurrentValues& other) const;
    bool isChosen(const FieldInfo& field) const;
    ExitStatus refuse(const std::string& sentence, ExitStatus status = kExitCouldNotTell) const;

    const DiffOptions& _options;
    const Environment& _environment;
};

/// `DiffCommand`, wired to this machine. Never returns kExitFailure but for a difference.
ExitStatus runDiff(const DiffOptions& options);

} // namespace pallax
