#pragma once

#include "app/BrowsingSession.h"
#include "host/FilePreferences.h"
#include "host/HostFileSystem.h"
#include "knowledge/Networks.h"
#include "link/BrowseLink.h"
#include "overview/StatusWatch.h"
#include "ui/terminal/CursesTerminal.h"
#include "ui/terminal/FrontEnd.h"

#include <memory>
#include <optional>

namespace pallax {

struct Settings;

/// A session on the terminal that the process runs in: its keys, its screen, and the signals.
class ScreenBrowser {
public:
    /// Terminal and notices must outlive the browser: errors and notices are printed once the
    /// terminal is restored.
    ScreenBrowser(SocketDirectory directory, OnFatalRecord onFatalRecord, ChildService* child,
                  BrowsedSource source, const Settings& settings,
                  terminal::CursesTerminal& terminal, StandardOutput& notices);
    ScreenBrowser(const ScreenBrowser&) = delete;
    ScreenBrowser& operator=(const ScreenBrowser&) = delete;

    /// Runs until the user quits or a signal ends it. False if the child ended before.
    bool run();

private:
    BrowsingSession::Surroundings sessionSurroundings(BrowsedSource source,
                                                      const Settings& settings);
    terminal::FrontEnd::Surroundings frontEndSurroundings();
    void waitForKey();
    void readKey();
    void needsDisplay();
    void display();
    void keepTurning();
    void adoptSize();
    const NetworkNames& names();
    Overview overview();

    bool _isDisplayPosted = false;
    terminal::CursesTerminal& _terminal;
    BrowseLink _link;
    DescriptorWatch _keys;
    StatusWatch _watch;
    std::optional<NetworkNames> _names; ///< read when a page asks for the first time
    const terminal::Marks _marks;
    terminal::FrontEnd _frontEnd;
    HostFileSystem _files;
    FilePreferences _preferences;
    BrowsingSession _session;
    std::unique_ptr<RepeatingTimer> _turning; // while something on the screen turns
};

} // namespace pallax
