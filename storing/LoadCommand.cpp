#include "console/Output.h"
#include "decoding/DecodeProgress.h"
#include "decoding/OrderedWorkers.h"
#include "host/Complaint.h"
#include "host/MonotonicClock.h"
#include "storing/Loading.h"
#include "storing/StoreOptions.h"
#include "text/Format.h"
#include "text/Printable.h"

#include <algorithm>
#include <cstdio>
#include <thread>
#include <unistd.h>

namespace pallax {

namespace {

/// Loads the recordings, one after the other or in several processes.
class LoadRun {
public:
    explicit LoadRun(const StoreLoadOptions& options)
        : _options(options), _loading(options.loading),
          _progress(options.recordings, TerminalLine::onStandardError(), _clock) {}

    ExitStatus run() {
        const auto count = _options.recordings.size();
        const unsigned jobs = _options.jobs.value_or(std::thread::hardware_concurrency());
        if (count > 1 && jobs > 1) {
            return loadAtOnce(jobs);
        }
        ExitStatus status = kExitSuccess;
        for (std::size_t recording = 0; recording < count; ++recording) {
            status = std::max(status, load(recording));
        }
        return status;
    }

private:
    ExitStatus load(std::size_t recording) {
        Output output([this, write = writeToDescriptor(STDOUT_FILENO, "Standard output")](
                          std::string_view block) {
            _progress.wipe();
            write(block);
        });
        const Loading::Seams seams{
            [&output](LoadOutcome::Kind /*kind*/, const std::string& line) {
                appendPrintable(output.text(), line);
                output.text() += '\n';
                output.lineDone();
            },
            [this](const std::string& sentence) {
                _progress.wipe();
                complain(sentence);
            },
            [this, recording](const Recording& source, std::uint64_t packets) {
                if (_progress.isShown()) {
                    _progress.packetDone(recording, source, packets);
                }
            },
            !_isAtOnce};
        const std::string& path = _options.recordings[recording];
        ExitStatus status = kExitFailure;
        try {
            status = _loading.load(path, seams);
        } catch (const StoreFailure& failure) { // the next one may fit
            seams.complain(formatText("%@ was not loaded: %@", {path, failure.what()}));
        }
        if (_progress.isShown()) {
            _progress.recordingDone(recording);
        }
        output.flush();
        return status;
    }

    ExitStatus loadAtOnce(unsigned jobs) {
        _isAtOnce = true;
        OrderedWorkers workers(
            _options.recordings.size(), jobs,
            [this](std::size_t recording, const WorkerFiles& /*files*/) {
                _progress.becomeWorker();
                return load(recording);
            },
            [this] { _progress.look(); });
        ExitStatus status = kExitSuccess;
        const auto error =
            workers.run([&](std::size_t recording, const auto& outcome, const WorkerFiles& files) {
                status = std::max(status, collect(recording, outcome, files));
                return true;
            });
        if (error) {
            _progress.wipe();
            complain(error->sentence);
            return kExitFailure;
        }
        return status;
    }

    ExitStatus collect(std::size_t recording, const OrderedWorkers::Outcome& outcome,
                       const WorkerFiles& files) {
        _progress.wipe();
        readWhole(files.output, writeToDescriptor(STDOUT_FILENO, "Standard output"));
        readWhole(files.complaints, [](std::string_view sentences) {
            (void)std::fwrite(sentences.data(), 1, sentences.size(), stderr);
        });
        if (outcome.signal != 0) {
            complain(formatText("%@: the process that loaded it was ended by signal %d.",
                                {_options.recordings[recording], outcome.signal}));
        }
        return outcome.status;
    }

    const StoreLoadOptions& _options;
    Loading _loading;
    MonotonicClock _clock;
    DecodeProgress _progress;
    bool _isAtOnce = false; ///< several processes write, one after the other
};

} // namespace

ExitStatus runStoreLoad(const StoreLoadOptions& options) {
    return LoadRun(options).run();
}

} // namespace pallax
