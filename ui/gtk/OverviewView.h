#pragma once

#include "overview/StatusWatch.h"
#include "ui/gtk/Ref.h"
#include "ui/gtk/Signals.h"

#include <adwaita.h>
#include <functional>
#include <optional>
#include <string>
#include <vector>

namespace pallax::gtk {

/// An overview of the radio as a page of groups: network, cells, levels, states, neighbours,
/// contexts and events. What a modem does not tell has no row.
class OverviewView {
public:
    OverviewView();
    OverviewView(const OverviewView&) = delete;
    OverviewView& operator=(const OverviewView&) = delete;
    ~OverviewView();

    void show(const Overview& overview);
    /// Shows the latest overview whenever the page comes into view: what it showed before is old.
    void showWhenSeen(const Guard& guard, std::function<Overview()> latest);
    GtkWidget* widget() const { return GTK_WIDGET(_page.get()); }

private:
    /// A row: "RSRP", "good", "-94.50 dBm", and how far the level is from the worst to the best.
    struct Row {
        std::string title;
        std::string subtitle = {};
        std::string value = {};
        std::optional<double> share = {};
        bool operator==(const Row&) const = default;
    };
    struct Group {
        std::string title;
        std::vector<Row> rows;
    };
    struct RowWidgets {
        AdwActionRow* row;
        GtkLabel* value;
        GtkLevelBar* bar;
        std::optional<Row> shown;
    };
    struct GroupWidgets {
        AdwPreferencesGroup* group;
        std::vector<RowWidgets> rows;
    };

    static std::vector<Group> groupsOf(const Overview& overview);
    static void addCells(std::vector<Group>& groups, const Status& status);
    static RowWidgets makeRow();
    static void fill(GroupWidgets& widgets, const Group& group);
    static void fill(RowWidgets& widgets, const Row& row);

    Ref<GtkBox> _page;
    gulong _seen = 0;    ///< the handler, if any
    GtkWidget* _nothing; ///< words that nothing is known; the page owns it and what follows
    GtkWidget* _groupsPage;
    std::vector<GroupWidgets> _groups; ///< as many as were ever needed
};

} // namespace pallax::gtk
