#include "window/Activation.h"

#include "host/AsioMainQueue.h"
#include "host/Complaint.h"
#include "ui/gtk/ShownText.h"
#include "ui/gtk/Signals.h"
#include "ui/gtk/Translation.h"
#include "window/GlibTurns.h"
#include "window/Instance.h"
#include "window/Programs.h"
#include "window/StartToolkit.h"

#include <adwaita.h>
#include <chrono>
#include <csignal>
#include <string>
#include <vector>

namespace pallax {

namespace {

constexpr std::chrono::seconds kPatience{10}; ///< for the next request

class Activation {
public:
    explicit Activation(GDBusConnection* bus)
        : _turns(_queue), _guard(_queue), _programs(_queue), _instance(bus) {}

    void run() {
        _queue.onSignal({SIGINT, SIGTERM, SIGHUP}, [this](int /*signal*/) { _queue.stop(); });
        _instance.serve(
            {.open = [this](const auto& words,
                            const auto& token) { _guard.run([&] { open(words, token); }); },
             .present = [](const auto& /*token*/) {}});
        endWhenUnused();
        _turns.run();
    }

private:
    void open(std::vector<std::string> words, const std::string& token) {
        ++_requests;
        ++_open;
        words.insert(words.begin(), windowProgram());
        _programs.start(
            words,
            [this](const std::string& complaint) {
                if (complaint.empty()) {
                    close();
                } else {
                    passOnComplaints(complaint + '\n');
                    tell(complaint);
                }
            },
            token);
    }

    void close() {
        --_open;
        endWhenUnused();
    }

    void endWhenUnused() {
        _queue.after(kPatience, [this, requests = _requests] {
            if (_open == 0 && requests == _requests) {
                _queue.stop();
            }
        });
    }

    void tell(const std::string& complaint) {
        if (!startToolkit()) {
            return close();
        }
        GtkWidget* dialog = adw_message_dialog_new(nullptr, gtk::translated("Cannot Open"),
                                                   gtk::shownText(complaint).c_str());
        adw_message_dialog_add_response(ADW_MESSAGE_DIALOG(dialog), "close",
                                        gtk::translated("Close"));
        adw_message_dialog_set_close_response(ADW_MESSAGE_DIALOG(dialog), "close");
        gtk::onSignal(dialog, "response", _guard, [this] { close(); });
        gtk_window_present(GTK_WINDOW(dialog));
    }

    AsioMainQueue _queue;
    GlibTurns _turns;
    gtk::Guard _guard;
    Programs _programs;
    std::size_t _requests = 0;
    int _open = 0; ///< processes, and dialogs
    Instance _instance;
};

} // namespace

ExitStatus runActivated() {
    const auto bus = sessionBus();
    if (!bus) {
        complain("There is no session bus.");
        return kExitFailure;
    }
    Activation(bus.get()).run();
    return kExitSuccess;
}

} // namespace pallax
