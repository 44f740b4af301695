#include "app/BrowsingSession.h"

#include "app/DateFormatter.h"
#include "platform/RunLoop.h"

#include <filesystem>
#include <utility>

namespace pallax {

bool BrowsingSession::Files::exists(const std::string& path) const {
    return _surroundings.files.exists(path);
}

bool BrowsingSession::Files::writePropertyList(const std::string& path,
                                               const PropertyList& object) {
    const bool isReplaced = exists(path);
    const bool isWritten = _surroundings.files.writePropertyList(path, object);
    if (isWritten) {
        _surroundings.face.message((isReplaced ? "Replaced " : "Saved ") + path);
    }
    return isWritten;
}

BrowsingSession::BrowsingSession(Surroundings surroundings)
    : _surroundings(std::move(surroundings)), _files(_surroundings),
      _app(applicationSurroundings()) {
    _surroundings.face.origin("", sourceTitle());
}

BrowsingSession::~BrowsingSession() {
    _app.applicationWillTerminate();
}

PallaxApp::Surroundings BrowsingSession::applicationSurroundings() {
    PallaxApp::Surroundings surroundings{
        .toolkit = _surroundings.toolkit,
        .files = _files,
        .preferences = _surroundings.preferences,
        .queue = _surroundings.queue,
        .clock = _surroundings.clock,
        .present = _surroundings.present,
        .makeModel = _surroundings.makeModel,
        .startsAfreshByItself = _surroundings.startsAfreshByItself,
        .linkChanged = [this](const std::string& technology,
                              const std::optional<Time>& valuesFrom) {
            linkChanged(technology, valuesFrom);
        }};
    if (_surroundings.snapshotDirectory) {
        surroundings.snapshotDirectory = *_surroundings.snapshotDirectory;
    }
    if (_surroundings.saveButtonMarker) {
        surroundings.saveButtonMarker = *_surroundings.saveButtonMarker;
    }
    return surroundings;
}

/// Leaves out a recording's folder, which does not fit into a title.
std::string BrowsingSession::sourceTitle() const {
    return std::filesystem::path(_surroundings.source.name).filename().string();
}

void BrowsingSession::linkChanged(const std::string& technology,
                                  const std::optional<Time>& valuesFrom) {
    _surroundings.face.origin(technology, sourceTitle());
    const DateFormatter time("HH:mm:ss", _surroundings.clock);
    _surroundings.face.oldValues(valuesFrom ? time.stringFromDate(*valuesFrom) : "");
}

void BrowsingSession::start() {
    _app.applicationDidFinishLaunching();
    _looks = _surroundings.timers.scheduleRepeating(_surroundings.lookInterval, [this] { look(); });
}

bool BrowsingSession::run() {
    start();
    _surroundings.loop.run();
    return !_hasLostSource;
}

void BrowsingSession::quit() {
    _surroundings.loop.stop();
}

void BrowsingSession::startAfresh() {
    if (_surroundings.source.isReadOnce) {
        return _surroundings.face.message("A stream can be played only once");
    }
    _surroundings.face.note(""); // removes the note about the old playback
    _app.startAfresh();
}

/// Acts only at the second check: a signal to the whole process group ends the source, and may
/// reach this process a little later.
void BrowsingSession::look() {
    if (_surroundings.isSourceGone() && std::exchange(_wasGone, true)) {
        _hasLostSource = true;
        quit();
    }
}

} // namespace pallax
