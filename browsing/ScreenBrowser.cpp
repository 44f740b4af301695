#include "browsing/ScreenBrowser.h"

#include "browsing/LinkNotes.h"
#include "host/KnowledgeFiles.h"
#include "host/UserFolders.h"
#include "link/Settings.h"
#include "platform/ZoneText.h"

#include <chrono>
#include <csignal>
#include <utility>

namespace pallax {

namespace {

constexpr std::chrono::milliseconds kTurnInterval{150};

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
                             ChildService* child, BrowsedSource source, const Settings& settings,
                             terminal::CursesTerminal& terminal, StandardOutput& notices)
    : _terminal(terminal), _link(std::move(directory), onFatalRecord, child, notices),
      _keys(_link.queue(), terminal.inputDescriptor()), _watch(_link.resources()),
      _marks(marksWith(terminal.marks(), settings.curves)),
      _frontEnd(frontEndSurroundings(), _marks), _preferences(FilePreferences::userFolder()),
      _session(sessionSurroundings(std::move(source), settings)) {
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
            .values = [this] { return _watch.values(); },
            .names = [this]() -> const NetworkNames& { return names(); },
            .time =
                [this] {
                    const Time now = _link.clock().now();
                    return terminal::DisplayTime{now, _link.clock().zone(now).offset};
                }};
}

BrowsingSession::Surroundings ScreenBrowser::sessionSurroundings(BrowsedSource source,
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
                    return model;
                },
            .face = {.message = [this](const auto& text) { _frontEnd.setMessage(text); },
                     .note = [this](const auto& text) { _frontEnd.setNote(text); },
                     .origin =
                         [this](const auto& technology, const auto& name) {
                             _watch.begin(technology);
                             _frontEnd.setOrigin({technology, name});
                         },
                     .oldValues = [this](const auto& time) { _frontEnd.setOldValues(time); }},
            .source = std::move(source),
            .isSourceGone = [this] { return _link.childHasEnded(); },
            .lookInterval = BrowseLink::kLookInterval,
            .snapshotDirectory = settings.snapshotDirectory,
            .saveButtonMarker = settings.saveButtonMarker,
            .startsAfreshByItself = settings.afterReconnect == AfterReconnect::Fresh};
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
    const Time now = _link.clock().now();
    Overview overview = _watch.overview(now, names(), *builtInProfile(kDefaultProfile));
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
    _frontEnd.resize(_terminal.columns(), _terminal.rows());
    waitForKey();
    return _session.run();
}

void ScreenBrowser::waitForKey() {
    _keys.onceReadable([this] { readKey(); });
}

/// One key at a time: what it posts to the queue comes before the next one.
void ScreenBrowser::readKey() {
    if (const auto key = _terminal.read()) {
        _frontEnd.handle(*key);
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
