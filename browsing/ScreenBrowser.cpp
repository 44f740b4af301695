#include "browsing/ScreenBrowser.h"

#include "browsing/LinkNotes.h"
#include "host/BoundedJournal.h"
#include "host/KnowledgeFiles.h"
#include "host/UserFolders.h"
#include "link/Settings.h"
#include "link/StreamState.h"
#include "platform/ZoneText.h"
#include "querying/QueryHistory.h"
#include "text/Format.h"
#include "timeline/Timeline.h"

#include <chrono>
#include <csignal>
#include <utility>

namespace pallax {

namespace {

constexpr std::chrono::milliseconds kTurnInterval{150};
constexpr std::chrono::milliseconds kSilentWork{100};

/// The terminal's marks, with the curves of the settings unless they must be ASCII.
terminal::Marks marksWith(terminal::Marks marks, CurveCharacters curves) {
    if (!marks.asciiOnly && curves == CurveCharacters::Blocks) {
        marks.curves = terminal::Curves::Blocks;
    } else if (curves == CurveCharacters::Ascii) {
        marks.curves = terminal::Curves::Ascii;
    }
    return marks;
}

} // namespace

ScreenBrowser::ScreenBrowser(SocketDirectory directory, OnFatalRecord onFatalRecord,
                             ChildService* child, const Source& source, const Settings& settings,
                             terminal::CursesTerminal& terminal, StandardOutput& notices,
                             bool isSafe)
    : _terminal(terminal), _link(std::move(directory), onFatalRecord, child, notices),
      _safe(_link.resources()), _keys(_link.queue(), terminal.inputDescriptor()),
      _watch(_link.resources()), _timeline({.link = _link,
                                            .source = source,
                                            .journal = settings.journal,
                                            .onlyWhatHasCome = isSafe,
                                            .indexed =
                                                [this] {
                                                    if (_travel.isAway()) { // the bar grows
                                                        needsDisplay();
                                                    }
                                                },
                                            .replaced =
                                                [this] {
                                                    _travel.reset();
                                                    _frontEnd.forgetTimeline();
                                                }}),
      _travel(travelSurroundings()),
      _alarms({settings.alarms, knowledge(),
               [this](const auto& text) {
                   _frontEnd.toolkit().showAlert({"Alarms that are left out", text, "Close"});
               }}),
      _marks(marksWith(terminal.marks(), settings.curves)),
      _frontEnd(frontEndSurroundings(), _marks), _preferences(FilePreferences::userFolder()),
      _session(sessionSurroundings(source, settings)) {
    if (isSafe) {
        _link.setFilter([this](Bytes packet) { return _safe.masked(packet); });
    }
    _frontEnd.showListsAsTables(settings.lists == Lists::Table);
    if (settings.firstScreen == FirstScreen::Overview) {
        _frontEnd.openOverview();
    }
}

terminal::FrontEnd::Surroundings ScreenBrowser::frontEndSurroundings() {
    return {.needsDisplay = [this] { needsDisplay(); },
            .quit = [this] { _session.quit(); },
            .copy = [this](const std::string& text) { _terminal.copy(text); },
            .repaint =
                [this] {
                    _terminal.repaint();
                    needsDisplay();
                },
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
                    needsDisplay();
                },
            .mayGoOn = [this] { return mayGoOn("Working. Esc stops."); },
            .queries = querySeams(),
            .ahead = [this] { return _link.clock().zone(_link.clock().now()).offset; },
            .travel = &_travel};
}

Travel::Surroundings ScreenBrowser::travelSurroundings() {
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

/// Tells of work that takes long, and looks for the key that stops it.
bool ScreenBrowser::mayGoOn(const std::string& words) {
    const auto now = std::chrono::steady_clock::now();
    if (!_workBegan) {
        _workBegan = now;
    }
    if (now - *_workBegan < kSilentWork) {
        return true;
    }
    if (now - _lookedForKey < kSilentWork) {
        return true;
    }
    _lookedForKey = now;
    _frontEnd.setMessage(words);
    _terminal.show(_frontEnd.draw());
    while (const auto key = _terminal.read()) {
        if (key->key == terminal::Key::Escape) {
            return false;
        }
        _typedAhead.push_back(*key);
    }
    return true;
}

BrowsingSession::Surroundings ScreenBrowser::sessionSurroundings(const Source& source,
                                                                 const Settings& settings) {
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
                    model->onPacket(
                        [this](Bytes packet, Time time) { _timeline.add(packet, time); });
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
            .source = {sourceName(source), isReadOnce(source)},
            .isSourceGone = [this] { return _link.childHasEnded(); },
            .lookInterval = BrowseLink::kLookInterval,
            .snapshotDirectory = settings.snapshotDirectory,
            .saveButtonMarker = settings.saveButtonMarker,
            .startsAfreshByItself = settings.afterReconnect == AfterReconnect::Fresh};
}

EntryPart ScreenBrowser::entryPart(const std::string& path) const {
    if (_watch.namesCell(path)) {
        return EntryPart::Cell;
    }
    return _watch.identifies(path) ? EntryPart::Identity : EntryPart::None;
}

