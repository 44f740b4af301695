#include "live/LiveEvents.h"

#include "console/ScopedLog.h"
#include "decoding/EventsCommand.h"
#include "host/Complaint.h"
#include "host/Interruption.h"
#include "host/LogSinks.h"
#include "link/Settings.h"
#include "link/WaitNotice.h"
#include "live/LiveRecording.h"

namespace pallax {

ExitStatus runLiveEvents(EventsOptions options) {
    const Interruption interruption;
    const SettingsResult settings = loadSettings(settingsFiles());
    if (!settings) {
        complain(settings.error().sentence);
        return kExitFailure;
    }
    SyslogSink syslog("pallax");
    const ScopedLog log(syslog, settings->systemLogLevel);
    options.recordings = {"live modem"};
    return runEvents(options, [&options](const std::string& /*name*/) {
        return LiveRecording::open({options.technology, options.duration, complainOfWaiting});
    });
}

} // namespace pallax
