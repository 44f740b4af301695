#pragma once

#include "ui/gtk/Ref.h"
#include "ui/gtk/Signals.h"

#include <functional>
#include <gtk/gtk.h>
#include <string>
#include <utility>
#include <vector>

namespace pallax::gtk {

/// The files that were shown lately, in the desktop's list, where they are marked as private:
/// other applications do not offer them. The desktop's setting that keeps no such list is heeded.
class RecentFiles {
public:
    /// At most so many are offered.
    static constexpr std::size_t kMost = 8;

    /// The manager must outlive the object. `open` opens a file.
    RecentFiles(GtkWindow* window, const Guard& guard, GtkRecentManager* manager,
                std::function<void(const std::string& path)> open);
    ~RecentFiles();
    RecentFiles(const RecentFiles&) = delete;
    RecentFiles& operator=(const RecentFiles&) = delete;

    /// The file was shown.
    void add(const std::string& path);
    /// Forgets all files of this application.
    void clear();
    /// The paths that are offered, the latest first; not those of files that are gone.
    std::vector<std::string> paths() const;

    /// A section of a menu, with a menu of the files while there are any. It follows the list.
    GMenuModel* section() const { return G_MENU_MODEL(_section.get()); }

private:
    template <class Action>
    void forEach(const Action& action) const;
    void writeNow();
    void refresh();

    Guard _guard;
    GtkRecentManager* _manager;
    Ref<GMenu> _section;
    std::vector<std::pair<gpointer, gulong>> _handlers;
};

} // namespace pallax::gtk
