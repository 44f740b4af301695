#include "app/PallaxApp.h"

#include "app/HomeScreenPreference.h"
#include "platform/Clock.h"
#include "platform/FileSystem.h"
#include "platform/MainQueue.h"
#include "platform/ui/Toolkit.h"

#include <algorithm>
#include <chrono>
#include <utility>

namespace pallax {

namespace {

constexpr const char* kNotConnected = "Connecting...";
/// The root pane's first status; without dots, unlike all later ones.
constexpr const char* kLaunching = "Connecting";
constexpr const char* kUpdatePattern = "'Updated' yyyy-MM-dd 'at' HH:mm:ss";
constexpr const char* kRootPath = "/";

/// All screens of the stack are panes, created here or by another pane.
PallaxPaneController& paneOf(ui::TableScreen& screen) {
    return dynamic_cast<PallaxPaneController&>(screen);
}

} // namespace

PallaxApp::PallaxApp(Surroundings surroundings)
    : _surroundings(std::move(surroundings)), _alive(std::make_shared<PallaxApp*>(this)) {}

PallaxApp::~PallaxApp() {
    if (_navController) {
        _navController->setDelegate(nullptr);
    }
}

std::function<void()> PallaxApp::whileAlive(void (PallaxApp::*action)()) {
    return [app = std::weak_ptr(_alive), action] {
        if (const auto alive = app.lock()) {
            ((*alive)->*action)();
        }
    };
}

void PallaxApp::applicationDidFinishLaunching() {
    ui::Toolkit& toolkit = _surroundings.toolkit;
    getSaveButtonPref();
    setWindow(toolkit.makeWindow(toolkit.screenBounds()));
    _model = _surroundings.makeModel(*this);
    setUpdateMessage(kNotConnected);
    _dateFormatter = std::make_unique<DateFormatter>(kUpdatePattern, _surroundings.clock);

    auto root = std::make_shared<PallaxPaneController>(toolkit, *this, nullptr, kRootPath);
    root->setStatus(kLaunching, true);
    _navController = toolkit.makeNavigationStack(std::move(root));
    _navController->setDelegate(this);
    _window->setRoot(*_navController);
    _window->addView(*_navController);
    _window->makeKeyAndVisible();

    postRestart();
}

/// The connection starts after the first screen is drawn.
void PallaxApp::postRestart() {
    if (!_isRestartPosted) {
        _isRestartPosted = true;
        _surroundings.queue.async(whileAlive(&PallaxApp::restartMonitor));
    }
}

void PallaxApp::restartMonitor() {
    _isRestartPosted = false;
    if (_model) {
        _model->restartMonitor();
    }
}

void PallaxApp::startAfresh() {
    if (!_model) {
        return;
    }
    _model.reset(); // frees the port's name for the next model
    _model = _surroundings.makeModel(*this);
    _displayAge = {};
    _valueAges.clear();
    _technology.clear();
    setUpdateMessage(kNotConnected);
    _navController->popTo(0, false);
    PallaxPaneController& root = paneOf(*_navController->screens().front());
    root.reloadWithNode(nullptr);
    root.setStatus(kLaunching, true);
    reportLink();
    postRestart();
}

void PallaxApp::applicationWillTerminate() {
    _setGSMRSSI(false);
    setUpdateMessage(std::nullopt);
    _dateFormatter.reset();
    setSaveViewController(nullptr);
    if (_window) {
        _window->takeOffScreen();
    }
    setWindow(nullptr);
    _model.reset();
}

void PallaxApp::getSaveButtonPref() {
    setAllowSaveButton(_surroundings.files.exists(_surroundings.saveButtonMarker));
}

void PallaxApp::_setGSMRSSI(bool shown) {
    setGSMRSSI(_surroundings.preferences, shown);
}

void PallaxApp::showSaveView() {
    if (_saveViewController) {
        return;
    }
    PallaxSaveViewController::Surroundings surroundings{
        .toolkit = _surroundings.toolkit,
        .files = _surroundings.files,
        .clock = _surroundings.clock,
        .present = _surroundings.present,
        .queue = _surroundings.queue,
        .snapshotDirectory = _surroundings.snapshotDirectory,
        .closeSaveView = whileAlive(&PallaxApp::closeSaveView),
        .bringUpToDate = whileAlive(&PallaxApp::bringUpToDate),
    };
    setSaveViewController(std::make_shared<PallaxSaveViewController>(
        std::move(surroundings), _model ? _model->getSaveContents() : PropertyList()));
    if (_navController) {
        _navController->presentModal(_saveViewController, true);
    }
}

void PallaxApp::bringUpToDate() {
    if (_model) {
        (void)_model->display();
    }
}

void PallaxApp::closeSaveView() {
    if (!_saveViewController) {
        return;
    }
    if (_navController) {
        _navController->dismissModal(true);
    }
    setSaveViewController(nullptr);
}

void PallaxApp::updateStatusForViewController(PallaxPaneController& pane) {
    if (isConnected()) {
        pane.setStatus(updateMessage(), false);
    } else {
        pane.setStatus(kNotConnected, true);
    }
}

void PallaxApp::updateViewControllerFromModel() {
    if (!_navController) {
        return;
    }
    _displayAge.shown(_surroundings.clock.now());
    reloadPanes();
    if (_model) {
        _valueAges.take(_model->sectionAges());
    }
    if (isConnected()) {
        setUpdateMessage(_dateFormatter->stringFromDate(_surroundings.clock.now()));
    }
    updateTopStatus();
}

void PallaxApp::generatorChosen(const std::string& technology, bool keepsDisplay) {
    _technology = technology;
    _displayAge.generatorChosen(keepsDisplay, _surroundings.clock.now());
    if (keepsDisplay && _surroundings.startsAfreshByItself) {
        // Posted, because the model is still running.
        _surroundings.queue.async(whileAlive(&PallaxApp::startAfresh));
    } else {
        reportLink();
    }
}

void PallaxApp::reportLink() const {
    if (_surroundings.linkChanged) {
        _surroundings.linkChanged(_technology, _displayAge.left());
    }
}

NodeRef PallaxApp::nodeOf(const PallaxPaneController& pane, std::size_t index) {
    if (!_model) {
        return nullptr;
    }
    return index == 0 ? _model->topLevelNodes() : _model->nodeAtPath(pane.path());
}

void PallaxApp::reloadPanes() {
    const auto panes = _navController->screens(); // a copy, because popping changes the list
    for (std::size_t index = 0; index < panes.size(); ++index) {
        PallaxPaneController& pane = paneOf(*panes[index]);
        NodeRef node = nodeOf(pane, index);
        if (index > 0 && !node) {
            _navController->popTo(index - 1, true);
            return;
        }
        pane.reloadWithNode(std::move(node), _surroundings.clock.now());
    }
}

ReadingAges PallaxApp::readingAges() {
    return [this](const std::string& path) -> std::optional<ReadingAge> {
        const Arrivals* arrivals = _valueAges.arrivals(path);
        if (arrivals == nullptr) {
            return std::nullopt;
        }
        // A stamp may be ahead of the display's clock, which does not step back.
        const std::chrono::nanoseconds age =
            std::max<std::chrono::nanoseconds>(_surroundings.clock.now() - *arrivals->last(), {});
        const auto patience = arrivals->patience();
        return ReadingAge{age, patience && age > *patience};
    };
}

void PallaxApp::updateTopStatus() {
    const auto& screens = _navController->screens();
    if (!screens.empty()) {
        updateStatusForViewController(paneOf(*screens.back()));
    }
}

void PallaxApp::navigationControllerWillShow(ui::NavigationStack& /*stack*/,
                                             ui::TableScreen& screen, bool /*animated*/) {
    updateStatusForViewController(paneOf(screen));
}

} // namespace pallax
