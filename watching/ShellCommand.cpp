#include "watching/ShellCommand.h"

#include "host/Interruption.h"
#include "text/Format.h"

#include <algorithm>
#include <array>
#include <cerrno>
#include <csignal>
#include <cstring>
#include <fcntl.h>
#include <spawn.h>
#include <sys/wait.h>
#include <unistd.h>

namespace pallax {

namespace {

/// The environment of this process with the variables in place of those of the same names.
std::vector<std::string> environmentWith(const WatchAction::Variables& variables) {
    std::vector<std::string> all;
    for (char** each = environ; *each != nullptr; ++each) {
        const std::string_view text = *each;
        const std::string_view name = text.substr(0, text.find('='));
        const bool isReplaced =
            std::any_of(variables.begin(), variables.end(),
                        [name](const auto& variable) { return variable.first == name; });
        if (!isReplaced) {
            all.emplace_back(text);
        }
    }
    for (const auto& [name, value] : variables) {
        all.emplace_back(name).append("=").append(value);
    }
    return all;
}

std::vector<char*> pointersTo(std::vector<std::string>& texts) {
    std::vector<char*> pointers;
    pointers.reserve(texts.size() + 1);
    for (std::string& text : texts) {
        pointers.push_back(text.data());
    }
    pointers.push_back(nullptr);
    return pointers;
}

/// How the command is started: with an empty standard input, without the files of this process,
/// and with the signals that this process ignores.
class SpawnSetup {
public:
    SpawnSetup() {
        sigset_t ignored;
        (void)::sigemptyset(&ignored);
        (void)::sigaddset(&ignored, SIGPIPE);
        (void)::sigaddset(&ignored, SIGXFSZ);
        (void)::posix_spawnattr_init(&_attributes);
        (void)::posix_spawnattr_setsigdefault(&_attributes, &ignored);
        (void)::posix_spawnattr_setflags(&_attributes, POSIX_SPAWN_SETSIGDEF);
        (void)::posix_spawn_file_actions_init(&_actions);
        (void)::posix_spawn_file_actions_addopen(&_actions, STDIN_FILENO, "/dev/null", O_RDONLY, 0);
        (void)::posix_spawn_file_actions_addclosefrom_np(&_actions, STDERR_FILENO + 1);
    }
    ~SpawnSetup() {
        (void)::posix_spawn_file_actions_destroy(&_actions);
        (void)::posix_spawnattr_destroy(&_attributes);
    }
    SpawnSetup(const SpawnSetup&) = delete;
    SpawnSetup& operator=(const SpawnSetup&) = delete;

    const posix_spawn_file_actions_t* actions() const { return &_actions; }
    const posix_spawnattr_t* attributes() const { return &_attributes; }

private:
    posix_spawnattr_t _attributes{};
    posix_spawn_file_actions_t _actions{};
};

} // namespace

ShellCommand::ShellCommand(std::string command, Mode mode, Report report)
    : _command(std::move(command)), _mode(mode), _report(std::move(report)) {
    // A parent may have ignored it, and then no command would have a status.
    (void)std::signal(SIGCHLD, SIG_DFL);
}

void ShellCommand::run(const std::string& time, const Variables& variables) {
    look();
    if (_process != 0) {
        _report(formatText("--exec: the command is not run for %@, because that for %@ still runs.",
                           {time, _time}));
        return;
    }
    _time = time;
    start(variables);
    if (_mode == Mode::Wait) {
        finish();
    }
}

void ShellCommand::start(const Variables& variables) {
    std::vector<std::string> arguments{"sh", "-c", _command};
    std::vector<std::string> environment = environmentWith(variables);
    const SpawnSetup setup;
    const int error = ::posix_spawn(&_process, "/bin/sh", setup.actions(), setup.attributes(),
                                    pointersTo(arguments).data(), pointersTo(environment).data());
    if (error != 0) {
        _process = 0;
        _report(formatText("--exec: the command for %@ cannot be started: %@.",
                           {_time, std::strerror(error)}));
    }
}

void ShellCommand::look() {
    reap(WNOHANG);
}

void ShellCommand::finish() {
    reap(0);
}

void ShellCommand::reap(int options) {
    while (_process != 0) {
        int status = 0;
        const pid_t ended = ::waitpid(_process, &status, options);
        if (ended == _process) {
            _process = 0;
            tell(status);
        } else if (ended == 0 || errno != EINTR || Interruption::isDue()) {
            return;
        }
    }
}

void ShellCommand::tell(int status) const {
    if (WIFSIGNALED(status)) {
        _report(formatText("--exec: the command for %@ was ended by signal %d.",
                           {_time, WTERMSIG(status)}));
    } else if (WEXITSTATUS(status) != 0) {
        _report(formatText("--exec: the command for %@ ended with status %d.",
                           {_time, WEXITSTATUS(status)}));
    }
}

} // namespace pallax
