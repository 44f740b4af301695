#pragma once

#include "ui/pages/ChangesPage.h"
#include "ui/pages/EventsPage.h"
#include "ui/pages/GraphPage.h"
#include "ui/pages/OverviewPage.h"
#include "ui/pages/QueryPage.h"
#include "ui/pages/SearchPage.h"
#include "ui/pages/ValuePage.h"

#include <list>
#include <utility>
#include <variant>

namespace pallax::terminal {

using Page = std::variant<OverviewPage, ChangesPage, EventsPage, QueryPage, SearchPage, ValuePage,
                          GraphPage>;

/// The pages over the panes, the last one on top. They are not on the navigation stack, whose panes
/// are updated meanwhile.
class Pages {
public:
    bool isOpen() const { return !_pages.empty(); }
    /// Whether a page of this kind is on top.
    template <class Kind>
    bool shows() const {
        return isOpen() && std::holds_alternative<Kind>(_pages.back());
    }
    /// Closes another page of the same kind, so that there are never more than kinds. Not while a
    /// page handles a key.
    void open(Page page);
    void closeTop() { _pages.pop_back(); }

    /// Gives a key to the page on top, which may close by it.
    PageAnswer handle(const KeyEvent& event);
    void draw(const PageScreen& screen, const PageSurroundings& around);

private:
    std::list<Page> _pages;
};

} // namespace pallax::terminal
