#include "reporting/ReportCommand.h"

#include "decoding/DecodeWindow.h"
#include "decoding/DisplayJson.h"
#include "decoding/StateCondition.h"
#include "fields/Reference.h"
#include "fleet/ServerRecordings.h"
#include "host/Files.h"
#include "masking/MaskedJournal.h"
#include "masking/MaskedPlaces.h"
#include "platform/Bundle.h"
#include "platform/Clock.h"
#include "query/Condition.h"
#include "querying/RecordedTimeline.h"
#include "report/Figures.h"
#include "report/Page.h"
#include "report/PageData.h"
#include "report/ReportWalk.h"
#include "report/StoredReport.h"
#include "text/Format.h"

#include <algorithm>
#include <filesystem>
#include <utility>

namespace pallax {

namespace {

/// "drive.pcapng": without its folder, whose names may be private.
std::string shownName(const PartPaths& paths) {
    if (paths.front() == "-") {
        return "standard input";
    }
    const auto part = partNameOf(paths.front());
    const bool isSeveral = paths.size() > 1 && part;
    return std::filesystem::path(isSeveral ? part->whole : paths.front()).filename().string();
}

/// Masks packets before anything else sees them.
auto maskWith(const Resources& resources) {
    return
        [&resources](std::unique_ptr<PacketJournal> packets, const RecordedTechnology& technology) {
            return std::make_unique<MaskedJournal>(std::move(packets), technology, resources);
        };
}

/// A sentence about a file, for readers who do not know its folder.
std::string withoutFolders(std::string sentence, const PartPaths& paths) {
    for (const std::string& path : paths) {
        const std::string name = std::filesystem::path(path).filename().string();
        const std::size_t place = sentence.find(path);
        if (place != std::string::npos) {
            sentence.replace(place, path.size(), name);
        }
    }
    return sentence;
}

/// Null if there is nothing wrong with the number of recordings.
const char* refusalOf(std::size_t recordings, const ReportOptions& options) {
    if (recordings > ReportCommand::kMostRecordings) {
        return "report takes one recording, or two to compare (see pallax report --help)";
    }
    if (options.labels.size() > (options.store.empty() ? recordings : 1)) {
        return "--label is for one recording each (see pallax report --help)";
    }
    return nullptr;
}

/// Whether the track has a point between the earliest and the latest tick, or little before.
bool hasPointWithin(const Track& track, const std::vector<Time>& ticks) {
    const auto [earliest, latest] = std::minmax_element(ticks.begin(), ticks.end());
    const Time first = *earliest - ReportBuilder::kKnownFor;
    const Time last = *latest;
    return std::any_of(track.begin(), track.end(), [first, last](const TrackPoint& point) {
        return point.time >= first && point.time <= last;
    });
}

TimeSpan spanOf(const Timeline& timeline) {
    TimeSpan span;
    for (const Stretch& stretch : timeline.stretches()) {
        span.stretches.push_back({stretch.first, stretch.latest});
        span.end = std::max(span.end.value_or(stretch.latest), stretch.latest);
    }
    span.begin = span.stretches.front().begin;
    return span;
}

} // namespace

std::optional<std::string> ReportCommand::make(ExitStatus& status) {
    const bool isStored = !_options.store.empty();
    const std::vector<PartPaths> recordings = joinedParts(_options.recordings, Recording::open);
    if (const char* refusal = refusalOf(recordings.size(), _options)) {
        _environment.report(refusal);
        status = kExitWrongUsage;
        return std::nullopt;
    }
    status = kExitSuccess;
    const auto track = readTrack(status);
    if (!track) {
        return std::nullopt;
    }
    std::string page = track->empty() ? "" : pageTrack(*track);
    std::string json;
    bool isOnTrack = track->empty();
    for (std::size_t place = 0; place < (isStored ? 1 : recordings.size()); ++place) {
        const auto part =
            isStored ? makeStoredPart(status) : makePart(recordings[place], place, status);
        if (!part) {
            return std::nullopt;
        }
        page += part->page;
        json += part->json;
        isOnTrack = isOnTrack || hasPointWithin(*track, part->ticks);
    }
    if (!isOnTrack) {
        complainOfTrack("none of its points is in the time of the report", status);
        return std::nullopt;
    }
    return _options.json ? json : pageHtml(page, PageUse::Report);
}

std::optional<ReportCommand::Part> ReportCommand::makeStoredPart(ExitStatus& status) {
    const Clock& zone = _environment.zone;
    StoredReportRequest request{_options.store, _options.device, _options.technology, _options.from,
                                _options.to};
    request.head.title = _options.title;
    request.head.label = _options.labels.empty() ? "" : _options.labels.front();
    request.head.version = _environment.decoder.bundle.version().value_or("");
    auto made =
        storedReport([this] { return openRecordings(_options.store); }, request,
                     {_environment.names, _environment.profile, _environment.decoder.resources,
                      [&zone](Time time) { return zone.zone(time).offset; }});
    if (!made) {
        _environment.report(made.error());
        status = kExitFailure;
        return std::nullopt;
    }
    StoredReport report = std::move(made).value();
    return Part{std::move(report.page), _options.json ? std::move(report.json) : "",
                std::move(report.ticks)};
}

std::optional<Track> ReportCommand::readTrack(ExitStatus& status) const {
    if (_options.track.empty()) {
        return Track();
    }
    const auto content = readRegularFile(_options.track, kLargestTrack);
    auto track =
        content ? parseTrack(*content) : Result<Track, std::string>(content.error().reason);
    if (!track) {
        complainOfTrack(track.error(), status);
        return std::nullopt;
    }
    return std::move(track).value();
}

void ReportCommand::complainOfTrack(const std::string& reason, ExitStatus& status) const {
    _environment.report(formatText("%@ cannot be used as a track: %@.", {_options.track, reason}));
    status = kExitFailure;
}

std::optional<ReportCommand::Part> ReportCommand::makePart(const PartPaths& paths,
                                                           std::size_t place, ExitStatus& status) {
    if (const auto missing = missingParts(paths)) {
        _environment.report(*missing);
    }
    RecordedTimeline::Request request{
        paths, _options.technology, _environment.journal,
        [this](std::uint64_t packets) { showProgress("reading", packets); }};
    if (!_options.withIdentities) {
        request.through = maskWith(_environment.decoder.resources);
    }
    const auto recorded = RecordedTimeline::open(request, _environment.decoder);
    if (!recorded) {
        _environment.report(recorded.error().sentence);
        status = kExitFailure;
        return std::nullopt;
    }
    Timeline& timeline = (*recorded)->timeline();
    const std::vector<std::string> notes = (*recorded)->notes();
    for (const std::string& note : notes) {
        _environment.report(note);
        status = kExitFailure;
    }
    if (timeline.packets() == 0 && !notes.empty()) {
        return std::nullopt;
    }
    const std::string name = shownName(paths);
    const RecordedTechnology& technology = *technologyOfCommandName(timeline.fields().technology());
    const IsLeftOut isLeftOut = _options.withIdentities
                                    ? IsLeftOut()
                                    : maskedPlaces(technology, _environment.decoder.resources);
    ReportBuilder report(_environment.names, _environment.profile, isLeftOut);
    std::vector<Event> events;
    if (!gather(timeline, name, report, events, status)) {
        return std::nullopt;
    }
    ReportHead head = headOf(paths, place, timeline);
    for (const std::string& note : notes) {
        head.notes.push_back(withoutFolders(note, paths));
    }
    status = timeline.hasEnded() ? kExitFatalRecord : status;
    const Dictionary figures = figuresOf(head, report, events, timeline.fields());
    Part part{.ticks = report.ticks()};
    if (_options.json) {
        appendJson(part.json, figures);
        part.json += '\n';
    } else {
        part.page = pageData(figures, report, place);
    }
    return part;
}

bool ReportCommand::gather(Timeline& timeline, const std::string& name, ReportBuilder& report,
                           std::vector<Event>& events, ExitStatus& status) {
    if (timeline.packets() == 0) {
        _environment.report(formatText("%@ holds no packets.", {name}));
        status = kExitFailure;
        return false;
    }
    DecodeWindow window({_options.from, _options.to});
    const Clock& zone = _environment.zone;
    const auto refusal =
        window.open(spanOf(timeline), [&zone](Time time) { return zone.zone(time).offset; });
    if (refusal) {
        _environment.report(name + ": " + *refusal);
        status = kExitFailure;
        return false;
    }
    std::unique_ptr<QueryCondition> condition;
    if (_options.where) {
        auto compiled =
            QueryCondition::compile(*_options.where, timeline.fields(),
                                    QueryCondition::About::State, _environment.decoder.knowledge);
        if (!compiled) {
            _environment.report("--where: " + compiled.error());
            status = kExitWrongUsage;
            return false;
        }
        condition = std::move(compiled).value();
    }
    gatherTicks(timeline, report, [&](const TickWalk::State& state) {
        showProgress("gathering", state.packet);
        if (!window.contains(state.tick.time) || condition == nullptr) {
            return window.contains(state.tick.time);
        }
        const auto holds = condition->holds(
            {{state.tick.time, state.packet, state.tick.number}, nullptr}, state.values);
        if (!holds) {
            throw ConditionFailure(holds.error());
        }
        return *holds;
    });
    report.finish();
    std::copy_if(timeline.events().begin(), timeline.events().end(), std::back_inserter(events),
                 [&window](const Event& event) { return window.contains(event.time); });
    if (report.ticks().empty()) {
        _environment.report(formatText("%@ shows nothing in that time.", {name}));
        status = kExitFailure;
        return false;
    }
    return true;
}

void ReportCommand::showProgress(std::string_view doing, std::uint64_t packets) const {
    if (_environment.progress) {
        _environment.progress(doing, packets);
    }
}

ReportHead ReportCommand::headOf(const PartPaths& paths, std::size_t place,
                                 const Timeline& timeline) const {
    const RecordedTechnology& technology = *technologyOfCommandName(timeline.fields().technology());
    return {
        .title = _options.title,
        .label = place < _options.labels.size() ? _options.labels[place] : "",
        .recording = shownName(paths),
        .technology =
            std::string(gatherReference(technology, _environment.decoder.resources).title),
        .version = _environment.decoder.bundle.version().value_or(""),
        .packets = timeline.packets(),
        .hasIdentities = _options.withIdentities,
        .where = _options.where.value_or(""),
    };
}

} // namespace pallax
