#pragma once

#include <functional>
#include <glib.h>

namespace pallax::doubles {

/// A timeout of GLib that calls the function once, after so many milliseconds.
inline void onceAfter(guint delay, const std::function<void()>& action) {
    g_timeout_add_full(
        G_PRIORITY_DEFAULT, delay,
        +[](gpointer data) -> gboolean {
            (*static_cast<std::function<void()>*>(data))();
            return G_SOURCE_REMOVE;
        },
        new std::function<void()>(action),
        +[](gpointer data) { delete static_cast<std::function<void()>*>(data); });
}

} // namespace pallax::doubles
