#pragma once

#include "ui/contents/SearchContent.h"
#include "ui/gtk/TablePage.h"

#include <functional>
#include <gtk/gtk.h>
#include <string>

namespace pallax::gtk {

/// The page that finds a text: a field, a choice where to search, and the hits.
class SearchView {
public:
    /// `work` runs a search, which may take long. `close` ends the page: a hit was gone to, or the
    /// user goes back.
    struct Surroundings {
        SearchContent::Surroundings search;
        std::function<void(std::function<void()> search)> work;
        std::function<void()> close;
    };

    SearchView(const PangoMetrics& metrics, const Guard& guard, Surroundings surroundings);
    SearchView(const SearchView&) = delete;
    SearchView& operator=(const SearchView&) = delete;

    /// Another frame is shown.
    void refresh();
    /// The page was opened.
    void focus();
    GtkWidget* widget() const { return _page.widget(); }

private:
    void buildFields();
    void search();
    void open();
    std::string sentence() const;
    SearchScope wantedScope() const;

    Guard _guard;
    std::function<void(std::function<void()> search)> _work;
    std::function<void()> _close;
    SearchContent _content;
    TablePage _page;
    GtkSearchEntry* _field; ///< the page owns it and what follows
    GtkToggleButton* _frame;
    GtkToggleButton* _recording;
};

} // namespace pallax::gtk
