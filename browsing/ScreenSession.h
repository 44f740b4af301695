#pragma once

#include "app/BrowsingSession.h"
#include "browsing/LinkNotes.h"
#include "browsing/SnapshotOverview.h"
#include "browsing/ViewedTimeline.h"
#include "host/FilePreferences.h"
#include "host/HostFileSystem.h"
#include "knowledge/Networks.h"
#include "knowledge/Quality.h"
#include "link/BrowseLink.h"
#include "link/StreamState.h"
#include "masking/SafePackets.h"
#include "overview/StatusWatch.h"
#include "travel/Travel.h"
#include "ui/terminal/FrontEnd.h"
#include "watching/AlarmWatch.h"

#include <cstdint>
#include <functional>
#include <memory>
#include <optional>
#include <string>

namespace pallax {

struct Settings;

/// One modem or recording on the terminal: its link, its model, its timeline and its front end.
/// Several can share a main queue and a terminal.
class ScreenSession {
public:
    /// What sessions share. All must outlive them.
    struct Screen {
        AsioMainQueue& queue;
        const terminal::Marks& marks;
        StandardOutput& notices;
        const Settings& settings;
        const QualityProfile& profile; ///< judges levels
        OnFatalRecord onFatalRecord;
        bool isSafe;                        ///< from the beginning: see `setSafe`
        std::function<void()> needsDisplay; ///< requests a drawing soon
        std::function<void()> repaint;
        std::function<void(const std::string& text)> copy; ///< to the clipboard
        std::function<void()> ringBell;
        std::function<void(std::size_t number)> chooseModem;
        std::function<void()> switchSafe; ///< for all sessions
        /// Asked often during long work: false stops it. If it takes long, `tell` is called.
        std::function<bool(const std::function<void()>& tell)> mayGoOn;
    };
    /// What a session shows.
    struct Shown {
        SocketDirectory directory;
        ChildService* child; ///< null for a service of this machine
        Source source;
    };

    ScreenSession(const Screen& screen, Shown shown);
    ScreenSession(const ScreenSession&) = delete;
    ScreenSession& operator=(const ScreenSession&) = delete;

    /// Connects and goes on until the queue stops.
    void start();
    /// True when the child ended by itself; the queue is then stopped.
    bool hasLostSource() const { return _session.hasLostSource(); }

    /// What is shown, in a few words.
    const std::string& name() const { return _name; }
    terminal::FrontEnd& frontEnd() { return _frontEnd; }
    /// Whether the source could be played again.
    bool canStartAfresh() const { return !_isReadOnce; }
    /// Shows nothing that identifies a person, or everything again: starts afresh with packets that
    /// are masked as they arrive, or not, so that nothing of the time before is left.
    void setSafe(bool isSafe);
    /// Says why the past is not whole, each time it is looked at.
    void tellTrouble();

private:
    BrowsingSession::Surroundings sessionSurroundings(bool isReadOnce);
    Travel::Surroundings travelSurroundings();
    terminal::FrontEnd::Surroundings frontEndSurroundings();
    bool mayGoOn(const std::string& words);
    void begin(const std::string& technology);
    void mask(bool isSafe);
    void take(Bytes packet, Time time);
    void tick();
    terminal::QuerySeams querySeams();
    const NetworkNames& names();
    QueryKnowledge knowledge();
    Overview overview();
    EntryPart entryPart(const std::string& path) const;

    const Screen& _screen;
    const std::string _name;
    const bool _isReadOnce;
    BrowseLink _link;
    SafePackets _safe;
    StatusWatch _watch;
    SnapshotOverview _snapshot;
    bool _isSnapshot = false; ///< the packets are the displays of a snapshot
    ViewedTimeline _timeline;
    Travel _travel;
    std::optional<std::string> _toldTrouble; ///< of the timeline, since time is held
    AlarmWatch _alarms;
    std::uint64_t _ticks = 0;
    std::optional<NetworkNames> _names; ///< read when a page asks for the first time
    terminal::FrontEnd _frontEnd;
    HostFileSystem _files;
    FilePreferences _preferences;
    BrowsingSession _session;
    std::unique_ptr<RepeatingTimer> _ticking;
    std::optional<LinkNotes> _notes;    ///< once it has started
    std::optional<StreamState> _stream; ///< likewise
};

} // namespace pallax
