#include "report/ReportBuilder.h"

#include "fields/CellFields.h"
#include "fields/EventFields.h"
#include "fields/Measures.h"
#include "monitor/TickGrid.h"
#include "overview/StatusWords.h"

#include <algorithm>
#include <cmath>
#include <utility>

namespace pallax {

namespace {

double secondsOf(std::chrono::nanoseconds time) {
    return std::chrono::duration<double>(time).count();
}

/// The unit of a level's text, of a field that has no measure: "-70 dBm".
std::string unitIn(const std::string& text) {
    const std::size_t blank = text.find(' ');
    return blank == std::string::npos ? "" : text.substr(blank + 1);
}

std::string unitOf(const StatusValue& level) {
    const auto measure = measureOf(level.field);
    return measure ? std::string(infoOf(*measure).unit) : unitIn(level.text);
}

const StatusValue* partOf(const StatusCell& cell, std::string_view name) {
    for (const StatusValue& part : cell.identity) {
        if (part.name == name) {
            return &part;
        }
    }
    return cell.channel && cell.channel->name == name ? &*cell.channel : nullptr;
}

bool isArea(const StatusValue& part) {
    return part.name == "cell" || part.name == "TAC" || part.name == "LAC";
}

/// "PCI 184": what tells the cells of a drive apart.
std::string cellWords(const StatusCell& cell) {
    std::string words;
    for (const StatusValue& part : cell.identity) {
        if (!isArea(part)) {
            words.append(words.empty() ? "" : " ").append(part.name).append(" ").append(part.text);
        }
    }
    return !words.empty() || cell.identity.empty() ? words : "cell " + cell.identity.front().text;
}

std::vector<std::string> detailsOf(const StatusCell& cell) {
    std::vector<std::string> details = channelWords(cell);
    if (!cell.site.empty()) {
        details.push_back(cell.site);
    }
    for (const StatusValue& part : cell.identity) {
        if (isArea(part) && part.name != "cell") {
            details.push_back(part.name + " " + part.text);
        }
    }
    return details;
}

/// The serving cell under the names that lists of neighbours give their cells.
std::set<std::string> namesInLists(const StatusCell& cell, std::string_view technology) {
    std::set<std::string> names;
    for (const StatusCellFields& rule : statusCells()) {
        if (rule.technology != technology || rule.name != cell.system) {
            continue;
        }
        for (const StatusList& list : rule.lists) {
            std::string words;
            for (const StatusField& field : list.identity) {
                const StatusValue* part = partOf(cell, field.name);
                const std::string name(field.name);
                if (part != nullptr && words.find(name + " ") == std::string::npos) {
                    words.append(words.empty() ? "" : " ").append(name + " " + part->text);
                }
            }
            if (!words.empty()) {
                names.insert(std::move(words));
            }
        }
    }
    return names;
}

std::string_view systemName(RadioSystem system, std::string_view technology) {
    for (const StatusCellFields& rule : statusCells()) {
        if (rule.technology == technology && rule.system == system) {
            return rule.name;
        }
    }
    return "";
}

} // namespace

bool ReportBuilder::areContextsPersonal(const FieldTable& fields) {
    const auto rules = eventFields();
    return std::any_of(rules.begin(), rules.end(), [&fields](const EventFields& rule) {
        const bool isContext =
            rule.technology == fields.technology() && rule.watch == EventFields::Watch::Contexts;
        const auto field = isContext ? fields.named(rule.fields.front()) : std::nullopt;
        return field && fields[*field].isPersonal;
    });
}

bool ReportBuilder::isKnown(const StatusValue& level, Time at) const {
    return std::isfinite(level.number) && at - level.read <= kKnownFor;
}

void ReportBuilder::take(const ReportTick& tick) {
    const bool isFirst = _ticks.empty();
    if (!isFirst) {
        const auto most = tick.isAfterStep ? TickGrid::kInterval : kKnownFor;
        const Time latest = _ticks.back() + most;
        settle(tick.isAfterStep ? latest : std::min(tick.time, latest));
    }
    if (isFirst || tick.time < _ticks.back()) {
        _stretches.push_back({static_cast<std::uint32_t>(_ticks.size()), tick.firstPacket});
    }
    _ticks.push_back(tick.time);
    _display.add(this->tick(), tick.display);
    Status status = statusOf(tick.values, tick.time, _names, _profile);
    if (status.network) {
        _network = status.network;
    }
    addSeries(status);
    addStays(status, tick);
    if (tick.isAfterStep) {
        for (ReportMeasure& measure : _measures) {
            measure.worst.restart();
        }
    }
    const bool hasContextNames = !_isMasked || !areContextsPersonal(tick.values.fields());
    _pending = {tick.time, std::move(status), hasContextNames, detectedIn(tick.values)};
}

void ReportBuilder::finish() {
    if (_pending) {
        settle(_pending->time + TickGrid::kInterval);
        _pending.reset();
    }
}

void ReportBuilder::settle(Time until) {
    const double seconds = secondsOf(until - _pending->time);
    if (seconds > 0) {
        settleLevels(seconds);
        settleNeighbours(seconds);
        settleLanes(until);
    }
}

void ReportBuilder::settleLevels(double seconds) {
    for (const StatusCell& cell : _pending->status.cells) {
        for (const StatusValue& level : cell.levels) {
            if (isKnown(level, _pending->time)) {
                ReportMeasure& measure = measureOf(cell, level);
                measure.spread.add(level.number, seconds);
                measure.worst.add(_pending->time, seconds, level.number, stretch());
            }
        }
    }
}

void ReportBuilder::settleNeighbours(double seconds) {
    const Status& status = _pending->status;
    for (const StatusNeighbour& each : status.neighbours) {
        ReportNeighbour* neighbour = neighbourOf(each.system, each.cell);
        if (neighbour == nullptr || !isKnown(each.level, _pending->time)) {
            continue;
        }
        neighbour->spread.add(each.level.number, seconds);
        for (const StatusCell& cell : status.cells) {
            for (const StatusValue& level : cell.levels) {
                const bool isSame = cell.system == each.system && level.name == each.level.name &&
                                    isKnown(level, _pending->time);
                neighbour->near +=
                    isSame && each.level.number >= level.number - kNear ? seconds : 0;
                neighbour->stronger += isSame && each.level.number > level.number ? seconds : 0;
            }
        }
    }
    for (const auto& [system, cell] : _pending->detected) {
        if (ReportNeighbour* neighbour = neighbourOf(system, cell)) {
            neighbour->detected += seconds;
        }
    }
}

void ReportBuilder::settleLanes(Time until) {
    const Time from = _pending->time;
    for (const StatusValue& state : _pending->status.states) {
        _states[state.name].add({from, until, state.text, stretch()});
    }
    settleContexts(until);
    for (auto& [system, place] : _current) {
        _stays[place].to = until;
    }
}

void ReportBuilder::settleContexts(Time until) {
    std::set<std::string> active;
    for (const StatusContext& context : _pending->status.contexts) {
        const std::string name = _pending->hasContextNames
                                     ? context.name
                                     : "context " + std::to_string(active.size() + 1);
        if (_contexts.size() < kMostNeighbours || _contexts.contains(name)) {
            const bool isTold = _pending->hasContextNames && !context.state.empty();
            _contexts[name].add(
                {_pending->time, until, isTold ? context.state : "there", stretch()});
            active.insert(name);
        }
    }
    for (auto& [name, lane] : _contexts) {
        if (!active.contains(name)) {
            lane.add({_pending->time, until, "", stretch()});
        }
    }
}

void ReportBuilder::addSeries(const Status& status) {
    std::set<std::uint32_t> known;
    for (const StatusCell& cell : status.cells) {
        for (const StatusValue& level : cell.levels) {
            ReportMeasure& measure = measureOf(cell, level);
            measure.series.add(tick(), isKnown(level, status.time) ? level.number : NAN);
            known.insert(measure.id);
        }
    }
    for (const StatusNeighbour& each : status.neighbours) {
        if (ReportNeighbour* neighbour = neighbourOf(each.system, each.cell)) {
            neighbour->unit = unitOf(each.level);
            neighbour->measure = pallax::measureOf(each.level.field);
            neighbour->series.add(tick(),
                                  isKnown(each.level, status.time) ? each.level.number : NAN);
            known.insert(neighbour->id);
        }
    }
    for (ReportMeasure& measure : _measures) {
        if (!known.contains(measure.id)) {
            measure.series.add(tick(), NAN);
        }
    }
    for (ReportNeighbour& neighbour : _neighbours) {
        if (!known.contains(neighbour.id)) {
            neighbour.series.add(tick(), NAN);
        }
    }
}

void ReportBuilder::addStays(const Status& status, const ReportTick& tick) {
    if (tick.isAfterStep) {
        _current.clear();
    }
    for (const StatusCell& cell : status.cells) {
        const std::string words = cellWords(cell);
        const auto current = _current.find(cell.system);
        const bool goesOn = current != _current.end() && _stays[current->second].cell == words;
        if (words.empty() || goesOn) {
            if (goesOn) {
                _stays[current->second].details = detailsOf(cell);
            }
            continue;
        }
        noteServing(cell, tick.values.fields().technology(), current != _current.end());
        if (_stays.size() < kMostStays) {
            _current[cell.system] = _stays.size();
            _stays.push_back(
                {cell.system, words, detailsOf(cell), tick.time, tick.time, stretch()});
        }
    }
}

/// `isNew`: the phone came from another cell.
void ReportBuilder::noteServing(const StatusCell& cell, std::string_view technology, bool isNew) {
    for (const std::string& name : namesInLists(cell, technology)) {
        const bool wasListed =
            _pending && std::any_of(_pending->status.neighbours.begin(),
                                    _pending->status.neighbours.end(), [&](const auto& each) {
                                        return each.system == cell.system && each.cell == name;
                                    });
        if (ReportNeighbour* neighbour = neighbourOf(cell.system, name)) {
            neighbour->isServing = true;
            neighbour->unlisted += isNew && !wasListed ? 1 : 0;
        }
    }
}

/// The cells that the phone has found without being told of them.
std::set<std::pair<std::string, std::string>>
ReportBuilder::detectedIn(const CurrentValues& values) const {
    std::set<std::pair<std::string, std::string>> detected;
    for (const CellFields& row : cellFields()) {
        const auto code =
            row.role == CellRole::Detected ? values.fields().named(row.code) : std::nullopt;
        if (!code) {
            continue;
        }
        values.forEachEntry([&](const EntryValues& entry) {
            if (const FieldValue* value = entry.value(*code)) {
                detected.emplace(systemName(row.system, values.fields().technology()),
                                 std::string(cellTermsOf(row.system).code) + " " + value->text());
            }
        });
    }
    return detected;
}

ReportMeasure& ReportBuilder::measureOf(const StatusCell& cell, const StatusValue& level) {
    const auto found =
        std::find_if(_measures.begin(), _measures.end(), [&](const ReportMeasure& measure) {
            return measure.system == cell.system && measure.name == level.name;
        });
    if (found != _measures.end()) {
        return *found;
    }
    const auto measure = pallax::measureOf(level.field);
    const bool isSmallerBetter = measure && infoOf(*measure).worst > infoOf(*measure).best;
    _measures.push_back({.id = _nextId++,
                         .system = cell.system,
                         .name = level.name,
                         .unit = unitOf(level),
                         .measure = measure,
                         .worst = WorstMinute(isSmallerBetter)});
    return _measures.back();
}

/// Null if there are too many.
ReportNeighbour* ReportBuilder::neighbourOf(const std::string& system, const std::string& cell) {
    const auto found = _places.find({system, cell});
    if (found != _places.end()) {
        return &_neighbours[found->second];
    }
    if (_neighbours.size() >= kMostNeighbours) {
        _hasMoreNeighbours = true;
        return nullptr;
    }
    _places.emplace(std::pair(system, cell), _neighbours.size());
    _neighbours.push_back({.id = _nextId++, .system = system, .cell = cell});
    return &_neighbours.back();
}

std::vector<std::string> ReportBuilder::notes() const {
    std::vector<std::string> notes;
    if (_hasMoreNeighbours) {
        notes.emplace_back("Only the first 512 neighbouring cells are in the report.");
    }
    if (_stays.size() >= kMostStays) {
        notes.emplace_back("Only the first 65,536 stays in a cell are in the report.");
    }
    if (_display.isFull()) {
        notes.emplace_back("Some values are left out: there are too many.");
    }
    return notes;
}

} // namespace pallax
