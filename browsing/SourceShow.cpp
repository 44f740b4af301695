#include "browsing/SourceShow.h"

#include "console/ScopedLog.h"
#include "console/TeeSink.h"
#include "decoding/InstalledKnowledge.h"
#include "decoding/Preconditions.h"
#include "host/Complaint.h"
#include "host/JoinedRecording.h"
#include "host/LogSinks.h"
#include "host/RecordingParts.h"
#include "link/SourceChild.h"
#include "telephony/ChildService.h"

#include <algorithm>
#include <memory>
#include <unistd.h>
#include <utility>

namespace pallax {

namespace {

ExitStatus showFrom(const ShowRequest& request, const ShowSource& show, SocketDirectory directory,
                    ChildService* child) {
    bool isWhole = false;
    try {
        isWhole = show(request, std::move(directory), child);
    } catch (const FatalRecord&) {
        if (child != nullptr) {
            (void)endChild(*child);
        }
        throw;
    }
    if (child == nullptr) {
        return kExitSuccess;
    }
    const bool isContented = endChild(*child);
    if (!isWhole) {
        complain(lostChildSentence(request.options.source));
    }
    return isWhole && isContented ? kExitSuccess : kExitFailure;
}

ExitStatus showWithLog(const ShowRequest& request, const ShowSource& show) {
    const Source& source = request.options.source;
    if (const auto refusal = refusalOf(source)) {
        complain(*refusal);
        return kExitFailure;
    }
    const auto recording = recordingPath(source);
    if (recording == "-" && ::isatty(STDIN_FILENO) != 0) {
        complain("Standard input is a terminal; pipe a recording into it.");
        return kExitWrongUsage;
    }
    const auto* file = std::get_if<FileRecording>(&source);
    const auto loss = file != nullptr ? outputIntoRecording(file->parts())
                      : recording     ? outputIntoRecording({&*recording, 1})
                                      : std::nullopt;
    if (loss) {
        complain(*loss);
        return kExitFailure;
    }
    if (const auto missing = file != nullptr ? missingParts(file->parts()) : std::nullopt) {
        complain(*missing);
    }
    const auto* modem = std::get_if<ServiceModem>(&source);
    std::unique_ptr<ChildService> child;
    if (modem == nullptr) {
        auto started = startChild(source, request.options.play);
        if (!started) {
            complain(started.error().sentence);
            return kExitFailure;
        }
        child = std::move(started).value();
    }
    auto directory = SocketDirectory::open(modem != nullptr ? modem->name : "");
    if (!directory) {
        complain(directory.error().sentence);
        return kExitFailure;
    }
    return showFrom(request, show, std::move(directory).value(), child.get());
}

} // namespace

ExitStatus showSource(const BrowseOptions& wanted, const ShowSource& show) {
    BrowseOptions options = wanted;
    if (isSnapshot(options.source)) {
        options.play.speed = PlayOptions::kAsFastAsTaken; // its displays stand side by side
    }
    const SettingsResult settings = loadSettings(settingsFiles());
    if (!settings) {
        complain(settings.error().sentence);
        return kExitFailure;
    }
    const std::string usual = settings->profile.value_or(std::string(kDefaultProfile));
    auto profile =
        profileOrComplaint({options.profile.value_or(usual), options.profile.has_value()});
    if (!profile) {
        return profile.error();
    }
    const ShowRequest request{options, *settings, std::move(profile).value(),
                              options.keepGoing ? OnFatalRecord::Skip : settings->onFatalRecord};
    SyslogSink syslog("pallax");
    if (!options.logLevel) {
        const ScopedLog log(syslog, settings->systemLogLevel);
        return showWithLog(request, show);
    }
    StderrSink standardError;
    TeeSink both(syslog, settings->systemLogLevel, standardError, *options.logLevel);
    const ScopedLog log(both, std::max(settings->systemLogLevel, *options.logLevel));
    return showWithLog(request, show);
}

} // namespace pallax
