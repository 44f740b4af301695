#include "web/WebCommand.h"

#include "console/Output.h"
#include "decoding/InstalledKnowledge.h"
#include "decoding/RequiredTemplates.h"
#include "fleet/ServerRecordings.h"
#include "host/AsioMainQueue.h"
#include "host/BuildBundle.h"
#include "host/Complaint.h"
#include "host/DirectoryResources.h"
#include "host/Files.h"
#include "host/Interruption.h"
#include "host/KnowledgeFiles.h"
#include "host/RecordingParts.h"
#include "host/UserFolders.h"
#include "host/WallClock.h"
#include "link/SourceChild.h"
#include "report/StoredReport.h"
#include "telephony/ChildService.h"
#include "text/Format.h"
#include "web/Browser.h"
#include "web/StoredPage.h"
#include "web/WebOptions.h"
#include "web/WebSession.h"

#include <csignal>
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

/// Where clients come in.
struct Entrance {
    Listener listener;
    std::optional<HttpServer::Identity> identity;
};

/// Nothing after a complaint.
std::optional<Entrance> openEntrance(const WebOptions& options) {
    std::optional<HttpServer::Identity> identity;
    if (!options.certificate.empty()) {
        const auto certificate = readPem(options.certificate);
        const auto key = certificate ? readPem(options.key) : std::nullopt;
        if (!key) {
            return std::nullopt;
        }
        identity = HttpServer::Identity{*certificate, *key};
    }
    auto listener = Listener::at(options.address, options.port);
    if (!listener) {
        complain(listener.error().sentence);
        return std::nullopt;
    }
    if (!listener->isLoopback && !identity) {
        complain("Others on the network can read along: the connection is not encrypted (see "
                 "--certificate and --key).");
    }
    return Entrance{std::move(listener).value(), std::move(identity)};
}

NetworkNames readNames() {
    InstalledNames installed = readInstalledNames(dataFolders());
    for (const std::string& complaint : installed.complaints) {
        complain(complaint);
    }
    return std::move(installed.names);
}

ExitStatus serveStored(const WebOptions& options, const QualityProfile& profile) {
    const RequiredTemplates resources(DirectoryResources::programFolder());
    const NetworkNames names = readNames();
    StoredReportRequest request{options.store, options.device, options.technology, options.from,
                                options.to};
    request.head.version = BuildBundle().version().value_or("");
    const auto report = storedReport(
        [&options] { return openRecordings(options.store); }, request,
        {names, profile, resources, [](Time time) { return WallClock().zone(time).offset; }});
    if (!report) {
        complain(report.error());
        return kExitFailure;
    }
    const StoredPage page(report->page);
    auto entrance = openEntrance(options);
    if (!entrance) {
        return kExitFailure;
    }
    RequestGate gate = gateOf(options, entrance->listener);
    AsioMainQueue queue;
    queue.onSignal({SIGINT, SIGTERM, SIGHUP}, [&queue](int /*signal*/) { queue.stop(); });
    const auto server =
        HttpServer::start({.queue = queue,
                           .listener = std::move(entrance->listener),
                           .identity = std::move(entrance->identity),
                           .answer = [&](const WebRequest& asked) {
                               RequestGate::Verdict verdict = gate.decide(asked);
                               return verdict.decision == RequestGate::Decision::Serve
                                          ? page.answer(asked)
                                          : std::move(verdict.response);
                           }});
    if (!server) {
        complain(server.error().sentence);
        return kExitFailure;
    }
    present(options, gate);
    queue.run();
    return kExitSuccess;
}

ExitStatus serve(const WebOptions& options, const Settings& settings,
                 const QualityProfile& profile) {
    auto entrance = openEntrance(options);
    if (!entrance) {
        return kExitFailure;
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
    const NetworkNames names = readNames();
    const RequestGate gate = gateOf(options, entrance->listener);
    WebSession session({.options = options,
                        .settings = settings,
                        .names = names,
                        .profile = profile,
                        .child = child.get(),
                        .gate = gate,
                        .listener = std::move(entrance->listener),
                        .identity = std::move(entrance->identity),
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
    const auto refused = options.store.empty() ? refuse(options.source) : std::nullopt;
    if (refused) {
        return *refused;
    }
    const Interruption interruption;
    const SettingsResult settings = loadSettings(settingsFiles());
    if (!settings) {
        complain(settings.error().sentence);
        return kExitFailure;
    }
    const std::string usual = settings->profile.value_or(std::string(kDefaultProfile));
    const auto profile =
        profileOrComplaint({options.profile.value_or(usual), options.profile.has_value()});
    if (!profile) {
        return profile.error();
    }
    return options.store.empty() ? serve(options, *settings, *profile)
                                 : serveStored(options, *profile);
}

} // namespace pallax
