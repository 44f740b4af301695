#pragma once

#include "platform/ui/Toolkit.h"
#include "ui/terminal/TerminalMetrics.h"
#include "ui/terminal/TerminalNavigation.h"
#include "ui/terminal/TerminalTable.h"
#include "ui/terminal/TerminalTextField.h"

#include <deque>
#include <functional>

namespace pallax::terminal {

/// The toolkit of a terminal: creates objects for the controllers and keeps the state of the
/// screen.
class TerminalToolkit final : public ui::Toolkit {
public:
    /// `needsDisplay` is called when a redraw is needed, possibly often.
    explicit TerminalToolkit(std::function<void()> needsDisplay)
        : _needsDisplay(std::move(needsDisplay)) {}

    const ui::TextMetrics& textMetrics() const override { return _metrics; }
    ui::Rect screenBounds() const override;
    ui::Rect applicationFrame() const override { return screenBounds(); }
    std::unique_ptr<ui::Window> makeWindow(const ui::Rect& bounds) override;
    std::unique_ptr<ui::NavigationStack>
    makeNavigationStack(std::shared_ptr<ui::TableScreen> root) override;
    std::unique_ptr<ui::ScreenView> makeScreenView() override;
    std::unique_ptr<ui::TableView> makeTableView(ui::TableSource& source) override;
    ui::ModalOutlets loadLayout(std::string_view name, ui::TableSource& source) override;
    void showAlert(const ui::Alert& alert) override;

    /// The terminal's extent.
    void setSize(int columns, int rows);
    int columns() const { return _columns; }
    int rows() const { return _rows; }

    /// The stack of the visible window; null if there is none.
    TerminalNavigation* navigation() const { return _visible; }
    /// The alert that is open, or null.
    const ui::Alert* alert() const { return _alerts.empty() ? nullptr : &_alerts.front(); }
    void closeAlert();
    /// For the tables of all panes.
    ListLook& lists() { return _lists; }
    void setNeedsDisplay() { _needsDisplay(); }

private:
    friend class TerminalWindow;

    std::function<void()> _needsDisplay;
    TerminalMetrics _metrics;
    ListLook _lists;
    int _columns = 80; // until the terminal's extent is known
    int _rows = 24;
    TerminalNavigation* _visible = nullptr;
    std::deque<ui::Alert> _alerts; // the front one is open
};

/// The content area of a row for this width: two columns are left for the mark after it.
ui::Rect rowContentBounds(int columns);

} // namespace pallax::terminal
