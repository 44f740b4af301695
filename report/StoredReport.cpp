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

constexpr const char* kNothing = "The store has nothing of %@ in that time.";

constexpr const char* kWithoutDisplay =
    "A store does not hold the display: its state at each tick is left out. Levels, cells, "
    "neighbours and states are drawn from the values that it holds.";

constexpr const char* kWithoutContexts =
    "Contexts are not shown: their names can identify a person, so the store leaves them out.";

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

std::string deviceOf(StoredRecordings& store, const StoredReportRequest& request) {
    const std::vector<std::string> devices = store.devices();
    if (devices.empty()) {
        throw NoReport(
            formatText("The store %@ is empty (see pallax store load).", {request.store}));
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

using StoredDrive = StoredTicks::Recording;

std::vector<StoredDrive> drivesOf(StoredRecordings& store, const std::string& device) {
    std::vector<StoredDrive> drives;
    for (LoadedRecording& loaded : store.ofDevice(device)) {
        const Time first = timeOf(loaded.first);
        const Time last = timeOf(loaded.last);
        drives.push_back({std::move(loaded), first, last});
    }
    return drives;
}

std::uint64_t packetsOf(const StoredDrive& drive) {
    return static_cast<std::uint64_t>(drive.loaded.packets);
}

/// The time of the report, in what the store has of the device.
DecodeWindow windowOf(const StoredReportRequest& request, const std::vector<StoredDrive>& drives,
                      const ZoneRule& zone) {
    DecodeWindow window({request.from, request.to});
    TimeSpan span{drives.front().first, drives.front().last};
    for (const StoredDrive& drive : drives) {
        span.end = std::max(*span.end, drive.last);
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
        all.insert(drive.loaded.technology);
    }
    if (request.technology == nullptr && all.size() > 1) {
        throw NoReport(formatText("The store has recordings of several technologies of %@ in that "
                                  "time; choose one with --technology: %@.",
                                  {device, listed({all.begin(), all.end()})}));
    }
    const std::string name = request.technology != nullptr
                                 ? std::string(request.technology->commandName)
                                 : (all.empty() ? "" : *all.begin());
    std::erase_if(drives,
                  [&name](const StoredDrive& each) { return each.loaded.technology != name; });
    const RecordedTechnology* technology = technologyOfCommandName(name);
    if (drives.empty() || technology == nullptr) {
        throw NoReport(formatText(kNothing, {device}));
    }
    return *technology;
}

/// The page has every tick.
void refuseTooMuch(const std::vector<StoredDrive>& drives) {
    constexpr std::chrono::days kMost{100};
    std::chrono::nanoseconds all{0};
    for (const StoredDrive& drive : drives) {
        const auto length = drive.last - drive.first;
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
    StoredWalk(StoredRecordings& store, FieldTable& fields, const DecodeWindow& window,
               ReportBuilder& report)
        : _store(store), _window(window), _report(report), _ticks(store, fields, _entries) {}

    void add(const StoredDrive& drive) {
        _ticks.walk(drive, [this](Time time, const CurrentValues& values, std::uint64_t packet) {
            take(time, values, packet);
        });
        addEvents(drive);
        _before += packetsOf(drive);
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
        for (Event& event : _store.events(drive.loaded)) {
            if (_window.contains(event.time)) {
                event.packet += _before;
                _events.push_back(std::move(event));
            }
        }
    }

    StoredRecordings& _store;
    const DecodeWindow& _window;
    ReportBuilder& _report;
    EntryTable _entries;
    StoredTicks _ticks;
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
    head.recording = drives.size() == 1 ? drives.front().loaded.name
                                        : counted(std::uint64_t{drives.size()}, "recording");
    head.technology = std::string(reference.title);
    head.notes.emplace_back(kWithoutDisplay);
    if (ReportBuilder::areContextsPersonal(fields)) {
        head.notes.emplace_back(kWithoutContexts);
    }
    for (const StoredDrive& drive : drives) {
        head.packets += packetsOf(drive);
        if (drive.loaded.trouble) {
            head.notes.push_back(drive.loaded.name + ": " + *drive.loaded.trouble);
        }
    }
    return head;
}

StoredReport reportOf(StoredRecordings& store, const StoredReportRequest& request,
                      const StoredReportKnowledge& knowledge) {
    const std::string device = deviceOf(store, request);
    std::vector<StoredDrive> drives = drivesOf(store, device);
    if (drives.empty()) { // it has been replaced meanwhile
        throw NoReport(formatText(kNothing, {device}));
    }
    const DecodeWindow window = windowOf(request, drives, knowledge.zone);
    std::erase_if(drives, [&window](const StoredDrive& drive) {
        return drive.last < window.from() || drive.first > window.to();
    });
    const RecordedTechnology& technology = technologyOf(drives, request, device);
    refuseTooMuch(drives);
    FieldTable fields(technology, knowledge.resources);
    // Identities are not in a store, at most their pseudonyms, which stay out as well.
    ReportBuilder report(knowledge.names, knowledge.profile,
                         [](const std::vector<std::string>& /*path*/) { return false; });
    StoredWalk walk(store, fields, window, report);
    for (const StoredDrive& drive : drives) {
        walk.add(drive);
    }
    report.finish();
    if (report.ticks().empty()) {
        throw NoReport(formatText(kNothing, {device}));
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

Result<StoredReport, std::string> storedReport(const OpenRecordings& open,
                                               const StoredReportRequest& request,
                                               const StoredReportKnowledge& knowledge) {
    try {
        return reportOf(*open(), request, knowledge);
    } catch (const NoReport& none) {
        return std::string(none.what());
    } catch (const StoreFailure& failure) {
        return std::string(failure.what());
    }
}

} // namespace pallax
