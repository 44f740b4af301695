#include "decoding/OrderedWorkers.h"

#include "console/Output.h"
#include "host/Complaint.h"
#include "text/Format.h"

#include <algorithm>
#include <array>
#include <cerrno>
#include <csignal>
#include <cstring>
#include <exception>
#include <fcntl.h>
#include <filesystem>
#include <string>
#include <sys/prctl.h>
#include <sys/wait.h>
#include <unistd.h>

namespace pallax {

namespace {

/// How many pieces may be finished or running ahead of the one collected next: each holds three
/// descriptors. If descriptors run out, the next piece waits for others to be collected.
constexpr std::size_t kMostAhead = 64;
/// The exit status of a worker whose work has thrown; not a status of decode.
constexpr int kGaveUp = 71;

HostError cannotStart(std::string_view what) {
    return {formatText("%@: %@.", {what, std::strerror(errno)})};
}

Descriptor unnamedFile() {
    std::error_code error;
    std::string path = std::filesystem::temp_directory_path(error).string() + "/pallax-XXXXXX";
    Descriptor file(::mkostemp(path.data(), O_CLOEXEC));
    if (file) {
        (void)::unlink(path.c_str());
    }
    return file;
}

/// Blocks or unblocks the signal of a child's end for a scope.
class ChildSignal {
public:
    explicit ChildSignal(int how) {
        const sigset_t signal = only();
        (void)::sigprocmask(how, &signal, &_before);
    }
    ~ChildSignal() { (void)::sigprocmask(SIG_SETMASK, &_before, nullptr); }
    ChildSignal(const ChildSignal&) = delete;
    ChildSignal& operator=(const ChildSignal&) = delete;

    /// Waits until a child ends, or briefly; the signal must be blocked.
    static void waitBriefly() {
        constexpr long kNanoseconds = 100'000'000;
        const timespec moment{0, kNanoseconds};
        const sigset_t signal = only();
        (void)::sigtimedwait(&signal, nullptr, &moment);
    }

private:
    static sigset_t only() {
        sigset_t signal{};
        (void)::sigemptyset(&signal);
        (void)::sigaddset(&signal, SIGCHLD);
        return signal;
    }

    sigset_t _before{};
};

OrderedWorkers::Outcome outcomeOf(int waitStatus) {
    if (WIFSIGNALED(waitStatus)) {
        return {kExitFailure, false, WTERMSIG(waitStatus)};
    }
    const int status = WEXITSTATUS(waitStatus);
    return status == kGaveUp ? OrderedWorkers::Outcome{kExitFailure, true, 0}
                             : OrderedWorkers::Outcome{static_cast<ExitStatus>(status), false, 0};
}

} // namespace

Result<WorkerFiles, HostError> WorkerFiles::create() {
    WorkerFiles files{unnamedFile(), unnamedFile(), unnamedFile()};
    if (!files.output || !files.complaints || !files.systemLog) {
        return cannotStart("A temporary file cannot be made");
    }
    return files;
}

void readWhole(const Descriptor& file, const std::function<void(std::string_view)>& take) {
    constexpr std::size_t kBlockSize = std::size_t{64} << 10U;
    std::array<char, kBlockSize> block{};
    off_t at = 0;
    for (;;) {
        const ssize_t length = ::pread(file.number(), block.data(), block.size(), at);
        if (length < 0 && errno == EINTR) {
            continue;
        }
        if (length < 0) {
            throw OutputFailure(
                formatText("A temporary file cannot be read: %@.", {std::strerror(errno)}));
        }
        if (length == 0) {
            return;
        }
        take({block.data(), static_cast<std::size_t>(length)});
        at += length;
    }
}

OrderedWorkers::~OrderedWorkers() {
    for (const Worker& worker : _workers) {
        if (!worker.outcome) {
            (void)::kill(worker.process, SIGKILL);
            (void)::waitpid(worker.process, nullptr, 0);
        }
    }
}

std::optional<HostError> OrderedWorkers::run(const Collect& collect) {
    (void)std::signal(SIGCHLD, SIG_DFL);  // if ignored, no child's end would be reported
    const ChildSignal blocked(SIG_BLOCK); // it is received by waiting
    for (std::size_t piece = 0; piece < _pieces; ++piece) {
        while (_workers.empty() || !_workers.front().outcome) {
            std::optional<HostError> error;
            while (!error && _started < _pieces && running() < _jobs &&
                   _workers.size() < kMostAhead) {
                error = startNext();
            }
            if (running() == 0) {
                return error; // once running ones end, there is room for the next
            }
            waitForOne();
        }
        const Worker worker = std::move(_workers.front());
        _workers.pop_front();
        if (!collect(piece, *worker.outcome, worker.files)) {
            return std::nullopt;
        }
    }
    return std::nullopt;
}

std::size_t OrderedWorkers::running() const {
    return static_cast<std::size_t>(
        std::count_if(_workers.begin(), _workers.end(),
                      [](const Worker& worker) { return !worker.outcome.has_value(); }));
}

std::optional<HostError> OrderedWorkers::startNext() {
    auto files = WorkerFiles::create();
    if (!files) {
        return files.error();
    }
    Worker worker;
    worker.files = std::move(files).value();
    worker.process = ::fork();
    if (worker.process < 0) {
        return cannotStart("A worker process cannot be started");
    }
    if (worker.process == 0) {
        become(worker, _started);
    }
    _workers.push_back(std::move(worker));
    ++_started;
    return std::nullopt;
}

/// Exits without cleaning up the parent's objects: runs no destructor, writes no buffer.
void OrderedWorkers::become(Worker& worker, std::size_t piece) {
    (void)::prctl(PR_SET_PDEATHSIG, SIGKILL);
    _workers.clear(); // their files would leave too few descriptors for this worker
    const ChildSignal unblocked(SIG_UNBLOCK);
    if (::dup2(worker.files.output.number(), STDOUT_FILENO) < 0 ||
        ::dup2(worker.files.complaints.number(), STDERR_FILENO) < 0) {
        ::_exit(kGaveUp);
    }
    int status = kGaveUp;
    try {
        status = static_cast<int>(_work(piece, worker.files));
    } catch (const std::exception& error) {
        complain(error.what());
    }
    ::_exit(status);
}

/// Waits until a worker has ended; negative on failure.
pid_t OrderedWorkers::nextEnded(int& status) const {
    if (!_meanwhile) {
        return ::waitpid(-1, &status, 0);
    }
    pid_t process = 0;
    while ((process = ::waitpid(-1, &status, WNOHANG)) == 0) {
        ChildSignal::waitBriefly();
        _meanwhile();
    }
    return process;
}

void OrderedWorkers::waitForOne() {
    int status = 0;
    const pid_t process = nextEnded(status);
    const bool lost = process < 0 && errno != EINTR;
    for (Worker& worker : _workers) {
        if (worker.process == process) {
            worker.outcome = outcomeOf(status);
        } else if (lost && !worker.outcome) {
            worker.outcome = Outcome{kExitFailure, true, 0};
        }
    }
}

} // namespace pallax
