#pragma once

#include "cli/ExitStatus.h"
#include "cli/RecordingDecoder.h"
#include "host/Recording.h"

#include <cstddef>
#include <functional>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace pallax {

enum class DecodeFormat { Json, Csv };

struct DecodeOptions {
    std::vector<std::string> recordings;
    /// What to take every recording for, whatever its link type says.
    const RecordedTechnology* technology = nullptr;
    /// Nothing: the last display, or in CSV, which tells what changes, every tick.
    std::optional<Every> every;
    DecodeFormat format = DecodeFormat::Json;
    std::optional<std::string> systemLog; ///< path of a text file
    bool strict = false;
    /// How many recordings are decoded at once; nothing: one on each core.
    std::optional<unsigned> jobs;

    Every chosenEvery() const {
        return every.value_or(format == DecodeFormat::Csv ? Every::Tick : Every::End);
    }
};

/// `pallax decode`: recordings to JSON or CSV, in the order of the command line, each with a
/// generator and a state of its own. A recording that cannot be read does not keep the others
/// from being decoded.
class DecodeCommand {
public:
    using Open = std::function<Recording::OpenResult(const std::string& path)>;
    /// Gets one sentence for the user.
    using Report = std::function<void(std::string_view sentence)>;

    DecodeCommand(const DecodeOptions& options, const DecoderEnvironment& environment, Open open,
                  Report report)
        : _options(options), _environment(environment), _open(std::move(open)),
          _report(std::move(report)) {}

    /// Writes to `output`, whose exceptions leave.
    ExitStatus run(Output& output);
    /// The same for one of the recordings, by its place; only the first writes what stands at the
    /// head of the whole output.
    ExitStatus runOne(std::size_t recording, Output& output);

private:
    ExitStatus decodePath(const std::string& path, DisplayOutput& output);
    ExitStatus decode(Recording& recording, DisplayOutput& output);
    ExitStatus decodePackets(Recording& recording, RecordingDecoder& decoder);

    DecodeOptions _options;
    DecoderEnvironment _environment;
    Open _open;
    Report _report;
};

} // namespace pallax
