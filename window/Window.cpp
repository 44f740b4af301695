#include "window/Window.h"

#include "browsing/KeptNotices.h"
#include "browsing/SourceShow.h"
#include "console/Output.h"
#include "host/Complaint.h"
#include "host/Interruption.h"
#include "ui/gtk/Menu.h"
#include "ui/gtk/RecentFiles.h"
#include "ui/gtk/ShownText.h"
#include "ui/gtk/Translation.h"
#include "window/Arguments.h"
#include "window/GlibTurns.h"
#include "window/Instance.h"
#include "window/Programs.h"
#include "window/Recordings.h"
#include "window/StartToolkit.h"
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

/// A window, and what its menu does.
class WindowProgram {
public:
    WindowProgram(GtkApplication* application, Instance& instance)
        : _application(application), _instance(instance), _turns(_queue), _guard(_queue),
          _programs(_queue), _frame(application, _guard, {.closed = [this] { close(); }}),
          _recordings({.queue = _queue,
                       .frame = _frame,
                       .guard = _guard,
                       .application = application,
                       .source =
                           [this](auto recorder) {
                               if (_session) {
                                   _session->recordWith(std::move(recorder));
                               }
                           }}),
          _recent(_frame.window(), _guard, gtk_recent_manager_get_default(),
                  [this](const auto& path) { open({path}, newToken()); }) {
        _queue.onSignal({SIGINT, SIGTERM, SIGHUP, SIGQUIT},
                        [this](int /*signal*/) { _queue.stop(); });
        acceptDrops();
        acceptShow();
    }
    /// Nobody may ask for anything once this is gone, while `instance` still is there.
    ~WindowProgram() { _instance.endServing(); }
    WindowProgram(const WindowProgram&) = delete;
    WindowProgram& operator=(const WindowProgram&) = delete;

