#include "ui/gtk/PangoMetrics.h"

#include "ui/gtk/ShownText.h"

#include <utility>

namespace pallax::gtk {

namespace {

struct FontFree {
    void operator()(PangoFontDescription* font) const { pango_font_description_free(font); }
};
using FontDescription = std::unique_ptr<PangoFontDescription, FontFree>;

FontDescription description(const std::string& family, const ui::Font& font, double scale) {
    FontDescription made(pango_font_description_new());
    pango_font_description_set_family(made.get(), family.c_str());
    pango_font_description_set_absolute_size(made.get(), font.size * scale * PANGO_SCALE);
    pango_font_description_set_weight(made.get(), font.face == ui::FontFace::BoldSystem
                                                      ? PANGO_WEIGHT_BOLD
                                                      : PANGO_WEIGHT_NORMAL);
    return made;
}

} // namespace

PangoMetrics::PangoMetrics(GtkWidget* widget) : _context(gtk_widget_create_pango_context(widget)) {
    (void)adoptSettings();
}

bool PangoMetrics::adoptSettings() {
    constexpr double kUsualResolution = 96 * 1024; // as the setting counts
    gint resolution = 0;
    gchar* name = nullptr;
    g_object_get(gtk_settings_get_default(), "gtk-xft-dpi", &resolution, "gtk-font-name", &name,
                 nullptr);
    if (name != nullptr) {
        const FontDescription font(pango_font_description_from_string(name));
        const char* family = pango_font_description_get_family(font.get());
        _systemFamily = family != nullptr ? family : "Sans";
        g_free(name);
    }
    const double scale = resolution > 0 ? resolution / kUsualResolution : 1;
    return std::exchange(_scale, scale) != scale;
}

std::string PangoMetrics::family(ui::FontFace face) const {
    return face == ui::FontFace::Helvetica ? "Helvetica" : _systemFamily;
}

ui::Size PangoMetrics::measure(std::string_view text, const ui::Font& font) const {
    const Ref<PangoLayout> layout(pango_layout_new(_context.get()));
    const FontDescription drawn = description(family(font.face), font, _scale);
    pango_layout_set_font_description(layout.get(), drawn.get());
    const std::string shown = shownText(text);
    pango_layout_set_text(layout.get(), shown.data(), static_cast<int>(shown.size()));
    int width = 0;
    int height = 0;
    pango_layout_get_pixel_size(layout.get(), &width, &height);
    return {width / _scale, height / _scale};
}

void PangoMetrics::setFont(GtkLabel* label, const ui::Font& font) const {
    PangoAttrList* list = pango_attr_list_new();
    const FontDescription drawn = description(family(font.face), font, _scale);
    pango_attr_list_insert(list, pango_attr_font_desc_new(drawn.get()));
    PangoAttrList* shown = gtk_label_get_attributes(label);
    if (shown == nullptr || pango_attr_list_equal(shown, list) == FALSE) {
        gtk_label_set_attributes(label, list);
    }
    pango_attr_list_unref(list);
}

} // namespace pallax::gtk
