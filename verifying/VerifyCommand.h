#pragma once

#include "console/ExitStatus.h"
#include "decoding/RecordingDecoder.h"
#include "host/Recording.h"
#include "verifying/EmbeddedCheck.h"

#include <functional>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace pallax {

class Output;

/// `pallax verify`: whether recordings are what they were.
struct VerifyOptions {
    std::vector<std::string> recordings = {};
    std::string expect = {}; ///< the file of digests; empty: the one beside each recording
    bool update = false;     ///< write the digests
};

class VerifyCommand {
public:
    struct Environment {
        DecoderEnvironment decoder;
        std::function<Recording::OpenResult(const std::string& path)> open;
        std::function<void(std::string_view sentence)> report;
    };

    VerifyCommand(VerifyOptions options, const Environment& environment)
        : _options(std::move(options)), _environment(environment) {}

    /// Success if all are what they were, failure if one is not, otherwise "could not tell".
    ExitStatus run(Output& output);

private:
    ExitStatus verify(const std::string& path, Output& output);
    std::optional<EmbeddedCheck> embeddedIn(const std::string& path, Output& output);
    ExitStatus tell(const std::optional<EmbeddedCheck>& check, const std::string& path,
                    Output& output);
    ExitStatus compare(Recording& recording, const std::string& file, Output& output);
    ExitStatus couldNotTell(const std::string& sentence);

    VerifyOptions _options;
    Environment _environment;
};

/// `pallax verify`, wired to this machine.
ExitStatus runVerify(const VerifyOptions& options);

} // namespace pallax
