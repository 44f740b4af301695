#include "decoding/Decode.h"

#include "console/ScopedLog.h"
#include "decoding/DecodeCommand.h"
#include "decoding/DecodeProgress.h"
#include "decoding/DroppedNotices.h"
#include "decoding/FieldSelection.h"
#include "decoding/InstalledKnowledge.h"
#include "decoding/OrderedWorkers.h"
#include "decoding/Preconditions.h"
#include "decoding/RequiredTemplates.h"
#include "decoding/SnapshotDisplay.h"
#include "host/BuildBundle.h"
#include "host/Complaint.h"
#include "host/LogSinks.h"
#include "host/MonotonicClock.h"
#include "host/RecordingFile.h"
#include "host/WallClock.h"
#include "text/Format.h"

#include <algorithm>
#include <cstdio>
#include <optional>
#include <string>
#include <thread>
#include <unistd.h>

namespace pallax {

namespace {

/// Why one of the recordings would be written over; nothing when none would.
std::optional<std::string> lossOfInput(const DecodeOptions& options) {
    if (auto loss = outputIntoRecording(options.recordings)) {
        return loss;
    }
    const auto log = options.systemLog ? regularFile(*options.systemLog) : std::nullopt;
    const auto recording = recordingAmong(options.recordings, log);
    return recording ? std::optional(formatText("The system log %@ would replace the recording %@.",
                                                {*options.systemLog, *recording}))
                     : std::nullopt;
}

std::chrono::seconds localZone(Time time) {
    return WallClock().zone(time).offset;
}

/// Calls `use` with the command, connected to this machine.
template <class Use>
ExitStatus withCommand(const DecodeOptions& options, DecodeProgress& progress, const Use& use) {
    const RequiredTemplates resources(DirectoryResources::programFolder());
    const BuildBundle bundle;
    DroppedNotices notices;
    const auto report = [&progress](std::string_view sentence) {
        progress.wipe();
        complain(sentence);
    };
    const auto open = [&report](const std::string& path) {
        return Recording::openInput({path, {}, report});
    };
    DecodeCommand command(options,
                          {resources, bundle, notices,
                           technologiesWithSnapshots(SnapshotDisplays::OneByOne),
                           installedKnowledge()},
                          open, report, progress.isShown() ? &progress : nullptr, localZone);
    return use(command);
}

/// Writes whole lines, possibly to the same terminal as the progress.
Output::Write standardOutput(DecodeProgress& progress) {
    return [&progress,
            write = writeToDescriptor(STDOUT_FILENO, "Standard output")](std::string_view block) {
        progress.wipe();
        write(block);
    };
}

ExitStatus decodeOneByOne(const DecodeOptions& options, DecodeProgress& progress) {
    Output output(standardOutput(progress));
    return withCommand(options, progress,
                       [&](DecodeCommand& command) { return command.run(output); });
}

/// Decodes one recording in a worker, into its files.
ExitStatus decodeInWorker(const DecodeOptions& options, DecodeProgress& progress,
                          std::size_t recording, const WorkerFiles& files) {
    progress.becomeWorker();
    const auto decode = [&] {
        Output output(writeToDescriptor(STDOUT_FILENO, "A temporary file"));
        return withCommand(options, progress, [&](DecodeCommand& command) {
            return command.runOne(recording, output);
        });
    };
    if (!options.systemLog) {
        return decode();
    }
    const auto sink = FileSink::onto(files.systemLog.number());
    if (!sink) {
        complain(sink.error().sentence);
        return kExitFailure;
    }
    ExitStatus status = kExitFailure;
    {
        const ScopedLog log(**sink);
        status = decode();
    }
    if (!(*sink)->flush()) {
        complain("A temporary file for the system log cannot be written.");
        return status == kExitSuccess ? kExitFailure : status;
    }
    return status;
}

/// Writes the workers' output in the order of the recordings, as if they were decoded one by one.
class DecodeCollector {
public:
    DecodeCollector(const DecodeOptions& options, DecodeProgress& progress, FileSink* log)
        : _options(options), _progress(progress), _log(log) {}

