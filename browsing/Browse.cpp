#include "browsing/Browse.h"

#include "LogGenerator/Technologies/Technologies.h"
#include "browsing/BrowseOptions.h"
#include "browsing/KeptNotices.h"
#include "browsing/PrintBrowser.h"
#include "browsing/ScreenBrowser.h"
#include "console/Output.h"
#include "console/ScopedLog.h"
#include "console/TeeSink.h"
#include "decoding/FatalRecord.h"
#include "decoding/Preconditions.h"
#include "host/Complaint.h"
#include "host/Interruption.h"
#include "host/LogSinks.h"
#include "host/RecordingFile.h"
#include "link/Settings.h"
#include "telephony/ChildService.h"
#include "ui/terminal/TerminalRestorer.h"

#include <algorithm>
#include <memory>
#include <stdexcept>
#include <unistd.h>
#include <utility>

namespace pallax {

namespace {

/// Ends the child, and says what it had to complain of; true when that was nothing.
bool endChild(ChildService& child) {
    child.stop();
    const std::string complaints = child.takeComplaints(); // lines that name the program
    passOnComplaints(complaints);
    return complaints.empty();
}

/// What the command line and the settings file ask for.
struct Request {
    const BrowseOptions& options;
    const Settings& settings;
    OnFatalRecord onFatalRecord;
    bool isOnScreen;
};

BrowsedSource sourceOf(const BrowseOptions& options) {
    if (options.simulation) {
        return {"simulated " + std::string(options.simulation->technology->commandName)};
    }
    if (!options.recording) {
        return {"live modem"};
    }
    return {*options.recording == "-" ? "standard input" : *options.recording,
            RecordingFile::isStream(*options.recording)};
}

/// False when the child (null where the machine's own service is asked) ended too early.
bool browseInPrint(const Request& request, SocketDirectory directory, ChildService* child) {
    Output output(writeToDescriptor(STDOUT_FILENO, "Standard output"));
    bool isWhole = false;
    try {
        PrintBrowser browser(std::move(directory), request.onFatalRecord, child,
                             request.settings.afterReconnect, output,
                             sourceOf(request.options).name);
        isWhole = browser.run();
    } catch (const FatalRecord&) {
        output.flush(); // what was printed, and the generators' last words
        throw;
    }
    output.flush();
    return isWhole;
}

/// Restores the terminal when a signal ends the program while the main queue does not handle
/// signals: before the queue starts and after it has gone.
class GuardedTerminal {
public:
    GuardedTerminal() { terminal::TerminalRestorer::guardEndings(); }
    ~GuardedTerminal() { terminal::TerminalRestorer::guardEndings(); }
    GuardedTerminal(const GuardedTerminal&) = delete;
    GuardedTerminal& operator=(const GuardedTerminal&) = delete;
};

/// As `browseInPrint`. The terminal is restored by the time anything else is told.
bool browseOnScreen(const Request& request, SocketDirectory directory, ChildService* child) {
    KeptNotices notices(writeToDescriptor(STDOUT_FILENO, "Standard output"));
    auto terminal = terminal::CursesTerminal::open({request.options.color, request.options.mouse});
    if (!terminal) {
        throw std::runtime_error(terminal.error().sentence);
    }
    const GuardedTerminal guard;
    ScreenBrowser browser(std::move(directory), request.onFatalRecord, child,
                          sourceOf(request.options), request.settings, **terminal, notices);
    return browser.run();
}

ExitStatus browse(const Request& request, SocketDirectory directory, ChildService* child) {
    bool isWhole = false;
    try {
        isWhole = request.isOnScreen ? browseOnScreen(request, std::move(directory), child)
                                     : browseInPrint(request, std::move(directory), child);
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
        complain(request.options.simulation ? "The service that simulates the modem has ended."
                                            : "The service that plays the recording has ended.");
    }
    return isWhole && isContented ? kExitSuccess : kExitFailure;
}

/// Why the recording cannot be browsed although it can be read; nothing when it can, or when only
/// its reader will find out (a stream is read once).
std::optional<std::string> refusalOf(const std::string& path) {
    if (RecordingFile::isStream(path)) {
        return std::nullopt;
    }
    const Recording::OpenResult recording = Recording::open(path);
    if (!recording) {
        return std::nullopt; // the child service has the sentence, as for a foreign link type
    }
    return missingGenerator(**recording, technologies());
}

/// The service that serves what is asked for. A stream by name is opened here, whose standard error
/// tells where it is waited for, and is the child's standard input.
Result<std::unique_ptr<ChildService>, HostError> startChild(const BrowseOptions& options) {
    ServiceOptions service;
    service.recording = options.recording.value_or("");
    service.play = options.play;
    service.simulation = options.simulation;
    if (service.recording.empty() || service.recording == "-" ||
        !RecordingFile::isStream(service.recording)) {
        return ChildService::start(std::move(service));
    }
    auto stream = RecordingFile::open(service.recording, complain);
    if (!stream) {
        return HostError{stream.error().sentence};
    }
    service.inputName = std::exchange(service.recording, "-");
    return ChildService::start(std::move(service), std::move(stream).value().descriptor);
}

ExitStatus browseWithLog(const Request& request) {
    const std::optional<std::string>& recording = request.options.recording;
    if (const auto refusal = recording ? refusalOf(*recording) : std::nullopt) {
        complain(*refusal);
        return kExitFailure;
    }
    if (recording == "-" && ::isatty(STDIN_FILENO) != 0) {
        complain("Standard input is a terminal; pipe a recording into it.");
        return kExitWrongUsage;
    }
    const auto loss = recording ? outputIntoRecording({&*recording, 1}) : std::nullopt;
    if (loss) {
        complain(*loss);
        return kExitFailure;
    }
    std::unique_ptr<ChildService> child;
    if (recording || request.options.simulation) {
        auto started = startChild(request.options);
        if (!started) {
            complain(started.error().sentence);
            return kExitFailure;
        }
        child = std::move(started).value();
    }
    auto directory = SocketDirectory::open();
    if (!directory) {
        complain(directory.error().sentence);
        return kExitFailure;
    }
    return browse(request, std::move(directory).value(), child.get());
}

} // namespace

ExitStatus runBrowse(const BrowseOptions& options) {
    const Interruption interruption(
        {terminal::TerminalRestorer::release, terminal::TerminalRestorer::restore});
    const SettingsResult settings = loadSettings(settingsFiles());
    if (!settings) {
        complain(settings.error().sentence);
        return kExitFailure;
    }
    const Request request{options, *settings,
                          options.keepGoing ? OnFatalRecord::Skip : settings->onFatalRecord,
                          !options.print && terminal::CursesTerminal::isPossible()};
    SyslogSink syslog("pallax");
    if (!options.logLevel) {
        const ScopedLog log(syslog, settings->systemLogLevel);
        return browseWithLog(request);
    }
    if (request.isOnScreen && ::isatty(STDERR_FILENO) != 0) {
        complain("--log-level writes to standard error, which is the screen here: send it to a "
                 "file (2>FILE), or add --print.");
        return kExitWrongUsage;
    }
    StderrSink standardError;
    TeeSink both(syslog, settings->systemLogLevel, standardError, *options.logLevel);
    const ScopedLog log(both, std::max(settings->systemLogLevel, *options.logLevel));
    return browseWithLog(request);
}

} // namespace pallax
