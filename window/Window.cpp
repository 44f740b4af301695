#include "window/Window.h"

#include "browsing/KeptNotices.h"
#include "browsing/SourceShow.h"
#include "console/Output.h"
#include "host/Complaint.h"
#include "host/Interruption.h"
#include "ui/gtk/Menu.h"
#include "ui/gtk/ShownText.h"
#include "ui/gtk/Translation.h"
#include "window/GlibTurns.h"
#include "window/Programs.h"
#include "window/WindowSession.h"

#include <adwaita.h>
#include <algorithm>
#include <csignal>
#include <filesystem>
#include <memory>
#include <optional>
#include <unistd.h>
#include <utility>

namespace pallax {

namespace {

/// Also the name of the desktop entry, the icon and the address on the session's bus.
constexpr const char* kApplicationId = "example.pallax.Pallax";

/// A window, and what its menu does.
class WindowProgram {
public:
    explicit WindowProgram(GtkApplication* application)
        : _application(application), _turns(_queue), _guard(_queue),
          _frame(application, _guard, {.closed = [this] { _queue.stop(); }}) {
        _queue.onSignal({SIGINT, SIGTERM, SIGHUP, SIGQUIT},
                        [this](int /*signal*/) { _queue.stop(); });
        acceptDrops();
    }

    /// False if the child ended too early.
    bool show(const ShowRequest& request, SocketDirectory directory, ChildService* child) {
        KeptNotices notices(writeToDescriptor(STDOUT_FILENO, "Standard output"));
        _recording = recordingPath(request.options.source).value_or("");
        _session.emplace(WindowSession::Setup{_queue, _frame, _guard, notices, request,
                                              std::move(directory), child,
                                              [this](const auto& name) { notify(name); }});
        _frame.setMenu(gtk::menuButton(_frame.window(), _guard, menu()));
        _frame.addBar(_session->timeBar().widget());
        _frame.onKey([this](guint key, GdkModifierType state) { return handleKey(key, state); });
        _session->start();
        try {
            _turns.run();
        } catch (const FatalRecord& fatal) {
            complain(fatal.what());
            _session.reset();
            _frame.showEnded(fatal.what());
            _turns.run();
            throw;
        }
        const bool isWhole = !_session->hasLostSource();
        _session.reset();
        return isWhole;
    }

private:
    std::vector<std::vector<gtk::MenuEntry>> menu() {
        const auto onSession = [this](void (WindowSession::*action)()) {
            return [this, action] {
                if (_session) {
                    ((*_session).*action)();
                }
            };
        };
        std::vector<std::vector<gtk::MenuEntry>> sections{
            {{"overview", gtk::translated("Overview"), [this] { _frame.toggleDetail(); }},
             {"search", gtk::translated("Search Rows"), [this] { _frame.toggleSearch(); }},
             {"time", gtk::translated("Time Bar"), onSession(&WindowSession::toggleTimeBar)}},
            {{"safe", gtk::translated("Hide Identities"), onSession(&WindowSession::toggleSafe),
              [this] { return _session && _session->isSafe(); }},
             {"afresh", gtk::translated("Start Afresh"), onSession(&WindowSession::startAfresh)}},
            {{"open", gtk::translated("Open Recording…"), [this] { chooseRecording(); }}}};
        if (!_recording.empty() && _recording != "-") {
            sections.back().push_back(
                {"report", gtk::translated("Report in the Browser"), [this] { report(); }});
        }
        return sections;
    }

    bool handleKey(guint key, GdkModifierType state) {
        const bool isControl = (state & GDK_CONTROL_MASK) != 0;
        if (isControl && key == GDK_KEY_o) {
            chooseRecording();
        } else if ((isControl && key == GDK_KEY_f) || key == GDK_KEY_slash) {
            _frame.toggleSearch();
        } else if (isControl && (key == GDK_KEY_q || key == GDK_KEY_w)) {
            _queue.stop();
        } else if (!isControl && key == GDK_KEY_o) {
            _frame.toggleDetail();
        } else {
            return !isControl && _session && _session->handleKey(key);
        }
        return true;
    }

    /// An alarm of the settings, as a notice of the desktop.
    void notify(const std::string& name) {
        const gtk::Ref<GNotification> notice(g_notification_new(gtk::translated("Alarm")));
        g_notification_set_body(notice.get(), gtk::shownText(name).c_str());
        g_application_send_notification(G_APPLICATION(_application), "alarm", notice.get());
    }

