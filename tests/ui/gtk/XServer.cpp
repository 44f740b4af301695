#include "tests/ui/gtk/XServer.h"

#include <array>
#include <csignal>
#include <fcntl.h>
#include <sys/prctl.h>
#include <sys/wait.h>
#include <unistd.h>

namespace pallax::doubles {

namespace {

/// Becomes the server, which writes the number of its display to the descriptor. It does not start
/// afresh when its last client leaves: a program that connects meanwhile would find no display.
[[noreturn]] void serve(int descriptor) {
    (void)::prctl(PR_SET_PDEATHSIG, SIGTERM);
    (void)::dup2(::open("/dev/null", O_RDWR), STDERR_FILENO);
    (void)::execlp("Xvfb", "Xvfb", "-displayfd", std::to_string(descriptor).c_str(), "-screen", "0",
                   "1280x1024x24", "-nolisten", "tcp", "-noreset", nullptr);
    ::_exit(1);
}

} // namespace

XServer::XServer() {
    std::array<int, 2> pipe{};
    if (::pipe(pipe.data()) != 0) {
        return;
    }
    _process = ::fork();
    if (_process == 0) {
        serve(pipe[1]);
    }
    (void)::close(pipe[1]);
    for (char digit = 0; ::read(pipe[0], &digit, 1) == 1 && digit != '\n';) {
        _display += _display.empty() ? ":" : "";
        _display += digit;
    }
    (void)::close(pipe[0]);
}

XServer::~XServer() {
    if (_process > 0) {
        (void)::kill(_process, SIGTERM);
        (void)::waitpid(_process, nullptr, 0);
    }
}

} // namespace pallax::doubles
