#include "ui/terminal/TerminalToolkit.h"

#include "platform/ui/Window.h"

#include <algorithm>
#include <utility>

namespace pallax::terminal {

namespace {

/// A screen has no state on a terminal: every event just redraws it.
class TerminalScreenView final : public ui::ScreenView {
public:
    explicit TerminalScreenView(std::function<void()> needsDisplay)
        : _needsDisplay(std::move(needsDisplay)) {}
    void didLoad() override { _needsDisplay(); }
    void willAppear(bool /*animated*/) override { _needsDisplay(); }
    void willDisappear(bool /*animated*/) override { _needsDisplay(); }
    void didReceiveMemoryWarning() override {}
    void didUnload() override {}
    void resignFirstResponder() override { _needsDisplay(); }
    void setFrame(const ui::Rect& /*frame*/) override { _needsDisplay(); }
    void titleChanged() override { _needsDisplay(); }
    void toolbarItemsChanged(bool /*animated*/) override { _needsDisplay(); }

private:
    std::function<void()> _needsDisplay;
};

} // namespace

/// Its stack becomes the one that the toolkit shows.
class TerminalWindow final : public ui::Window {
public:
    explicit TerminalWindow(TerminalToolkit& toolkit) : _toolkit(toolkit) {}
    ~TerminalWindow() override { TerminalWindow::takeOffScreen(); }
    TerminalWindow(const TerminalWindow&) = delete;
    TerminalWindow& operator=(const TerminalWindow&) = delete;

    void setRoot(ui::NavigationStack& stack) override {
        _stack = static_cast<TerminalNavigation*>(&stack);
    }
    void addView(ui::NavigationStack& /*stack*/) override { _toolkit.setNeedsDisplay(); }
    void makeKeyAndVisible() override {
        _toolkit._visible = _stack;
        if (_stack != nullptr) {
            _stack->appear();
        }
    }
    void takeOffScreen() override {
        if (_stack != nullptr && _toolkit._visible == _stack) {
            _toolkit._visible = nullptr;
        }
    }

private:
    TerminalToolkit& _toolkit;
    TerminalNavigation* _stack = nullptr;
};

ui::Rect TerminalToolkit::screenBounds() const {
    return {{}, {_columns * kPointsPerColumn, _rows * kPointsPerRow}};
}

std::unique_ptr<ui::Window> TerminalToolkit::makeWindow(const ui::Rect& /*bounds*/) {
    return std::make_unique<TerminalWindow>(*this);
}

std::unique_ptr<ui::NavigationStack>
TerminalToolkit::makeNavigationStack(std::shared_ptr<ui::TableScreen> root) {
    return std::make_unique<TerminalNavigation>(std::move(root), _needsDisplay);
}

std::unique_ptr<ui::ScreenView> TerminalToolkit::makeScreenView() {
    return std::make_unique<TerminalScreenView>(_needsDisplay);
}

std::unique_ptr<ui::TableView> TerminalToolkit::makeTableView(ui::TableSource& source) {
    return std::make_unique<TerminalTable>(source, rowContentBounds(_columns), _needsDisplay,
                                           &_lists);
}

/// There is one layout for every name: a list, the field, and the two buttons.
ui::ModalOutlets TerminalToolkit::loadLayout(std::string_view /*name*/, ui::TableSource& source) {
    ui::ModalOutlets outlets;
    outlets.list =
        std::make_unique<TerminalTable>(source, rowContentBounds(_columns), _needsDisplay);
    outlets.field = std::make_unique<TerminalTextField>(_needsDisplay);
    return outlets;
}

void TerminalToolkit::showAlert(const ui::Alert& alert) {
    _alerts.push_back(alert);
    _needsDisplay();
}

void TerminalToolkit::setSize(int columns, int rows) {
    _columns = std::max(columns, 0);
    _rows = std::max(rows, 0);
    _needsDisplay();
}

void TerminalToolkit::closeAlert() {
    if (!_alerts.empty()) {
        _alerts.pop_front();
        _needsDisplay();
    }
}

ui::Rect rowContentBounds(int columns) {
    constexpr int kMarkColumns = 2;
    return {{}, {std::max(columns - kMarkColumns, 0) * kPointsPerColumn, kPointsPerRow}};
}

} // namespace pallax::terminal
