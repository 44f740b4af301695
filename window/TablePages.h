#pragma once

#include "browsing/ViewerSession.h"
#include "ui/contents/HitWalk.h"
#include "ui/gtk/EventsView.h"
#include "ui/gtk/MainFrame.h"
#include "ui/gtk/Menu.h"
#include "ui/gtk/QueryView.h"
#include "ui/gtk/SearchView.h"
#include "window/LongWork.h"

#include <cstdint>
#include <functional>
#include <optional>
#include <vector>

namespace pallax {

/// The pages of a window that are tables: events, the hits of a search, answers to queries. They
/// are made when they are opened for the first time.
class TablePages {
public:
    /// References must outlive the pages.
    struct Surroundings {
        gtk::MainFrame& frame;
        const gtk::Guard& guard;
        ViewerSession& viewer;
        LongWork& work;
        std::function<void(std::uint64_t packet)> goTo; ///< shows an instant
    };

    explicit TablePages(Surroundings surroundings);
    ~TablePages() { forget(); }
    TablePages(const TablePages&) = delete;
    TablePages& operator=(const TablePages&) = delete;

    std::vector<gtk::MenuEntry> menu();
    /// The same keys as on a terminal; false if it means nothing here.
    bool handleKey(guint key);
    /// Goes to the next or previous hit of the latest search for a text; false if none came after
    /// the latest condition.
    bool findAgain(Travel::Direction direction);
    /// New data have come, or another instant is shown.
    void refresh();
    /// The timeline is another one.
    void forgetTimeline() { _finder.forget(); }
    /// Nothing is left of what was shown, found or typed.
    void forget();

private:
    EventsContent::Surroundings eventsSurroundings() const;
    SearchContent::Surroundings searchSurroundings();
    QueryContent::Surroundings querySurroundings();
    TextFinder::Surroundings finderSurroundings();
    void openEvents();
    void openSearch();
    void openQuery();
    void toggle(GtkWidget* page, void (TablePages::*open)());
    HitWalk::Surroundings hitWalkSurroundings();
    void goToPlace(const std::vector<std::size_t>& place);

    gtk::MainFrame& _frame;
    gtk::Guard _guard;
    ViewerSession& _viewer;
    LongWork& _work;
    std::function<void(std::uint64_t packet)> _goTo;
    EntryPartAt _partAt;
    TextFinder _finder;
    HitWalk _hitWalk;
    std::optional<gtk::EventsView> _events;
    std::optional<gtk::SearchView> _search;
    std::optional<gtk::QueryView> _query;
};

} // namespace pallax
