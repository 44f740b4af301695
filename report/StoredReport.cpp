#include "report/StoredReport.h"

#include "decoding/DecodeWindow.h"
#include "decoding/DisplayJson.h"
#include "fields/Reference.h"
#include "platform/RecordedTechnology.h"
#include "report/PageData.h"
#include "report/StoredTicks.h"
#include "text/Counted.h"
#include "text/Format.h"
#include "text/Suggestion.h"
#include "timeline/FieldTable.h"

#include <algorithm>
#include <chrono>
#include <cstdint>
#include <set>
#include <stdexcept>
#include <utility>

namespace pallax {

namespace {

using std::chrono::milliseconds;

/// Why there is no report.
class NoReport : public std::runtime_error {
public:
    using std::runtime_error::runtime_error;
};

constexpr std::int64_t kMicroseconds = 1000; // in a millisecond

constexpr const char* kWithoutDisplay =
    "A store does not hold the display: its state at each tick is left out. Levels, cells, "
    "neighbours and states are drawn from the values that it holds.";

constexpr const char* kWithoutContexts =
    "Contexts are not shown: their names can identify a person, so the store leaves them out.";

struct StoredDrive {
    StoredTicks::Recording recording;
    std::string name;
    std::string technology;
    std::uint64_t packets = 0;
    std::string trouble;
};

/// Of milliseconds since 1970, of which a file may have any.
Time timeOf(std::int64_t time) {
    const std::int64_t most =
        std::chrono::floor<milliseconds>(kLatestTime.time_since_epoch()).count();
    return Time(milliseconds(std::clamp<std::int64_t>(time, 0, most)));
}

std::string listed(const std::vector<std::string>& names) {
    constexpr std::size_t kMost = 10;
    std::string text;
    for (std::size_t place = 0; place < std::min(names.size(), kMost); ++place) {
        text += (place > 0 ? ", " : "") + names[place];
    }
    return text + (names.size() > kMost ? " and others" : "");
}

std::string deviceOf(StoreConnection& store, const StoredReportRequest& request) {
    std::vector<std::string> devices;
    Statement find = store.prepare("SELECT DISTINCT device FROM recordings ORDER BY device");
    while (find.step()) {
        devices.push_back(find.text(0));
    }
    if (devices.empty()) {
        throw NoReport(
            formatText("The store %@ is empty (see pallax store load).", {request.file}));
    }
    if (!request.device) {
        if (devices.size() > 1) {
            throw NoReport(formatText(
                "The store has several devices; choose one with --device: %@.", {listed(devices)}));
        }
        return devices.front();
    }
    if (std::find(devices.begin(), devices.end(), *request.device) == devices.end()) {
        const std::string meant = suggestion(*request.device, devices);
        throw NoReport(formatText("The store has no device \"%@\"%@",
                                  {*request.device, meant.empty() ? "." : meant}));
    }
    return *request.device;
}

std::vector<StoredDrive> drivesOf(StoreConnection& store, const std::string& device) {
    std::vector<StoredDrive> drives;
    Statement find = store.prepare("SELECT id, name, technology, every, packets, first, last, "
                                   "coalesce(trouble, '') FROM recordings WHERE device = ? "
                                   "ORDER BY first, name");
    enum DriveColumn : int { kId, kName, kTechnology, kEvery, kPackets, kFirst, kLast, kTrouble };
    find.bind(1, device);
    while (find.step()) {
        drives.push_back({{find.integer(kId), timeOf(find.integer(kFirst)),
                           timeOf(find.integer(kLast)), find.text(kEvery) == "packet"},
                          find.text(kName),
                          find.text(kTechnology),
                          static_cast<std::uint64_t>(find.integer(kPackets)),
                          find.text(kTrouble)});
    }
    return drives;
}

/// The time of the report, in what the store has of the device.
DecodeWindow windowOf(const StoredReportRequest& request, const std::vector<StoredDrive>& drives,
                      const ZoneRule& zone) {
    DecodeWindow window({request.from, request.to});
    TimeSpan span{drives.front().recording.first, drives.front().recording.last};
    for (const StoredDrive& drive : drives) {
        span.end = std::max(*span.end, drive.recording.last);
    }
    if (const auto refusal = window.open(span, zone)) {
        throw NoReport(*refusal);
    }
    return window;
}

/// The technology of the drives, of which only those remain that have it.
const RecordedTechnology& technologyOf(std::vector<StoredDrive>& drives,
                                       const StoredReportRequest& request,
                                       const std::string& device) {
    std::set<std::string> all;
    for (const StoredDrive& drive : drives) {
        all.insert(drive.technology);
    }
    if (request.technology == nullptr && all.size() > 1) {
        throw NoReport(formatText("The store has recordings of several technologies of %@ in that "
                                  "time; choose one with --technology: %@.",
                                  {device, listed({all.begin(), all.end()})}));
    }
    const std::string name = request.technology != nullptr
                                 ? std::string(request.technology->commandName)
                                 : (all.empty() ? "" : *all.begin());
    std::erase_if(drives, [&name](const StoredDrive& each) { return each.technology != name; });
    const RecordedTechnology* technology = technologyOfCommandName(name);
    if (drives.empty() || technology == nullptr) {
        throw NoReport(formatText("The store has nothing of %@ in that time.", {device}));
    }
    return *technology;
}

/// The page has every tick.
void refuseTooMuch(const std::vector<StoredDrive>& drives) {
    constexpr std::chrono::days kMost{100};
    std::chrono::nanoseconds all{0};
    for (const StoredDrive& drive : drives) {
        const auto length = drive.recording.last - drive.recording.first;
        if (length < std::chrono::nanoseconds(0) || length > kMost - all) {
            throw NoReport("The recordings of that time last more than 100 days, which is too much "
                           "for a page; choose less with --from and --to.");
        }
        all += length;
    }
}

/// Numbers packets through all drives, as of the parts of one recording.
class StoredWalk {
public:
    StoredWalk(StoreConnection& store, FieldTable& fields, const DecodeWindow& window,
               ReportBuilder& report)
        : _window(window), _report(report), _ticks(store, fields, _entries),
          _find(store.prepare("SELECT time, packet, kind, words FROM events WHERE recording = ? "
                              "ORDER BY rowid")) {}

