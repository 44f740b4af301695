#include "ui/gtk/GraphView.h"

#include "ui/gtk/PageParts.h"
#include "ui/gtk/Translation.h"

#include <adwaita.h>
#include <algorithm>
#include <utility>

namespace pallax::gtk {

namespace {

GtkLabel* addLegend(GtkBox* to, std::size_t number) {
    GtkWidget* row = gtk_box_new(GTK_ORIENTATION_HORIZONTAL, kPageBorder);
    gtk_box_append(GTK_BOX(row), curveSwatch(number));
    GtkWidget* label = gtk_label_new(nullptr);
    gtk_label_set_xalign(GTK_LABEL(label), 0);
    gtk_label_set_wrap(GTK_LABEL(label), TRUE);
    gtk_box_append(GTK_BOX(row), label);
    gtk_box_append(to, row);
    return GTK_LABEL(label);
}

GtkWidget* nothingInGraph() {
    GtkWidget* page = adw_status_page_new();
    adw_status_page_set_title(ADW_STATUS_PAGE(page), translated("The graph is empty"));
    adw_status_page_set_description(ADW_STATUS_PAGE(page),
                                    translated("The page of a value adds it to the graph."));
    return page;
}

} // namespace

GraphView::GraphView(const Guard& guard, Actions actions)
    : _guard(guard), _actions(std::move(actions)), _spans(guard, _actions.chooseSpan),
      _scroller(pageScroller()),
      _plotsBox(GTK_BOX(gtk_box_new(GTK_ORIENTATION_VERTICAL, kPageBorder))),
      _words(GTK_LABEL(gtk_label_new(nullptr))) {
    GtkBox* box = pageBox();
    gtk_box_append(box, _spans.widget());
    gtk_label_set_xalign(_words, 0);
    gtk_label_set_wrap(_words, TRUE);
    gtk_box_append(box, GTK_WIDGET(_words));
    gtk_box_append(box, GTK_WIDGET(_plotsBox));
    gtk_scrolled_window_set_child(_scroller.get(), GTK_WIDGET(box));
    build({});
}

void GraphView::build(const std::vector<Plot>& plots) {
    while (GtkWidget* child = gtk_widget_get_first_child(GTK_WIDGET(_plotsBox))) {
        gtk_box_remove(_plotsBox, child);
    }
    _plots.clear();
    for (const Plot& plot : plots) {
        PlotWidgets& made = _plots.emplace_back();
        for (const CurvePlot::Line& line : plot.content.lines) {
            made.numbers.push_back(line.number);
            made.legend.push_back(addLegend(_plotsBox, line.number));
        }
        made.plot = std::make_unique<CurvePlot>(_guard, _actions.pointed);
        gtk_box_append(_plotsBox, made.plot->widget());
    }
    if (plots.empty()) {
        gtk_box_append(_plotsBox, nothingInGraph());
    }
}

void GraphView::show(const Content& content) {
    const auto isOf = [](const PlotWidgets& widgets, const Plot& plot) {
        return std::equal(
            widgets.numbers.begin(), widgets.numbers.end(), plot.content.lines.begin(),
            plot.content.lines.end(),
            [](std::size_t number, const auto& line) { return number == line.number; });
    };
    if (!std::equal(_plots.begin(), _plots.end(), content.plots.begin(), content.plots.end(),
                    isOf)) {
        build(content.plots);
    }
    _spans.show(content.span);
    gtk_widget_set_visible(_spans.widget(), content.plots.empty() ? FALSE : TRUE);
    changeText(_words, content.plots.empty() ? "" : content.words);
    int labels = 0;
    for (std::size_t index = 0; index < _plots.size(); ++index) {
        const Plot& plot = content.plots[index];
        std::string description = translated("Curves: ");
        for (std::size_t line = 0; line < plot.legend.size(); ++line) {
            changeText(_plots[index].legend[line], plot.legend[line]);
            description += (line == 0 ? "" : "; ") + plot.legend[line];
        }
        _plots[index].plot->show(plot.content, description);
        labels = std::max(labels, _plots[index].plot->labelWidth());
    }
    for (const PlotWidgets& widgets : _plots) {
        widgets.plot->setLabelWidth(labels);
    }
}

} // namespace pallax::gtk
