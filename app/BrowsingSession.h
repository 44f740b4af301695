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

/// Where the packets come from.
struct BrowsedSource {
    std::string name; ///< a recording's path, or words
    bool isReadOnce = false;
};

/// The application on any front end, from its launch to its end: builds the application object,
/// looks after its source, and says what happens beside the panes. A front end adds its toolkit,
/// its input and its drawing.
class BrowsingSession {
public:
    /// Where a front end shows words beside the panes.
    struct Face {
        /// What has just happened.
        std::function<void(const std::string& text)> message;
        /// A few words beside the status, from now on; none for an empty text.
        std::function<void(const std::string& text)> note;
        /// What the values come from: what the modem speaks ("" before it is known), and the
        /// source.
        std::function<void(const std::string& technology, const std::string& source)> origin;
        /// A restarted link has left the values behind, which are from before `time` ("22:13:30");
        /// with an empty text, they follow the modem.
        std::function<void(const std::string& time)> oldValues;
    };

    /// All that is referred to outlives the session. Queue, timers and loop belong together.
    struct Surroundings {
        ui::Toolkit& toolkit;
        FileSystem& files;
        Preferences& preferences;
        MainQueue& queue;
        TimerScheduler& timers;
        RunLoop& loop;
        const Clock& clock;   ///< of the display
        const Clock& present; ///< names files
        PallaxApp::ModelMaker makeModel;
        Face face;
        BrowsedSource source;
        /// Whether the source is gone for good; asked at every `lookInterval`.
        std::function<bool()> isSourceGone = [] { return false; };
        std::chrono::nanoseconds lookInterval = std::chrono::milliseconds(500);
        std::optional<std::string> snapshotDirectory = {}; ///< instead of the built-in default
        std::optional<std::string> saveButtonMarker = {};  ///< the same
        bool startsAfreshByItself = false;                 ///< as PallaxApp::Surroundings
    };

    explicit BrowsingSession(Surroundings surroundings);
    /// The application terminates as it is to at every exit.
    ~BrowsingSession();
    BrowsingSession(const BrowsingSession&) = delete;
    BrowsingSession& operator=(const BrowsingSession&) = delete;

    /// Launches the application. The loop is the caller's: it runs until it is stopped.
    void start();
    /// Launches the application and runs the loop. False when the source was lost.
    bool run();
    /// Stops the loop.
    void quit();
    /// True when the source was gone at two looks, which has stopped the loop.
    bool hasLostSource() const { return _hasLostSource; }

    /// A new model in place of the old one; says so where the source can be read only once.
    void startAfresh();
    bool isConnected() const { return _app.isConnected(); }

private:
    /// The front end's files; tells where a snapshot went.
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
    bool _wasGone = false; ///< the source, at an earlier look
    bool _hasLostSource = false;
};

} // namespace pallax
