#include "ui/gtk/OverviewView.h"

#include "overview/StatusWords.h"
#include "ui/contents/TimeOfDay.h"
#include "ui/gtk/ShownText.h"
#include "ui/gtk/Translation.h"

#include <algorithm>
#include <utility>

namespace pallax::gtk {

namespace {

constexpr int kBarWidth = 80;
constexpr std::size_t kMostEvents = 12;

std::string joined(const std::vector<std::string>& words) {
    std::string text;
    for (const std::string& word : words) {
        if (!word.empty()) {
            text += (text.empty() ? "" : " · ") + word;
        }
    }
    return text;
}

} // namespace

OverviewView::OverviewView() : _page(owned(GTK_BOX(gtk_box_new(GTK_ORIENTATION_VERTICAL, 0)))) {
    build({});
}

/// Texts change in place, so that the place on the page and the focus stay.
void OverviewView::show(const Overview& overview) {
    const std::vector<Group> groups = groupsOf(overview);
    const bool isSame =
        groups.size() == _rows.size() && std::equal(groups.begin(), groups.end(), _rows.begin(),
                                                    [](const Group& group, const auto& rows) {
                                                        return group.rows.size() == rows.size();
                                                    });
    if (!isSame) {
        build(groups);
    }
    for (std::size_t group = 0; group < groups.size(); ++group) {
        adw_preferences_group_set_title(_groups[group], shownMarkup(groups[group].title).c_str());
        for (std::size_t row = 0; row < groups[group].rows.size(); ++row) {
            fill(_rows[group][row], groups[group].rows[row]);
        }
    }
}

void OverviewView::addCells(std::vector<Group>& groups, const Status& status) {
    for (const StatusCell& cell : status.cells) {
        Group group{cell.system + translated(" cell"), {}};
        std::vector<std::string> where = channelWords(cell);
        where.insert(where.end(), cell.details.begin(), cell.details.end());
        group.rows.push_back({joined(identityWords(cell)), joined(where)});
        for (const StatusValue& level : cell.levels) {
            const std::string age =
                isOverdue(status.time, level) ? ageWords(status.time - level.read) : "";
            group.rows.push_back({level.name, joined({std::string(qualityWord(level)), age}),
                                  level.text, shareOf(level)});
        }
        groups.push_back(std::move(group));
    }
}

std::vector<OverviewView::Group> OverviewView::groupsOf(const Overview& overview) {
    const Status& status = overview.status;
    std::vector<Group> groups;
    const auto add = [&groups](std::string title, std::vector<Row> rows) {
        if (!rows.empty()) {
            groups.push_back({std::move(title), std::move(rows)});
        }
    };
    if (status.network) {
        add(translated("Operator"), {{operatorWords(*status.network),
                                      status.network->isHome ? translated("home network") : ""}});
    }
    addCells(groups, status);
    std::vector<Row> rows;
    for (const StatusValue& state : status.states) {
        rows.push_back({state.name, "", state.text});
    }
    add(translated("States"), std::exchange(rows, {}));
    for (const StatusNeighbour& neighbour : status.neighbours) {
        const std::string age =
            isOld(status.time, neighbour.level) ? ageWords(status.time - neighbour.level.read) : "";
        rows.push_back({neighbour.cell, joined({neighbour.system, age}), neighbour.level.text,
                        shareOf(neighbour.level)});
    }
    add(translated("Neighbours"), std::exchange(rows, {}));
    for (const StatusContext& context : status.contexts) {
        rows.push_back({context.name, "", context.state});
    }
    add(translated("Contexts"), std::exchange(rows, {}));
    for (auto event = overview.events.rbegin();
         event != overview.events.rend() && rows.size() < kMostEvents; ++event) {
        rows.push_back({event->words, timeOfDay(event->time, overview.ahead)});
    }
    add(translated("Events"), std::move(rows));
    return groups;
}

void OverviewView::build(const std::vector<Group>& groups) {
    while (GtkWidget* child = gtk_widget_get_first_child(widget())) {
        gtk_box_remove(_page.get(), child);
    }
    _groups.clear();
    _rows.clear();
    if (groups.empty()) {
        GtkWidget* nothing = adw_status_page_new();
        adw_status_page_set_icon_name(ADW_STATUS_PAGE(nothing), "network-wireless-symbolic");
        adw_status_page_set_title(ADW_STATUS_PAGE(nothing),
                                  translated("Nothing is known about the radio."));
        gtk_widget_set_vexpand(nothing, TRUE);
        return gtk_box_append(_page.get(), nothing);
    }
    _groupsPage = ADW_PREFERENCES_PAGE(adw_preferences_page_new());
    gtk_widget_set_vexpand(GTK_WIDGET(_groupsPage), TRUE);
    for (const Group& group : groups) {
        auto* made = ADW_PREFERENCES_GROUP(adw_preferences_group_new());
        std::vector<RowWidgets>& rows = _rows.emplace_back();
        for (std::size_t row = 0; row < group.rows.size(); ++row) {
            rows.push_back(makeRow());
            adw_preferences_group_add(made, GTK_WIDGET(rows.back().row));
        }
        adw_preferences_page_add(_groupsPage, made);
        _groups.push_back(made);
    }
    gtk_box_append(_page.get(), GTK_WIDGET(_groupsPage));
}

OverviewView::RowWidgets OverviewView::makeRow() {
    GtkWidget* row = adw_action_row_new();
    adw_preferences_row_set_use_markup(ADW_PREFERENCES_ROW(row), FALSE);
    GtkWidget* bar = gtk_level_bar_new();
    gtk_widget_set_size_request(bar, kBarWidth, -1);
    gtk_widget_set_valign(bar, GTK_ALIGN_CENTER);
    GtkWidget* value = gtk_label_new(nullptr);
    gtk_widget_add_css_class(value, "numeric");
    adw_action_row_add_suffix(ADW_ACTION_ROW(row), value);
    adw_action_row_add_suffix(ADW_ACTION_ROW(row), bar);
    return {ADW_ACTION_ROW(row), GTK_LABEL(value), GTK_LEVEL_BAR(bar)};
}

void OverviewView::fill(const RowWidgets& widgets, const Row& row) {
    adw_preferences_row_set_title(ADW_PREFERENCES_ROW(widgets.row), shownText(row.title).c_str());
    adw_action_row_set_subtitle(widgets.row, shownText(row.subtitle).c_str());
    showText(widgets.value, row.value);
    gtk_level_bar_set_value(widgets.bar, row.share.value_or(0));
    gtk_widget_set_visible(GTK_WIDGET(widgets.bar), row.share ? TRUE : FALSE);
    const std::string spoken = joined({row.title, row.value, row.subtitle});
    gtk_accessible_update_property(GTK_ACCESSIBLE(widgets.row), GTK_ACCESSIBLE_PROPERTY_LABEL,
                                   shownText(spoken).c_str(), -1);
}

} // namespace pallax::gtk
