#pragma once

#include "console/ExitStatus.h"
#include "decoding/DecodeCommand.h"
#include "host/RecordingParts.h"

#include <chrono>
#include <functional>
#include <optional>
#include <string>
#include <vector>

namespace pallax {

class Clock;
class Output;

/// `pallax events`: what happened in recordings.
struct EventsOptions {
    std::vector<std::string> recordings;
    /// The technology of every recording, overriding its link type.
    const RecordedTechnology* technology = nullptr;
    bool json = false;
    std::optional<std::string> where = {}; ///< condition on the events to write
    bool live = false;                     ///< of the live modem, without recordings
    std::optional<std::chrono::nanoseconds> duration = {}; ///< live; if missing, until a signal
    std::string service = {}; ///< of the live modem; empty: the one without a name
};

/// Writes a line for each event of the recordings, in the order of the command line: local time,
/// kind and words, or a JSON object. The numbered parts of a recording are one. Those of a pipe are
/// written when they happen. A recording that cannot be read does not stop the others; a fatal
/// record ends its recording.
class EventsCommand {
public:
    /// `zone` tells the local time.
    EventsCommand(const EventsOptions& options, const DecoderEnvironment& environment,
                  DecodeCommand::Open open, DecodeCommand::Report report, const Clock& zone)
        : _options(options), _environment(environment), _open(std::move(open)),
          _report(std::move(report)), _zone(zone) {}

    /// Exceptions of `output` and TemplateFailure propagate.
    ExitStatus run(Output& output);

private:
    ExitStatus tell(const PartPaths& parts, Output& output);
    ExitStatus tellEvents(Recording& recording, const RecordedTechnology& technology,
                          Output& output);

    const EventsOptions& _options;
    const DecoderEnvironment& _environment;
    DecodeCommand::Open _open;
    DecodeCommand::Report _report;
    const Clock& _zone;
    bool _areSeveral = false; ///< recordings
};

/// `EventsCommand`, wired to this machine; `open` opens what the options name.
ExitStatus runEvents(const EventsOptions& options, const DecodeCommand::Open& open);
/// The same for recordings.
ExitStatus runEvents(const EventsOptions& options);

} // namespace pallax
