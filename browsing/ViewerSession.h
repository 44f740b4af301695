#pragma once

#include "app/BrowsingSession.h"
#include "app/table/ListTable.h"
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
#include "platform/Clock.h"
#include "travel/Travel.h"
#include "ui/contents/QueryContent.h"
#include "watching/AlarmWatch.h"

#include <chrono>
#include <cstdint>
#include <functional>
#include <memory>
#include <optional>
#include <string>
#include <vector>

namespace pallax {

struct RecordedTechnology;
struct Settings;

/// One modem or recording under any front end: its link, its model, its timeline and its alarms.
/// Several can share a main queue.
class ViewerSession {
public:
    /// What a front end shows of a session, beside the panes. Each may be called before the front
    /// end is attached.
    struct Face {
        std::function<void(const std::string& text)> message; ///< an event that has just happened
        std::function<void(const std::string& text)> note;    ///< as BrowsingSession::Face
        std::function<void(const std::string& technology, const std::string& source)> origin;
        std::function<void(const std::string& time)> oldValues; ///< as BrowsingSession::Face
        /// Why nothing changes ("no data for 7 s"); "" if the display is as current as it can be.
        std::function<void(const std::string& state)> stream;
        /// The names of the alarms that are true, at each tick.
        std::function<void(std::vector<std::string> names)> alarms;
        /// An alarm has become true.
        std::function<void(const AlarmRule& rule)> alarmBegan;
        std::function<void()> timelineGrew;
        std::function<void()> timelineReplaced;
        /// Asked often during long work, which these words tell of; false stops it.
        std::function<bool(const std::string& words)> mayGoOn;
    };
    /// References must outlive the session.
    struct Setup {
        AsioMainQueue& queue;
        StandardOutput& notices;
        const Settings& settings;
        const QualityProfile& profile; ///< judges levels
        OnFatalRecord onFatalRecord;
        bool isSafe; ///< from the beginning: see `setSafe`
        SocketDirectory directory;
        ChildService* child; ///< null for a service of this machine
        Source source;
        Face face;
        /// Packets that come slowly are taken together, after such pauses (SocketLocalPort).
        std::chrono::milliseconds pause{0};
    };

    explicit ViewerSession(Setup setup);
    ViewerSession(const ViewerSession&) = delete;
    ViewerSession& operator=(const ViewerSession&) = delete;

    /// Builds the application on a front end's toolkit. Call it once, before everything below.
    void attach(ui::Toolkit& toolkit);
    /// Terminates the application, while its toolkit still exists. Nothing comes after it.
    void detach() { _session.reset(); }
    /// Connects and runs until the queue stops.
    void start();
    /// True when the child ended by itself; the queue is then stopped.
    bool hasLostSource() const { return _session->hasLostSource(); }
    void startAfresh() { _session->startAfresh(); }
    void quit() { _session->quit(); }

    /// What is shown, in a few words.
    const std::string& name() const { return _name; }
    /// Whether the source could be played again.
    bool canStartAfresh() const { return !_isReadOnce; }
    /// Shows nothing that identifies a person, or everything again: starts afresh with packets that
    /// are masked as they arrive, or not, so that nothing of the time before is left.
    void setSafe(bool isSafe);
    /// Gives each packet, with the stamp of its source, to a recorder before it is decoded: as it
    /// is shown, so masked while nothing identifies a person. An empty function ends that.
    void
    recordWith(std::function<void(const RecordedTechnology&, Time stamp, Bytes packet)> recorder);
    /// Says why the past is not whole, each time it is looked at.
    void tellTrouble();

    /// Which instant is shown.
    Travel& travel() { return _travel; }
    /// The time of what is shown.
    Time time() const;
    /// The zone in force at a time of the source.
    Clock::Zone zone(Time time) const { return _link.clock().zone(time); }
    Time now() const { return _link.clock().now(); }
    /// What the overview shows now.
    Overview overview();
    /// The current values while there is no timeline; null if there are none.
    const CurrentValues* values() const { return _watch.values(); }
    EntryPart entryPart(const std::string& path) const;
    const NetworkNames& names();
    QueryKnowledge knowledge();
    QuerySeams querySeams();

private:
    BrowsingSession::Surroundings sessionSurroundings(ui::Toolkit& toolkit);
    Travel::Surroundings travelSurroundings();
    void begin(const std::string& technology);
    void mask(bool isSafe);
    void take(Bytes packet, Time time);
    void tick();

    AsioMainQueue& _queue;
    const Settings& _settings;
    const QualityProfile& _profile;
    const Face _face;
    const std::string _name;
    const bool _isReadOnce;
    BrowseLink _link;
    SafePackets _safe;
    StatusWatch _watch;
    SnapshotOverview _snapshot;
    bool _isSnapshot = false; ///< the packets are the displays of a snapshot
    const RecordedTechnology* _technology =
        nullptr; ///< of the packets; null: none that is recorded
    ViewedTimeline _timeline;
    Travel _travel;
    std::optional<std::string> _toldTrouble; ///< of the timeline, since time is held
    AlarmWatch _alarms;
    std::uint64_t _ticks = 0;
    std::optional<NetworkNames> _names; ///< read when a page asks for the first time
    ui::Toolkit* _toolkit = nullptr;    ///< once a front end is attached
    HostFileSystem _files;
    FilePreferences _preferences;
    std::optional<BrowsingSession> _session; ///< likewise
    std::unique_ptr<RepeatingTimer> _ticking;
    std::optional<LinkNotes> _notes;    ///< once it has started
    std::optional<StreamState> _stream; ///< likewise
};

} // namespace pallax
