#include "web/Metrics.h"

#include "overview/StatusWords.h"
#include "text/Format.h"

#include <algorithm>
#include <array>
#include <charconv>
#include <chrono>
#include <map>
#include <utility>
#include <vector>

namespace pallax {

namespace {

using Labels = std::vector<std::pair<std::string, std::string>>;

/// "RSRP" as a part of a name: "rsrp".
std::string nameOfText(std::string_view text) {
    std::string name;
    for (const char each : text) {
        const bool isUpper = each >= 'A' && each <= 'Z';
        const bool isKept = (each >= 'a' && each <= 'z') || (each >= '0' && each <= '9');
        if (isUpper || isKept) {
            name += isUpper ? static_cast<char>(each - 'A' + 'a') : each;
        } else if (!name.empty() && name.back() != '_') {
            name += '_';
        }
    }
    return name;
}

std::string numberText(double number) {
    std::array<char, 32> digits{};
    const auto result = std::to_chars(digits.data(), digits.data() + digits.size(), number);
    return {digits.data(), result.ptr};
}

void appendLabelValue(std::string& out, std::string_view value) {
    for (const char each : value) {
        if (each == '\\' || each == '"') {
            out += '\\';
        }
        out += each == '\n' ? "\\n" : std::string(1, each);
    }
}

/// Samples of one name, which must stand together.
struct Family {
    std::string type;
    std::string unit; ///< the end of the name; empty if there is none
    std::string help;
    std::string samples = {};
};

/// The families by name; that of a counter is without "_total".
class Families {
public:
    void add(const std::string& name, const Family& family, const Labels& labels, double value) {
        Family& into = _all.try_emplace(name, family).first->second;
        into.samples += name;
        into.samples += family.type == "counter" ? "_total" : "";
        for (std::size_t index = 0; index < labels.size(); ++index) {
            into.samples += index == 0 ? "{" : ",";
            into.samples += labels[index].first + "=\"";
            appendLabelValue(into.samples, labels[index].second);
            into.samples += '"';
        }
        into.samples += labels.empty() ? " " : "} ";
        into.samples += numberText(value) + '\n';
    }
    std::string text(MetricsForm form) const {
        const bool isOpen = form == MetricsForm::OpenMetrics;
        std::string out;
        for (const auto& [name, family] : _all) {
            const std::string named = family.type == "counter" && !isOpen ? name + "_total" : name;
            out += formatText("# HELP %@ %@\n# TYPE %@ %@\n",
                              {named, family.help, named, family.type});
            if (isOpen && !family.unit.empty()) {
                out += formatText("# UNIT %@ %@\n", {named, family.unit});
            }
            out += family.samples;
        }
        return out + (isOpen ? "# EOF\n" : "");
    }

private:
    std::map<std::string, Family> _all;
};

/// "-94.50 dBm" has the unit "dbm".
std::string unitOf(const StatusValue& level) {
    const std::size_t space = level.text.find(' ');
    return space == std::string::npos ? "" : nameOfText(level.text.substr(space + 1));
}

void addLevel(Families& to, const StatusCell& cell, const StatusValue& level,
              const std::string& profile) {
    const std::string unit = unitOf(level);
    const std::string name = "pallax_" + nameOfText(level.name) + (unit.empty() ? "" : "_" + unit);
    to.add(name, {"gauge", unit, level.name + " of the serving cell."}, {{"system", cell.system}},
           level.number);
    if (level.grade) {
        to.add("pallax_level_grade",
               {"gauge", "", "Quality of a level: 0 none, 1 poor, 2 fair, 3 good, 4 excellent."},
               {{"system", cell.system}, {"level", level.name}, {"profile", profile}},
               static_cast<double>(*level.grade));
    }
}

void addCell(Families& to, const StatusCell& cell) {
    Labels labels{{"system", cell.system}};
    for (const StatusValue& part : cell.identity) {
        labels.emplace_back(nameOfText(part.name), part.text);
    }
    if (cell.channel) {
        labels.emplace_back(nameOfText(cell.channel->name), cell.channel->text);
    }
    if (!cell.band.empty()) {
        labels.emplace_back("band", cell.band);
    }
    to.add("pallax_cell_info", {"gauge", "", "The serving cell."}, labels, 1);
}

void addRadio(Families& to, const Status& status) {
    for (const StatusCell& cell : status.cells) {
        addCell(to, cell);
        for (const StatusValue& level : cell.levels) {
            if (!isOld(status.time, level)) {
                addLevel(to, cell, level, status.profile);
            }
        }
    }
    for (const StatusValue& state : status.states) {
        to.add("pallax_state_info", {"gauge", "", "A state of the protocols."},
               {{"name", state.name}, {"state", state.text}}, 1);
    }
    to.add("pallax_neighbours", {"gauge", "", "Neighbour cells with a current level."}, {},
           static_cast<double>(
               std::count_if(status.neighbours.begin(), status.neighbours.end(),
                             [&](const auto& each) { return !isOld(status.time, each.level); })));
}

void addCounts(Families& to, const SessionCounts& counts) {
    to.add("pallax_connected", {"gauge", "", "Whether packets of the modem can come: 1 or 0."}, {},
           counts.isConnected ? 1 : 0);
    to.add("pallax_packets", {"counter", "", "Packets that have come."}, {},
           static_cast<double>(counts.packets));
    to.add("pallax_packets_dropped",
           {"counter", "", "Packets that are no longer kept, to bound memory and disk."}, {},
           static_cast<double>(counts.forgotten));
    to.add("pallax_viewers", {"gauge", "", "Pages that follow the session."}, {},
           static_cast<double>(counts.viewers));
    if (counts.latest) {
        to.add("pallax_latest_packet_timestamp_seconds",
               {"gauge", "seconds", "Time of the latest packet, since 1970."}, {},
               std::chrono::duration<double>(counts.latest->time_since_epoch()).count());
    }
}

} // namespace

MetricsForm metricsFormFor(std::string_view accept) {
    return accept.find("application/openmetrics-text") != std::string_view::npos
               ? MetricsForm::OpenMetrics
               : MetricsForm::Prometheus;
}

std::string metricsType(MetricsForm form) {
    return form == MetricsForm::OpenMetrics
               ? "application/openmetrics-text; version=1.0.0; charset=utf-8"
               : "text/plain; version=0.0.4; charset=utf-8";
}

std::string metricsText(const std::optional<Status>& status, const SessionCounts& counts,
                        MetricsForm form) {
    Families families;
    addCounts(families, counts);
    if (status) {
        addRadio(families, *status);
    }
    return families.text(form);
}

} // namespace pallax
