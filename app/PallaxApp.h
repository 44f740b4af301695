#pragma once

#include "app/DateFormatter.h"
#include "app/PallaxPaneController.h"
#include "app/PallaxSaveViewController.h"
#include "monitor/DisplayAge.h"
#include "monitor/PallaxModel.h"
#include "monitor/ValueAges.h"
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

/// The application object: creates window and panes, owns the model, reloads the panes at its
/// ticks, opens and closes the snapshot screen, and switches a home-screen preference off at exit.
class PallaxApp final : public ModelObserver,
                        public PaneApplication,
                        public ui::NavigationDelegate {
public:
    static constexpr std::string_view kSnapshotDirectory = "/var/mobile/Library/Logs/Faultbox";
    /// The save button is offered only if this path exists.
    static constexpr std::string_view kSaveButtonMarker =
        "/NorvaneInternal/Library/PreferenceBundles/Carrier Settings.bundle";

    /// Creates the model, whose observer is the application object.
    using ModelMaker = std::function<std::unique_ptr<PallaxModel>(ModelObserver& observer)>;

    /// Receives the technology (empty until known) and, if a restarted link left old values on
    /// display, their time.
    using LinkChanged =
        std::function<void(const std::string& technology, const std::optional<Time>& valuesFrom)>;

    /// All references must outlive the application object. The model must use the same queue.
    struct Surroundings {
        ui::Toolkit& toolkit;
        FileSystem& files;
        Preferences& preferences;
        MainQueue& queue;
        const Clock& clock;   ///< for the display; in a recording, the recording's
        const Clock& present; ///< for file names
        ModelMaker makeModel;
        std::string snapshotDirectory = std::string(kSnapshotDirectory);
        std::string saveButtonMarker = std::string(kSaveButtonMarker);
        /// Whether to start afresh after a restart of the link.
        bool startsAfreshByItself = false;
        LinkChanged linkChanged = {};
    };

    /// Does not launch the application.
    explicit PallaxApp(Surroundings surroundings);
    ~PallaxApp() override;
    PallaxApp(const PallaxApp&) = delete;
    PallaxApp& operator=(const PallaxApp&) = delete;

    /// Shows the root pane and posts the first start of the model to the queue.
    void applicationDidFinishLaunching();
    /// Replaces the model with a new one and shows the root pane as at launch; an open snapshot
    /// screen keeps its contents. The model itself must not call this.
    void startAfresh();
    /// Must be called at every exit, once.
    void applicationWillTerminate();

    void getSaveButtonPref();
    /// Stores whether the home screen shows the GSM signal strength, and notifies it.
    void _setGSMRSSI(bool shown);
    /// Opens the snapshot screen unless it is open.
    void showSaveView() override;
    /// Closes it if it is open.
    void closeSaveView();
    /// Brings the displays that the snapshot screen saves up to date with the latest packet.
    void bringUpToDate();
    void updateStatusForViewController(PallaxPaneController& pane);
    /// Reloads every pane, or pops to below the first whose path has vanished, then updates the
    /// status of the top pane.
    void updateViewControllerFromModel() override;
    void generatorChosen(const std::string& technology, bool keepsDisplay) override;
    void navigationControllerWillShow(ui::NavigationStack& stack, ui::TableScreen& screen,
                                      bool animated) override;

    bool isConnected() const { return _model && _model->isConnected(); }

    /// Null before the launch and after termination.
    ui::Window* window() const { return _window.get(); }
    void setWindow(std::unique_ptr<ui::Window> window) { _window = std::move(window); }
    /// The snapshot screen while it is shown, otherwise null.
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
    /// By the display's clock.
    ReadingAges readingAges() override;
    ui::NavigationStack* navigationController() override { return _navController.get(); }

private:
    NodeRef nodeOf(const PallaxPaneController& pane, std::size_t index);
    void reloadPanes();
    void updateTopStatus();
    /// A block for the queue that does nothing after the application object is destroyed.
    std::function<void()> whileAlive(void (PallaxApp::*action)());
    void restartMonitor();
    void postRestart();
    void reportLink() const;

    Surroundings _surroundings;
    std::unique_ptr<ui::NavigationStack> _navController;
    std::unique_ptr<ui::Window> _window; // destroyed before the stack
    std::unique_ptr<PallaxModel> _model;
    std::shared_ptr<PallaxSaveViewController> _saveViewController;
    std::unique_ptr<DateFormatter> _dateFormatter;
    std::optional<std::string> _updateMessage;
    bool _allowSaveButton = false;
    bool _isRestartPosted = false;
    std::string _technology;
    DisplayAge _displayAge;
    ValueAges _valueAges;
    std::shared_ptr<PallaxApp*> _alive;
};

} // namespace pallax
