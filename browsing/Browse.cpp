#include "browsing/Browse.h"

#include "browsing/BrowseOptions.h"
#include "browsing/KeptNotices.h"
#include "browsing/PrintBrowser.h"
#include "browsing/ScreenBrowser.h"
#include "console/Output.h"
#include "console/ScopedLog.h"
#include "console/TeeSink.h"
#include "decoding/FatalRecord.h"
#include "decoding/InstalledKnowledge.h"
#include "decoding/Preconditions.h"
#include "host/Complaint.h"
#include "host/Interruption.h"
#include "host/JoinedRecording.h"
#include "host/LogSinks.h"
#include "host/RecordingParts.h"
#include "link/Settings.h"
#include "link/SourceChild.h"
#include "telephony/ChildService.h"
#include "ui/curses/TerminalRestorer.h"

#include <algorithm>
#include <memory>
#include <stdexcept>
#include <unistd.h>
#include <utility>

namespace pallax {

namespace {

/// The requests of the command line and the settings file.
struct Request {
    const BrowseOptions& options;
    const Settings& settings;
    QualityProfile profile;
    OnFatalRecord onFatalRecord;
    bool isOnScreen;
};

/// False if the child (null for the machine's own service) ended too early.
bool browseInPrint(const Request& request, SocketDirectory directory, ChildService* child) {
    Output output(writeToDescriptor(STDOUT_FILENO, "Standard output"));
    bool isWhole = false;
    try {
        PrintBrowser browser(std::move(directory), request.onFatalRecord, child, request.settings,
                             output, sourceName(request.options.source),
                             request.options.plain ? TreePrinter::Form::Sentences
                                                   : TreePrinter::Form::Tree,
                             request.options.safe);
        isWhole = browser.run();
    } catch (const FatalRecord&) {
        output.flush(); // the printed text and the generators' notices
        throw;
    }
    output.flush();
    return isWhole;
}

/// Restores the terminal when a signal ends the program while the main queue does not handle
/// signals: before it starts and after it is destroyed.
class GuardedTerminal {
public:
    GuardedTerminal() { terminal::TerminalRestorer::guardEndings(); }
    ~GuardedTerminal() { terminal::TerminalRestorer::guardEndings(); }
    GuardedTerminal(const GuardedTerminal&) = delete;
    GuardedTerminal& operator=(const GuardedTerminal&) = delete;
};

/// Like `browseInPrint`, with the further modems. The terminal is restored before anything else is
/// printed.
bool browseOnScreen(const Request& request, SocketDirectory directory, ChildService* child) {
    std::vector<ScreenSession::Shown> shown{{std::move(directory), child, request.options.source}};
    for (const ServiceModem& modem : request.options.further) {
        auto further = SocketDirectory::open(modem.name);
        if (!further) {
            throw std::runtime_error(further.error().sentence);
        }
        shown.push_back({std::move(further).value(), nullptr, modem});
    }
    KeptNotices notices(writeToDescriptor(STDOUT_FILENO, "Standard output"));
    auto terminal = terminal::CursesTerminal::open({request.options.color, request.options.mouse});
    if (!terminal) {
        throw std::runtime_error(terminal.error().sentence);
    }
    const GuardedTerminal guard;
    ScreenBrowser browser({request.settings, request.profile, request.onFatalRecord,
                           request.options.safe, **terminal, notices},
                          std::move(shown));
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
        complain(lostChildSentence(request.options.source));
    }
    return isWhole && isContented ? kExitSuccess : kExitFailure;
}

ExitStatus browseWithLog(const Request& request) {
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
    return browse(request, std::move(directory).value(), child.get());
}

} // namespace

ExitStatus runBrowse(const BrowseOptions& wanted) {
    BrowseOptions options = wanted;
    if (isSnapshot(options.source)) {
        options.play.speed = PlayOptions::kAsFastAsTaken; // its displays stand side by side
    }
    const Interruption interruption(
        {terminal::TerminalRestorer::release, terminal::TerminalRestorer::restore});
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
    const Request request{options, *settings, std::move(profile).value(),
                          options.keepGoing ? OnFatalRecord::Skip : settings->onFatalRecord,
                          !options.print && !options.plain &&
                              terminal::CursesTerminal::isPossible()};
    if (!request.isOnScreen && !options.further.empty()) {
        complain("Several modems are shown only on the screen of a terminal: give one --connect.");
        return kExitWrongUsage;
    }
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
