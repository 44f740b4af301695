#pragma once

#include "app/PallaxApp.h"
#include "platform/FileSystem.h"
#include "platform/RepeatingTimer.h"

#include <chrono>
#include <functional>
#include <memory>
#include <optional>
#include <string>

namespace pallax {

class RunLoop;

/// The source of the packets.
struct BrowsedSource {
    std::string name; ///< a recording's path or a description
    bool isReadOnce = false;
};

/// The application on any front end, from its launch to its end: builds the application object,
/// watches its source, and reports events that the panes do not show. A front end adds its
/// toolkit, input and drawing.
class BrowsingSession {
public:
    /// The texts that a front end shows beside the panes.
    struct Face {
        /// Shows an event that has just happened.
        std::function<void(const std::string& text)> message;
        /// Shows a few words beside the status until the next call; "" removes them.
        std::function<void(const std::string& text)> note;
        /// Shows the modem's technology ("" before it is known) and the source.
        std::function<void(const std::string& technology, const std::string& source)> origin;
        /// Shows that the values are old, last updated at `time` ("22:13:30"), because the link was
        /// restarted; "" means that they are current.
        std::function<void(const std::string& time)> oldValues;
    };

    /// All references must outlive the session. Queue, timers and loop belong together.
    struct Surroundings {
        ui::Toolkit& toolkit;
        FileSystem& files;
        Preferences& preferences;
        MainQueue& queue;
        TimerScheduler& timers;
        RunLoop& loop;
        const Clock& clock;   ///< for the display
        const Clock& present; ///< for file names
        PallaxApp::ModelMaker makeModel;
        Face face;
        BrowsedSource source;
        /// Whether the source is gone for good; asked at every `lookInterval`.
        std::function<bool()> isSourceGone = [] { return false; };
        std::chrono::nanoseconds lookInterval = std::chrono::milliseconds(500);
        std::optional<std::string> snapshotDirectory = {}; ///< replaces the built-in default
        std::optional<std::string> saveButtonMarker = {};  ///< replaces the built-in default
        bool startsAfreshByItself = false;                 ///< as in PallaxApp::Surroundings
    };

    explicit BrowsingSession(Surroundings surroundings);
    /// Terminates the application, which is required at every exit.
    ~BrowsingSession();
    BrowsingSession(const BrowsingSession&) = delete;
    BrowsingSession& operator=(const BrowsingSession&) = delete;

    /// Launches the application. The caller then runs the loop until it is stopped.
    void start();
    /// Launches the application and runs the loop. False when the source was lost.
    bool run();
    /// Stops the loop.
    void quit();
    /// True when the source was gone at two checks; the loop is then stopped.
    bool hasLostSource() const { return _hasLostSource; }

    /// Replaces the model with a new one, or shows a message if the source can be read only once.
    void startAfresh();
    bool isConnected() const { return _app.isConnected(); }

private:
    /// The front end's files; also shows where a snapshot was saved.
    class Files final : public FileSystem {
    public:
        explicit Files(const Surroundings& surroundings) : _surroundings(surroundings) {}
        bool exists(const std::string& path) const override;
        bool writePropertyList(const std::string& path, const PropertyList& object) override;

    private:
        const Surroundings& _surroundings;
    };

    PallaxApp::Surroundings applicationSurroundings();
    std::string sourceTitle() const;
    void linkChanged(const std::string& technology, const std::optional<Time>& valuesFrom);
    void look();

    Surroundings _surroundings;
    Files _files;
    PallaxApp _app;
    std::unique_ptr<RepeatingTimer> _looks;
    bool _wasGone = false; ///< the source was gone at an earlier check
    bool _hasLostSource = false;
};

} // namespace pallax
