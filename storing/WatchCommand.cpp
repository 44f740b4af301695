#include "console/Output.h"
#include "console/Progress.h"
#include "console/TerminalLine.h"
#include "host/AsioMainQueue.h"
#include "host/Complaint.h"
#include "host/FolderWatch.h"
#include "host/Interruption.h"
#include "host/MonotonicClock.h"
#include "storing/Loading.h"
#include "storing/StoreOptions.h"
#include "text/Format.h"
#include "text/Printable.h"

#include <algorithm>
#include <csignal>
#include <filesystem>
#include <stdexcept>
#include <system_error>
#include <unistd.h>
#include <vector>

namespace pallax {

namespace {

/// A signal has come while a recording is loaded.
class Stopped : public std::runtime_error {
public:
    Stopped() : std::runtime_error("stopped") {}
};

/// Whether a file has the name of a recording. Programs that copy files give them others until they
/// are whole.
bool isNamedLikeRecording(const std::filesystem::path& path) {
    const std::string name = path.filename().string();
    const auto endsWith = [&name](std::string_view end) { return name.ends_with(end); };
    const std::vector<std::string_view> ends{".pcap",      ".pcapng",   ".pcap.gz",
                                             ".pcapng.gz", ".pcap.zst", ".pcapng.zst"};
    return !name.starts_with('.') && std::any_of(ends.begin(), ends.end(), endsWith);
}

class StoreWatch {
public:
    explicit StoreWatch(const StoreWatchOptions& options)
        : _folder(options.folder), _loading(options.loading),
          _output([this, write = writeToDescriptor(STDOUT_FILENO, "Standard output")](
                      std::string_view block) {
              _line.wipe();
              write(block);
          }) {}

    ExitStatus run() {
        const Interruption interruption;
        _queue.onSignal({SIGINT, SIGTERM, SIGHUP}, [this](int /*signal*/) { _queue.stop(); });
        const FolderWatch watch(
            _queue, _folder,
            {[this](const std::string& path) { load(path); }, [this] { loadAll(); }});
        try {
            loadAll();
            _queue.run();
        } catch (const Stopped&) {
            _line.wipe(); // the recording is loaded the next time
        }
        return kExitSuccess;
    }

private:
    /// What is in the folder and in those in it.
    void loadAll() {
        std::vector<std::string> paths;
        std::error_code error;
        std::filesystem::recursive_directory_iterator entries(_folder, error);
        for (; !error && entries != std::filesystem::recursive_directory_iterator();
             entries.increment(error)) {
            if (entries.depth() > 0) {
                entries.disable_recursion_pending();
            }
            if (entries->is_regular_file(error)) {
                paths.push_back(entries->path().string());
            }
        }
        std::sort(paths.begin(), paths.end());
        for (const std::string& path : paths) {
            load(path);
        }
    }

    void load(const std::string& path) {
        if (!isNamedLikeRecording(path)) {
            return;
        }
        (void)_loading.load(path,
                            {[this](LoadOutcome::Kind kind, const std::string& line) {
                                 if (kind != LoadOutcome::Kind::Skipped) {
                                     appendPrintable(_output.text(), line);
                                     _output.text() += '\n';
                                 }
                             },
                             [this](const std::string& sentence) {
                                 _line.wipe();
                                 complain(sentence);
                             },
                             [this, &path](const Recording& /*recording*/, std::uint64_t packets) {
                                 if (Interruption::signal() != 0) {
                                     throw Stopped();
                                 }
                                 if (_line.isPossible() && _pace.isDue()) {
                                     _line.show(path + ": " + packetCount(packets));
                                 }
                             }});
        _line.wipe();
        _output.flush(); // a user waits for it
    }

    const std::string& _folder;
    Loading _loading;
    AsioMainQueue _queue;
    MonotonicClock _clock;
    TerminalLine _line = TerminalLine::onStandardError();
    ProgressPace _pace{_clock};
    Output _output;
};

} // namespace

ExitStatus runStoreWatch(const StoreWatchOptions& options) {
    std::error_code ignored;
    if (!std::filesystem::is_directory(options.folder, ignored)) {
        complain(formatText("%@ is no folder.", {options.folder}));
        return kExitFailure;
    }
    try {
        return StoreWatch(options).run();
    } catch (const std::system_error& error) {
        complain(formatText("%@ cannot be watched: %@.", {options.folder, error.code().message()}));
        return kExitFailure;
    }
}

} // namespace pallax
