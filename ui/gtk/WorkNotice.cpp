#include "ui/gtk/WorkNotice.h"

#include "ui/gtk/ShownText.h"
#include "ui/gtk/Translation.h"

#include <utility>

namespace pallax::gtk {

namespace {

constexpr std::chrono::milliseconds kSilentWork{500};
constexpr std::chrono::milliseconds kBetweenLooks{50};
constexpr const char* kStop = "stop";

} // namespace

void WorkNotice::during(const std::function<void()>& work) {
    if (std::exchange(_isWorking, true)) {
        return;
    }
    _isStopped = false;
    _began = _looked = _now();
    try {
        work();
    } catch (...) {
        close();
        throw;
    }
    close();
}

bool WorkNotice::mayGoOn(const std::string& words) {
    const auto now = _now();
    const bool isSilent = now - _began < kSilentWork || now - _looked < kBetweenLooks;
    if (!_isWorking || _isStopped || isSilent) {
        return !_isStopped;
    }
    if (_dialog == nullptr) {
        open(words);
    }
    adw_message_dialog_set_body(_dialog, shownText(words).c_str());
    while (g_main_context_iteration(nullptr, FALSE) != FALSE) {
    }
    _looked = _now();
    return !_isStopped;
}

/// What is below the dialog cannot be used: a screen reader would not be kept from it by the
/// dialog alone.
void WorkNotice::open(const std::string& words) {
    if (GtkWidget* focus = gtk_window_get_focus(_window)) {
        _focus = shared(focus);
        gtk_window_set_focus(_window, nullptr);
    }
    gtk_widget_set_sensitive(gtk_widget_get_first_child(GTK_WIDGET(_window)), FALSE);
    _dialog = ADW_MESSAGE_DIALOG(
        adw_message_dialog_new(_window, translated("Working"), shownText(words).c_str()));
    adw_message_dialog_add_response(_dialog, kStop, translated("Stop"));
    adw_message_dialog_set_close_response(_dialog, kStop);
    onSignal(_dialog, "response", _guard, [this] { _isStopped = true; });
    gtk_window_present(GTK_WINDOW(_dialog));
}

void WorkNotice::close() {
    _isWorking = false;
    if (_dialog == nullptr) {
        return;
    }
    if (!_isStopped) { // otherwise it closes itself
        gtk_window_destroy(GTK_WINDOW(_dialog));
    }
    _dialog = nullptr;
    gtk_widget_set_sensitive(gtk_widget_get_first_child(GTK_WIDGET(_window)), TRUE);
    if (const Ref<GtkWidget> focus = std::move(_focus)) {
        if (GTK_IS_TEXT(focus.get()) != FALSE) {
            gtk_text_grab_focus_without_selecting(GTK_TEXT(focus.get()));
        } else {
            gtk_widget_grab_focus(focus.get());
        }
    }
}

} // namespace pallax::gtk