    /// False if the child ended too early.
    bool show(const ShowRequest& request, SocketDirectory directory, ChildService* child) {
        KeptNotices notices(writeToDescriptor(STDOUT_FILENO, "Standard output"));
        _recording = recordingPath(request.options.source).value_or("");
        _session.emplace(WindowSession::Setup{_queue, _frame, _guard, notices, request,
                                              std::move(directory), child,
                                              [this](const auto& name) { notify(name); }});
        GtkWidget* const button = gtk::menuButton(_frame.window(), _guard, menu());
        g_menu_append_section(G_MENU(gtk_menu_button_get_menu_model(GTK_MENU_BUTTON(button))),
                              nullptr, _recent.section());
        _frame.setMenu(button);
        _frame.addBar(_session->timeBar().widget());
        _frame.onKey([this](guint key, GdkModifierType state) { return handleKey(key, state); });
        _session->start();
        std::error_code unknown;
        if (std::filesystem::is_regular_file(_recording, unknown) && !request.options.safe) {
            _recent.add(_recording);
        }
        serve();
        try {
            _turns.run();
        } catch (const FatalRecord& fatal) {
            complain(fatal.what());
            endRecording();
            _session.reset();
            _instance.giveUpClaim();
            _frame.showEnded(fatal.what());
            _turns.run();
            throw;
        }
        endRecording();
        const bool isWhole = !_session->hasLostSource();
        _session.reset();
        return isWhole;
    }
    /// Whether all recordings that were made are whole.
    bool isRecorded() const { return _isRecorded; }

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
             {"time", gtk::translated("Time Bar"), onSession(&WindowSession::toggleTimeBar)},
             {"graph", gtk::translated("Graph"), onSession(&WindowSession::openGraph)},
             {"changes", gtk::translated("Changes since the Mark"),
              onSession(&WindowSession::toggleChanges)}},
            _session->tablePages().menu(),
            {{"safe", gtk::translated("Hide Identities"), [this] { toggleSafe(); },
              [this] { return _session && _session->isSafe(); }},
             {"afresh", gtk::translated("Start Afresh"), onSession(&WindowSession::startAfresh)}},
            {{"open", gtk::translated("Open Recording…"), [this] { chooseRecording(); }}}};
        sections.back().push_back({.name = "save",
                                   .label = gtk::translated("Save Snapshot…"),
                                   .action = [this] { _frame.save(); },
                                   .besides = _frame.saveButton()});
        if (isFile()) {
            sections.back().push_back(
                {"report", gtk::translated("Report in the Browser"), [this] { report(); }});
        }
        if (_recording.empty()) {
            sections.insert(sections.end() - 1,
                            {{"record", gtk::translated("Record…"), [this] { record(); }}});
        }
        return sections;
    }

    void close() {
        _recordings.beforeClosing([this] { _queue.stop(); });
    }

    void record() {
        if (_session) {
            _recordings.choose();
        }
    }

    /// Before the session ends. What is not whole is told on standard error, too.
    void endRecording() {
        if (const auto failure = _recordings.finish()) {
            complain(*failure);
            _isRecorded = false;
        }
    }

    /// A recording holds either what identifies a person or not.
    void toggleSafe() {
        if (_recordings.isOn()) {
            _frame.setMessage(gtk::translated("Stop the recording first."));
        } else if (_session) {
            _session->toggleSafe();
        }
    }

    bool handleKey(guint key, GdkModifierType state) {
        const bool isControl = (state & GDK_CONTROL_MASK) != 0;
        if (isControl && key == GDK_KEY_o) {
            chooseRecording();
        } else if ((isControl && key == GDK_KEY_f) || key == GDK_KEY_slash) {
            _frame.toggleSearch();
        } else if (isControl && (key == GDK_KEY_q || key == GDK_KEY_w)) {
            close();
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
        g_notification_set_default_action_and_target(notice.get(),
                                                     (std::string("app.") + kShowAction).c_str(),
                                                     "s", _instance.windowName().c_str());
        g_application_send_notification(G_APPLICATION(_application), "alarm", notice.get());
    }

    /// What others of the application ask this process for.
    void serve() {
        _instance.serve(
            {.open = [this](const auto& words,
                            const auto& token) { _guard.run([&] { open(words, token); }); },
             .present = [this](const auto& token) { _guard.run([&] { _frame.present(token); }); }});
    }

    /// As a process of its own, which brings the window that shows the same to the front, if there
    /// is one; what it cannot do is told here.
    void open(std::vector<std::string> words, const std::string& token) {
        words.insert(words.begin(), windowProgram());
        _programs.start(
            words,
            [this](const std::string& complaint) {
                if (!complaint.empty()) {
                    _frame.showAlert(
                        {gtk::translated("Cannot Open"), complaint, gtk::translated("Close")});
                }
            },
            token);
    }

    /// For a window that is opened from this one.
    std::string newToken() {
        const gtk::Ref<GAppLaunchContext> context(
            G_APP_LAUNCH_CONTEXT(gdk_display_get_app_launch_context(
                gtk_widget_get_display(GTK_WIDGET(_frame.window())))));
        const gtk::Ref<GAppInfo> program(g_app_info_create_from_commandline(
            "pallax-window", "Pallax", G_APP_INFO_CREATE_SUPPORTS_STARTUP_NOTIFICATION, nullptr));
        gchar* made =
            g_app_launch_context_get_startup_notify_id(context.get(), program.get(), nullptr);
        std::string token = made != nullptr ? made : "";
        g_free(made);
        return token;
    }

    void openFile(GFile* file) {
        if (gchar* path = file != nullptr ? g_file_get_path(file) : nullptr) {
            open({path}, newToken());
            g_free(path);
        }
    }

    /// A notice of this window was pressed, where the desktop calls the program itself.
    void acceptShow() {
        const gtk::Ref<GSimpleAction> show(g_simple_action_new(kShowAction, G_VARIANT_TYPE_STRING));
        gtk::onSignal(show.get(), "activate", _guard, [this] { _frame.present(); });
        g_action_map_add_action(G_ACTION_MAP(_application), G_ACTION(show.get()));
    }

    /// Whether a recording or snapshot in a file is shown.
    bool isFile() const { return !_recording.empty() && _recording != "-"; }

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
        _programs.start({terminalProgram(), "report", _recording, "-o", page},
                        [this, page](const std::string& complaint) {
                            if (complaint.empty()) {
                                gchar* address = g_filename_to_uri(page.c_str(), nullptr, nullptr);
                                gtk_show_uri(_frame.window(), address, GDK_CURRENT_TIME);
                                g_free(address);
                            } else {
                                _frame.showAlert({gtk::translated("No Report"), complaint,
                                                  gtk::translated("Close")});
                            }
                        });
    }

    GtkApplication* _application;
    Instance& _instance;
    AsioMainQueue _queue;
    GlibTurns _turns;
    gtk::Guard _guard;
    Programs _programs;
    gtk::MainFrame _frame;
    std::string _recording; ///< its path; empty if what is shown is none
    std::optional<WindowSession> _session;
    Recordings _recordings;
    bool _isRecorded = true;
    gtk::RecentFiles _recent;
    gtk::Ref<GtkFileChooserNative> _chooser; ///< the latest
};

} // namespace

ExitStatus runWindow(const BrowseOptions& options) {
    const Interruption interruption;
    const gtk::Ref<GDBusConnection> bus = sessionBus();
    Instance instance(bus.get());
    const auto key = keyOf(options);
    if (key && !instance.claim(*key, activationToken())) {
        return kExitSuccess; // another process shows it
    }
    if (!startToolkit()) {
        return kExitFailure;
    }
    const gtk::Ref<GtkApplication> application(
        GTK_APPLICATION(adw_application_new(kApplicationId, G_APPLICATION_NON_UNIQUE)));
    (void)g_application_register(G_APPLICATION(application.get()), nullptr, nullptr);
    bool isRecorded = true;
    const ExitStatus status = showSource(
        options, [&](const ShowRequest& request, SocketDirectory directory, ChildService* child) {
            WindowProgram program(application.get(), instance);
            const bool isWhole = program.show(request, std::move(directory), child);
            isRecorded = program.isRecorded();
            return isWhole;
        });
    return isRecorded ? status : kExitFailure;
}

} // namespace pallax
