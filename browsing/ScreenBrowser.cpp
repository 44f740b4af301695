#include "browsing/ScreenBrowser.h"

#include "browsing/ZoneText.h"
#include "decoding/StampSentence.h"
#include "link/Settings.h"
#include "link/WaitNotice.h"

#include <chrono>
#include <csignal>
#include <filesystem>
#include <utility>

namespace pallax {

namespace {

constexpr std::chrono::milliseconds kTurnInterval{150};

/// Without the folder of a recording, for which a title has no room.
std::string titleOf(const BrowsedSource& source) {
    return std::filesystem::path(source.name).filename().string();
}

} // namespace

bool ScreenBrowser::Files::writePropertyList(const std::string& path, const PropertyList& object) {
    const bool isReplaced = _files.exists(path);
    const bool isWritten = _files.writePropertyList(path, object);
    if (isWritten) {
        _frontEnd.setMessage((isReplaced ? "Replaced " : "Saved ") + path);
    }
    return isWritten;
}

ScreenBrowser::ScreenBrowser(SocketDirectory directory, OnFatalRecord onFatalRecord,
                             ChildService* child, BrowsedSource source, const Settings& settings,
                             terminal::CursesTerminal& terminal, StandardOutput& notices)
    : _source(std::move(source)), _terminal(terminal),
      _link(std::move(directory), onFatalRecord, child, notices),
      _keys(_link.queue(), terminal.inputDescriptor()),
      _frontEnd(frontEndSurroundings(), terminal.marks()), _files(_frontEnd),
      _preferences(FilePreferences::userFolder()), _app(applicationSurroundings(settings)) {
    _frontEnd.setOrigin({"", titleOf(_source)});
}

ScreenBrowser::~ScreenBrowser() {
    _app.applicationWillTerminate();
}

terminal::FrontEnd::Surroundings ScreenBrowser::frontEndSurroundings() {
    return {.needsDisplay = [this] { needsDisplay(); },
            .quit = [this] { _link.queue().stop(); },
            .copy = [this](const std::string& text) { _terminal.copy(text); },
            .repaint =
                [this] {
                    _terminal.repaint();
                    needsDisplay();
                },
            .startAfresh = [this] { startAfresh(); },
            .zone = [this] { return zoneText(_link.clock().zone(_link.clock().now())); }};
}

void ScreenBrowser::startAfresh() {
    if (_source.isReadOnce) {
        return _frontEnd.setMessage("A stream can be played only once");
    }
    _frontEnd.setNote(""); // of what was played until now
    _app.startAfresh();
}

void ScreenBrowser::linkChanged(const std::string& technology,
                                const std::optional<Time>& valuesFrom) {
    _frontEnd.setOrigin({technology, titleOf(_source)});
    const DateFormatter time("HH:mm:ss", _link.clock());
    _frontEnd.setOldValues(valuesFrom ? time.stringFromDate(*valuesFrom) : "");
}

PallaxApp::Surroundings ScreenBrowser::applicationSurroundings(const Settings& settings) {
    PallaxApp::Surroundings surroundings{_frontEnd.toolkit(),
                                         _files,
                                         _preferences,
                                         _link.queue(),
                                         _link.clock(),
                                         _link.present(),
                                         [this](ModelObserver& observer) {
                                             auto model = std::make_unique<PallaxModel>(
                                                 _link.platform(), observer);
                                             _model = model.get();
                                             return model;
                                         }};
    surroundings.startsAfreshByItself = settings.afterReconnect == AfterReconnect::Fresh;
    surroundings.linkChanged = [this](const auto& technology, const auto& valuesFrom) {
        linkChanged(technology, valuesFrom);
    };
    if (settings.snapshotDirectory) {
        surroundings.snapshotDirectory = *settings.snapshotDirectory;
    }
    if (settings.saveButtonMarker) {
        surroundings.saveButtonMarker = *settings.saveButtonMarker;
    }
    return surroundings;
}

bool ScreenBrowser::run() {
    AsioMainQueue& queue = _link.queue();
    // Behind SIGCONT the terminal may have another extent than before.
    queue.onSignal({SIGINT, SIGTERM, SIGHUP, SIGQUIT, SIGWINCH, SIGCONT}, [this](int signal) {
        if (signal == SIGWINCH || signal == SIGCONT) {
            adoptSize();
        } else {
            _link.queue().stop();
        }
    });
    _link.clock().onStampRemark([this](std::uint32_t packet, const StampRemark& remark) {
        _frontEnd.setNote(stampNote(packet, remark));
    });
    if (_link.hasChild()) {
        _link.clock().onEnd([this] { _frontEnd.setNote("End of the recording"); });
    }
    _frontEnd.resize(_terminal.columns(), _terminal.rows());
    _app.applicationDidFinishLaunching();
    waitForKey();
    const auto looks = queue.scheduleRepeating(BrowseLink::kLookInterval, [this] { look(); });
    const WaitNotice notice({queue, [this] { return _model != nullptr && _model->isConnected(); },
                             [this] { return _link.obstacle(); },
                             [this](const std::string& text) { _frontEnd.setNote(text); }});
    queue.run();
    return !_childLost;
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
        _link.queue().stop();
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

void ScreenBrowser::look() {
    if (_link.childHasEnded()) {
        // A signal to the whole process group may be on its way to us too.
        _link.queue().after(BrowseLink::kLookInterval, [this] {
            _childLost = true;
            _link.queue().stop();
        });
    }
}

} // namespace pallax
