#include "window/Programs.h"

#include "console/ExitStatus.h"
#include "ui/gtk/Ref.h"

#include <filesystem>
#include <gio/gio.h>
#include <memory>

namespace pallax {

namespace {

struct Waiting {
    std::weak_ptr<MainQueue*> queue;
    std::function<void(const std::string&)> ended;
};

/// Comes from GLib's loop, so only posts.
void finished(GObject* process, GAsyncResult* result, gpointer data) {
    const std::unique_ptr<Waiting> waiting(static_cast<Waiting*>(data));
    gchar* text = nullptr;
    (void)g_subprocess_communicate_utf8_finish(G_SUBPROCESS(process), result, nullptr, &text,
                                               nullptr);
    auto* ended = G_SUBPROCESS(process);
    const bool isDone = g_subprocess_get_successful(ended) != FALSE ||
                        (g_subprocess_get_if_exited(ended) != FALSE &&
                         g_subprocess_get_exit_status(ended) == kExitFatalRecord);
    std::string complaint = isDone || text == nullptr ? "" : text;
    g_free(text);
    if (complaint.ends_with('\n')) {
        complaint.pop_back();
    }
    if (!isDone && complaint.empty()) {
        complaint = "The program was ended.";
    }
    if (const auto queue = waiting->queue.lock()) {
        (*queue)->async(
            [ended = waiting->ended, complaint = std::move(complaint)] { ended(complaint); });
    }
}

} // namespace

Programs::Programs(MainQueue& queue) : _queue(std::make_shared<MainQueue*>(&queue)) {}

void Programs::start(const std::vector<std::string>& words,
                     const std::function<void(const std::string& complaint)>& ended,
                     const std::string& token) {
    std::vector<const char*> arguments;
    arguments.reserve(words.size() + 1);
    for (const std::string& word : words) {
        arguments.push_back(word.c_str());
    }
    arguments.push_back(nullptr);
    const gtk::Ref<GSubprocessLauncher> launcher(
        g_subprocess_launcher_new(G_SUBPROCESS_FLAGS_STDERR_PIPE));
    for (const char* name : {"DESKTOP_STARTUP_ID", "XDG_ACTIVATION_TOKEN"}) {
        if (!token.empty()) {
            g_subprocess_launcher_setenv(launcher.get(), name, token.c_str(), TRUE);
        }
    }
    GError* error = nullptr;
    GSubprocess* process = g_subprocess_launcher_spawnv(launcher.get(), arguments.data(), &error);
    if (process == nullptr) {
        (*_queue)->async([ended, complaint = std::string(error->message)] { ended(complaint); });
        g_error_free(error);
        return;
    }
    g_subprocess_communicate_utf8_async(process, nullptr, nullptr, finished,
                                        new Waiting{_queue, ended});
    g_object_unref(process);
}

std::string windowProgram() {
    return std::filesystem::read_symlink("/proc/self/exe").string();
}

std::string terminalProgram() {
    return std::filesystem::path(windowProgram()).replace_filename("pallax").string();
}

} // namespace pallax
