#pragma once

#include "app/BrowsingSession.h"
#include "browsing/SafePackets.h"
#include "browsing/ViewedTimeline.h"
#include "host/FilePreferences.h"
#include "host/HostFileSystem.h"
#include "knowledge/Networks.h"
#include "link/BrowseLink.h"
#include "overview/StatusWatch.h"
#include "travel/Travel.h"
#include "ui/terminal/CursesTerminal.h"
#include "ui/terminal/FrontEnd.h"
#include "watching/AlarmWatch.h"

#include <chrono>
#include <cstdint>
#include <deque>
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
                  const Source& source, const Settings& settings,
                  terminal::CursesTerminal& terminal, StandardOutput& notices, bool isSafe);
    ScreenBrowser(const ScreenBrowser&) = delete;
    ScreenBrowser& operator=(const ScreenBrowser&) = delete;

    /// Runs until the user quits or a signal ends it. False if the child ended before.
    bool run();

private:
    BrowsingSession::Surroundings sessionSurroundings(const Source& source,
                                                      const Settings& settings);
    Travel::Surroundings travelSurroundings();
    bool mayGoOn(const std::string& words);
    terminal::FrontEnd::Surroundings frontEndSurroundings();
    void waitForKey();
    void readKey();
    void begin(const std::string& technology);
    void tick();
    void tellTrouble();
    void needsDisplay();
    void display();
    void keepTurning();
    void adoptSize();
    terminal::QuerySeams querySeams();
    const NetworkNames& names();
    QueryKnowledge knowledge();
    Overview overview();
    EntryPart entryPart(const std::string& path) const;

    bool _isDisplayPosted = false;
    terminal::CursesTerminal& _terminal;
    BrowseLink _link;
    SafePackets _safe;
    DescriptorWatch _keys;
    StatusWatch _watch;
    ViewedTimeline _timeline;
    Travel _travel;
    std::optional<std::chrono::steady_clock::time_point> _workBegan; ///< since the latest key
    std::chrono::steady_clock::time_point _lookedForKey;
    std::deque<terminal::KeyEvent> _typedAhead; ///< keys that came during work
    std::optional<std::string> _toldTrouble;    ///< of the timeline, since time is held
    AlarmWatch _alarms;
    std::uint64_t _ticks = 0;
    std::optional<NetworkNames> _names; ///< read when a page asks for the first time
    const terminal::Marks _marks;
    terminal::FrontEnd _frontEnd;
    HostFileSystem _files;
    FilePreferences _preferences;
    BrowsingSession _session;
    std::unique_ptr<RepeatingTimer> _ticking;
    std::unique_ptr<RepeatingTimer> _turning; // while something on the screen turns
};

} // namespace pallax
