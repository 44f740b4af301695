#include "browsing/ViewerSession.h"

#include "host/BoundedJournal.h"
#include "host/KnowledgeFiles.h"
#include "host/Snapshot.h"
#include "host/UserFolders.h"
#include "link/Settings.h"
#include "platform/RecordedTechnology.h"
#include "querying/QueryHistory.h"
#include "text/Format.h"
#include "timeline/Timeline.h"

#include <chrono>
#include <utility>

namespace pallax {

ViewerSession::ViewerSession(Setup setup)
    : _queue(setup.queue), _settings(setup.settings), _profile(setup.profile),
      _face(std::move(setup.face)), _name(sourceName(setup.source)),
      _isReadOnce(isReadOnce(setup.source)), _link(setup.queue, std::move(setup.directory),
                                                   setup.onFatalRecord, setup.child, setup.notices),
      _safe(_link.resources()), _watch(_link.resources()), _snapshot(_link.resources()),
      _timeline({.link = _link,
                 .source = setup.source,
                 .journal = _settings.journal,
                 .onlyWhatHasCome = setup.isSafe,
                 .indexed = [this] { _face.timelineGrew(); },
                 .replaced =
                     [this] {
                         _travel.reset();
                         _face.timelineReplaced();
                     }}),
      _travel(travelSurroundings()),
      _alarms({_settings.alarms, knowledge(),
               [this](const auto& text) {
                   _toolkit->showAlert({"Alarms that are left out", text, "Close"});
               }}),
      _preferences(FilePreferences::userFolder()) {
    mask(setup.isSafe);
    _link.setPause(setup.pause);
}

void ViewerSession::attach(ui::Toolkit& toolkit) {
    _toolkit = &toolkit;
    _session.emplace(sessionSurroundings(toolkit));
}

void ViewerSession::start() {
    const auto isConnected = [this] { return _session->isConnected(); };
    _notes.emplace(_link, isConnected, _face.note);
    _stream.emplace(StreamState::Setup{_queue, isConnected,
                                       [this] { return _link.clock().isLive(); },
                                       [this] { return _link.received(); },
                                       [this] { return _link.briefObstacle(); }, _face.stream});
    _ticking = _link.clock().scheduleRepeating(PallaxModel::kDisplayInterval, [this] { tick(); });
    _session->start();
}

void ViewerSession::setSafe(bool isSafe) {
    _travel.reset();
    _face.timelineReplaced();
    _timeline.restart(isSafe);
    mask(isSafe);
    _session->startAfresh();
}

void ViewerSession::recordWith(
    std::function<void(const RecordedTechnology&, Time stamp, Bytes packet)> recorder) {
    _link.setTap(recorder
                     ? LinkPorts::PacketTap([this, recorder = std::move(recorder)](Bytes packet) {
                           if (_technology != nullptr) {
                               recorder(*_technology, _link.clock().stamp(), packet);
                           }
                       })
                     : nullptr);
}

/// Applies to the packets that follow.
void ViewerSession::mask(bool isSafe) {
    _link.setFilter(
        isSafe ? LinkPorts::PacketFilter([this](Bytes packet) { return _safe.masked(packet); })
               : nullptr);
}

Time ViewerSession::time() const {
    return _travel.isAway() ? _travel.time().value_or(now()) : now();
}

Travel::Surroundings ViewerSession::travelSurroundings() {
    return {.timeline = [this] { return _timeline.timeline(); },
            .present = [this] { return _timeline.present(); },
            .now = [this] { return now(); },
            .steadyNow = std::chrono::steady_clock::now,
            .zone = [this](Time time) { return zone(time).offset; },
            .knowledge = knowledge(),
            .progress =
                [this](double share) {
                    return _face.mayGoOn(formatText("Searching: %d %%. Esc stops.",
                                                    {static_cast<int>(share * 100)}));
                }};
}

BrowsingSession::Surroundings ViewerSession::sessionSurroundings(ui::Toolkit& toolkit) {
    return {.toolkit = toolkit,
            .files = _files,
            .preferences = _preferences,
            .queue = _link.queue(),
            .timers = _link.queue(),
            .loop = _link.queue(),
            .clock = _link.clock(),
            .present = _link.present(),
            .makeModel =
                [this](ModelObserver& observer) {
                    auto model = std::make_unique<PallaxModel>(_link.platform(), observer);
                    model->addSampleSink(_watch);
                    model->onPacket([this](Bytes packet, Time time) { take(packet, time); });
                    return model;
                },
            .face = {.message = _face.message,
                     .note = _face.note,
                     .origin =
                         [this](const auto& technology, const auto& name) {
                             begin(technology);
                             _face.origin(technology, name);
                         },
                     .oldValues = _face.oldValues},
            .source = {_name, _isReadOnce},
            .isSourceGone = [this] { return _link.childHasEnded(); },
            .lookInterval = BrowseLink::kLookInterval,
            .snapshotDirectory = _settings.snapshotDirectory,
            .saveButtonMarker = _settings.saveButtonMarker,
            .startsAfreshByItself = _settings.afterReconnect == AfterReconnect::Fresh};
}

EntryPart ViewerSession::entryPart(const std::string& path) const {
    if (_watch.namesCell(path)) {
        return EntryPart::Cell;
    }
    return _watch.identifies(path) ? EntryPart::Identity : EntryPart::None;
}

void ViewerSession::begin(const std::string& technology) {
    _alarms.begin(nullptr); // the values end
    _isSnapshot = technology == kSnapshotTechnology.identifier;
    _technology = technologyOfIdentifier(technology);
    _safe.begin(technology);
    _watch.begin(technology);
    _timeline.begin(technology);
    _alarms.begin(_watch.values());
    _face.alarms({});
}

void ViewerSession::take(Bytes packet, Time time) {
    if (_isSnapshot) {
        _snapshot.take(packet, time);
    } else {
        _timeline.add(packet, time);
    }
}

/// Comes also while there are no packets, when ages grow.
void ViewerSession::tick() {
    const StateMoment moment{now(), _link.clock().packetNumber(), ++_ticks};
    for (const AlarmWatch::Change& change : _alarms.tick(moment)) {
        const auto held = std::chrono::round<std::chrono::seconds>(change.held).count();
        Event event{EventKind::Alarm,
                    moment.time,
                    moment.packet,
                    change.isTrue ? "alarm: " + change.rule->name
                                  : formatText("alarm ended: %@ (held for %lld s)",
                                               {change.rule->name, held}),
                    {}};
        _watch.add(event);
        if (Timeline* const timeline = _timeline.timeline()) {
            event.packet = _timeline.present();
            timeline->add(std::move(event));
        }
        if (change.isTrue) {
            _face.alarmBegan(*change.rule);
        }
    }
    _face.alarms(_alarms.holding());
}

void ViewerSession::tellTrouble() {
    auto trouble = _travel.isAway() ? _timeline.trouble() : std::nullopt;
    if (trouble && trouble != _toldTrouble) {
        _face.message(*trouble);
    }
    _toldTrouble = std::move(trouble);
}

/// As `installedKnowledge`, but complaints go to the screen.
QueryKnowledge ViewerSession::knowledge() {
    return {[this] { return &names(); },
            [](std::string_view name) {
                auto profile = loadProfile(name, profileFolder());
                return profile ? std::optional(std::move(profile).value()) : std::nullopt;
            }};
}

/// The history is that of the shell of `pallax sql`, where a query ends in ";" and other lines are
/// commands, which begin with ".".
QuerySeams ViewerSession::querySeams() {
    return {.earlier =
                [] {
                    auto lines = QueryHistory(BoundedJournal::stateFolder()).load();
                    std::erase_if(lines, [](const auto& line) { return line.starts_with('.'); });
                    return lines;
                },
            .remember =
                [](const std::string& query) {
                    (void)QueryHistory(BoundedJournal::stateFolder())
                        .add(query.ends_with(';') ? query : query + ';');
                },
            .addFunctions =
                [this](Database& database, Timeline& timeline) {
                    pallax::addFunctions(database, knowledge(), &timeline.fields());
                }};
}

const NetworkNames& ViewerSession::names() {
    if (!_names) {
        InstalledNames installed = readInstalledNames(dataFolders());
        for (const std::string& complaint : installed.complaints) {
            // Not while the screen is being drawn.
            _queue.async([this, complaint] { _face.message(complaint); });
        }
        _names = std::move(installed.names);
    }
    return *_names;
}

Overview ViewerSession::overview() {
    Overview overview = _isSnapshot        ? _snapshot.overview(names(), _profile)
                        : _travel.isAway() ? overviewAt(_travel.moment(), names(), _profile)
                                           : _watch.overview(now(), names(), _profile);
    overview.ahead = zone(now()).offset;
    return overview;
}

} // namespace pallax
