#pragma once

#include "console/ExitStatus.h"
#include "host/Descriptor.h"
#include "host/HostError.h"
#include "text/Result.h"

#include <cstddef>
#include <deque>
#include <functional>
#include <optional>
#include <string_view>
#include <sys/types.h>

namespace pallax {

/// Unnamed files that disappear with their last descriptor: a worker process writes to them until
/// it is its turn in the order.
struct WorkerFiles {
    Descriptor output;
    Descriptor complaints; ///< sentences for standard error
    Descriptor systemLog;

    static Result<WorkerFiles, HostError> create();
};

/// Passes the whole content of a worker's file on, in blocks; throws OutputFailure if it cannot be
/// read.
void readWhole(const Descriptor& file, const std::function<void(std::string_view)>& take);

/// Runs pieces of work in separate processes, several at once, each with its files, and collects
/// their output in the order of the pieces. Processes, because the array lock is process-wide and
/// may stay held by a thread that has walked nested arrays.
class OrderedWorkers {
public:
    /// Runs in the worker, whose standard output and error are its files. An exception is reported
    /// there, and the worker counts as having given up.
    using Work = std::function<ExitStatus(std::size_t piece, const WorkerFiles& files)>;
    struct Outcome {
        ExitStatus status = kExitFailure;
        /// The work has thrown: serially, the following pieces would not have been started.
        bool gaveUp = false;
        /// The signal that ended the worker, or 0.
        int signal = 0;
    };
    /// Runs in this process; false stops the following pieces. Exceptions propagate.
    using Collect =
        std::function<bool(std::size_t piece, const Outcome& outcome, const WorkerFiles& files)>;

    /// Runs in this process several times a second while it waits for workers.
    using Meanwhile = std::function<void()>;

    OrderedWorkers(std::size_t pieces, unsigned jobs, Work work, Meanwhile meanwhile = {})
        : _pieces(pieces), _jobs(jobs), _work(std::move(work)), _meanwhile(std::move(meanwhile)) {}
    /// Ends the remaining workers.
    ~OrderedWorkers();
    OrderedWorkers(const OrderedWorkers&) = delete;
    OrderedWorkers& operator=(const OrderedWorkers&) = delete;

    /// Nothing, or why no further worker could be started; all earlier ones have been collected.
    std::optional<HostError> run(const Collect& collect);

private:
    struct Worker {
        pid_t process = -1;
        WorkerFiles files;
        std::optional<Outcome> outcome; ///< set once it has ended
    };

    std::size_t running() const;
    std::optional<HostError> startNext();
    [[noreturn]] void become(Worker& worker, std::size_t piece);
    pid_t nextEnded(int& status) const;
    void waitForOne();

    std::size_t _pieces;
    unsigned _jobs;
    Work _work;
    Meanwhile _meanwhile;
    std::deque<Worker> _workers; ///< not yet collected, in order
    std::size_t _started = 0;
};

} // namespace pallax
