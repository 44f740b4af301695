#pragma once

#include "app/DateFormatter.h"
#include "app/PallaxPaneController.h"
#include "app/PallaxSaveViewController.h"
#include "monitor/DisplayAge.h"
#include "monitor/PallaxModel.h"
#include "platform/ui/NavigationStack.h"
#include "platform/ui/Window.h"

#include <functional>
#include <memory>
#include <optional>
#include <string>
#include <string_view>

namespace pallax {

class Clock;
class FileSystem;
class MainQueue;
class Preferences;

/// The application object: builds window and panes, owns the model, turns its ticks into reloads,
/// opens and closes the snapshot screen, and switches a home-screen preference off at exit.
class PallaxApp final : public ModelObserver,
                        public PaneApplication,
                        public ui::NavigationDelegate {
public:
    static constexpr std::string_view kSnapshotDirectory = "/var/mobile/Library/Logs/Faultbox";
    /// Only where this path exists is the save button offered.
    static constexpr std::string_view kSaveButtonMarker =
        "/NorvaneInternal/Library/PreferenceBundles/Carrier Settings.bundle";

    /// Makes the model, whose observer is the application object.
    using ModelMaker = std::function<std::unique_ptr<PallaxModel>(ModelObserver& observer)>;

    /// Told what the modem speaks (nothing before it is known), and when the shown values came if a
    /// restarted link has left them behind.
    using LinkChanged =
        std::function<void(const std::string& technology, const std::optional<Time>& valuesFrom)>;

    /// All that is referred to outlives the application object. The model's queue is this one.
    struct Surroundings {
        ui::Toolkit& toolkit;
        FileSystem& files;
        Preferences& preferences;
        MainQueue& queue;
        const Clock& clock;   ///< of the display: a recording's while one is played
        const Clock& present; ///< names files
        ModelMaker makeModel;
        std::string snapshotDirectory = std::string(kSnapshotDirectory);
        std::string saveButtonMarker = std::string(kSaveButtonMarker);
        /// When a restarted link leaves the display with its old values.
        bool startsAfreshByItself = false;
        LinkChanged linkChanged = {};
    };

    /// Starts nothing.
    explicit PallaxApp(Surroundings surroundings);
    ~PallaxApp() override;
    PallaxApp(const PallaxApp&) = delete;
    PallaxApp& operator=(const PallaxApp&) = delete;

    /// Shows the root pane and posts the model's first start to the queue.
    void applicationDidFinishLaunching();
    /// Makes a new model in place of the old one, and shows the root pane as at the launch; a
    /// snapshot screen that is open keeps what it holds. Not to be called by the model itself.
    void startAfresh();
    /// To be called at every exit, once.
    void applicationWillTerminate();

    void getSaveButtonPref();
    /// Stores whether the home screen shows the GSM signal strength, and tells it to read again.
    void _setGSMRSSI(bool shown);
    /// Opens the snapshot screen unless it is open.
    void showSaveView() override;
    /// Closes it if it is open.
    void closeSaveView();
    /// Updates the displays that the snapshot screen saves, with every packet that has arrived.
    void bringUpToDate();
    void updateStatusForViewController(PallaxPaneController& pane);
    /// Reloads every pane, or pops back to below the first whose path has vanished; then the
    /// status of the top pane.
    void updateViewControllerFromModel() override;
    void generatorChosen(const std::string& technology, bool keepsDisplay) override;
    void navigationControllerWillShow(ui::NavigationStack& stack, ui::TableScreen& screen,
                                      bool animated) override;

    bool isConnected() const { return _model && _model->isConnected(); }

    /// Null before the launch and after termination.
    ui::Window* window() const { return _window.get(); }
    void setWindow(std::unique_ptr<ui::Window> window) { _window = std::move(window); }
    /// The snapshot screen while it is shown, else null.
    const std::shared_ptr<PallaxSaveViewController>& saveViewController() const {
        return _saveViewController;
    }
    void setSaveViewController(std::shared_ptr<PallaxSaveViewController> screen) {
        _saveViewController = std::move(screen);
    }
    /// The status while connected.
    const std::optional<std::string>& updateMessage() const { return _updateMessage; }
    void setUpdateMessage(std::optional<std::string> message) {
        _updateMessage = std::move(message);
    }
    bool allowSaveButton() const override { return _allowSaveButton; }
    void setAllowSaveButton(bool allowed) { _allowSaveButton = allowed; }
    ui::NavigationStack* navigationController() override { return _navController.get(); }

private:
    NodeRef nodeOf(const PallaxPaneController& pane, std::size_t index);
    void reloadPanes();
    void updateTopStatus();
    /// A block for the queue that does nothing once the application object is gone.
    std::function<void()> whileAlive(void (PallaxApp::*action)());
    void restartMonitor();
    void postRestart();
    void reportLink() const;

    Surroundings _surroundings;
    std::unique_ptr<ui::NavigationStack> _navController;
    std::unique_ptr<ui::Window> _window; // goes before the stack
    std::unique_ptr<PallaxModel> _model;
    std::shared_ptr<PallaxSaveViewController> _saveViewController;
    std::unique_ptr<DateFormatter> _dateFormatter;
    std::optional<std::string> _updateMessage;
    bool _allowSaveButton = false;
    bool _isRestartPosted = false;
    std::string _technology;
    DisplayAge _displayAge;
    std::shared_ptr<PallaxApp*> _alive;
};

} // namespace pallax
