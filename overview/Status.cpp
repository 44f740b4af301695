#include "overview/Status.h"

#include "fields/EventFields.h"
#include "fields/Measures.h"
#include "fields/StatusFields.h"
#include "overview/StatusNetwork.h"
#include "overview/StatusWords.h"
#include "text/Format.h"
#include "timeline/EventFinder.h"

#include <algorithm>
#include <cmath>
#include <functional>
#include <utility>

namespace pallax {

namespace {

using Role = StatusField::Role;

/// Whether the value names something: "Not Present" and "N/A" do not.
bool tells(const FieldValue& value) {
    return value.text().find_first_of("0123456789") != std::string::npos;
}

/// "367" of "367 × 64chips", whose text alone a snapshot has.
std::string identityText(const FieldValue& value) {
    const std::string text = value.text();
    const std::size_t blank = text.find(' ');
    const bool startsWithNumber = text.find_first_not_of("0123456789") == blank;
    return startsWithNumber ? text.substr(0, blank) : text;
}

std::string siteOf(RadioSystem system, const FieldValue& identity) {
    const std::string words = siteWords(system, identity.number);
    return words.empty() ? "cell " + identityText(identity) : words;
}

/// "0" of "800 MHz cellular band [0]".
std::string bandNumber(const std::string& text) {
    const std::size_t open = text.rfind('[');
    return open != std::string::npos && text.ends_with(']')
               ? text.substr(open + 1, text.size() - open - 2)
               : text;
}

/// The frequency of an uplink's channel, or its number if that has no meaning.
std::string uplinkText(RadioSystem system, const FieldValue& value) {
    if (const auto number = wholeNumber(value.number)) {
        for (const Carrier& carrier : carriersOf(system, *number)) {
            const bool isBoth = carrier.downlink == carrier.uplink; // in a band of TDD
            if (carrier.uplink && (carrier.isOfUplink || isBoth)) {
                return megahertzText(carrier.uplink->hertz) + " MHz";
            }
        }
    }
    return "channel " + value.text();
}

/// One gathering.
class Gathering {
public:
    Gathering(const CurrentValues& values, Time time, const QualityProfile& profile)
        : _values(values), _fields(values.fields()), _profile(profile) {
        _status.time = time;
        _status.profile = profile.name;
    }

    Status status(const NetworkNames& names) {
        for (const StatusCellFields& rule : statusCells()) {
            if (rule.technology == _fields.technology()) {
                rule.isList ? addCellsOfList(rule) : addCell(rule);
            }
        }
        const auto isOld = [this](const StatusNeighbour& neighbour) {
            return _status.time - neighbour.level.read > kFresh;
        };
        std::stable_sort(_status.neighbours.begin(), _status.neighbours.end(),
                         [&](const StatusNeighbour& one, const StatusNeighbour& other) {
                             return isOld(one) != isOld(other)
                                        ? isOld(other)
                                        : one.level.number > other.level.number;
                         });
        addStatesAndContexts();
        _status.network = statusNetworkOf(_values, names);
        return std::move(_status);
    }

private:
    StatusValue valueOf(std::string_view name, std::string_view field,
                        const FieldValue& value) const {
        return {
            std::string(name), std::string(field), value.text(), value.number, {}, value.read, {}};
    }
    StatusValue identityOf(const StatusField& field, const FieldValue& value) const {
        StatusValue identity = valueOf(field.name, field.field, value);
        identity.text = identityText(value);
        return identity;
    }
    StatusValue levelOf(std::string_view name, std::string_view field,
                        const FieldValue& value) const {
        StatusValue level = valueOf(name, field, value);
        level.grade =
            std::isfinite(value.number) ? qualityOf(_profile, field, value.number) : std::nullopt;
        return level;
    }
    const FieldValue* find(std::string_view field) const {
        const FieldValue* value = field.empty() ? nullptr : _values.value(field);
        return value != nullptr && tells(*value) ? value : nullptr;
    }

    bool holds(const StatusCondition& condition) const {
        const FieldValue* value =
            condition.field.empty() ? nullptr : _values.value(condition.field);
        return condition.field.empty() ||
               condition.text == (value != nullptr ? value->text() : std::string());
    }
    bool holds(const StatusCondition& condition, const EntryValues& entry) const {
        return condition.field.empty() ||
               std::any_of(entry.values.begin(), entry.values.end(), [&](const auto& held) {
                   return _fields[held.first].name == condition.field &&
                          held.second.text() == condition.text;
               });
    }
    /// The value of a field, of the display or of one entry of a list; null if there is none.
    using Find = std::function<const FieldValue*(std::string_view field)>;

