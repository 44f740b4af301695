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

/// Files that nobody else sees and that end with their last descriptor: where a worker process
/// writes, until it is its turn in the order.
struct WorkerFiles {
    Descriptor output;
    Descriptor complaints; ///< sentences for standard error
    Descriptor systemLog;

    static Result<WorkerFiles, HostError> create();
};

/// Hands the whole content of a worker's file on, in blocks; throws OutputFailure where it cannot
/// be read.
void readWhole(const Descriptor& file, const std::function<void(std::string_view)>& take);

/// Pieces of work that processes of their own do, so many at once, each with its files; what they
/// leave is collected in the order of the pieces. Processes, for the array lock is process-wide and
/// may stay held by whoever has walked nested arrays.
class OrderedWorkers {
public:
    /// Done in the worker, whose standard output and error are its files. An exception is reported
    /// there, and the worker counts as given up.
    using Work = std::function<ExitStatus(std::size_t piece, const WorkerFiles& files)>;
    struct Outcome {
        ExitStatus status = kExitFailure;
        /// An exception left the work: what follows it would not have been begun.
        bool gaveUp = false;
        /// The signal that ended the worker, or 0.
        int signal = 0;
    };
    /// Done here; false ends the pieces that follow. Its exceptions leave.
    using Collect =
        std::function<bool(std::size_t piece, const Outcome& outcome, const WorkerFiles& files)>;

    /// Done here a few times a second while workers are waited for.
    using Meanwhile = std::function<void()>;

    OrderedWorkers(std::size_t pieces, unsigned jobs, Work work, Meanwhile meanwhile = {})
        : _pieces(pieces), _jobs(jobs), _work(std::move(work)), _meanwhile(std::move(meanwhile)) {}
    /// Ends the workers that are left.
    ~OrderedWorkers();
    OrderedWorkers(const OrderedWorkers&) = delete;
    OrderedWorkers& operator=(const OrderedWorkers&) = delete;

    /// Why no further worker could be started, if so; everything before has been collected.
    std::optional<HostError> run(const Collect& collect);

private:
    struct Worker {
        pid_t process = -1;
        WorkerFiles files;
        std::optional<Outcome> outcome; ///< once it has ended
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
    std::deque<Worker> _workers; ///< those not collected, in order
    std::size_t _started = 0;
};

} // namespace pallax
