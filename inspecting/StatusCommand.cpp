#include "inspecting/StatusCommand.h"

#include "LogGenerator/Technologies/Technologies.h"
#include "console/Output.h"
#include "decoding/DroppedNotices.h"
#include "decoding/InstalledKnowledge.h"
#include "decoding/RequiredTemplates.h"
#include "fields/Reference.h"
#include "host/BuildBundle.h"
#include "host/Complaint.h"
#include "host/Interruption.h"
#include "host/KnowledgeFiles.h"
#include "host/Snapshot.h"
#include "host/UserFolders.h"
#include "host/WallClock.h"
#include "inspecting/StatusText.h"
#include "inspecting/ViewedFile.h"
#include "link/Settings.h"
#include "live/LiveSession.h"
#include "overview/Status.h"
#include "text/Format.h"

#include <unistd.h>

namespace pallax {

ExitStatus StatusCommand::run(Output& output) {
    return show(ViewedFile::open(*_options.recording, _options.technology, _environment.decoder,
                                 _environment.journal),
                output);
}

ExitStatus StatusCommand::runOn(LiveSession& session, Output& output) {
    return show(ViewedFile::of(session), output);
}

ExitStatus StatusCommand::show(const Result<std::unique_ptr<ViewedFile>, NotSeen>& file,
                               Output& output) {
    const auto refuse = [this](const NotSeen& reason) {
        _environment.report(reason.sentence);
        return reason.isEmpty ? kExitFailure : kExitCouldNotTell;
    };
    if (!file) {
        return refuse(file.error());
    }
    const Clock& zone = _environment.zone;
    const auto moment =
        (*file)->at(_options.at, [&zone](Time time) { return zone.zone(time).offset; });
    const std::vector<std::string> notes = (*file)->notes();
    for (const std::string& note : notes) {
        _environment.report(note);
    }
    if (!moment) {
        return refuse(moment.error());
    }
    if (moment->mayBeLater) {
        _environment.report(std::string(kSharedSections));
    }
    const Status status =
        statusOf(moment->values, moment->time, _environment.names, _environment.profile);
    if (status.isEmpty()) {
        return refuse({formatText("%@ tells nothing about the radio%@.",
                                  {(*file)->name(), _options.at ? " by then" : ""}),
                       notes.empty()});
    }
    const TechnologyReference technology =
        gatherReference((*file)->technology(), _environment.decoder.resources);
    const StatusOrigin origin{(*file)->name(), technology.technology->commandName, technology.title,
                              zone.zone(moment->time).offset,
                              moment->packet != 0 ? std::optional(moment->packet) : std::nullopt};
    (_options.json ? appendStatusJson : appendStatusText)(output.text(), origin, status);
    output.flush();
    return notes.empty() ? kExitSuccess : kExitCouldNotTell;
}

namespace {

/// Receives the live modem and shows it. Ctrl-C ends the reception early.
ExitStatus showLive(const StatusOptions& options, const Settings& settings, StatusCommand& command,
                    Output& output) {
    LiveSession session({.settings = settings,
                         .wanted = options.technology,
                         .duration = options.duration,
                         .service = options.service});
    std::optional<std::string> failure;
    {
        const Interruption interruption;
        failure = session.run();
    }
    if (failure) {
        complain(*failure);
        return kExitCouldNotTell;
    }
    return command.runOn(session, output);
}

} // namespace

ExitStatus runStatus(const StatusOptions& options) {
    const SettingsResult settings = loadSettings(settingsFiles());
    if (!settings) {
        complain(settings.error().sentence);
        return kExitFailure;
    }
    const auto profile = profileOrComplaint({options.profile, true, "status"});
    if (!profile) {
        return profile.error();
    }
    const InstalledNames installed = readInstalledNames(dataFolders());
    for (const std::string& complaint : installed.complaints) {
        complain(complaint);
    }
    const RequiredTemplates resources(DirectoryResources::programFolder());
    const BuildBundle bundle;
    DroppedNotices notices;
    const WallClock zone;
    const DecoderEnvironment decoder{resources, bundle, notices, technologies()};
    const StatusCommand::Environment environment{
        decoder,
        installed.names,
        *profile,
        zone,
        [](const std::string& sentence) { complain(sentence); },
        settings->journal};
    Output output(writeToDescriptor(STDOUT_FILENO, "Standard output"));
    StatusCommand command(options, environment);
    return !options.recording ? showLive(options, *settings, command, output) : command.run(output);
}

} // namespace pallax
