#include "ui/gtk/OverviewView.h"

#include "overview/StatusWords.h"
#include "ui/contents/TimeOfDay.h"
#include "ui/gtk/ShownText.h"
#include "ui/gtk/Translation.h"

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

OverviewView::OverviewView()
    : _page(owned(GTK_BOX(gtk_box_new(GTK_ORIENTATION_VERTICAL, 0)))),
      _nothing(adw_status_page_new()), _groupsPage(adw_preferences_page_new()) {
    adw_status_page_set_icon_name(ADW_STATUS_PAGE(_nothing), "network-wireless-symbolic");
    adw_status_page_set_title(ADW_STATUS_PAGE(_nothing),
                              translated("Nothing is known about the radio."));
    for (GtkWidget* page : {_nothing, _groupsPage}) {
        gtk_widget_set_vexpand(page, TRUE);
        gtk_box_append(_page.get(), page);
    }
    show({});
}

OverviewView::~OverviewView() {
    if (_seen != 0) { // the page may outlive the view
        g_signal_handler_disconnect(widget(), _seen);
    }
}

void OverviewView::showWhenSeen(const Guard& guard, std::function<Overview()> latest) {
    _seen =
        onSignal(widget(), "map", guard, [this, latest = std::move(latest)] { show(latest()); });
}

/// Widgets stay, so that the place on the page and the focus do, too: making them takes much longer
/// than changing their texts. Those that are not needed now are hidden.
void OverviewView::show(const Overview& overview) {
    const std::vector<Group> groups = groupsOf(overview);
    gtk_widget_set_visible(_nothing, groups.empty() ? TRUE : FALSE);
    gtk_widget_set_visible(_groupsPage, groups.empty() ? FALSE : TRUE);
    for (std::size_t index = 0; index < groups.size(); ++index) {
        if (index == _groups.size()) {
            auto* made = ADW_PREFERENCES_GROUP(adw_preferences_group_new());
            adw_preferences_page_add(ADW_PREFERENCES_PAGE(_groupsPage), made);
            _groups.push_back({made, {}});
        }
        fill(_groups[index], groups[index]);
    }
    for (std::size_t index = 0; index < _groups.size(); ++index) {
        gtk_widget_set_visible(GTK_WIDGET(_groups[index].group),
                               index < groups.size() ? TRUE : FALSE);
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

void OverviewView::fill(GroupWidgets& widgets, const Group& group) {
    adw_preferences_group_set_title(widgets.group, shownMarkup(group.title).c_str());
    for (std::size_t index = 0; index < group.rows.size(); ++index) {
        if (index == widgets.rows.size()) {
            widgets.rows.push_back(makeRow());
            adw_preferences_group_add(widgets.group, GTK_WIDGET(widgets.rows.back().row));
        }
        fill(widgets.rows[index], group.rows[index]);
    }
    for (std::size_t index = 0; index < widgets.rows.size(); ++index) {
        gtk_widget_set_visible(GTK_WIDGET(widgets.rows[index].row),
                               index < group.rows.size() ? TRUE : FALSE);
    }
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
    return {ADW_ACTION_ROW(row), GTK_LABEL(value), GTK_LEVEL_BAR(bar), {}};
}

void OverviewView::fill(RowWidgets& widgets, const Row& row) {
    if (widgets.shown == row) {
        return;
    }
    widgets.shown = row;
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