    void add(const StoredDrive& drive) {
        _ticks.walk(drive.recording, [this](Time time, const CurrentValues& values,
                                            std::uint64_t packet) { take(time, values, packet); });
        addEvents(drive);
        _before += drive.packets;
    }
    const std::vector<Event>& events() const { return _events; }

private:
    void take(Time time, const CurrentValues& values, std::uint64_t packet) {
        constexpr std::chrono::seconds kGap{60}; // as an event "gap"
        _isAfterStep = _isAfterStep || (_latest && (time < *_latest || time - *_latest > kGap));
        _latest = time;
        if (!_window.contains(time)) {
            _isAfterStep = true; // it is not known to go on
            return;
        }
        _report.take({time, values, Dictionary{{"Display", "not held by a store"}}, _isAfterStep,
                      _before + packet});
        _isAfterStep = false;
    }
    void addEvents(const StoredDrive& drive) {
        _find.bind(1, drive.recording.id);
        while (_find.step()) {
            const auto kind = eventKindNamed(_find.text(2));
            const Time time = timeOf(_find.integer(0) / kMicroseconds) +
                              std::chrono::microseconds(_find.integer(0) % kMicroseconds);
            if (kind && _window.contains(time)) {
                _events.push_back({*kind,
                                   time,
                                   _before + static_cast<std::uint64_t>(_find.integer(1)),
                                   _find.text(3),
                                   {}});
            }
        }
    }

    const DecodeWindow& _window;
    ReportBuilder& _report;
    EntryTable _entries;
    StoredTicks _ticks;
    Statement _find;
    std::vector<Event> _events;
    std::uint64_t _before = 0; ///< packets of earlier drives
    std::optional<Time> _latest;
    bool _isAfterStep = false;
};

ReportHead headOf(const StoredReportRequest& request, const std::string& device,
                  const std::vector<StoredDrive>& drives, const FieldTable& fields,
                  const TechnologyReference& reference) {
    ReportHead head = request.head;
    head.label = head.label.empty() ? device : head.label;
    head.recording = drives.size() == 1 ? drives.front().name
                                        : counted(std::uint64_t{drives.size()}, "recording");
    head.technology = std::string(reference.title);
    head.notes.emplace_back(kWithoutDisplay);
    if (ReportBuilder::areContextsPersonal(fields)) {
        head.notes.emplace_back(kWithoutContexts);
    }
    for (const StoredDrive& drive : drives) {
        head.packets += drive.packets;
        if (!drive.trouble.empty()) {
            head.notes.push_back(drive.name + ": " + drive.trouble);
        }
    }
    return head;
}

StoredReport reportOf(const StoredReportRequest& request, const StoredReportKnowledge& knowledge) {
    const auto store = StoreConnection::openToRead(request.file);
    const std::string device = deviceOf(*store, request);
    std::vector<StoredDrive> drives = drivesOf(*store, device);
    const DecodeWindow window = windowOf(request, drives, knowledge.zone);
    std::erase_if(drives, [&window](const StoredDrive& drive) {
        return drive.recording.last < window.from() || drive.recording.first > window.to();
    });
    const RecordedTechnology& technology = technologyOf(drives, request, device);
    refuseTooMuch(drives);
    FieldTable fields(technology, knowledge.resources);
    // Identities are not in a store, at most their pseudonyms, which stay out as well.
    ReportBuilder report(knowledge.names, knowledge.profile,
                         [](const std::vector<std::string>& /*path*/) { return false; });
    StoredWalk walk(*store, fields, window, report);
    for (const StoredDrive& drive : drives) {
        walk.add(drive);
    }
    report.finish();
    if (report.ticks().empty()) {
        throw NoReport(formatText("The store has nothing of %@ in that time.", {device}));
    }
    const ReportHead head =
        headOf(request, device, drives, fields, gatherReference(technology, knowledge.resources));
    const Dictionary figures = figuresOf(head, report, walk.events(), fields);
    StoredReport made{pageData(figures, report, 0), {}, report.ticks()};
    appendJson(made.json, figures);
    made.json += '\n';
    return made;
}

} // namespace

Result<StoredReport, std::string> storedReport(const StoredReportRequest& request,
                                               const StoredReportKnowledge& knowledge) {
    if (request.file.find("://") != std::string::npos) {
        return formatText("\"%@\" is no file, and a report is drawn from the file of a store.",
                          {request.file});
    }
    try {
        return reportOf(request, knowledge);
    } catch (const NoReport& none) {
        return std::string(none.what());
    } catch (const StoreFailure& failure) {
        return std::string(failure.what());
    }
}

} // namespace pallax
