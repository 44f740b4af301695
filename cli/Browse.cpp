#include "LogGenerator/Technologies/Technologies.h"
#include "cli/FatalRecord.h"
#include "cli/Preconditions.h"
#include "cli/Programs.h"
#include "cli/ScopedLog.h"
#include "cli/Settings.h"
#include "cli/TeeSink.h"
#include "cli/TreePrinter.h"
#include "host/AsioMainQueue.h"
#include "host/BuildBundle.h"
#include "host/DirectoryResources.h"
#include "host/LogSinks.h"
#include "host/Recording.h"
#include "host/SocketMessagePorts.h"
#include "host/SourceClock.h"
#include "host/WallClock.h"
#include "monitor/PallaxModel.h"
#include "platform/StandardOutput.h"
#include "telephony/ChildService.h"
#include "telephony/SocketTelephonyService.h"

#include <algorithm>
#include <csignal>
#include <memory>
#include <sys/wait.h>
#include <unistd.h>

namespace pallax {

namespace {

/// What the machine's log gets: failures. Every packet makes several lines of less urgency.
constexpr int kSyslogLevel = static_cast<int>(LogPriority::Error);

/// How often the connection and the child service are looked at.
constexpr std::chrono::milliseconds kLookInterval{500};

/// What generators print when they end goes where the tree goes.
class PrintedNotices final : public StandardOutput {
public:
    explicit PrintedNotices(Output& output) : _output(output) {}
    void printLine(std::string_view line) override {
        _output.text() += line;
        _output.text() += '\n';
    }

private:
    Output& _output;
};

/// True once the child has ended; it is left to its owner to reap.
bool hasEnded(const ChildService& child) {
    siginfo_t info{};
    const auto process = static_cast<id_t>(child.processId());
    return ::waitid(P_PID, process, &info, WEXITED | WNOHANG | WNOWAIT) == 0 && info.si_pid != 0;
}

/// A model over the message ports of this machine, and the printer that shows it.
class Browser {
public:
    Browser(SocketDirectory directory, OnFatalRecord onFatalRecord, ChildService* child,
            Output& output)
        : _child(child),
          _localPortName(child != nullptr ? child->privateName(PallaxModel::kLocalPortName)
                                          : std::string(PallaxModel::kLocalPortName)),
          _clock(_wallClock, _queue), _socketPorts(_queue, std::move(directory), &_clock),
          _ports(_socketPorts, onFatalRecord, [this] { return _clock.packetNumber(); }),
          _telephony(_socketPorts, child != nullptr ? child->controlPortName()
                                                    : std::string(kTelephonyControlPort)),
          _resources(DirectoryResources::programFolder()), _notices(output),
          _printer(output, _clock, [this] { return _model.topLevelNodes(); }),
          _model({_ports,
                  _telephony,
                  _queue,
                  _clock,
                  {_clock, _resources, _bundle, _notices},
                  technologies(),
                  _printer,
                  _localPortName}) {}

    /// Browses until a signal, or with a child until its recording has ended. False when the
    /// child ended before.
    bool run() {
        _queue.onSignal({SIGINT, SIGTERM, SIGHUP}, [this](int /*signal*/) { _queue.stop(); });
        if (_child != nullptr) {
            // The last tick has posted its view update before; that is to come first.
            _clock.onEnd([this] { _queue.async([this] { _queue.stop(); }); });
        }
        _queue.async([this] {
            _model.startMonitor();
            _printer.showConnection(_model.isConnected());
        });
        const auto looks = _queue.scheduleRepeating(kLookInterval, [this] { look(); });
        _queue.run();
        return !_childLost;
    }

private:
    void look() {
        _printer.showConnection(_model.isConnected());
        if (_child != nullptr && hasEnded(*_child)) {
            // A signal to the whole process group may be on its way to us too.
            _queue.after(kLookInterval, [this] {
                _childLost = true;
                _queue.stop();
            });
        }
    }

    ChildService* _child;
    std::string _localPortName;
    bool _childLost = false;
    AsioMainQueue _queue;
    WallClock _wallClock;
    SourceClock _clock;
    SocketMessagePorts _socketPorts;
    GuardedMessagePorts _ports;
    SocketTelephonyService _telephony;
    DirectoryResources _resources;
    BuildBundle _bundle;
    PrintedNotices _notices;
    TreePrinter _printer;
    PallaxModel _model;
};

/// Ends the child, and says what it had to complain of; true when that was nothing.
bool endChild(ChildService& child) {
    child.stop();
    const std::string complaints = child.takeComplaints(); // lines that name the program
    (void)!::write(STDERR_FILENO, complaints.data(), complaints.size());
    return complaints.empty();
}

ExitStatus browse(SocketDirectory directory, OnFatalRecord onFatalRecord, ChildService* child) {
    Output output(writeToDescriptor(STDOUT_FILENO, "Standard output"));
    bool whole = false;
    try {
        Browser browser(std::move(directory), onFatalRecord, child, output);
        whole = browser.run();
    } catch (const FatalRecord&) {
        output.flush(); // what was printed, and the generators' last words
        if (child != nullptr) {
            (void)endChild(*child);
        }
        throw;
    }
    output.flush();
    if (child == nullptr) {
        return kExitSuccess;
    }
    const bool contented = endChild(*child);
    if (!whole) {
        complain("The service that plays the recording has ended.");
    }
    return whole && contented ? kExitSuccess : kExitFailure;
}

/// Why the recording cannot be browsed although it can be read; nothing when it can, or when only
/// its reader will find out (standard input is read once).
std::optional<std::string> refusalOf(const std::string& path) {
    if (path == "-") {
        return std::nullopt;
    }
    const Recording::OpenResult recording = Recording::open(path);
    if (!recording) {
        return std::nullopt; // the child service has the sentence, as for a foreign link type
    }
    return missingGenerator(**recording, technologies());
}

ExitStatus browseWithLog(const BrowseOptions& options, OnFatalRecord onFatalRecord) {
    if (const auto refusal = options.recording ? refusalOf(*options.recording) : std::nullopt) {
        complain(*refusal);
        return kExitFailure;
    }
    std::unique_ptr<ChildService> child;
    if (options.recording) {
        auto started = ChildService::start({*options.recording, options.play});
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
    return browse(std::move(directory).value(), onFatalRecord, child.get());
}

} // namespace

ExitStatus runBrowse(const BrowseOptions& options) {
    const SettingsResult settings = loadSettings(settingsFiles());
    if (!settings) {
        complain(settings.error().sentence);
        return kExitFailure;
    }
    if (const auto missing = missingTemplates()) {
        complain(*missing);
        return kExitFailure;
    }
    const OnFatalRecord onFatalRecord =
        options.keepGoing ? OnFatalRecord::Skip : settings->onFatalRecord;
    SyslogSink syslog("pallax");
    if (!options.logLevel) {
        const ScopedLog log(syslog, kSyslogLevel);
        return browseWithLog(options, onFatalRecord);
    }
    StderrSink standardError;
    TeeSink both(syslog, kSyslogLevel, standardError, *options.logLevel);
    const ScopedLog log(both, std::max(kSyslogLevel, *options.logLevel));
    return browseWithLog(options, onFatalRecord);
}

} // namespace pallax
