#include "LogGenerator/Technologies/Technologies.h"
#include "console/Output.h"
#include "console/ScopedLog.h"
#include "decoding/DroppedNotices.h"
#include "decoding/InstalledKnowledge.h"
#include "decoding/Preconditions.h"
#include "decoding/RequiredTemplates.h"
#include "host/BuildBundle.h"
#include "host/Complaint.h"
#include "host/Interruption.h"
#include "host/LogSinks.h"
#include "host/ServiceName.h"
#include "host/WallClock.h"
#include "link/Settings.h"
#include "link/WaitNotice.h"
#include "live/LiveRecording.h"
#include "text/Format.h"
#include "watching/ShellCommand.h"
#include "watching/WatchCommand.h"

#include <exception>
#include <memory>
#include <unistd.h>

namespace pallax {

namespace {

void report(std::string_view sentence) {
    complain(sentence);
}

class NoAction final : public WatchAction {
public:
    void run(const std::string& /*time*/, const Variables& /*variables*/) override {}
    void look() override {}
    void finish() override {}
};

std::unique_ptr<WatchAction> actionOf(const WatchOptions& options, ShellCommand::Mode mode) {
    if (!options.command) {
        return std::make_unique<NoAction>();
    }
    return std::make_unique<ShellCommand>(*options.command, mode, report);
}

ExitStatus watchWith(const WatchOptions& options, const DecodeCommand::Open& open,
                     ShellCommand::Mode mode) {
    const RequiredTemplates resources(DirectoryResources::programFolder());
    const BuildBundle bundle;
    const WallClock zone;
    DroppedNotices notices;
    const DecoderEnvironment decoder{resources, bundle, notices, technologies(),
                                     installedKnowledge()};
    const auto action = actionOf(options, mode);
    Output output(writeToDescriptor(STDOUT_FILENO, "Standard output"));
    return WatchCommand(options, {decoder, open, report, zone, *action}).run(output);
}

ExitStatus watchLive(WatchOptions options) {
    const Interruption interruption;
    const SettingsResult settings = loadSettings(settingsFiles());
    if (!settings) {
        complain(settings.error().sentence);
        return kExitCouldNotTell;
    }
    SyslogSink syslog("pallax");
    const ScopedLog log(syslog, settings->systemLogLevel);
    options.recordings = {liveModemName(options.service)};
    const auto open = [&options](const std::string& /*name*/) {
        return LiveRecording::open({options.technology, {}, complainOfWaiting, options.service});
    };
    return watchWith(options, open, ShellCommand::Mode::Beside);
}

ExitStatus watchRecordings(const WatchOptions& options) {
    if (const auto loss = outputIntoRecording(options.recordings)) {
        complain(*loss);
        return kExitCouldNotTell;
    }
    const auto open = [](const std::string& path) {
        return Recording::openInput({path, {}, complain});
    };
    return watchWith(options, open, ShellCommand::Mode::Wait);
}

struct RuleError {
    std::string sentence;
    ExitStatus status;
};

/// The options with the condition of the rule that they name, if they name one.
Result<WatchOptions, RuleError> withRule(WatchOptions options) {
    if (!options.rule) {
        return options;
    }
    const SettingsResult settings = loadSettings(settingsFiles());
    if (!settings) {
        return RuleError{settings.error().sentence, kExitCouldNotTell};
    }
    const AlarmRule* rule = alarmNamed(settings->alarms, *options.rule);
    if (rule == nullptr) {
        return RuleError{formatText("--rule: pallax.conf has no alarm \"%@\".", {*options.rule}),
                         kExitWrongUsage};
    }
    options.condition = rule->condition;
    options.needed = rule->needed;
    return options;
}

} // namespace

ExitStatus runWatch(const WatchOptions& wanted) {
    try {
        const auto ruled = withRule(wanted);
        if (!ruled) {
            complain(ruled.error().sentence);
            return ruled.error().status;
        }
        const WatchOptions& options = *ruled;
        return options.recordings.empty() ? watchLive(options) : watchRecordings(options);
    } catch (const OutputClosed&) {
        return kExitFailure; // only what has become true is written
    } catch (const std::exception& error) {
        complain(error.what());
        return kExitCouldNotTell;
    }
}

} // namespace pallax