    ExitStatus status() const { return _status; }

    bool collect(std::size_t recording, const OrderedWorkers::Outcome& outcome,
                 const WorkerFiles& files) {
        readWhole(files.output, standardOutput(_progress));
        _progress.wipe();
        readWhole(files.complaints, [](std::string_view sentences) {
            (void)std::fwrite(sentences.data(), 1, sentences.size(), stderr);
        });
        if (_log != nullptr) {
            readWhole(files.systemLog, [this](std::string_view lines) { _log->append(lines); });
        }
        if (outcome.signal != 0) {
            complain(formatText("%@: the process that decoded it was ended by signal %d.",
                                {_options.recordings.at(recording), outcome.signal}));
        }
        _status = outcome.status == kExitSuccess ? _status : outcome.status;
        return !outcome.gaveUp && outcome.status != kExitFatalRecord &&
               outcome.status != kExitWrongUsage;
    }

private:
    const DecodeOptions& _options;
    DecodeProgress& _progress;
    FileSink* _log;
    ExitStatus _status = kExitSuccess;
};

ExitStatus decodeAtOnce(const DecodeOptions& options, DecodeProgress& progress, unsigned jobs,
                        FileSink* log) {
    OrderedWorkers workers(
        options.recordings.size(), jobs,
        [&](std::size_t recording, const WorkerFiles& files) {
            return decodeInWorker(options, progress, recording, files);
        },
        [&progress] { progress.look(); });
    DecodeCollector collector(options, progress, log);
    const auto error = workers.run(
        [&collector](std::size_t recording, const auto& outcome, const WorkerFiles& files) {
            return collector.collect(recording, outcome, files);
        });
    if (error) {
        progress.wipe();
        complain(error->sentence);
        return kExitFailure;
    }
    return collector.status();
}

/// The number of processes. Displays of a live recording must not wait for its end; but several
/// pipes may have one writer, which waits until all of them are opened.
unsigned jobsFor(const DecodeOptions& options) {
    const auto& recordings = options.recordings;
    if (recordings.size() < 2 || options.join ||
        std::find(recordings.begin(), recordings.end(), "-") != recordings.end() ||
        std::count_if(recordings.begin(), recordings.end(), RecordingFile::isStream) == 1) {
        return 1;
    }
    return options.jobs.value_or(std::thread::hardware_concurrency());
}

ExitStatus decodeAll(const DecodeOptions& options, FileSink* log) {
    const MonotonicClock clock;
    DecodeProgress progress(options.recordings, TerminalLine::onStandardError(), clock);
    const unsigned jobs = jobsFor(options);
    return jobs > 1 ? decodeAtOnce(options, progress, jobs, log)
                    : decodeOneByOne(options, progress);
}

} // namespace

ExitStatus runDecode(const DecodeOptions& options) {
    if (const auto loss = lossOfInput(options)) {
        complain(*loss);
        return kExitFailure;
    }
    if (options.window.areReversed(localZone)) {
        complain("The time of --from is later than that of --to.");
        return kExitWrongUsage;
    }
    if (!options.select.empty()) {
        const RequiredTemplates resources(DirectoryResources::programFolder());
        if (const auto name = FieldSelection::unknownName(options.select, resources)) {
            complain(formatText("No field is named \"%@\" (see pallax fields).", {*name}));
            return kExitWrongUsage;
        }
    }
    if (!options.systemLog) {
        return decodeAll(options, nullptr);
    }
    const auto sink = FileSink::create(*options.systemLog);
    if (!sink) {
        complain(sink.error().sentence);
        return kExitFailure;
    }
    const ScopedLog log(**sink);
    const ExitStatus status = decodeAll(options, sink->get());
    if (!(*sink)->flush()) {
        complain("The system log cannot be written to " + *options.systemLog + ".");
        return status == kExitSuccess ? kExitFailure : status;
    }
    return status;
}

} // namespace pallax
