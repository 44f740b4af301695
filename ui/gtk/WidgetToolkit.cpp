#include "ui/gtk/WidgetToolkit.h"

#include "platform/ui/Window.h"
#include "ui/gtk/WidgetNavigation.h"
#include "ui/gtk/WidgetTable.h"
#include "ui/gtk/WidgetTextField.h"

#include <utility>

namespace pallax::gtk {

namespace {

/// A screen's widgets are those of its table; its title and its toolbar are the frame's.
class WidgetScreenView final : public ui::ScreenView {
public:
    explicit WidgetScreenView(MainFrame& frame) : _frame(frame) {}
    void didLoad() override {}
    void willAppear(bool /*animated*/) override {}
    void willDisappear(bool /*animated*/) override {}
    void didReceiveMemoryWarning() override {}
    void didUnload() override {}
    void resignFirstResponder() override {}
    void setFrame(const ui::Rect& /*frame*/) override {} // the whole window
    void titleChanged() override { _frame.refresh(); }
    void toolbarItemsChanged(bool /*animated*/) override { _frame.refresh(); }

private:
    MainFrame& _frame;
};

/// Its stack becomes the one that the frame shows.
class WidgetWindow final : public ui::Window {
public:
    explicit WidgetWindow(MainFrame& frame) : _frame(frame) {}
    ~WidgetWindow() override { WidgetWindow::takeOffScreen(); }
    WidgetWindow(const WidgetWindow&) = delete;
    WidgetWindow& operator=(const WidgetWindow&) = delete;

    void setRoot(ui::NavigationStack& stack) override {
        _stack = static_cast<WidgetNavigation*>(&stack);
    }
    void addView(ui::NavigationStack& /*stack*/) override { _frame.setStack(_stack); }
    void makeKeyAndVisible() override {
        _frame.present();
        if (_stack != nullptr) {
            _stack->appear();
        }
    }
    /// The frame stays: it has a page for when nothing comes any more.
    void takeOffScreen() override {
        if (std::exchange(_stack, nullptr) != nullptr) {
            _frame.setStack(nullptr);
        }
    }

private:
    MainFrame& _frame;
    WidgetNavigation* _stack = nullptr;
};

} // namespace

std::unique_ptr<ui::Window> WidgetToolkit::makeWindow(const ui::Rect& /*bounds*/) {
    return std::make_unique<WidgetWindow>(_frame);
}

std::unique_ptr<ui::NavigationStack>
WidgetToolkit::makeNavigationStack(std::shared_ptr<ui::TableScreen> root) {
    return std::make_unique<WidgetNavigation>(
        std::move(root), _guard,
        WidgetNavigation::Frame{
            .changed = [this] { _frame.refresh(); },
            .toolbarShown = [this] { _frame.refresh(); },
            .leafSelected = [this](const std::string& path,
                                   const std::string& text) { _frame.leafSelected(path, text); },
            .modalChanged = [this] { _frame.modalChanged(); }});
}

std::unique_ptr<ui::ScreenView> WidgetToolkit::makeScreenView() {
    return std::make_unique<WidgetScreenView>(_frame);
}

std::unique_ptr<ui::TableView> WidgetToolkit::makeTableView(ui::TableSource& source) {
    return std::make_unique<WidgetTable>(source, _frame.metrics(), _guard, 0, &_lists);
}

/// There is one layout for every name: a list, the field, and the two buttons.
ui::ModalOutlets WidgetToolkit::loadLayout(std::string_view /*name*/, ui::TableSource& source) {
    constexpr double kInset = 10; // of plain cells, which have no margin of their own
    ui::ModalOutlets outlets;
    outlets.list = std::make_unique<WidgetTable>(source, _frame.metrics(), _guard, kInset);
    outlets.field = std::make_unique<WidgetTextField>(_guard);
    return outlets;
}

} // namespace pallax::gtk
