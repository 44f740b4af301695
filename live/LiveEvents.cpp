#include "live/LiveEvents.h"

#include "console/ScopedLog.h"
#include "decoding/EventsCommand.h"
#include "decoding/InstalledKnowledge.h"
#include "host/Complaint.h"
#include "host/Interruption.h"
#include "host/LogSinks.h"
#include "host/ServiceName.h"
#include "link/Settings.h"
#include "link/WaitNotice.h"
#include "live/LiveRecording.h"
#include "query/Condition.h"

namespace pallax {

ExitStatus runLiveEvents(EventsOptions options) {
    // The modem may keep the user waiting, and tells the fields only then.
    const auto wrong = options.where
                           ? QueryCondition::errorBeforeFields(*options.where, installedKnowledge())
                           : std::nullopt;
    if (wrong) {
        complain("--where: " + *wrong);
        return kExitWrongUsage;
    }
    const Interruption interruption;
    const SettingsResult settings = loadSettings(settingsFiles());
    if (!settings) {
        complain(settings.error().sentence);
        return kExitFailure;
    }
    SyslogSink syslog("pallax");
    const ScopedLog log(syslog, settings->systemLogLevel);
    options.recordings = {liveModemName(options.service)};
    return runEvents(options, [&options](const std::string& /*name*/) {
        return LiveRecording::open(
            {options.technology, options.duration, complainOfWaiting, options.service});
    });
}

} // namespace pallax
