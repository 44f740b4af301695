#pragma once

#include "overview/StatusWatch.h"
#include "ui/gtk/Ref.h"

#include <adwaita.h>
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

    void show(const Overview& overview);
    GtkWidget* widget() const { return GTK_WIDGET(_page.get()); }

private:
    /// A row: "RSRP", "good", "-94.50 dBm", and how far the level is from the worst to the best.
    struct Row {
        std::string title;
        std::string subtitle = {};
        std::string value = {};
        std::optional<double> share = {};
    };
    struct Group {
        std::string title;
        std::vector<Row> rows;
    };
    struct RowWidgets {
        AdwActionRow* row;
        GtkLabel* value;
        GtkLevelBar* bar;
    };

    static std::vector<Group> groupsOf(const Overview& overview);
    static void addCells(std::vector<Group>& groups, const Status& status);
    void build(const std::vector<Group>& groups);
    RowWidgets makeRow();
    static void fill(const RowWidgets& widgets, const Row& row);

    Ref<GtkBox> _page; ///< the groups, or words that nothing is known
    AdwPreferencesPage* _groupsPage = nullptr;
    std::vector<AdwPreferencesGroup*> _groups;
    std::vector<std::vector<RowWidgets>> _rows; ///< of each group
};

} // namespace pallax::gtk
