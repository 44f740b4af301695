#pragma once

#include "ui/gtk/Ref.h"

#include <gtk/gtk.h>
#include <string>
#include <vector>

namespace pallax::gtk {

/// The page of what differs between two instants.
class ChangesView {
public:
    ChangesView();
    ChangesView(const ChangesView&) = delete;
    ChangesView& operator=(const ChangesView&) = delete;

    /// Lines that begin with a blank belong to the section whose name is above them. The same
    /// content again changes nothing.
    void show(const std::string& title, const std::vector<std::string>& lines);
    GtkWidget* widget() const { return GTK_WIDGET(_scroller.get()); }

private:
    void build();
    void addHeading(const std::string& text, const char* look);
    void addLine(GtkGrid* to, int row, const std::string& line);

    Ref<GtkScrolledWindow> _scroller;
    GtkBox* _box; ///< the scroller owns it
    std::string _title;
    std::vector<std::string> _lines;
};

} // namespace pallax::gtk
