#include "ui/gtk/RecentFiles.h"

#include "ui/gtk/ShownText.h"
#include "ui/gtk/Translation.h"

#include <algorithm>
#include <ctime>
#include <filesystem>

namespace pallax::gtk {

namespace {

constexpr const char* kApplication = "Pallax";
constexpr const char* kProgram = "pallax-window %f";

/// Whether the desktop keeps a list of recent files.
bool isWanted() {
    gboolean isOn = TRUE;
    g_object_get(gtk_settings_get_default(), "gtk-recent-files-enabled", &isOn, nullptr);
    return isOn != FALSE;
}

std::string taken(gchar* text) {
    std::string copy = text != nullptr ? text : "";
    g_free(text);
    return copy;
}

std::string typeOf(GFile* file) {
    const Ref<GFileInfo> info(g_file_query_info(file, G_FILE_ATTRIBUTE_STANDARD_CONTENT_TYPE,
                                                G_FILE_QUERY_INFO_NONE, nullptr, nullptr));
    const char* type = info ? g_file_info_get_content_type(info.get()) : nullptr;
    return type != nullptr ? type : "application/octet-stream";
}

/// A menu would leave out a single "_", and underline what follows.
std::string entryOf(const std::string& path) {
    std::string entry;
    for (const char each : shownText(std::filesystem::path(path).filename().string())) {
        entry.append(each == '_' ? 2 : 1, each);
    }
    return entry;
}

} // namespace

RecentFiles::RecentFiles(GtkWindow* window, const Guard& guard, GtkRecentManager* manager,
                         std::function<void(const std::string& path)> open)
    : _guard(guard), _manager(manager), _section(g_menu_new()) {
    const Ref<GSimpleActionGroup> actions(g_simple_action_group_new());
    const Ref<GSimpleAction> opening(g_simple_action_new("open", G_VARIANT_TYPE_BYTESTRING));
    connect(opening.get(), "activate", guard,
            std::function<void(GVariant*)>([open = std::move(open)](GVariant* path) {
                open(g_variant_get_bytestring(path));
            }));
    const Ref<GSimpleAction> clearing(g_simple_action_new("clear", nullptr));
    onSignal(clearing.get(), "activate", guard, [this] { clear(); });
    for (GSimpleAction* action : {opening.get(), clearing.get()}) {
        g_action_map_add_action(G_ACTION_MAP(actions.get()), G_ACTION(action));
    }
    gtk_widget_insert_action_group(GTK_WIDGET(window), "recent", G_ACTION_GROUP(actions.get()));
    _handlers.emplace_back(_manager, onSignal(_manager, "changed", guard, [this] { refresh(); }));
    GtkSettings* settings = gtk_settings_get_default();
    _handlers.emplace_back(settings, onSignal(settings, "notify::gtk-recent-files-enabled", guard,
                                              [this] { refresh(); }));
    refresh();
}

RecentFiles::~RecentFiles() {
    for (const auto& [instance, handler] : _handlers) {
        g_signal_handler_disconnect(instance, handler);
    }
}

/// Of each file of this application.
template <class Action>
void RecentFiles::forEach(const Action& action) const {
    GList* const items = gtk_recent_manager_get_items(_manager);
    for (const GList* each = items; each != nullptr; each = each->next) {
        auto* item = static_cast<GtkRecentInfo*>(each->data);
        if (gtk_recent_info_has_application(item, kApplication) != FALSE) {
            action(item);
        }
        gtk_recent_info_unref(item);
    }
    g_list_free(items);
}

void RecentFiles::add(const std::string& path) {
    if (!isWanted()) {
        return;
    }
    const Ref<GFile> file(g_file_new_for_path(path.c_str()));
    std::string type = typeOf(file.get());
    std::string application = kApplication;
    std::string program = kProgram;
    const GtkRecentData data{.display_name = nullptr,
                             .description = nullptr,
                             .mime_type = type.data(),
                             .app_name = application.data(),
                             .app_exec = program.data(),
                             .groups = nullptr,
                             .is_private = TRUE};
    (void)gtk_recent_manager_add_full(_manager, taken(g_file_get_uri(file.get())).c_str(), &data);
    writeNow();
}

void RecentFiles::clear() {
    std::vector<std::string> addresses;
    forEach([&](GtkRecentInfo* item) { addresses.emplace_back(gtk_recent_info_get_uri(item)); });
    for (const std::string& address : addresses) {
        (void)gtk_recent_manager_remove_item(_manager, address.c_str(), nullptr);
    }
    writeNow();
}

/// The manager would write its list a little later, when the program may have ended.
void RecentFiles::writeNow() {
    g_signal_emit_by_name(_manager, "changed");
}

std::vector<std::string> RecentFiles::paths() const {
    std::vector<std::pair<std::time_t, std::string>> found;
    if (isWanted()) {
        forEach([&](GtkRecentInfo* item) {
            if (gtk_recent_info_is_local(item) != FALSE && gtk_recent_info_exists(item) != FALSE) {
                GDateTime* shown = gtk_recent_info_get_modified(item);
                found.emplace_back(
                    g_date_time_to_unix(shown),
                    taken(g_filename_from_uri(gtk_recent_info_get_uri(item), nullptr, nullptr)));
            }
        });
    }
    std::stable_sort(found.begin(), found.end(),
                     [](const auto& a, const auto& b) { return a.first > b.first; });
    found.resize(std::min(found.size(), kMost));
    std::vector<std::string> paths;
    paths.reserve(found.size());
    for (auto& [time, path] : found) {
        paths.push_back(std::move(path));
    }
    return paths;
}

void RecentFiles::refresh() {
    g_menu_remove_all(_section.get());
    const std::vector<std::string> files = paths();
    if (files.empty()) {
        return;
    }
    const Ref<GMenu> names(g_menu_new());
    for (const std::string& path : files) {
        const Ref<GMenuItem> item(g_menu_item_new(entryOf(path).c_str(), nullptr));
        // As bytes, because a file name need not be UTF-8.
        g_menu_item_set_action_and_target(item.get(), "recent.open", "^ay", path.c_str());
        g_menu_append_item(names.get(), item.get());
    }
    const Ref<GMenu> clearing(g_menu_new());
    g_menu_append(clearing.get(), translated("Clear List"), "recent.clear");
    g_menu_append_section(names.get(), nullptr, G_MENU_MODEL(clearing.get()));
    g_menu_append_submenu(_section.get(), translated("Recent"), G_MENU_MODEL(names.get()));
}

} // namespace pallax::gtk
