#pragma once

#include "app/table/PaneTable.h"
#include "platform/ui/Toolkit.h"
#include "ui/gtk/MainFrame.h"
#include "ui/gtk/Signals.h"

namespace pallax::gtk {

/// The toolkit of a window: creates objects for the controllers.
class WidgetToolkit final : public ui::Toolkit {
public:
    /// The frame must outlive the toolkit.
    WidgetToolkit(MainFrame& frame, const Guard& guard) : _frame(frame), _guard(guard) {}

    const ui::TextMetrics& textMetrics() const override { return _frame.metrics(); }
    ui::Rect screenBounds() const override { return _frame.bounds(); }
    ui::Rect applicationFrame() const override { return _frame.bounds(); }
    std::unique_ptr<ui::Window> makeWindow(const ui::Rect& bounds) override;
    std::unique_ptr<ui::NavigationStack>
    makeNavigationStack(std::shared_ptr<ui::TableScreen> root) override;
    std::unique_ptr<ui::ScreenView> makeScreenView() override;
    std::unique_ptr<ui::TableView> makeTableView(ui::TableSource& source) override;
    ui::ModalOutlets loadLayout(std::string_view name, ui::TableSource& source) override;
    void showAlert(const ui::Alert& alert) override { _frame.showAlert(alert); }

    /// For the tables of all panes.
    ListLook& lists() { return _lists; }

private:
    MainFrame& _frame;
    Guard _guard;
    ListLook _lists;
};

} // namespace pallax::gtk