void ScreenBrowser::begin(const std::string& technology) {
    _alarms.begin(nullptr); // the values end
    _safe.begin(technology);
    _watch.begin(technology);
    _timeline.begin(technology);
    _alarms.begin(_watch.values());
    _frontEnd.setAlarms({});
}

/// Comes also while there are no packets, when ages grow.
void ScreenBrowser::tick() {
    const Time now = _link.clock().now();
    const StateMoment moment{now, _link.clock().packetNumber(), ++_ticks};
    for (const AlarmWatch::Change& change : _alarms.tick(moment)) {
        const auto held = std::chrono::round<std::chrono::seconds>(change.held).count();
        _watch.add({EventKind::Alarm,
                    now,
                    moment.packet,
                    change.isTrue ? "alarm: " + change.rule->name
                                  : formatText("alarm ended: %@ (held for %lld s)",
                                               {change.rule->name, held}),
                    {}});
        if (change.isTrue && change.rule->ringsBell) {
            _terminal.ringBell();
        }
    }
    _frontEnd.setAlarms(_alarms.holding());
}

/// Says why the past is not whole, each time it is looked at.
void ScreenBrowser::tellTrouble() {
    auto trouble = _travel.isAway() ? _timeline.trouble() : std::nullopt;
    if (trouble && trouble != _toldTrouble) {
        _frontEnd.setMessage(*trouble);
    }
    _toldTrouble = std::move(trouble);
}

/// The history is that of the shell of `pallax sql`, where a query ends in ";" and other lines are
/// commands, which begin with ".".
terminal::QuerySeams ScreenBrowser::querySeams() {
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
QueryKnowledge ScreenBrowser::knowledge() {
    return {[this] { return &names(); },
            [](std::string_view name) {
                auto profile = loadProfile(name, profileFolder());
                return profile ? std::optional(std::move(profile).value()) : std::nullopt;
            }};
}

const NetworkNames& ScreenBrowser::names() {
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

Overview ScreenBrowser::overview() {
    const QualityProfile profile = *builtInProfile(kDefaultProfile);
    const Time now = _link.clock().now();
    Overview overview = _travel.isAway() ? overviewAt(_travel.moment(), names(), profile)
                                         : _watch.overview(now, names(), profile);
    overview.ahead = _link.clock().zone(now).offset;
    return overview;
}

bool ScreenBrowser::run() {
    // After SIGCONT the terminal may have another extent than before.
    _link.queue().onSignal({SIGINT, SIGTERM, SIGHUP, SIGQUIT, SIGWINCH, SIGCONT},
                           [this](int signal) {
                               if (signal == SIGWINCH || signal == SIGCONT) {
                                   adoptSize();
                               } else {
                                   _session.quit();
                               }
                           });
    const LinkNotes notes(
        _link, [this] { return _session.isConnected(); },
        [this](const std::string& text) { _frontEnd.setNote(text); });
    const StreamState stream({_link.queue(), [this] { return _session.isConnected(); },
                              [this] { return _link.clock().isLive(); },
                              [this] { return _link.received(); },
                              [this] { return _link.briefObstacle(); },
                              [this](const std::string& text) { _frontEnd.setStream(text); }});
    _frontEnd.resize(_terminal.columns(), _terminal.rows());
    _ticking = _link.clock().scheduleRepeating(PallaxModel::kDisplayInterval, [this] { tick(); });
    waitForKey();
    return _session.run();
}

void ScreenBrowser::waitForKey() {
    _keys.onceReadable([this] { readKey(); });
}

/// One key at a time: what it posts to the queue comes before the next one.
void ScreenBrowser::readKey() {
    std::optional<terminal::KeyEvent> key;
    if (_typedAhead.empty()) {
        key = _terminal.read();
    } else {
        key = _typedAhead.front();
        _typedAhead.pop_front();
    }
    if (key) {
        _workBegan.reset();
        _frontEnd.handle(*key);
        tellTrouble();
        _link.queue().async([this] { readKey(); });
    } else if (_terminal.isHungUp()) {
        _session.quit();
    } else {
        waitForKey();
    }
}

void ScreenBrowser::needsDisplay() {
    if (!_isDisplayPosted) {
        _isDisplayPosted = true;
        _link.queue().async([this] { display(); });
    }
}

void ScreenBrowser::display() {
    _terminal.show(_frontEnd.draw());
    _isDisplayPosted = false; // drawing itself asks for no other drawing
    keepTurning();
}

void ScreenBrowser::keepTurning() {
    if (!_frontEnd.isAnimated()) {
        _turning.reset();
    } else if (!_turning) {
        _turning = _link.queue().scheduleRepeating(kTurnInterval, [this] { _frontEnd.turn(); });
    }
}

void ScreenBrowser::adoptSize() {
    _terminal.adoptSize();
    _frontEnd.resize(_terminal.columns(), _terminal.rows());
}

} // namespace pallax
