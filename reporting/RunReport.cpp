#include "LogGenerator/Technologies/Technologies.h"
#include "console/Output.h"
#include "console/Progress.h"
#include "console/TerminalLine.h"
#include "decoding/DroppedNotices.h"
#include "decoding/InstalledKnowledge.h"
#include "decoding/Preconditions.h"
#include "decoding/RequiredTemplates.h"
#include "decoding/StateCondition.h"
#include "host/BuildBundle.h"
#include "host/Complaint.h"
#include "host/DirectoryResources.h"
#include "host/FileIdentity.h"
#include "host/KnowledgeFiles.h"
#include "host/NewFile.h"
#include "host/UserFolders.h"
#include "host/WallClock.h"
#include "link/Settings.h"
#include "reporting/ReportCommand.h"
#include "text/Format.h"

#include <cerrno>
#include <csignal>
#include <cstring>
#include <filesystem>
#include <optional>
#include <unistd.h>

namespace pallax {

namespace {

bool isStandardOutput(const ReportOptions& options) {
    return options.output == "-" || (options.output.empty() && options.json);
}

/// Signals that end the program wait while it exists.
class DelayedSignals {
public:
    DelayedSignals() {
        sigset_t ending{};
        sigemptyset(&ending);
        for (const int signal : {SIGINT, SIGTERM, SIGHUP}) {
            sigaddset(&ending, signal);
        }
        (void)::sigprocmask(SIG_BLOCK, &ending, &_before);
    }
    ~DelayedSignals() { (void)::sigprocmask(SIG_SETMASK, &_before, nullptr); }
    DelayedSignals(const DelayedSignals&) = delete;
    DelayedSignals& operator=(const DelayedSignals&) = delete;

private:
    sigset_t _before{};
};

/// Whole, or not at all.
ExitStatus write(const ReportOptions& options, const std::string& content) {
    if (isStandardOutput(options)) {
        Output output(writeToDescriptor(STDOUT_FILENO, "Standard output"));
        output.text() += content;
        output.flush();
        return kExitSuccess;
    }
    std::optional<DelayedSignals> delayed;
    std::error_code ignored;
    if (!std::filesystem::is_other(options.output, ignored)) {
        delayed.emplace(); // they would leave what is written under another name
    }
    const auto file = NewFile::create(options.output);
    const Bytes bytes{reinterpret_cast<const std::uint8_t*>(content.data()), content.size()};
    if (file && file->write(bytes) && file->finish()) {
        return kExitSuccess;
    }
    complain(formatText("%@ cannot be written: %@.", {options.output, std::strerror(errno)}));
    return kExitFailure;
}

std::optional<std::string> refusalOf(const ReportOptions& options) {
    if (isStandardOutput(options)) {
        return outputIntoRecording(options.recordings);
    }
    std::error_code ignored;
    if (!options.store.empty() &&
        std::filesystem::equivalent(options.store, options.output, ignored)) {
        return formatText("%@ would be replaced by its report.", {options.output});
    }
    if (recordingAmong(options.recordings, regularFile(options.output))) {
        return formatText("%@ would be replaced by its report.", {options.output});
    }
    return std::nullopt;
}

ExitStatus make(const ReportOptions& options, const Settings& settings,
                const QualityProfile& profile) {
    const InstalledNames installed = readInstalledNames(dataFolders());
    for (const std::string& complaint : installed.complaints) {
        complain(complaint);
    }
    const RequiredTemplates resources(DirectoryResources::programFolder());
    const BuildBundle bundle;
    DroppedNotices notices;
    const WallClock clock;
    TerminalLine line = TerminalLine::onStandardError();
    ProgressPace pace(clock);
    const DecoderEnvironment decoder{resources, bundle, notices, technologies(),
                                     installedKnowledge()};
    const ReportCommand::Environment environment{
        decoder,
        installed.names,
        profile,
        clock,
        [&line](const std::string& sentence) {
            line.wipe();
            complain(sentence);
        },
        [&](std::string_view doing, std::uint64_t packets) {
            if (line.isPossible() && pace.isDue()) {
                line.show(std::string(doing) + ": " + packetCount(packets));
            }
        },
        settings.journal};
    ExitStatus status = kExitSuccess;
    const auto content = ReportCommand(options, environment).make(status);
    line.wipe();
    if (!content) {
        return status;
    }
    const ExitStatus written = write(options, *content);
    return written == kExitSuccess ? status : written;
}

} // namespace

ExitStatus runReport(const ReportOptions& options) {
    if (const auto refusal = refusalOf(options)) {
        complain(*refusal);
        return kExitFailure;
    }
    const SettingsResult settings = loadSettings(settingsFiles());
    if (!settings) {
        complain(settings.error().sentence);
        return kExitFailure;
    }
    const auto profile = profileOrComplaint({options.profile, true, "report"});
    if (!profile) {
        return profile.error();
    }
    return make(options, *settings, *profile);
}

} // namespace pallax
