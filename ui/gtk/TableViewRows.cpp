#include "ui/gtk/ShownText.h"
#include "ui/gtk/Style.h"
#include "ui/gtk/TableView.h"
#include "ui/gtk/Translation.h"

#include <algorithm>
#include <map>

namespace pallax::gtk {

namespace {

GtkLabel* cellLabel(bool isRight) {
    GtkWidget* label = gtk_label_new(nullptr);
    gtk_label_set_xalign(GTK_LABEL(label), isRight ? 1 : 0);
    gtk_label_set_ellipsize(GTK_LABEL(label), PANGO_ELLIPSIZE_END);
    gtk_label_set_single_line_mode(GTK_LABEL(label), TRUE);
    gtk_widget_set_margin_start(label, kRoomBefore);
    gtk_widget_set_margin_end(label, kRoomBehind);
    return GTK_LABEL(label);
}

} // namespace

/// The objects of rows that stay keep their identity, so that the list keeps its place and the
/// keyboard.
void TableView::syncItems() {
    std::vector<std::string> keys;
    keys.reserve(_model.shownRows());
    for (std::size_t shown = 0; shown < _model.shownRows(); ++shown) {
        keys.push_back(_model.content().rows[_model.rowAt(shown)].key);
    }
    if (keys == _keys) {
        return;
    }
    GListModel* list = G_LIST_MODEL(_items.get());
    const auto same = std::mismatch(keys.begin(), keys.end(), _keys.begin(), _keys.end());
    const auto first = static_cast<std::size_t>(same.first - keys.begin());
    std::size_t after = 0; // how many are the same at the end
    while (after < std::min(keys.size(), _keys.size()) - first &&
           keys[keys.size() - after - 1] == _keys[_keys.size() - after - 1]) {
        ++after;
    }
    std::multimap<std::string, Ref<GObject>> spare;
    for (std::size_t index = first; index < _keys.size() - after; ++index) {
        spare.emplace(_keys[index],
                      G_OBJECT(g_list_model_get_item(list, static_cast<guint>(index))));
    }
    std::vector<Ref<GObject>> added;
    std::vector<gpointer> pointers;
    for (std::size_t index = first; index < keys.size() - after; ++index) {
        const auto found = spare.find(keys[index]);
        added.push_back(found != spare.end()
                            ? std::move(found->second)
                            : Ref<GObject>(G_OBJECT(g_object_new(G_TYPE_OBJECT, nullptr))));
        if (found != spare.end()) {
            spare.erase(found);
        }
        pointers.push_back(added.back().get());
    }
    _isSyncing = true;
    g_list_store_splice(_items.get(), static_cast<guint>(first),
                        static_cast<guint>(_keys.size() - after - first), pointers.data(),
                        static_cast<guint>(pointers.size()));
    _keys = std::move(keys);
    _isSyncing = false;
}

void TableView::makeLabels(Bound& bound) const {
    bound.labels.clear();
    std::vector<GtkWidget*> cells;
    for (const ColumnPlan::Place& place : _plan.places) {
        bound.labels.push_back(cellLabel(place.isRight));
        cells.push_back(GTK_WIDGET(bound.labels.back()));
    }
    bound.strip->setCells(_plan, cells);
    gtk_widget_set_size_request(bound.strip->widget(), -1, rowHeight());
    bound.plan = _planNumber;
}

void TableView::fill(Bound& bound, std::size_t shown) const {
    if (shown >= _model.shownRows()) {
        return; // the list hears of it soon
    }
    if (bound.plan != _planNumber) {
        makeLabels(bound);
    }
    bound.isStale = false;
    const std::size_t row = _model.rowAt(shown);
    for (std::size_t index = 0; index < bound.labels.size(); ++index) {
        fillCell(bound.labels[index], row, _plan.places[index].column);
    }
    setClass(bound.strip->widget(), "pallax-open", shown == _model.cursor());
    setClass(bound.strip->widget(), "dim-label", _model.content().rows[row].isSecondary);
    gtk_accessible_update_property(GTK_ACCESSIBLE(bound.strip->widget()),
                                   GTK_ACCESSIBLE_PROPERTY_LABEL, spokenName(row).c_str(), -1);
}

void TableView::fillCell(GtkLabel* label, std::size_t row, std::size_t column) const {
    const TableCell& cell = _model.content().rows[row].cells[column];
    const std::string text = shownText(cell.text) + (cell.opens ? " ›" : "");
    const bool hasChanged = _model.hasChanged(row, column);
    _metrics.setFont(label, hasChanged ? kChangedFont : kCellFont);
    gtk_label_set_text(label, text.c_str());
    setClass(GTK_WIDGET(label), "pallax-changed", hasChanged);
}

/// "PCI 252, RSRP -91.50 dBm, changed, age 2 s".
std::string TableView::spokenName(std::size_t row) const {
    std::string name;
    for (const ColumnPlan::Place& place : _plan.places) {
        const TableColumn& column = _model.content().columns[place.column];
        const TableCell& cell = _model.content().rows[row].cells[place.column];
        if (cell.text.empty()) {
            continue;
        }
        name += (name.empty() ? "" : ", ") + column.name + " " + cell.text;
        name += cell.number && !column.unit.empty() ? " " + column.unit : "";
        name += _model.hasChanged(row, place.column) ? translated(", changed") : "";
    }
    return shownText(name);
}

} // namespace pallax::gtk