    /// In a window, and process, of its own; what that cannot do is told here.
    void open(const std::string& path) {
        runBeside(_queue, {windowProgram(), path}, [this](const std::string& complaint) {
            if (!complaint.empty()) {
                _frame.showAlert(
                    {gtk::translated("Cannot Open"), complaint, gtk::translated("Close")});
            }
        });
    }

    void openFile(GFile* file) {
        if (gchar* path = file != nullptr ? g_file_get_path(file) : nullptr) {
            open(path);
            gchar* address = g_file_get_uri(file);
            (void)gtk_recent_manager_add_item(gtk_recent_manager_get_default(), address);
            g_free(address);
            g_free(path);
        }
    }

    void chooseRecording() {
        _chooser = gtk::Ref<GtkFileChooserNative>(gtk_file_chooser_native_new(
            gtk::translated("Open Recording"), _frame.window(), GTK_FILE_CHOOSER_ACTION_OPEN,
            gtk::translated("Open"), gtk::translated("Cancel")));
        const auto answered = [this](int response) {
            if (response == GTK_RESPONSE_ACCEPT) {
                const gtk::Ref<GFile> file(
                    gtk_file_chooser_get_file(GTK_FILE_CHOOSER(_chooser.get())));
                openFile(file.get());
            }
        };
        gtk::connect(_chooser.get(), "response", _guard, std::function<void(int)>(answered));
        gtk_native_dialog_show(GTK_NATIVE_DIALOG(_chooser.get()));
    }

    void acceptDrops() {
        GtkDropTarget* target = gtk_drop_target_new(G_TYPE_FILE, GDK_ACTION_COPY);
        const auto dropped = [this](const GValue* value) -> gboolean {
            openFile(G_FILE(g_value_get_object(value)));
            return TRUE;
        };
        gtk::connect(target, "drop", _guard, std::function<gboolean(const GValue*)>(dropped));
        gtk_widget_add_controller(GTK_WIDGET(_frame.window()), GTK_EVENT_CONTROLLER(target));
    }

    void report() {
        const std::filesystem::path folder =
            std::filesystem::path(g_get_user_cache_dir()) / "pallax";
        std::error_code ignored; // the command tells
        std::filesystem::create_directories(folder, ignored);
        const std::string page =
            folder / (std::filesystem::path(_recording).filename().string() + ".html");
        _frame.setMessage(gtk::translated("Making a report…"));
        runBeside(_queue, {terminalProgram(), "report", _recording, "-o", page},
                  [this, page](const std::string& complaint) {
                      if (complaint.empty()) {
                          gtk_show_uri(_frame.window(), ("file://" + page).c_str(),
                                       GDK_CURRENT_TIME);
                      } else {
                          _frame.showAlert(
                              {gtk::translated("No Report"), complaint, gtk::translated("Close")});
                      }
                  });
    }

    GtkApplication* _application;
    AsioMainQueue _queue;
    GlibTurns _turns;
    gtk::Guard _guard;
    gtk::MainFrame _frame;
    std::string _recording; ///< its path; empty if what is shown is none
    std::optional<WindowSession> _session;
    gtk::Ref<GtkFileChooserNative> _chooser; ///< the latest
};

/// Whether OpenGL has a graphics processor. Without one, this processor would do its work, which
/// takes longer than the toolkit's own drawing, and 70 MB more.
bool hasGraphicsProcessor() {
    std::error_code missing;
    const std::filesystem::directory_iterator devices("/dev/dri", missing);
    return std::any_of(begin(devices), end(devices), [](const auto& device) {
        return device.path().filename().string().starts_with("render");
    });
}

/// Beside the program where it was built, or where it is installed.
std::string translationsFolder() {
    const std::filesystem::path folder = std::filesystem::path(windowProgram()).parent_path();
    std::error_code missing;
    return std::filesystem::exists(folder / "locale", missing)
               ? (folder / "locale").string()
               : (folder.parent_path() / "share/locale").string();
}

} // namespace

ExitStatus runWindow(const BrowseOptions& options) {
    const Interruption interruption;
    gtk_disable_setlocale(); // numbers are written and read in the same way everywhere
    gtk::useTranslations(translationsFolder().c_str());
    if (!hasGraphicsProcessor()) {
        g_setenv("GSK_RENDERER", "cairo", FALSE); // unless the user has chosen
    }
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
