#pragma once

#include "ui/gtk/Ref.h"

#include <gtk/gtk.h>
#include <string>
#include <vector>

namespace pallax::gtk {

/// The line below the status: alarms that are true, why nothing changes, and a note.
class Remarks {
public:
    Remarks();
    Remarks(const Remarks&) = delete;
    Remarks& operator=(const Remarks&) = delete;

    void setNote(std::string text);
    void setStream(std::string state);
    void setAlarms(const std::vector<std::string>& names);

    GtkWidget* widget() const { return GTK_WIDGET(_label.get()); }

private:
    void show();

    Ref<GtkLabel> _label;
    std::string _note;
    std::string _stream;
    std::string _alarms;
    std::string _shown; ///< a label that is set again is laid out again
};

} // namespace pallax::gtk
