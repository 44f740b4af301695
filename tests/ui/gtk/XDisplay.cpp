#include "tests/ui/gtk/XDisplay.h"

#include <adwaita.h>
#include <array>
#include <csignal>
#include <cstdlib>
#include <fcntl.h>
#include <string>
#include <sys/prctl.h>
#include <sys/wait.h>
#include <unistd.h>

namespace pallax::doubles {

namespace {

/// The server of this process, which ends with it.
class XServer {
public:
    XServer() {
        std::array<int, 2> pipe{};
        if (::pipe(pipe.data()) != 0) {
            return;
        }
        _process = ::fork();
        if (_process == 0) {
            run(pipe[1]);
        }
        (void)::close(pipe[1]);
        for (char digit = 0; ::read(pipe[0], &digit, 1) == 1 && digit != '\n';) {
            _number += digit;
        }
        (void)::close(pipe[0]);
    }
    ~XServer() {
        if (_process > 0) {
            (void)::kill(_process, SIGTERM);
            (void)::waitpid(_process, nullptr, 0);
        }
    }
    XServer(const XServer&) = delete;
    XServer& operator=(const XServer&) = delete;

    /// Its display; empty if it could not be started.
    const std::string& number() const { return _number; }

private:
    [[noreturn]] static void run(int descriptor) {
        (void)::prctl(PR_SET_PDEATHSIG, SIGTERM);
        const int nowhere = ::open("/dev/null", O_RDWR);
        (void)::dup2(nowhere, STDERR_FILENO);
        (void)::execlp("Xvfb", "Xvfb", "-displayfd", std::to_string(descriptor).c_str(), "-screen",
                       "0", "1280x1024x24", "-nolisten", "tcp", nullptr);
        ::_exit(1);
    }

    pid_t _process = -1;
    std::string _number;
};

bool open() {
    static const XServer server;
    if (server.number().empty()) {
        return false;
    }
    for (const auto& [name, value] :
         {std::pair<std::string, std::string>{"DISPLAY", ":" + server.number()},
          {"GDK_BACKEND", "x11"},
          {"GSK_RENDERER", "cairo"},
          {"GTK_A11Y", "test"},
          {"GSETTINGS_BACKEND", "memory"},
          {"ADW_DISABLE_PORTAL", "1"}}) {
        (void)::setenv(name.c_str(), value.c_str(), 1);
    }
    adw_init();
    g_object_set(gtk_settings_get_default(), "gtk-enable-animations", FALSE, nullptr);
    return true;
}

} // namespace

bool openXDisplay() {
    static const bool isOpen = open();
    return isOpen;
}

} // namespace pallax::doubles
