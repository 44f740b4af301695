#pragma once

#include "ui/gtk/Ref.h"
#include "ui/gtk/Signals.h"

#include <adwaita.h>
#include <chrono>
#include <functional>
#include <string>

namespace pallax::gtk {

/// Keeps the window alive during work that takes long: after a short time a dialog tells of the
/// work, and stops it. Meanwhile nothing else in the window can be used, and no block of the main
/// queue runs.
class WorkNotice {
public:
    using Clock = std::function<std::chrono::steady_clock::time_point()>;

    /// The window must outlive the notice.
    WorkNotice(GtkWindow* window, const Guard& guard, Clock now = std::chrono::steady_clock::now)
        : _window(window), _guard(guard), _now(std::move(now)) {}
    WorkNotice(const WorkNotice&) = delete;
    WorkNotice& operator=(const WorkNotice&) = delete;

    /// Runs the work, which asks `mayGoOn` often. Does nothing while there is other work.
    void during(const std::function<void()>& work);
    /// Tells the words, if the work has taken long. False if the user has stopped it.
    bool mayGoOn(const std::string& words);

private:
    void open(const std::string& words);
    void close();

    GtkWindow* _window;
    Guard _guard;
    Clock _now;
    bool _isWorking = false;
    bool _isStopped = false;
    std::chrono::steady_clock::time_point _began;
    std::chrono::steady_clock::time_point _looked; ///< for what the user does
    AdwMessageDialog* _dialog = nullptr;           ///< once it is open
    Ref<GtkWidget> _focus;                         ///< what had the keyboard before
};

} // namespace pallax::gtk
