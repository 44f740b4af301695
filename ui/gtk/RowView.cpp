#include "ui/gtk/RowView.h"

#include "ui/gtk/ShownText.h"
#include "ui/gtk/Style.h"
#include "ui/gtk/Translation.h"

#include <algorithm>
#include <cmath>
#include <utility>

namespace pallax::gtk {

namespace {

constexpr int kAccessoryMargin = 8;
constexpr const char* kChangedClass = "pallax-changed";
constexpr const char* kOpenClass = "pallax-open";

GtkLabel* dimLabel() {
    GtkWidget* label = gtk_label_new(nullptr);
    gtk_widget_add_css_class(label, "dim-label");
    gtk_widget_set_visible(label, FALSE);
    return GTK_LABEL(label);
}

/// What a screen reader says of a row: "Measured RSRP: -94.75 dBm, changed".
std::string spokenName(const ui::CellContents& contents, const RowNotes& notes) {
    std::string name;
    for (const ui::Label* label : contents.labels) {
        name += name.empty() ? "" : ": ";
        name += shownText(label->text);
    }
    if (!notes.count.empty()) {
        name += ", " + notes.count;
    }
    if (notes.hasChanged) {
        name += translated(", changed");
    }
    if (!notes.age.empty()) {
        name += ", " + notes.age + translated(" old");
    }
    return name;
}

/// A container inside a list takes the wheel from it. In its place, a controller that takes only
/// what goes sideways.
void replaceWheel(GtkWidget* scroller) {
    const Ref<GListModel> controllers(gtk_widget_observe_controllers(scroller));
    for (guint index = g_list_model_get_n_items(controllers.get()); index > 0; --index) {
        const Ref<GObject> controller(
            G_OBJECT(g_list_model_get_item(controllers.get(), index - 1)));
        if (GTK_IS_EVENT_CONTROLLER_SCROLL(controller.get()) != 0) {
            gtk_widget_remove_controller(scroller, GTK_EVENT_CONTROLLER(controller.get()));
        }
    }
}

} // namespace

RowView::RowView(const PangoMetrics& metrics, const Guard& guard,
                 std::function<void(double)> scrolled)
    : _metrics(metrics), _box(owned(GTK_BOX(gtk_box_new(GTK_ORIENTATION_HORIZONTAL, 0)))),
      _scroller(GTK_SCROLLED_WINDOW(gtk_scrolled_window_new())),
      _content(GTK_FIXED(gtk_fixed_new())) {
    GtkWidget* scroller = GTK_WIDGET(_scroller);
    gtk_scrolled_window_set_policy(_scroller, GTK_POLICY_EXTERNAL, GTK_POLICY_NEVER);
    gtk_scrolled_window_set_child(_scroller, GTK_WIDGET(_content));
    gtk_widget_set_hexpand(scroller, TRUE);
    gtk_widget_set_can_focus(scroller, FALSE);
    gtk_box_append(_box.get(), scroller);
    buildSide();
    _age = dimLabel();
    gtk_fixed_put(_content, GTK_WIDGET(_age), 0, 0);
    replaceWheel(scroller);
    listen(guard, std::move(scrolled));
}

void RowView::buildSide() {
    GtkWidget* side = gtk_box_new(GTK_ORIENTATION_HORIZONTAL, 0);
    gtk_widget_set_hexpand(side, FALSE); // the room is the content's
    _side = GTK_BOX(side);
    gtk_box_append(_box.get(), side);
    GtkWidget* marks = gtk_box_new(GTK_ORIENTATION_HORIZONTAL, kAccessoryMargin);
    gtk_widget_set_hexpand(marks, TRUE);
    gtk_widget_set_halign(marks, GTK_ALIGN_END);
    gtk_box_append(_side, marks);
    _count = dimLabel();
    gtk_box_append(GTK_BOX(marks), GTK_WIDGET(_count));
    _accessory = GTK_IMAGE(gtk_image_new());
    gtk_widget_add_css_class(GTK_WIDGET(_accessory), "dim-label");
    gtk_widget_set_margin_end(GTK_WIDGET(_accessory), kAccessoryMargin);
    gtk_box_append(GTK_BOX(marks), GTK_WIDGET(_accessory));
}

RowView::~RowView() {
    g_signal_handler_disconnect(gtk_scrolled_window_get_hadjustment(_scroller), _scrolling);
}

void RowView::listen(const Guard& guard, std::function<void(double)> scrolled) {
    _scrolling = onSignal(gtk_scrolled_window_get_hadjustment(_scroller), "value-changed", guard,
                          [this, scrolled = std::move(scrolled)] { scrolled(offset()); });
    GtkEventController* wheel =
        gtk_event_controller_scroll_new(GTK_EVENT_CONTROLLER_SCROLL_BOTH_AXES);
    const auto turned = [this, wheel](double x, double y) -> gboolean {
        constexpr double kStep = 40; // points
        const bool isShifted =
            (gtk_event_controller_get_current_event_state(wheel) & GDK_SHIFT_MASK) != 0;
        const double distance = isShifted && x == 0 ? y : x;
        return distance != 0 && scrollBy(distance * kStep) ? TRUE : FALSE;
    };
    connect(wheel, "scroll", guard, std::function<gboolean(double, double)>(turned));
    gtk_widget_add_controller(GTK_WIDGET(_scroller), wheel);
}

GtkLabel* RowView::labelAt(std::size_t index) {
    while (_labels.size() <= index) {
        GtkWidget* label = gtk_label_new(nullptr);
        gtk_label_set_xalign(GTK_LABEL(label), 0);
        gtk_label_set_single_line_mode(GTK_LABEL(label), TRUE);
        gtk_fixed_put(_content, label, 0, 0);
        _labels.push_back(GTK_LABEL(label));
    }
    return _labels[index];
}

void RowView::place(GtkLabel* label, const ui::Label& content, const ui::Rect& area, bool isBold) {
    const double scale = _metrics.scale();
    const ui::Rect& frame = content.frame;
    // What has changed is bold, for which the layouts leave room, and not only coloured.
    _metrics.setFont(label,
                     isBold ? ui::Font{ui::FontFace::BoldSystem, content.font.size} : content.font);
    gtk_label_set_text(label, shownText(content.text).c_str());
    // Where nothing scrolls, a text that is too long ends in dots.
    const double room = area.origin.x + area.size.width - frame.origin.x;
    const bool isCut = area.size.width > 0 && frame.size.width > room;
    gtk_label_set_ellipsize(label, isCut ? PANGO_ELLIPSIZE_END : PANGO_ELLIPSIZE_NONE);
    showTooltip(GTK_WIDGET(label), isCut ? std::string_view(content.text) : "");
    const double width = isCut ? std::max(room, 0.0) : frame.size.width;
    gtk_widget_set_size_request(GTK_WIDGET(label), static_cast<int>(std::lround(width * scale)),
                                static_cast<int>(std::lround(frame.size.height * scale)));
    gtk_fixed_move(_content, GTK_WIDGET(label), std::round(frame.origin.x * scale),
                   std::round(frame.origin.y * scale));
    gtk_widget_set_visible(GTK_WIDGET(label), TRUE);
}

bool RowView::isSame(const Shown& shown, const Shown& other) {
    const auto sameLabel = [](const ui::Label& one, const ui::Label& another) {
        return one.text == another.text && one.font == another.font && one.frame == another.frame;
    };
    const auto extent = [](const Shown& of) {
        return of.container ? of.container->contentSize : ui::Size();
    };
    return shown.scale == other.scale && shown.area == other.area &&
           shown.accessory == other.accessory && shown.notes == other.notes &&
           shown.container.has_value() == other.container.has_value() &&
           extent(shown) == extent(other) &&
           std::equal(shown.labels.begin(), shown.labels.end(), other.labels.begin(),
                      other.labels.end(), sameLabel);
}

void RowView::fill(const ui::TableCell& cell, const RowNotes& notes) {
    const ui::CellContents contents = cell.contents();
    Shown wanted{.labels = {},
                 .container = {},
                 .area = {},
                 .accessory = cell.accessory(),
                 .notes = notes,
                 .scale = _metrics.scale()};
    for (const ui::Label* label : contents.labels) {
        wanted.labels.push_back(*label);
    }
    if (contents.container != nullptr) {
        wanted.container = *contents.container;
    } else {
        wanted.area = cell.contentBounds();
    }
    if (isSame(_shown, wanted)) {
        return;
    }
    _shown = std::move(wanted);
    const ui::ScrollContainer* container = contents.container;
    for (std::size_t index = 0; index < contents.labels.size(); ++index) {
        place(labelAt(index), *contents.labels[index], _shown.area,
              notes.hasChanged && index + 1 == contents.labels.size());
    }
    for (std::size_t index = contents.labels.size(); index < _labels.size(); ++index) {
        gtk_widget_set_visible(GTK_WIDGET(_labels[index]), FALSE);
    }
    const bool isWider =
        container != nullptr && container->contentSize.width > container->frame.size.width;
    gtk_widget_set_size_request(GTK_WIDGET(_content),
                                isWider ? _metrics.pixels(container->contentSize.width) : 0,
                                _metrics.pixels(kRowHeight));
    gtk_widget_set_size_request(widget(), -1, _metrics.pixels(kRowHeight));
    gtk_widget_set_size_request(GTK_WIDGET(_side), _metrics.pixels(kAccessoryWidth), -1);
    showNotes(cell, notes);
    showAge(contents, notes.age);
    gtk_accessible_update_property(GTK_ACCESSIBLE(widget()), GTK_ACCESSIBLE_PROPERTY_LABEL,
                                   spokenName(contents, notes).c_str(), -1);
}

void RowView::showNotes(const ui::TableCell& cell, const RowNotes& notes) {
    showText(_count, notes.count);
    const ui::CellAccessory accessory = cell.accessory();
    const char* icon = accessory == ui::CellAccessory::DisclosureIndicator ? "go-next-symbolic"
                       : accessory == ui::CellAccessory::Checkmark ? "object-select-symbolic"
                                                                   : nullptr;
    gtk_image_set_from_icon_name(_accessory, icon);
    const std::size_t last = _labels.size() - 1;
    for (std::size_t index = 0; index < _labels.size(); ++index) {
        setClass(GTK_WIDGET(_labels[index]), kChangedClass, notes.hasChanged && index == last);
        setClass(GTK_WIDGET(_labels[index]), "dim-label", !notes.age.empty() && index == last);
    }
    setClass(widget(), kOpenClass, notes.isOpen);
}

/// Between name and value, if there is room.
void RowView::showAge(const ui::CellContents& contents, const std::string& age) {
    constexpr double kMargin = 10;
    constexpr ui::Font kFont{ui::FontFace::System, 12};
    const ui::Size extent = _metrics.measure(age, kFont);
    const ui::Rect& name = contents.labels.front()->frame;
    const ui::Rect& value = contents.labels.back()->frame;
    const double x = value.origin.x - kMargin - extent.width;
    const bool hasRoom =
        contents.labels.size() > 1 && x >= name.origin.x + name.size.width + kMargin;
    showText(_age, hasRoom ? age : "");
    _metrics.setFont(_age, kFont);
    gtk_fixed_move(_content, GTK_WIDGET(_age), std::round(x * _metrics.scale()),
                   std::round((kRowHeight - extent.height) / 2 * _metrics.scale()));
}

double RowView::offset() const {
    return gtk_adjustment_get_value(gtk_scrolled_window_get_hadjustment(_scroller)) /
           _metrics.scale();
}

/// The container's extent is known only after it was drawn: until then, more is allowed for.
void RowView::setOffset(double offset) {
    GtkAdjustment* adjustment = gtk_scrolled_window_get_hadjustment(_scroller);
    const double value = offset * _metrics.scale();
    const double needed = value + gtk_adjustment_get_page_size(adjustment);
    if (gtk_adjustment_get_upper(adjustment) < needed) {
        gtk_adjustment_set_upper(adjustment, needed);
    }
    gtk_adjustment_set_value(adjustment, value);
}

bool RowView::scrollBy(double distance) {
    GtkAdjustment* adjustment = gtk_scrolled_window_get_hadjustment(_scroller);
    const double before = gtk_adjustment_get_value(adjustment);
    gtk_adjustment_set_value(adjustment, before + distance * _metrics.scale());
    return gtk_adjustment_get_value(adjustment) != before;
}

} // namespace pallax::gtk
