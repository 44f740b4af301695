#include "window/StartToolkit.h"

#include "host/Complaint.h"
#include "ui/gtk/Translation.h"
#include "window/Instance.h"
#include "window/Programs.h"

#include <adwaita.h>
#include <algorithm>
#include <filesystem>
#include <string>

namespace pallax {

namespace {

/// Beside the program where it was built, or where it is installed.
std::string translationsFolder() {
    const std::filesystem::path folder = std::filesystem::path(windowProgram()).parent_path();
    std::error_code missing;
    return std::filesystem::exists(folder / "locale", missing)
               ? (folder / "locale").string()
               : (folder.parent_path() / "share/locale").string();
}

} // namespace

bool hasGraphicsProcessor(const std::string& folder) {
    std::error_code missing;
    const std::filesystem::directory_iterator devices(folder, missing);
    return std::any_of(begin(devices), end(devices), [](const auto& device) {
        return device.path().filename().string().starts_with("render");
    });
}

bool startToolkit() {
    gtk_disable_setlocale(); // numbers are written and read in the same way everywhere
    gtk::useTranslations(translationsFolder().c_str());
    if (!hasGraphicsProcessor("/dev/dri")) {
        g_setenv("GSK_RENDERER", "cairo", FALSE); // unless the user has chosen
    }
    if (gtk_init_check() == FALSE) {
        complain("There is no display for a window; pallax shows the same in a terminal.");
        return false;
    }
    g_set_prgname(kApplicationId); // what a compositor knows the window by
    g_set_application_name("Pallax");
    adw_init();
    return true;
}

} // namespace pallax
