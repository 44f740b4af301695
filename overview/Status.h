#pragma once

#include "knowledge/Networks.h"
#include "knowledge/Quality.h"
#include "timeline/CurrentValues.h"

#include <chrono>
#include <optional>
#include <string>
#include <vector>

namespace pallax {

/// A value that was read longer ago is old.
inline constexpr std::chrono::seconds kFresh{10};

/// A value with what a reader wants to know about it.
struct StatusValue {
    std::string name;  ///< "RSRP"
    std::string field; ///< its name in the registry
    std::string text;  ///< "-94.50 dBm"
    double number = 0.0;
    std::optional<Grade> grade; ///< nothing where the profile does not judge the field
    Time read;
    /// A value that was read longer ago is overdue; nothing if it is not known how often it comes.
    std::optional<std::chrono::nanoseconds> patience = {};
    std::string entry = {}; ///< the words of the list's entry that has the value
};

inline bool isOverdue(Time now, const StatusValue& value) {
    return value.patience && now - value.read > *value.patience;
}
/// An overdue value is also old.
inline bool isOld(Time now, const StatusValue& value) {
    return now - value.read > kFresh || isOverdue(now, value);
}

struct StatusCell {
    std::string system;                ///< "LTE"
    std::string site;                  ///< "eNodeB 104470 sector 1"; empty if it is not known
    std::vector<StatusValue> identity; ///< the cell's identity as a number, PCI and so on
    std::optional<StatusValue> channel;
    std::string band; ///< empty if the channel has no meaning
    std::optional<double> megahertz;
    std::vector<StatusValue> levels;
    std::vector<std::string> details = {}; ///< "uplink 1775.0 MHz", "bandwidth 20 MHz"
};

struct StatusNeighbour {
    std::string system;
    std::string cell; ///< "PCI 252"
    StatusValue level;
};

struct StatusOperator {
    std::optional<NetworkCode> code;
    std::string name; ///< empty if it is not known
    std::string country;
    NameSource source = NameSource::Database; ///< of the name
    bool isHome = false; ///< the network of the SIM: the one that serves is not known
};

struct StatusContext {
    std::string name;
    std::string state;
};

/// What a radio does at one time. What it does not tell is empty.
struct Status {
    Time time;
    std::string profile; ///< the name of the profile that grades
    std::optional<StatusOperator> network;
    std::vector<StatusCell> cells; ///< serving ones, of one system or several
    std::vector<StatusValue> states;
    /// Those that were read within `kFresh` first, and of these the strongest first.
    std::vector<StatusNeighbour> neighbours;
    std::vector<StatusContext> contexts;

    bool isEmpty() const {
        return !network && cells.empty() && states.empty() && neighbours.empty() &&
               contexts.empty();
    }
};

/// `time` is that of the values.
Status statusOf(const CurrentValues& values, Time time, const NetworkNames& names,
                const QualityProfile& profile);

} // namespace pallax
