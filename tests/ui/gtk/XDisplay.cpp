#include "tests/ui/gtk/XDisplay.h"

#include "tests/ui/gtk/XServer.h"

#include <adwaita.h>
#include <cstdlib>
#include <string>
#include <utility>

namespace pallax::doubles {

namespace {

bool open() {
    static const XServer server;
    if (server.display().empty()) {
        return false;
    }
    for (const auto& [name, value] :
         {std::pair<std::string, std::string>{"DISPLAY", server.display()},
          {"GDK_BACKEND", "x11"},
          {"GSK_RENDERER", "cairo"},
          {"GTK_A11Y", "test"},
          {"GSETTINGS_BACKEND", "memory"},
          {"ADW_DISABLE_PORTAL", "1"}}) {
        (void)::setenv(name.c_str(), value.c_str(), 1);
    }
    adw_init();
    g_object_set(gtk_settings_get_default(), "gtk-enable-animations", FALSE, nullptr);
    return true;
}

} // namespace

bool openXDisplay() {
    static const bool isOpen = open();
    return isOpen;
}

} // namespace pallax::doubles
