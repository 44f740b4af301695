#pragma once

#include "ui/gtk/Ref.h"

#include <functional>
#include <gio/gio.h>
#include <string>
#include <vector>

namespace pallax {

/// The name of the desktop entry, of the icon and of the application on the session's bus.
inline constexpr const char* kApplicationId = "example.pallax.Pallax";

/// The action of the application that brings the window with a name (`Instance::windowName`) to
/// the front.
inline constexpr const char* kShowAction = "show";

/// A connection to the session's bus, beside that of the toolkit, which has objects of its own at
/// the application's path; null if there is no bus.
gtk::Ref<GDBusConnection> sessionBus();

/// What the desktop sent along so that the window of this start may come to the front; "" if it is
/// nothing. Call it before the toolkit starts, which takes it.
std::string activationToken();

/// One process of the application on the session's bus.
///
/// Each window is a process. All ask for the application's name: one has it, the others wait in the
/// bus's queue, so that the next one takes over when it ends. Whoever has it answers the
/// desktop (org.freedesktop.Application). Each window also has a name made from what it shows, so
/// that a second window of the same source is noticed before it opens.
class Instance {
public:
    /// What others ask for. A token is as from `activationToken`. Exceptions must not leave.
    struct Requests {
        /// A start with these words of a command line.
        std::function<void(std::vector<std::string> words, const std::string& token)> open;
        /// The window is to come to the front.
        std::function<void(const std::string& token)> present;
    };

    /// Without a bus (null), nothing is asked and everything is claimed.
    explicit Instance(GDBusConnection* bus);
    /// Ends serving.
    ~Instance();
    Instance(const Instance&) = delete;
    Instance& operator=(const Instance&) = delete;

    /// Takes the name of the window that shows what the key says. False if a window of another
    /// process has it, which has been told to come to the front.
    bool claim(const std::string& key, const std::string& token);
    /// The window's name; "" without a claim.
    const std::string& windowName() const { return _windowName; }
    /// What the window shows is over: another one may open the same.
    void giveUpClaim();

    /// Asks for the application's name. Requests come from the loop of the default context.
    void serve(Requests requests);
    /// Gives up all names, and answers what has already come: what is to be opened is, but the
    /// window no longer comes to the front, so that a start that asks for that opens its own. After
    /// it, everything is refused.
    void endServing();

private:
    struct Call;
    static const GDBusInterfaceVTable& table();
    void exportObject(const char* path);
    void answer(const Call& call);
    void answerOpen(const Call& call);
    void answerAction(const Call& call);
    void showWindow(const std::string& name, const std::string& token);
    guint32 requestName(const std::string& name, guint32 flags);
    void releaseName(const std::string& name);
    bool present(const std::string& windowName, const std::string& token);

    gtk::Ref<GDBusConnection> _bus; ///< may be null
    std::vector<guint> _objects;
    std::string _windowName;
    Requests _requests;
};

} // namespace pallax
