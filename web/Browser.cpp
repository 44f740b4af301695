#include "web/Browser.h"

#include "text/Format.h"

#include <array>
#include <cstring>
#include <fcntl.h>
#include <spawn.h>
#include <unistd.h>

namespace pallax {

std::optional<std::string> openInBrowser(const std::string& link) {
    std::string program = "xdg-open";
    std::string argument = link;
    const std::array<char*, 3> words{program.data(), argument.data(), nullptr};
    posix_spawn_file_actions_t files;
    ::posix_spawn_file_actions_init(&files);
    for (const int descriptor : {STDIN_FILENO, STDOUT_FILENO, STDERR_FILENO}) {
        ::posix_spawn_file_actions_addopen(&files, descriptor, "/dev/null", O_RDWR, 0);
    }
    pid_t process = 0;
    const int error =
        ::posix_spawnp(&process, program.c_str(), &files, nullptr, words.data(), environ);
    ::posix_spawn_file_actions_destroy(&files);
    if (error != 0) {
        return formatText("xdg-open cannot be started: %@. Open the link yourself.",
                          {std::strerror(error)});
    }
    return std::nullopt;
}

} // namespace pallax
