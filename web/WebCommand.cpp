#include "web/WebCommand.h"

#include "console/Output.h"
#include "host/Complaint.h"
#include "host/Files.h"
#include "host/Interruption.h"
#include "host/KnowledgeFiles.h"
#include "host/RecordingParts.h"
#include "host/UserFolders.h"
#include "link/SourceChild.h"
#include "telephony/ChildService.h"
#include "text/Format.h"
#include "web/Browser.h"
#include "web/WebOptions.h"
#include "web/WebSession.h"

#include <unistd.h>
#include <utility>

namespace pallax {

namespace {

/// Why the source cannot be shown, with the exit status; nothing if it can.
std::optional<ExitStatus> refuse(const Source& source) {
    if (const auto refusal = refusalOf(source)) {
        complain(*refusal);
        return kExitFailure;
    }
    if (isSnapshot(source)) {
        complain(formatText("%@ is a saved snapshot; pallax web shows recordings.",
                            {sourceName(source)}));
        return kExitFailure;
    }
    if (recordingPath(source) == "-" && ::isatty(STDIN_FILENO) != 0) {
        complain("Standard input is a terminal; pipe a recording into it.");
        return kExitWrongUsage;
    }
    const auto* file = std::get_if<FileRecording>(&source);
    if (const auto missing = file != nullptr ? missingParts(file->parts()) : std::nullopt) {
        complain(*missing);
    }
    return std::nullopt;
}

/// The content of a PEM file; nothing after a complaint.
std::optional<std::string> readPem(const std::string& path) {
    constexpr std::size_t kLargest = std::size_t{1} << 20U;
    const auto content = readRegularFile(path, kLargest);
    if (!content) {
        complain(formatText("%@ cannot be read: %@.", {path, content.error().reason}));
        return std::nullopt;
    }
    return std::string(content->begin(), content->end());
}

/// Nothing after a complaint.
std::optional<QualityProfile> profileOf(const WebOptions& options, const Settings& settings,
                                        ExitStatus& status) {
    const std::string usual = settings.profile.value_or(std::string(kDefaultProfile));
    auto profile = loadProfile(options.profile.value_or(usual), profileFolder());
    if (!profile) {
        complain(profile.error().sentence);
        status = options.profile && profile.error().isUnknown ? kExitWrongUsage : kExitFailure;
        return std::nullopt;
    }
    return std::move(profile).value();
}

RequestGate gateOf(const WebOptions& options, const Listener& listener) {
    return RequestGate({.address = listener.address,
                        .port = listener.port,
                        .isEncrypted = !options.certificate.empty(),
                        .link = AccessToken::random(),
                        .once = options.open ? std::optional(AccessToken::random()) : std::nullopt,
                        .session = AccessToken::random(),
                        .hasMetrics = options.metrics});
}

/// Prints the link, and opens it if that is wanted.
void present(const WebOptions& options, const RequestGate& gate) {
    Output output(writeToDescriptor(STDOUT_FILENO, "Standard output"));
    output.text() += gate.link() + '\n';
    output.flush();
    if (options.open) {
        if (const auto trouble = openInBrowser(gate.linkForOnce())) {
            complain(*trouble);
        }
    }
}

ExitStatus serve(const WebOptions& options, const Settings& settings,
                 const QualityProfile& profile) {
    std::optional<HttpServer::Identity> identity;
    if (!options.certificate.empty()) {
        const auto certificate = readPem(options.certificate);
        const auto key = certificate ? readPem(options.key) : std::nullopt;
        if (!key) {
            return kExitFailure;
        }
        identity = HttpServer::Identity{*certificate, *key};
    }
    auto listener = Listener::at(options.address, options.port);
    if (!listener) {
        complain(listener.error().sentence);
        return kExitFailure;
    }
    if (!listener->isLoopback && !identity) {
        complain("Others on the network can read along: the connection is not encrypted (see "
                 "--certificate and --key).");
    }
    std::unique_ptr<ChildService> child;
    if (!std::holds_alternative<ServiceModem>(options.source)) {
        auto started = startChild(options.source, options.play);
        if (!started) {
            complain(started.error().sentence);
            return kExitFailure;
        }
        child = std::move(started).value();
    }
    const InstalledNames installed = readInstalledNames(dataFolders());
    for (const std::string& complaint : installed.complaints) {
        complain(complaint);
    }
    const RequestGate gate = gateOf(options, *listener);
    WebSession session({.options = options,
                        .settings = settings,
                        .names = installed.names,
                        .profile = profile,
                        .child = child.get(),
                        .gate = gate,
                        .listener = std::move(listener).value(),
                        .identity = std::move(identity),
                        .ready = [&] { present(options, gate); }});
    const auto failure = session.run();
    const bool isContented = child == nullptr || endChild(*child);
    if (failure) {
        complain(*failure);
    }
    return failure || !isContented ? kExitFailure : kExitSuccess;
}

} // namespace

ExitStatus runWeb(const WebOptions& options) {
    if (const auto refused = refuse(options.source)) {
        return *refused;
    }
    const Interruption interruption;
    const SettingsResult settings = loadSettings(settingsFiles());
    if (!settings) {
        complain(settings.error().sentence);
        return kExitFailure;
    }
    ExitStatus status = kExitSuccess;
    const auto profile = profileOf(options, *settings, status);
    return profile ? serve(options, *settings, *profile) : status;
}

} // namespace pallax
