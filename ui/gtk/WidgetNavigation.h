#pragma once

#include "platform/ui/NavigationStack.h"
#include "ui/gtk/Ref.h"
#include "ui/gtk/Signals.h"

#include <adwaita.h>
#include <cstddef>
#include <functional>
#include <memory>
#include <optional>
#include <string>
#include <vector>

namespace pallax::gtk {

/// A stack of panes. Where there is room, the root pane is a list at the left, and the topmost pane
/// stands beside it; on a narrow screen there is one pane at a time, and a swipe goes back.
class WidgetNavigation final : public ui::NavigationStack {
public:
    /// Told what changes, to draw the frame around the panes.
    struct Frame {
        std::function<void()> changed; ///< the topmost pane is another one
        std::function<void()> toolbarShown;
        std::function<void(const std::string& path, const std::string& text)> leafSelected;
        std::function<void()> modalChanged; ///< a modal screen was presented or dismissed
    };

    WidgetNavigation(std::shared_ptr<ui::TableScreen> root, const Guard& guard, Frame frame);
    ~WidgetNavigation() override;
    WidgetNavigation(const WidgetNavigation&) = delete;
    WidgetNavigation& operator=(const WidgetNavigation&) = delete;

    void setDelegate(ui::NavigationDelegate* delegate) override { _delegate = delegate; }
    const std::vector<std::shared_ptr<ui::TableScreen>>& screens() const override {
        return _screens;
    }
    void push(std::shared_ptr<ui::TableScreen> screen, bool animated) override;
    void popTo(std::size_t index, bool animated) override;
    void showToolbar() override;
    void presentModal(std::shared_ptr<ui::ModalScreen> screen, bool animated) override;
    void dismissModal(bool animated) override;

    /// The root is about to appear for the first time.
    void appear();
    ui::TableScreen& top() const { return *_screens.back(); }
    bool isAtRoot() const { return _screens.size() == 1; }
    /// One pane back; does nothing at the root.
    void back();
    /// As WidgetTable, of any pane that is seen.
    std::optional<std::string> focusedValue() const;
    bool isToolbarShown() const { return _isToolbarShown; }
    const std::shared_ptr<ui::ModalScreen>& modal() const { return _modal; }
    /// Whether the root pane stands beside the topmost one.
    bool isSideBySide() const { return adw_leaflet_get_folded(_columns.get()) == FALSE; }

    GtkWidget* widget() const { return GTK_WIDGET(_columns.get()); }
    /// What stands beside the root pane while no other is open, instead of what did; null: nothing.
    void setDetail(GtkWidget* widget);
    /// Whether the detail is shown over the root pane, where there is no room beside it.
    void showDetail(bool isShown);
    bool isDetailOnTop() const { return _isDetailOnTop && isAtRoot(); }

private:
    void add(ui::TableScreen& screen, AdwLeaflet* to);
    void show(ui::TableScreen& screen, bool animated);
    void showPages();
    /// The user has gone back with a swipe.
    void adoptSwipe();
    void removeLeaving();

    Guard _guard;
    Frame _frame;
    Ref<AdwLeaflet> _columns; ///< the root pane and, beside or over it, the others
    AdwLeaflet* _others;
    GtkWidget* _detail = nullptr;
    std::vector<std::shared_ptr<ui::TableScreen>> _screens; // never empty
    std::vector<std::shared_ptr<ui::TableScreen>> _leaving; ///< that still move off the screen
    ui::NavigationDelegate* _delegate = nullptr;
    std::shared_ptr<ui::ModalScreen> _modal;
    bool _isToolbarShown = false;
    bool _isDetailOnTop = false;
    bool _isShowing = false; ///< the pages are being changed by us
    std::vector<std::pair<gpointer, gulong>> _handlers;
    std::shared_ptr<WidgetNavigation*> _alive = std::make_shared<WidgetNavigation*>(this);
};

} // namespace pallax::gtk
