#pragma once

#include "ui/gtk/FilterBar.h"
#include "ui/gtk/Signals.h"

#include <functional>
#include <gtk/gtk.h>
#include <memory>
#include <string>
#include <utility>
#include <vector>

namespace pallax::gtk {

/// The pages over the panes of a window: going back from one shows the one that it was opened from.
class PageStack {
public:
    /// The first child of `stack`, which must outlive the object, is below all pages.
    PageStack(GtkStack* stack, const Guard& guard) : _stack(stack), _guard(guard) {}
    PageStack(const PageStack&) = delete;
    PageStack& operator=(const PageStack&) = delete;

    /// Puts a page on top. One that is open comes there, so that none is open twice. The widget
    /// belongs to the caller. `filter`, if there is one, shows only what contains a text.
    void open(GtkWidget* widget, const std::string& title,
              std::function<void(const std::string& text)> filter = nullptr);
    bool isOpen() const { return !_pages.empty(); }
    /// Whether this page is on top.
    bool shows(GtkWidget* widget) const { return isOpen() && _pages.back().content == widget; }
    /// Goes back from the page on top, if there is one.
    void close();
    void closeAll();
    /// Called when a page is seen again.
    void onUncovered(std::function<void()> action) { _uncovered = std::move(action); }
    /// The filter of the page on top.
    void toggleFilter();

private:
    struct Page {
        GtkWidget* box; ///< with the header
        GtkWidget* content;
        std::unique_ptr<FilterBar> filter; ///< null: it cannot be filtered
    };

    void showTop();
    void remove(const Page& page);

    GtkStack* _stack;
    Guard _guard;
    std::function<void()> _uncovered = [] {};
    std::vector<Page> _pages;
};

} // namespace pallax::gtk