    void addCell(const StatusCellFields& rule);
    void addCellsOfList(const StatusCellFields& rule);
    void keep(StatusCell cell);
    void addFields(StatusCell& cell, const StatusCellFields& rule, const Find& find) const;
    static void addLevel(StatusCell& cell, StatusValue level);
    void addChannel(StatusCell& cell, const StatusCellFields& rule, const FieldValue* band) const;
    void addList(StatusCell& cell, const StatusCellFields& rule, const StatusList& list);
    /// The values of an entry, as "PCI" and "252".
    std::vector<std::pair<std::string, std::string>> namesOf(const StatusList& list,
                                                             const EntryValues& entry) const;
    void addNeighbour(StatusNeighbour neighbour);
    void addStatesAndContexts();

    const CurrentValues& _values;
    const FieldTable& _fields;
    const QualityProfile& _profile;
    Status _status;
};

bool isNamed(const std::vector<StatusValue>& values, std::string_view name) {
    return std::any_of(values.begin(), values.end(),
                       [name](const StatusValue& value) { return value.name == name; });
}

void Gathering::addCell(const StatusCellFields& rule) {
    StatusCell cell;
    cell.system = rule.name;
    if (holds(rule.only)) {
        addFields(cell, rule, [this](std::string_view field) { return find(field); });
    }
    for (const StatusList& list : rule.lists) {
        addList(cell, rule, list);
    }
    keep(std::move(cell));
}

void Gathering::addCellsOfList(const StatusCellFields& rule) {
    _values.forEachEntry([&](const EntryValues& entry) {
        if (!holds(rule.only, entry)) {
            return;
        }
        StatusCell cell;
        cell.system = rule.name;
        addFields(cell, rule, [&](std::string_view name) -> const FieldValue* {
            const auto field = _fields.named(name);
            const FieldValue* value = field ? entry.value(*field) : nullptr;
            return value != nullptr && tells(*value) ? value : nullptr;
        });
        for (StatusValue& level : cell.levels) {
            level.entry = _values.entries().words(entry.entry);
        }
        keep(std::move(cell));
    });
}

void Gathering::keep(StatusCell cell) {
    if (!cell.identity.empty() || cell.channel || !cell.levels.empty()) {
        _status.cells.push_back(std::move(cell));
    }
}

void Gathering::addFields(StatusCell& cell, const StatusCellFields& rule, const Find& find) const {
    const FieldValue* band = nullptr;
    for (const StatusField& field : rule.fields) {
        const FieldValue* value = find(field.field);
        if (value == nullptr) {
            continue;
        }
        switch (field.role) {
        case Role::Site:
        case Role::Identity:
            if (!isNamed(cell.identity, field.name)) {
                cell.site = field.role == Role::Site ? siteOf(rule.system, *value) : cell.site;
                cell.identity.push_back(identityOf(field, *value));
            }
            break;
        case Role::Channel:
            if (!cell.channel) {
                cell.channel = identityOf(field, *value);
            }
            break;
        case Role::Uplink:
            cell.details.push_back(std::string(field.name) + " " + uplinkText(rule.system, *value));
            break;
        case Role::Band:
            band = value;
            break;
        case Role::Detail:
            if (tells(*value)) {
                cell.details.push_back(std::string(field.name) + " " + value->text());
            }
            break;
        case Role::Level:
            addLevel(cell, levelOf(field.name, field.field, *value));
            break;
        }
    }
    addChannel(cell, rule, band);
}

/// Of levels with the same name, the one that was read last counts.
void Gathering::addLevel(StatusCell& cell, StatusValue level) {
    const auto same =
        std::find_if(cell.levels.begin(), cell.levels.end(),
                     [&level](const StatusValue& other) { return other.name == level.name; });
    if (same == cell.levels.end()) {
        cell.levels.push_back(std::move(level));
    } else if (same->read < level.read) {
        *same = std::move(level);
    }
}

void Gathering::addChannel(StatusCell& cell, const StatusCellFields& rule,
                           const FieldValue* band) const {
    const auto number = cell.channel ? wholeNumber(cell.channel->number) : std::nullopt;
    if (!number) {
        return;
    }
    cell.band = bandText(rule.system, *number);
    cell.megahertz = megahertz(rule.system, *number);
    if (band == nullptr) {
        return;
    }
    cell.band = bandNumber(band->text());
    for (const Carrier& carrier : carriersOf(rule.system, *number)) {
        if (carrier.band == cell.band && carrier.downlink) {
            constexpr double kHertz = 1e6;
            cell.megahertz = static_cast<double>(carrier.downlink->hertz) / kHertz;
            return;
        }
    }
}

std::vector<std::pair<std::string, std::string>>
Gathering::namesOf(const StatusList& list, const EntryValues& entry) const {
    std::vector<std::pair<std::string, std::string>> names;
    if (list.identity.empty()) {
        const std::string& words = _values.entries().words(entry.entry); // "PN 117"
        const std::size_t blank = words.find(' ');
        names.emplace_back(words.substr(0, blank),
                           words.substr(std::min(blank, words.size() - 1) + 1));
        return names;
    }
    for (const StatusField& part : list.identity) {
        for (const auto& [field, value] : entry.values) {
            if (_fields[field].name == part.field && tells(value)) {
                names.emplace_back(part.name, identityText(value));
            }
        }
    }
    return names;
}

/// Whether the cell has the same values under these names. It must have the first; any other that
/// it lacks does not count.
bool isSame(const StatusCell& cell, const std::vector<std::pair<std::string, std::string>>& names) {
    bool hasFirst = false;
    for (const auto& [name, text] : names) {
        const auto isPart = [&name = name](const StatusValue& part) { return part.name == name; };
        const auto part = std::find_if(cell.identity.begin(), cell.identity.end(), isPart);
        const StatusValue* own = part != cell.identity.end() ? &*part : nullptr;
        own = own == nullptr && cell.channel && isPart(*cell.channel) ? &*cell.channel : own;
        if (own != nullptr && own->text != text) {
            return false;
        }
        hasFirst = hasFirst || (own != nullptr && &name == &names.front().first);
    }
    return hasFirst;
}

void Gathering::addList(StatusCell& cell, const StatusCellFields& rule, const StatusList& list) {
    const auto level = _fields.named(list.level);
    if (!level) {
        return;
    }
    _values.forEachEntry([&](const EntryValues& entry) {
        for (const auto& [field, value] : entry.values) {
            if (field != *level || !tells(value) || !holds(list.only, entry)) {
                continue;
            }
            const auto names = namesOf(list, entry);
            const bool isServing = list.servingMark.empty()
                                       ? isSame(cell, names)
                                       : value.text().starts_with(list.servingMark);
            StatusValue measured = levelOf(list.levelName, list.level, value);
            measured.entry = _values.entries().words(entry.entry);
            if (isServing) {
                const std::size_t mark = list.servingMark.size();
                measured.text.erase(0, mark + (mark > 0 ? 1 : 0)); // and its blank
                addLevel(cell, std::move(measured));
                continue;
            }
            std::string words;
            for (const auto& [name, text] : names) {
                words.append(words.empty() ? "" : " ").append(name).append(" ").append(text);
            }
            addNeighbour({std::string(rule.name), std::move(words), std::move(measured)});
        }
    });
}

/// Of a cell that is in several lists, the latest level counts.
void Gathering::addNeighbour(StatusNeighbour neighbour) {
    const auto same = std::find_if(
        _status.neighbours.begin(), _status.neighbours.end(), [&](const StatusNeighbour& other) {
            return other.system == neighbour.system && other.cell == neighbour.cell;
        });
    if (same == _status.neighbours.end()) {
        _status.neighbours.push_back(std::move(neighbour));
    } else if (same->level.read < neighbour.level.read) {
        *same = std::move(neighbour);
    }
}

void Gathering::addStatesAndContexts() {
    for (const EventFields& rule : eventFields()) {
        if (rule.technology != _fields.technology()) {
            continue;
        }
        const std::string_view name = rule.fields.front();
        const FieldValue* value = _values.value(name);
        if (rule.watch == EventFields::Watch::State && value != nullptr) {
            _status.states.push_back(valueOf(rule.subject, name, *value));
        } else if (rule.watch == EventFields::Watch::Contexts) {
            _values.forEachEntry([&](const EntryValues& entry) {
                for (const auto& [field, held] : entry.values) {
                    if (_fields[field].name == name) {
                        const DictionaryRef keys = held.shown.dictionary();
                        const PropertyList* state = keys ? keys->find("State") : nullptr;
                        _status.contexts.push_back(
                            {contextName(held.shown),
                             state != nullptr ? state->string().value_or("") : ""});
                    }
                }
            });
        }
    }
}

} // namespace

Status statusOf(const CurrentValues& values, Time time, const NetworkNames& names,
                const QualityProfile& profile) {
    return Gathering(values, time, profile).status(names);
}

} // namespace pallax
