#include "browsing/Browse.h"

#include "browsing/KeptNotices.h"
#include "browsing/PrintBrowser.h"
#include "browsing/ScreenBrowser.h"
#include "browsing/SourceShow.h"
#include "console/Output.h"
#include "host/Complaint.h"
#include "host/Interruption.h"
#include "ui/curses/TerminalRestorer.h"

#include <stdexcept>
#include <unistd.h>
#include <utility>

namespace pallax {

namespace {

/// False if the child (null for the machine's own service) ended too early.
bool browseInPrint(const ShowRequest& request, SocketDirectory directory, ChildService* child) {
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
bool browseOnScreen(const ShowRequest& request, SocketDirectory directory, ChildService* child) {
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

} // namespace

/// Standard error may be the screen, too.
ExitStatus runBrowse(const BrowseOptions& options) {
    const Interruption interruption(
        {terminal::TerminalRestorer::release, terminal::TerminalRestorer::restore});
    const bool isOnScreen =
        !options.print && !options.plain && terminal::CursesTerminal::isPossible();
    if (!isOnScreen && !options.further.empty()) {
        complain("Several modems are shown only on the screen of a terminal: give one --connect.");
        return kExitWrongUsage;
    }
    if (isOnScreen && options.logLevel && ::isatty(STDERR_FILENO) != 0) {
        complain("--log-level writes to standard error, which is the screen here: send it to a "
                 "file (2>FILE), or add --print.");
        return kExitWrongUsage;
    }
    return showSource(options, isOnScreen ? browseOnScreen : browseInPrint);
}

} // namespace pallax
