#include "report/Figures.h"

#include "fields/Measures.h"
#include "monitor/TickGrid.h"
#include "overview/StatusWords.h"
#include "timeline/FieldTable.h"

#include <algorithm>
#include <chrono>
#include <cmath>

namespace pallax {

namespace {

constexpr double kThousand = 1000;

/// Whole numbers without an exponent: the shortest text of a real can have one.
PropertyList number(double value) {
    constexpr double kExact = 9007199254740992.0;
    if (std::abs(value) < kExact && value == std::trunc(value)) {
        return PropertyList::integer(static_cast<std::int64_t>(value));
    }
    return std::isfinite(value) ? PropertyList::real(value) : PropertyList();
}

/// A figure with no more digits than it can have.
PropertyList rounded(double value) {
    return number(std::round(value * kThousand) / kThousand);
}

PropertyList count(std::uint64_t value) {
    return PropertyList::unsignedInteger(value);
}

Array textsOf(const std::vector<std::string>& texts) {
    return {texts.begin(), texts.end()};
}

std::uint64_t eventsOf(const std::vector<Event>& events, EventKind kind) {
    return static_cast<std::uint64_t>(std::count_if(
        events.begin(), events.end(), [kind](const Event& event) { return event.kind == kind; }));
}

Array bordersOf(const QualityProfile& profile, std::optional<Measure> measure) {
    Array borders;
    const auto found = measure ? profile.borders.find(*measure) : profile.borders.end();
    if (found != profile.borders.end()) {
        for (const Borders::Border& border : found->second.borders) {
            borders.emplace_back(Dictionary{{"grade", std::string(nameOf(border.grade))},
                                            {"value", number(border.value)}});
        }
    }
    return borders;
}

/// The places of the display whose numbers the profile judges.
Array gradedPlaces(const QualityProfile& profile, const FieldTable& fields) {
    Array places;
    for (FieldIndex index = 0; index < fields.size(); ++index) {
        const auto measure = measureOf(fields[index].name);
        if (measure && profile.borders.contains(*measure)) {
            places.emplace_back(Dictionary{{"path", fields[index].path},
                                           {"measure", std::string(infoOf(*measure).name)}});
        }
    }
    return places;
}

Dictionary profileObject(const QualityProfile& profile, const FieldTable& fields) {
    Dictionary borders;
    for (const auto& [measure, each] : profile.borders) {
        borders.set(std::string(infoOf(measure).name), bordersOf(profile, measure));
    }
    return Dictionary{{"name", profile.name},
                      {"source", profile.source},
                      {"borders", std::move(borders)},
                      {"graded", gradedPlaces(profile, fields)}};
}

Array stretchesOf(const ReportBuilder& report) {
    const auto& starts = report.stretches();
    Array stretches;
    for (std::size_t index = 0; index < starts.size(); ++index) {
        const std::size_t end =
            index + 1 < starts.size() ? starts[index + 1].tick : report.ticks().size();
        const std::size_t begin = starts[index].tick;
        stretches.emplace_back(Dictionary{{"from", number(pageSeconds(report.ticks()[begin]))},
                                          {"to", number(pageSeconds(report.ticks()[end - 1]))},
                                          {"ticks", count(end - begin)}});
    }
    return stretches;
}

Dictionary headObject(const ReportHead& head, const ReportBuilder& report,
                      const std::vector<Event>& events, const FieldTable& fields) {
    const auto& ticks = report.ticks();
    std::vector<std::string> notes = head.notes;
    for (std::string& note : report.notes()) {
        notes.push_back(std::move(note));
    }
    return Dictionary{
        {"title", head.title},
        {"label", head.label},
        {"recording", head.recording},
        {"technology", head.technology},
        {"operator", report.network() ? operatorWords(*report.network()) : ""},
        {"from", ticks.empty() ? PropertyList() : number(pageSeconds(ticks.front()))},
        {"to", ticks.empty() ? PropertyList() : number(pageSeconds(ticks.back()))},
        {"packets", count(head.packets)},
        {"ticks", count(ticks.size())},
        {"interval", number(std::chrono::duration<double>(TickGrid::kInterval).count())},
        {"gaps", count(eventsOf(events, EventKind::Gap))},
        {"timeSteps", count(eventsOf(events, EventKind::TimeStep))},
        {"cellChanges",
         count(eventsOf(events, EventKind::CellChange) + eventsOf(events, EventKind::PingPong))},
        {"pingPongs", count(eventsOf(events, EventKind::PingPong))},
        {"version", head.version},
        {"identities", head.hasIdentities ? "included" : "left out"},
        {"where", head.where},
        {"notes", textsOf(notes)},
        {"profile", profileObject(report.profile(), fields)},
        {"stretches", stretchesOf(report)},
    };
}

PropertyList quantilesOf(const Spread& spread) {
    if (spread.isEmpty()) {
        return {};
    }
    constexpr double kLow = 0.05;
    constexpr double kMiddle = 0.5;
    constexpr double kHigh = 0.95;
    return Dictionary{{"p5", number(spread.quantile(kLow))},
                      {"p50", number(spread.quantile(kMiddle))},
                      {"p95", number(spread.quantile(kHigh))},
                      {"least", number(spread.least())},
                      {"most", number(spread.most())}};
}

Array sharesOf(const ReportMeasure& measure, const QualityProfile& profile) {
    Array shares;
    const auto borders =
        measure.measure ? profile.borders.find(*measure.measure) : profile.borders.end();
    if (borders != profile.borders.end()) {
        for (const Spread::Share& share : measure.spread.shares(borders->second)) {
            shares.emplace_back(Dictionary{{"grade", std::string(nameOf(share.grade))},
                                           {"share", number(share.share)}});
        }
    }
    return shares;
}

PropertyList worstOf(const WorstMinute& worst) {
    const auto& found = worst.found();
    return !found ? PropertyList()
                  : Dictionary{{"from", number(pageSeconds(found->from))},
                               {"to", number(pageSeconds(found->to))},
                               {"mean", rounded(found->mean)},
                               {"stretch", count(found->stretch)}};
}

/// The range of the axis: that of the measure, so that two drives look alike where they are alike.
std::pair<double, double> rangeOf(const ReportMeasure& measure) {
    if (measure.measure) {
        return {infoOf(*measure.measure).worst, infoOf(*measure.measure).best};
    }
    return measure.spread.isEmpty() ? std::pair(0.0, 1.0)
                                    : std::pair(measure.spread.least(), measure.spread.most());
}

Dictionary objectOf(const ReportMeasure& measure, const QualityProfile& profile) {
    const auto [worst, best] = rangeOf(measure);
    return Dictionary{
        {"id", count(measure.id)},
        {"name", measure.name},
        {"system", measure.system},
        {"unit", measure.unit},
        {"measure", measure.measure ? std::string(infoOf(*measure.measure).name) : ""},
        {"meaning", measure.measure ? std::string(infoOf(*measure.measure).meaning) : ""},
        {"worst", number(worst)},
        {"best", number(best)},
        {"borders", bordersOf(profile, measure.measure)},
        {"seconds", rounded(measure.spread.total())},
        {"shares", sharesOf(measure, profile)},
        {"quantiles", quantilesOf(measure.spread)},
        {"worstStretch", worstOf(measure.worst)},
    };
}

Array measuresOf(const ReportBuilder& report) {
    Array measures;
    for (const ReportMeasure& measure : report.measures()) {
        measures.emplace_back(objectOf(measure, report.profile()));
    }
    return measures;
}

/// The place of a packet's stretch of time among those of a report.
std::uint32_t stretchOf(const ReportBuilder& report, std::uint64_t packet) {
    std::uint32_t place = 0;
    for (std::uint32_t index = 0; index < report.stretches().size(); ++index) {
        place = report.stretches()[index].firstPacket <= packet ? index : place;
    }
    return place;
}

/// A change of the serving cell. `instant` is its stretch and its time: the clock can be set back.
struct CellChange {
    std::pair<std::uint32_t, Time> instant;
    bool isPingPong;
};

std::vector<CellChange> cellChanges(const ReportBuilder& report, const std::vector<Event>& events) {
    std::vector<CellChange> changes;
    for (const Event& event : events) {
        if (event.kind == EventKind::CellChange || event.kind == EventKind::PingPong) {
            changes.push_back(
                {{stretchOf(report, event.packet), event.time}, event.kind == EventKind::PingPong});
        }
    }
    std::stable_sort(changes.begin(), changes.end(), [](const auto& one, const auto& other) {
        return one.instant < other.instant;
    });
    return changes;
}

/// The change that a stay began with, within the tick that first showed it. Null if there is none.
const CellChange* changeBefore(const std::vector<CellChange>& changes, const ReportStay& stay) {
    const auto past = std::lower_bound(
        changes.begin(), changes.end(), std::pair(stay.stretch, stay.from),
        [](const CellChange& change, const auto& instant) { return change.instant < instant; });
    const bool isNear = past != changes.begin() && (past - 1)->instant.first == stay.stretch &&
                        (past - 1)->instant.second >= stay.from - TickGrid::kInterval;
    return isNear ? &*(past - 1) : nullptr;
}

Array staysOf(const ReportBuilder& report, const std::vector<Event>& events) {
    const std::vector<CellChange> changes = cellChanges(report, events);
    Array stays;
    for (const ReportStay& stay : report.stays()) {
        const CellChange* change = changeBefore(changes, stay);
        stays.emplace_back(Dictionary{
            {"system", stay.system},
            {"cell", stay.cell},
            {"details", textsOf(stay.details)},
            {"from", number(pageSeconds(change != nullptr ? change->instant.second : stay.from))},
            {"to", number(pageSeconds(stay.to))},
            {"stretch", count(stay.stretch)},
            {"pingPong", PropertyList::boolean(change != nullptr && change->isPingPong)},
        });
    }
    return stays;
}

Array neighboursOf(const ReportBuilder& report) {
    std::vector<const ReportNeighbour*> all;
    for (const ReportNeighbour& neighbour : report.neighbours()) {
        if (!neighbour.spread.isEmpty() || neighbour.detected > 0 || neighbour.unlisted > 0) {
            all.push_back(&neighbour);
        }
    }
    std::stable_sort(all.begin(), all.end(), [](const auto* one, const auto* other) {
        return one->near != other->near ? one->near > other->near
                                        : one->spread.total() > other->spread.total();
    });
    Array neighbours;
    for (const ReportNeighbour* each : all) {
        const Spread& spread = each->spread;
        neighbours.emplace_back(Dictionary{
            {"id", count(each->id)},
            {"system", each->system},
            {"cell", each->cell},
            {"unit", each->unit},
            {"measure", each->measure ? std::string(infoOf(*each->measure).name) : ""},
            {"seconds", rounded(spread.total())},
            {"best", spread.isEmpty() ? PropertyList() : number(spread.most())},
            {"median", spread.isEmpty() ? PropertyList() : number(spread.quantile(0.5))},
            {"near", rounded(each->near)},
            {"stronger", rounded(each->stronger)},
            {"detected", rounded(each->detected)},
            {"served", PropertyList::boolean(each->isServing)},
            {"unlisted", count(each->unlisted)},
        });
    }
    return neighbours;
}

Array lanesOf(const std::map<std::string, SpanLane>& lanes) {
    Array objects;
    for (const auto& [name, lane] : lanes) {
        Array spans;
        for (const SpanLane::Span& span : lane.spans()) {
            spans.emplace_back(Dictionary{{"from", number(pageSeconds(span.from))},
                                          {"to", number(pageSeconds(span.to))},
                                          {"text", span.text},
                                          {"stretch", count(span.stretch)}});
        }
        objects.emplace_back(Dictionary{{"name", name}, {"spans", std::move(spans)}});
    }
    return objects;
}

/// The words of an event without the name of a context.
std::string wordsWithoutName(const Event& event) {
    const bool hasName = event.kind == EventKind::ContextUp || event.kind == EventKind::ContextDown;
    return hasName ? event.words.substr(0, event.words.find(": ")) : event.words;
}

Array eventObjects(const ReportHead& head, const ReportBuilder& report,
                   const std::vector<Event>& events, const FieldTable& fields) {
    const bool hasNames = head.hasIdentities || !ReportBuilder::areContextsPersonal(fields);
    Array objects;
    for (const Event& event : events) {
        objects.emplace_back(Dictionary{{"time", number(pageSeconds(event.time))},
                                        {"packet", count(event.packet)},
                                        {"kind", std::string(wordOf(event.kind))},
                                        {"words", hasNames ? event.words : wordsWithoutName(event)},
                                        {"stretch", count(stretchOf(report, event.packet))}});
    }
    return objects;
}

} // namespace

double pageSeconds(Time time) {
    const auto milliseconds = std::chrono::floor<std::chrono::milliseconds>(time);
    return static_cast<double>(milliseconds.time_since_epoch().count()) / kThousand;
}

Dictionary figuresOf(const ReportHead& head, const ReportBuilder& report,
                     const std::vector<Event>& events, const FieldTable& fields) {
    return Dictionary{
        {"head", headObject(head, report, events, fields)},
        {"measures", measuresOf(report)},
        {"cells", staysOf(report, events)},
        {"neighbours", neighboursOf(report)},
        {"states", lanesOf(report.states())},
        {"contexts", lanesOf(report.contexts())},
        {"events", eventObjects(head, report, events, fields)},
    };
}

} // namespace pallax
