#include "window/Window.h"

#include "browsing/KeptNotices.h"
#include "browsing/SourceShow.h"
#include "console/Output.h"
#include "host/Complaint.h"
#include "host/Interruption.h"
#include "window/GlibTurns.h"
#include "window/WindowSession.h"

#include <adwaita.h>
#include <csignal>
#include <memory>
#include <optional>
#include <unistd.h>
#include <utility>

namespace pallax {

namespace {

/// Also the name of the desktop entry, the icon and the address on the session's bus.
constexpr const char* kApplicationId = "example.pallax.Pallax";

class WindowProgram {
public:
    explicit WindowProgram(GtkApplication* application)
        : _turns(_queue), _guard(_queue),
          _frame(application, _guard, {.closed = [this] { _queue.stop(); }}) {
        _queue.onSignal({SIGINT, SIGTERM, SIGHUP, SIGQUIT},
                        [this](int /*signal*/) { _queue.stop(); });
    }

    /// False if the child ended too early.
    bool show(const ShowRequest& request, SocketDirectory directory, ChildService* child) {
        KeptNotices notices(writeToDescriptor(STDOUT_FILENO, "Standard output"));
        std::optional<WindowSession> session;
        session.emplace(WindowSession::Setup{_queue, _frame, _guard, notices, request,
                                             std::move(directory), child});
        session->start();
        try {
            _turns.run();
        } catch (const FatalRecord& fatal) {
            complain(fatal.what());
            session.reset();
            _frame.showEnded(fatal.what());
            _turns.run();
            throw;
        }
        return !session->hasLostSource();
    }

private:
    AsioMainQueue _queue;
    GlibTurns _turns;
    gtk::Guard _guard;
    gtk::MainFrame _frame;
};

} // namespace

ExitStatus runWindow(const BrowseOptions& options) {
    const Interruption interruption;
    if (gtk_init_check() == FALSE) {
        complain("There is no display for a window; pallax shows the same in a terminal.");
        return kExitFailure;
    }
    g_set_prgname(kApplicationId); // what a compositor knows the window by
    g_set_application_name("Pallax");
    adw_init();
    const gtk::Ref<GtkApplication> application(
        GTK_APPLICATION(adw_application_new(kApplicationId, G_APPLICATION_NON_UNIQUE)));
    (void)g_application_register(G_APPLICATION(application.get()), nullptr, nullptr);
    return showSource(options, [&application](const ShowRequest& request, SocketDirectory directory,
                                              ChildService* child) {
        return WindowProgram(application.get()).show(request, std::move(directory), child);
    });
}

} // namespace pallax
