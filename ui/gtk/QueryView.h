#pragma once

#include "ui/contents/QueryContent.h"
#include "ui/gtk/TablePage.h"

#include <functional>
#include <gtk/gtk.h>
#include <string>

namespace pallax::gtk {

/// The page that asks in SQL: a field, and the answer as a table.
class QueryView {
public:
    struct Surroundings {
        QueryContent::Surroundings queries;
        std::function<void(std::function<void()> query)>
            work;                    ///< runs a query, which may take long
        std::function<void()> close; ///< ends the page
        std::function<void(const std::string& text)> say;
    };

    QueryView(const PangoMetrics& metrics, const Guard& guard, Surroundings surroundings);
    QueryView(const QueryView&) = delete;
    QueryView& operator=(const QueryView&) = delete;

    TableView& table() { return _page.table(); }
    /// The page was opened.
    void focus();
    GtkWidget* widget() const { return _page.widget(); }

private:
    void buildField();
    gboolean handleKey(guint key);
    void ask();
    void open();
    std::string sentence() const;

    Guard _guard;
    std::function<void(std::function<void()> query)> _work;
    std::function<void()> _close;
    std::function<void(const std::string& text)> _say;
    QueryContent _content;
    TablePage _page;
    GtkEntry* _field; ///< the page owns it
};

} // namespace pallax::gtk
