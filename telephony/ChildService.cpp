#include "telephony/ChildService.h"

#include "host/SocketDirectory.h"
#include "text/Format.h"

#include <climits>

#include <array>
#include <cerrno>
#include <charconv>
#include <chrono>
#include <csignal>
#include <cstring>
#include <fcntl.h>
#include <poll.h>
#include <span>
#include <sys/prctl.h>
#include <sys/wait.h>
#include <thread>
#include <unistd.h>
#include <vector>

namespace pallax {

namespace {

constexpr int kReadyDescriptor = 3;
constexpr int kExecFailed = 127;

// The child's arguments, after the program's name.
enum Argument { kCommand = 1, kControlPort, kSpeed, kLoop, kInterval, kSource };
constexpr std::string_view kLooping = "loop";
constexpr std::string_view kOnce = "once";

struct Pipe {
    Descriptor read;
    Descriptor write;
};

Pipe makePipe() {
    std::array<int, 2> ends{};
    if (::pipe2(ends.data(), O_CLOEXEC) != 0) {
        return {};
    }
    return {Descriptor(ends[0]), Descriptor(ends[1])};
}

/// Appends what is there; false at the end.
bool readPiece(const Descriptor& descriptor, std::string& text) {
    std::array<char, 1024> piece{};
    const ssize_t count = ::read(descriptor.number(), piece.data(), piece.size());
    if (count > 0) {
        text.append(piece.data(), static_cast<std::size_t>(count));
    }
    return count > 0 || (count < 0 && errno == EINTR);
}

std::string readToEnd(const Descriptor& descriptor) {
    std::string text;
    while (readPiece(descriptor, text)) {
    }
    return text;
}

/// True when the child reports that it is ready; false if it ends before. Meanwhile its complaints
/// are read: a pipe holds 64 KiB, and a child that waits for room would never end.
bool waitUntilReady(const Descriptor& ready, const Descriptor& complaints, std::string& told) {
    std::array<pollfd, 2> watched{{{ready.number(), POLLIN, 0}, {complaints.number(), POLLIN, 0}}};
    auto& [readiness, complaint] = watched;
    std::string sign;
    for (;;) {
        if (::poll(watched.data(), watched.size(), -1) < 0) {
            continue; // a signal has come
        }
        if (complaint.revents != 0 && !readPiece(complaints, told)) {
            complaint.fd = -1; // no more will come
        }
        if (readiness.revents != 0 && (!readPiece(ready, sign) || !sign.empty())) {
            return !sign.empty();
        }
    }
}

std::vector<std::string> argumentsFor(const ServiceOptions& options) {
    std::vector<std::string> arguments{"pallax",
                                       std::string(kChildServiceCommand),
                                       options.controlPortName,
                                       speedText(options.play.speed),
                                       std::string(options.play.loop ? kLooping : kOnce),
                                       std::to_string(options.play.displayInterval.count())};
    const std::vector<std::string> source = argumentsOf(options.source);
    arguments.insert(arguments.end(), source.begin(), source.end());
    return arguments;
}

/// The options that a parent has written.
std::optional<ServiceOptions> optionsFrom(std::span<const std::string> arguments) {
    const auto source =
        arguments.size() > kSource ? sourceOf(arguments.subspan(kSource)) : std::nullopt;
    if (!source) {
        return std::nullopt;
    }
    ServiceOptions options{*source};
    options.controlPortName = arguments[kControlPort];
    options.play.speed = parseSpeed(arguments[kSpeed]).value_or(1.0);
    options.play.loop = arguments[kLoop] == kLooping;
    options.lossless = true; // its only client is the viewer that started it
    const std::string& interval = arguments[kInterval];
    std::int64_t count = 0;
    (void)std::from_chars(interval.data(), interval.data() + interval.size(), count);
    if (count > 0) {
        options.play.displayInterval = std::chrono::nanoseconds(count);
    }
    return options;
}

/// Starts this program again: by its path, which process lists and memory checkers show; if an
/// update has replaced the file, by the running image.
void startAgain(char* const* arguments) {
    std::array<char, PATH_MAX> path{};
    if (::readlink("/proc/self/exe", path.data(), path.size() - 1) > 0) {
        (void)::execv(path.data(), arguments);
    }
    (void)::execv("/proc/self/exe", arguments);
}

/// In the child, between fork and exec: only uses functions that are safe there, and does not
/// return. `input` becomes its standard input; if negative, standard input is empty.
[[noreturn]] void becomeService(pid_t parent, char* const* arguments, int input, int ready,
                                int complaints) {
    // Moved first, because each may have the number intended for the other.
    const int readyCopy = ::fcntl(ready, F_DUPFD_CLOEXEC, kReadyDescriptor + 1);
    const int complaintsCopy = ::fcntl(complaints, F_DUPFD_CLOEXEC, kReadyDescriptor + 1);
    const int nothing = ::open("/dev/null", O_RDWR | O_CLOEXEC);
    const bool wired =
        (input == STDIN_FILENO || ::dup2(input >= 0 ? input : nothing, STDIN_FILENO) >= 0) &&
        ::dup2(nothing, STDOUT_FILENO) >= 0 && ::dup2(complaintsCopy, STDERR_FILENO) >= 0 &&
        ::dup2(readyCopy, kReadyDescriptor) >= 0;
    // Ctrl-C at the terminal goes to the whole process group, but the viewer decides when the child
    // ends.
    (void)::setpgid(0, 0);
    if (wired && ::prctl(PR_SET_PDEATHSIG, SIGTERM) == 0 && ::getppid() == parent) {
        startAgain(arguments);
    }
    ::_exit(kExecFailed);
}

bool hasEnded(pid_t process) {
    const pid_t result = ::waitpid(process, nullptr, WNOHANG);
    return result == process || (result < 0 && errno == ECHILD);
}

void end(pid_t process) {
    constexpr std::chrono::milliseconds kPatience{2000};
    constexpr std::chrono::milliseconds kLook{2};
    (void)::kill(process, SIGTERM);
    for (auto waited = kLook; waited < kPatience; waited += kLook) {
        if (hasEnded(process)) {
            return;
        }
        std::this_thread::sleep_for(kLook);
    }
    (void)::kill(process, SIGKILL);
    (void)::waitpid(process, nullptr, 0);
}

/// The complaint without its newline and the program's name.
std::string sentenceOf(std::string complaint) {
    constexpr std::string_view kName = "pallax: ";
    if (complaint.starts_with(kName)) {
        complaint.erase(0, kName.size());
    }
    while (complaint.ends_with('\n')) {
        complaint.pop_back();
    }
    return complaint.empty() ? "The telephony service did not start." : complaint;
}

std::string uniqueSuffix() {
    static int count = 0; // of the services that this process has started
    return formatText(".%d.%d", {::getpid(), ++count});
}

} // namespace

Result<std::unique_ptr<ChildService>, HostError> ChildService::start(ServiceOptions options,
                                                                     Descriptor input) {
    const auto directory = SocketDirectory::open();
    if (!directory) {
        return directory.error();
    }
    directory->removeStaleSockets();
    const std::string suffix = uniqueSuffix();
    options.controlPortName = std::string(kTelephonyControlPort) + suffix;
    std::vector<std::string> arguments = argumentsFor(options);
    std::vector<char*> pointers;
    pointers.reserve(arguments.size() + 1);
    for (std::string& argument : arguments) {
        pointers.push_back(argument.data());
    }
    pointers.push_back(nullptr);
    Pipe ready = makePipe();
    Pipe complaints = makePipe();
    const bool readsOurs = !input && recordingPath(options.source) == "-";
    const int childsInput = readsOurs ? STDIN_FILENO : input.number();
    const pid_t parent = ::getpid();
    const pid_t process = ready.read && complaints.read ? ::fork() : -1;
    if (process == 0) {
        becomeService(parent, pointers.data(), childsInput, ready.write.number(),
                      complaints.write.number());
    }
    if (process < 0) {
        return HostError{
            formatText("The telephony service cannot be started: %@.", {std::strerror(errno)})};
    }
    input.reset(); // otherwise the stream's writer would not notice the child's end
    ready.write.reset();
    complaints.write.reset();
    std::unique_ptr<ChildService> service(
        new ChildService(suffix, process, std::move(complaints.read)));
    std::string complaint;
    if (waitUntilReady(ready.read, service->_complaints, complaint)) {
        service->_told = std::move(complaint);
        return service;
    }
    return HostError{sentenceOf(complaint + readToEnd(service->_complaints))};
}

ChildService::ChildService(std::string suffix, pid_t process, Descriptor complaints)
    : _suffix(std::move(suffix)), _controlPortName(std::string(kTelephonyControlPort) + _suffix),
      _process(process), _complaints(std::move(complaints)) {}

ChildService::~ChildService() {
    stop();
}

std::string ChildService::privateName(std::string_view base) const {
    return std::string(base) + _suffix;
}

void ChildService::stop() {
    if (_process == 0) {
        return;
    }
    end(std::exchange(_process, 0));
    if (const auto directory = SocketDirectory::open()) {
        directory->removeStaleSockets();
    }
}

std::string ChildService::takeComplaints() {
    const int flags = ::fcntl(_complaints.number(), F_GETFL);
    (void)::fcntl(_complaints.number(), F_SETFL, flags | O_NONBLOCK);
    return std::exchange(_told, {}) + readToEnd(_complaints);
}

int runChildService(int argc, char** argv) {
    const std::vector<std::string> arguments(argv, argv + argc);
    const auto options = optionsFrom(arguments);
    // Without a waiting parent, the descriptor would be an unrelated file.
    if (!options || ::fcntl(kReadyDescriptor, F_GETFD) < 0) {
        return 2;
    }
    return runService(*options, [] {
        const Descriptor ready(kReadyDescriptor);
        (void)::fcntl(ready.number(), F_SETFD, FD_CLOEXEC);
        (void)!::write(ready.number(), "+", 1);
    });
}

} // namespace pallax
