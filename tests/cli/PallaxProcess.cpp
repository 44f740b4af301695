#include "tests/cli/PallaxProcess.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <array>
#include <csignal>
#include <cstdlib>
#include <fcntl.h>
#include <fstream>
#include <spawn.h>
#include <sys/prctl.h>
#include <sys/syscall.h>
#include <sys/wait.h>
#include <thread>
#include <unistd.h>

namespace pallax::doubles {

namespace {

using std::chrono::milliseconds;
using std::chrono::seconds;

constexpr milliseconds kLook{5};

/// Programs run by another program (a memory checker) may take this many times as long.
constexpr int kSlowness = 10;

const char* standIn() {
    return std::getenv("PALLAX_TEST_PROGRAM");
}

bool within(std::chrono::nanoseconds patience, const std::function<bool()>& condition) {
    const auto end =
        std::chrono::steady_clock::now() + patience * (standIn() != nullptr ? kSlowness : 1);
    while (!condition()) {
        if (std::chrono::steady_clock::now() > end) {
            return false;
        }
        std::this_thread::sleep_for(kLook);
    }
    return true;
}

} // namespace

World::World() {
    (void)::prctl(PR_SET_CHILD_SUBREAPER, 1);
}

std::vector<std::string> World::sockets() const {
    std::vector<std::string> names;
    std::error_code missing;
    for (const auto& entry : std::filesystem::directory_iterator(path("pallax"), missing)) {
        if (entry.is_socket()) {
            names.push_back(entry.path().filename().string());
        }
    }
    std::sort(names.begin(), names.end());
    return names;
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

std::string programPath() {
    return standIn() != nullptr ? standIn() : PALLAX_PROGRAM;
}

std::vector<std::string> programEnvironment(const World& world) {
    std::vector<std::string> environment = world.environment; // the first of two assignments counts
    environment.insert(environment.end(), {"XDG_RUNTIME_DIR=" + world.path(),
                                           "XDG_CONFIG_HOME=" + world.path("config"),
                                           "XDG_STATE_HOME=" + world.path("state"), "TZ=UTC"});
    return environment;
}

bool eventually(const std::function<bool()>& condition) {
    return within(seconds(30), condition);
}

bool waitsForItsReader(pid_t process, int output) {
    return eventually([=] { return waitsForItsReaderNow(process, output); });
}

bool waitsForItsReaderNow(pid_t process, int output) {
    std::ifstream call("/proc/" + std::to_string(process) + "/syscall");
    std::string text;
    std::getline(call, text); // the number of the blocking system call, and its arguments
    return text.starts_with(std::to_string(SYS_write) + " 0x" + std::to_string(output) + " ");
}

bool hasEnded(pid_t process) {
    return eventually([process] {
        siginfo_t info{};
        const auto id = static_cast<id_t>(process);
        return ::waitid(P_PID, id, &info, WEXITED | WNOHANG | WNOWAIT) == 0 && info.si_pid != 0;
    });
}

bool noChildLeft() {
    return eventually([] { return ::waitpid(-1, nullptr, WNOHANG) < 0; });
}

PallaxProcess::PallaxProcess(const World& world, const std::vector<std::string>& arguments,
                             const std::string& input, const std::string& output) {
    static int count = 0;
    const std::string number = std::to_string(++count);
    _out = output.empty() ? world.path("out." + number) : output;
    _err = world.path("err." + number);

    std::vector<std::string> words{programPath()};
    words.insert(words.end(), arguments.begin(), arguments.end());
    std::vector<std::string> environment = programEnvironment(world);
    posix_spawn_file_actions_t files;
    ::posix_spawn_file_actions_init(&files);
    ::posix_spawn_file_actions_addopen(&files, STDIN_FILENO, input.c_str(), O_RDONLY, 0);
    constexpr mode_t kMode = 0600;
    constexpr int kWrite = O_WRONLY | O_CREAT | O_TRUNC;
    ::posix_spawn_file_actions_addopen(&files, STDOUT_FILENO, _out.c_str(), kWrite, kMode);
    ::posix_spawn_file_actions_addopen(&files, STDERR_FILENO, _err.c_str(), kWrite, kMode);
    const int error = ::posix_spawn(&_process, words.front().c_str(), &files, nullptr,
                                    pointersTo(words).data(), pointersTo(environment).data());
    ::posix_spawn_file_actions_destroy(&files);
    if (error != 0) {
        ADD_FAILURE() << words.front() << " cannot be started";
        _process = -1;
    }
}

PallaxProcess::~PallaxProcess() {
    if (_process > 0) {
        signal(SIGKILL);
        (void)::waitpid(_process, nullptr, 0);
    }
}

int PallaxProcess::wait() {
    int status = 0;
    const bool ended =
        within(seconds(60), [&] { return ::waitpid(_process, &status, WNOHANG) == _process; });
    if (!ended) {
        ADD_FAILURE() << "it does not end\n" << out() << err();
        signal(SIGKILL);
        (void)::waitpid(_process, &status, 0);
    }
    _process = -1;
    return WIFEXITED(status) ? WEXITSTATUS(status) : -WTERMSIG(status);
}

void PallaxProcess::signal(int number) const {
    (void)::kill(_process, number);
}

std::string PallaxProcess::out() const {
    return contentOf(_out);
}

std::string PallaxProcess::err() const {
    return contentOf(_err);
}

bool PallaxProcess::says(const std::string& text) const {
    return eventually([&] {
        return out().find(text) != std::string::npos || err().find(text) != std::string::npos;
    });
}

} // namespace pallax::doubles
