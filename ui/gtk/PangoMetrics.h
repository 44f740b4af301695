#pragma once

#include "platform/ui/TextMetrics.h"
#include "ui/gtk/Ref.h"

#include <gtk/gtk.h>
#include <memory>
#include <string>
#include <string_view>

namespace pallax::gtk {

/// Fonts and lengths of the window. A point is a pixel of the toolkit, times the size that the user
/// has chosen for texts: everything in the layouts grows with it.
class PangoMetrics final : public ui::TextMetrics {
public:
    /// Measures as texts in this widget are drawn.
    explicit PangoMetrics(GtkWidget* widget);

    /// Of the text as it is shown: see `shownText`.
    ui::Size measure(std::string_view text, const ui::Font& font) const override;

    /// Pixels per point.
    double scale() const { return _scale; }
    /// Adopts the user's settings; true if the scale has changed.
    bool adoptSettings();

    int pixels(double points) const { return static_cast<int>(points * _scale); }

    /// Gives a label this font. A label that has it already is left alone, because it would be laid
    /// out anew, and its window with it.
    void setFont(GtkLabel* label, const ui::Font& font) const;

private:
    std::string family(ui::FontFace face) const;

    Ref<PangoContext> _context;
    double _scale = 1;
    std::string _systemFamily;
};

} // namespace pallax::gtk
