#pragma once

#include "console/ExitStatus.h"
#include "decoding/DecodeCommand.h"
#include "host/RecordingParts.h"
#include "watching/WatchAction.h"

#include <chrono>
#include <optional>
#include <string>
#include <vector>

namespace pallax {

class Clock;
class Output;
class TickWatch;

/// `pallax watch`: tells when a condition becomes true.
struct WatchOptions {
    std::string condition;
    std::vector<std::string> recordings; ///< empty: the live modem
    /// The technology of every recording, overriding its link type; the one wanted of the modem.
    const RecordedTechnology* technology = nullptr;
    std::chrono::nanoseconds needed{}; ///< how long the condition must hold to be true
    std::optional<std::string> command = {};
    bool once = false;                    ///< ends when it has become true
    std::optional<std::string> rule = {}; ///< the name of an alarm, in place of the condition
    std::string service = {};             ///< of the live modem; empty: the one without a name
};

/// Writes a line each time the condition becomes true at a tick, and one when it ends. The numbered
/// parts of a recording are one; each recording begins without a state. A recording that cannot be
/// read does not stop the others; a record that throws is dropped.
class WatchCommand {
public:
    struct Environment {
        const DecoderEnvironment& decoder;
        DecodeCommand::Open open;
        DecodeCommand::Report report;
        const Clock& zone;   ///< tells the local time
        WatchAction& action; ///< done each time the condition becomes true
    };

    WatchCommand(const WatchOptions& options, Environment environment)
        : _options(options), _environment(std::move(environment)) {}

    /// Failure (1) if the condition became true. Exceptions of `output`, ConditionFailure and
    /// TemplateFailure propagate.
    ExitStatus run(Output& output);

private:
    /// What is wrong with the condition as far as it shows now.
    std::optional<std::string> errorBeforeReading() const;
    ExitStatus watch(const PartPaths& parts, Output& output);
    ExitStatus watchTicks(Recording& recording, const RecordedTechnology& technology,
                          Output& output);
    /// Reads the packets until the end or the last one that is needed; whether none was damaged.
    bool readPackets(Recording& recording, RecordingDecoder& decoder, const TickWatch& watch,
                     Output& output) const;
    bool isDone() const { return _options.once && _hasHeld; }

    const WatchOptions& _options;
    Environment _environment;
    bool _areSeveral = false; ///< recordings
    bool _hasHeld = false;
};

/// `WatchCommand`, wired to this machine.
ExitStatus runWatch(const WatchOptions& options);

} // namespace pallax
