#pragma once

#include "console/ExitStatus.h"
#include "decoding/RecordingDecoder.h"
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

/// Is told how decoding goes on; the recordings are told by their place on the command line.
class DecodeWatcher {
public:
    virtual ~DecodeWatcher() = default;
    /// After each packet, of which `source` has given so many.
    virtual void packetDone(std::size_t recording, const Recording& source,
                            std::uint64_t packets) = 0;
    /// At its end, also of one that could not be opened or read on.
    virtual void recordingDone(std::size_t recording) = 0;
};

/// `pallax decode`: recordings to JSON or CSV, in the order of the command line, each with a
/// generator and a state of its own. A recording that cannot be read does not keep the others
/// from being decoded.
class DecodeCommand {
public:
    using Open = std::function<Recording::OpenResult(const std::string& path)>;
    /// Gets one sentence for the user.
    using Report = std::function<void(std::string_view sentence)>;

    /// The watcher, if any, outlives the command.
    DecodeCommand(const DecodeOptions& options, const DecoderEnvironment& environment, Open open,
                  Report report, DecodeWatcher* watcher = nullptr)
        : _options(options), _environment(environment), _open(std::move(open)),
          _report(std::move(report)), _watcher(watcher) {}

    /// Writes to `output`, whose exceptions leave, and TemplateFailure. What a recording gives that
    /// is waited for (a pipe) is written with each display, that of a file in blocks.
    ExitStatus run(Output& output);
    /// The same for one of the recordings, by its place; only the first writes what stands at the
    /// head of the whole output.
    ExitStatus runOne(std::size_t recording, Output& output);

private:
    struct Destination {
        Output& output;
        DisplayOutput& displays; // which end up there
    };

    ExitStatus decodeNext(std::size_t place, const Destination& destination);
    ExitStatus decodePath(const std::string& path, const Destination& destination);
    ExitStatus decode(Recording& recording, const Destination& destination);
    ExitStatus decodePackets(Recording& recording, RecordingDecoder& decoder, Output& output);

    DecodeOptions _options;
    DecoderEnvironment _environment;
    Open _open;
    Report _report;
    DecodeWatcher* _watcher;
    std::size_t _place = 0; // of the recording that is being decoded
};

} // namespace pallax
