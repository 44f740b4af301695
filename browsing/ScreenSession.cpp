#include "browsing/ScreenSession.h"

#include "host/BoundedJournal.h"
#include "host/KnowledgeFiles.h"
#include "host/Snapshot.h"
#include "host/UserFolders.h"
#include "link/Settings.h"
#include "platform/ZoneText.h"
#include "querying/QueryHistory.h"
#include "text/Format.h"
#include "timeline/Timeline.h"

#include <chrono>
#include <utility>

namespace pallax {

ScreenSession::ScreenSession(const Screen& screen, Shown shown)
    : _screen(screen), _name(sourceName(shown.source)), _isReadOnce(isReadOnce(shown.source)),
      _link(screen.queue, std::move(shown.directory), screen.onFatalRecord, shown.child,
            screen.notices),
      _safe(_link.resources()), _watch(_link.resources()), _snapshot(_link.resources()),
      _timeline({.link = _link,
                 .source = shown.source,
                 .journal = screen.settings.journal,
                 .onlyWhatHasCome = screen.isSafe,
                 .indexed =
                     [this] {
                         if (_travel.isAway()) { // the bar grows
                             _screen.needsDisplay();
                         }
                     },
                 .replaced =
                     [this] {
                         _travel.reset();
                         _frontEnd.forgetTimeline();
                     }}),
      _travel(travelSurroundings()),
      _alarms({screen.settings.alarms, knowledge(),
               [this](const auto& text) {
                   _frontEnd.toolkit().showAlert({"Alarms that are left out", text, "Close"});
               }}),
      _frontEnd(frontEndSurroundings(), screen.marks), _preferences(FilePreferences::userFolder()),
      _session(sessionSurroundings(_isReadOnce)) {
    mask(screen.isSafe);
    _frontEnd.setSafe(screen.isSafe);
    _frontEnd.showListsAsTables(screen.settings.lists == Lists::Table);
    if (screen.settings.firstScreen == FirstScreen::Overview) {
        _frontEnd.openOverview();
    }
}

void ScreenSession::start() {
    const auto isConnected = [this] { return _session.isConnected(); };
    _notes.emplace(_link, isConnected,
                   [this](const std::string& text) { _frontEnd.setNote(text); });
    _stream.emplace(StreamState::Setup{
        _screen.queue, isConnected, [this] { return _link.clock().isLive(); },
        [this] { return _link.received(); }, [this] { return _link.briefObstacle(); },
        [this](const std::string& text) { _frontEnd.setStream(text); }});
    _ticking = _link.clock().scheduleRepeating(PallaxModel::kDisplayInterval, [this] { tick(); });
    _session.start();
}

void ScreenSession::setSafe(bool isSafe) {
    _travel.reset();
    _frontEnd.forgetTimeline();
    _timeline.restart(isSafe);
    mask(isSafe);
    _session.startAfresh();
    _frontEnd.setSafe(isSafe);
}

/// Applies to the packets that follow.
void ScreenSession::mask(bool isSafe) {
    _link.setFilter(
        isSafe ? LinkPorts::PacketFilter([this](Bytes packet) { return _safe.masked(packet); })
               : nullptr);
}

bool ScreenSession::mayGoOn(const std::string& words) {
    return _screen.mayGoOn([this, &words] { _frontEnd.setMessage(words); });
}

terminal::FrontEnd::Surroundings ScreenSession::frontEndSurroundings() {
    return {.needsDisplay = _screen.needsDisplay,
            .quit = [this] { _session.quit(); },
            .copy = _screen.copy,
            .repaint = _screen.repaint,
            .startAfresh = [this] { _session.startAfresh(); },
            .zone = [this] { return zoneText(_link.clock().zone(_link.clock().now())); },
            .overview = [this] { return overview(); },
            .entryPart = [this](const auto& path) { return entryPart(path); },
            .moment = [this] { return _travel.moment(); },
            .values = [this] { return _watch.values(); },
            .names = [this]() -> const NetworkNames& { return names(); },
            .time =
                [this] {
                    const Time now = _travel.isAway() ? _travel.time().value_or(_link.clock().now())
                                                      : _link.clock().now();
                    return terminal::DisplayTime{now, _link.clock().zone(now).offset};
                },
            .goTo =
                [this](std::uint64_t packet) {
                    if (const auto refusal = _travel.toInstant(packet)) {
                        _frontEnd.setMessage(*refusal);
                    }
                    _screen.needsDisplay();
                },
            .mayGoOn = [this] { return mayGoOn("Working. Esc stops."); },
            .queries = querySeams(),
            .ahead = [this] { return _link.clock().zone(_link.clock().now()).offset; },
            .travel = &_travel,
            .chooseModem = _screen.chooseModem,
            .profile = [this]() -> const QualityProfile& { return _screen.profile; },
            .switchSafe = _screen.switchSafe};
}

Travel::Surroundings ScreenSession::travelSurroundings() {
    return {.timeline = [this] { return _timeline.timeline(); },
            .present = [this] { return _timeline.present(); },
            .now = [this] { return _link.clock().now(); },
            .steadyNow = std::chrono::steady_clock::now,
            .zone = [this](Time time) { return _link.clock().zone(time).offset; },
            .knowledge = knowledge(),
            .progress =
                [this](double share) {
                    return mayGoOn(formatText("Searching: %d %%. Esc stops.",
                                              {static_cast<int>(share * 100)}));
                }};
}

BrowsingSession::Surroundings ScreenSession::sessionSurroundings(bool isReadOnce) {
    const Settings& settings = _screen.settings;
    return {.toolkit = _frontEnd.toolkit(),
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
            .face = {.message = [this](const auto& text) { _frontEnd.setMessage(text); },
                     .note = [this](const auto& text) { _frontEnd.setNote(text); },
                     .origin =
                         [this](const auto& technology, const auto& name) {
                             begin(technology);
                             _frontEnd.setOrigin({technology, name});
                         },
                     .oldValues = [this](const auto& time) { _frontEnd.setOldValues(time); }},
            .source = {_name, isReadOnce},
            .isSourceGone = [this] { return _link.childHasEnded(); },
            .lookInterval = BrowseLink::kLookInterval,
            .snapshotDirectory = settings.snapshotDirectory,
            .saveButtonMarker = settings.saveButtonMarker,
            .startsAfreshByItself = settings.afterReconnect == AfterReconnect::Fresh};
}

EntryPart ScreenSession::entryPart(const std::string& path) const {
    if (_watch.namesCell(path)) {
        return EntryPart::Cell;
    }
    return _watch.identifies(path) ? EntryPart::Identity : EntryPart::None;
}

void ScreenSession::begin(const std::string& technology) {
    _alarms.begin(nullptr); // the values end
    _isSnapshot = technology == kSnapshotTechnology.identifier;
    _safe.begin(technology);
    _watch.begin(technology);
    _timeline.begin(technology);
    _alarms.begin(_watch.values());
    _frontEnd.setAlarms({});
}

void ScreenSession::take(Bytes packet, Time time) {
    if (_isSnapshot) {
        _snapshot.take(packet, time);
    } else {
        _timeline.add(packet, time);
    }
}

/// Comes also while there are no packets, when ages grow.
void ScreenSession::tick() {
    const Time now = _link.clock().now();
    const StateMoment moment{now, _link.clock().packetNumber(), ++_ticks};
    for (const AlarmWatch::Change& change : _alarms.tick(moment)) {
        const auto held = std::chrono::round<std::chrono::seconds>(change.held).count();
        Event event{EventKind::Alarm,
                    now,
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
        if (change.isTrue && change.rule->ringsBell) {
            _screen.ringBell();
        }
    }
    _frontEnd.setAlarms(_alarms.holding());
}

void ScreenSession::tellTrouble() {
    auto trouble = _travel.isAway() ? _timeline.trouble() : std::nullopt;
    if (trouble && trouble != _toldTrouble) {
        _frontEnd.setMessage(*trouble);
    }
    _toldTrouble = std::move(trouble);
}

/// The history is that of the shell of `pallax sql`, where a query ends in ";" and other lines are
/// commands, which begin with ".".
terminal::QuerySeams ScreenSession::querySeams() {
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

/// As `installedKnowledge`, but complaints go to the screen.
QueryKnowledge ScreenSession::knowledge() {
    return {[this] { return &names(); },
            [](std::string_view name) {
                auto profile = loadProfile(name, profileFolder());
                return profile ? std::optional(std::move(profile).value()) : std::nullopt;
            }};
}

const NetworkNames& ScreenSession::names() {
    if (!_names) {
        InstalledNames installed = readInstalledNames(dataFolders());
        for (const std::string& complaint : installed.complaints) {
            // Not while the screen is being drawn.
            _link.queue().async([this, complaint] { _frontEnd.setMessage(complaint); });
        }
        _names = std::move(installed.names);
    }
    return *_names;
}

Overview ScreenSession::overview() {
    const Time now = _link.clock().now();
    Overview overview = _isSnapshot        ? _snapshot.overview(names(), _screen.profile)
                        : _travel.isAway() ? overviewAt(_travel.moment(), names(), _screen.profile)
                                           : _watch.overview(now, names(), _screen.profile);
    overview.ahead = _link.clock().zone(now).offset;
    return overview;
}

} // namespace pallax
