#include "recording/Record.h"

#include "console/ScopedLog.h"
#include "console/TeeSink.h"
#include "console/TerminalLine.h"
#include "host/Complaint.h"
#include "host/Interruption.h"
#include "host/LogSinks.h"
#include "link/Settings.h"
#include "link/WaitNotice.h"
#include "recording/RecordOptions.h"
#include "recording/Recorder.h"
#include "telephony/ChildService.h"

#include <algorithm>
#include <csignal>

namespace pallax {

namespace {

constexpr int kNothing = -1;

ExitStatus record(const RecordOptions& options) {
    auto directory = SocketDirectory::open(options.service);
    if (!directory) {
        complain(directory.error().sentence);
        return kExitFailure;
    }
    TerminalLine progress = TerminalLine::onStandardError();
    const auto files =
        RecordingFiles::open(options.files, [&progress](const std::string& sentence) {
            progress.wipe();
            complain(sentence);
        });
    if (!files && files.error().readerHasGone) {
        return kExitSuccess;
    }
    if (!files) {
        complain(files.error().sentence);
        return kExitFailure;
    }
    std::unique_ptr<ChildService> child;
    if (options.modem) {
        auto started = ChildService::start({*options.modem});
        if (!started) {
            complain(started.error().sentence);
            return kExitFailure;
        }
        child = std::move(started).value();
        passOnComplaints(child->takeComplaints()); // what the modem's stream waits for
    }
    std::optional<std::string> failure;
    {
        Recorder recorder(
            std::move(directory).value(), options.technology, **files,
            [&progress](const std::string& text) { progress.show(text); },
            [&progress](const std::string& text) {
                progress.wipe();
                complainOfWaiting(text);
            },
            child.get());
        failure = recorder.run();
    }
    progress.leave();
    if (const auto error = failure ? std::nullopt : (*files)->finish()) {
        failure = Recorder::failureText(*error, **files);
    }
    if ((*files)->tooLarge() > 0) {
        complain(Recorder::omissionText(**files));
    }
    if (failure) {
        complain(*failure);
        return kExitFailure;
    }
    return kExitSuccess;
}

} // namespace

ExitStatus runRecord(const RecordOptions& options) {
    const Interruption interruption;
    const SettingsResult settings = loadSettings(settingsFiles());
    if (!settings) {
        complain(settings.error().sentence);
        return kExitFailure;
    }
    SyslogSink syslog("pallax");
    StderrSink standardError;
    const int wanted = options.logLevel.value_or(kNothing);
    TeeSink both(syslog, settings->systemLogLevel, standardError, wanted);
    const ScopedLog log(both, std::max(settings->systemLogLevel, wanted));
    return record(options);
}

} // namespace pallax
