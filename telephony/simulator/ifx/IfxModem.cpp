#include "telephony/simulator/ifx/IfxModem.h"

#include "platform/PropertyListCodec.h"
#include "telephony/simulator/Measurement.h"

#include <algorithm>
#include <stdexcept>
#include <string>

namespace pallax {

namespace {

using Phase = Activity::Phase;

constexpr double kNoiseDb = 0.6;
constexpr int kLeastAccessDbm = -105;

/// The modem wraps what has a unit or a name into a dictionary of its own.
PropertyList wrapped(const char* key, std::string value) {
    return Dictionary{{key, std::move(value)}};
}

PropertyList levelOf(int level_dbm) {
    std::string text = std::to_string(level_dbm);
    text.append(" dBm");
    return wrapped("Value", std::move(text));
}

/// "3,5": network and base station colour code.
std::string bsicOf(const Cell& cell) {
    constexpr unsigned kColours = 8;
    std::string text = std::to_string(cell.code / kColours % kColours);
    text.append(",").append(std::to_string(cell.code % kColours));
    return text;
}

const char* stateOf(const Activity& activity) {
    switch (activity.phase()) {
    case Phase::Off:
        return "Off";
    case Phase::Searching:
        return "Cell Selection";
    case Phase::Registering:
    case Phase::Updating:
    case Phase::Connecting:
        return "Connection Establishment";
    case Phase::Connected:
        return "Dedicated";
    case Phase::Releasing:
        return "Connection Release";
    case Phase::Idle:
        break;
    }
    return "Idle";
}

PropertyList servingCell(const Scenario& scenario, Random& random) {
    const RadioLayer& layer = scenario.serving();
    const Cell& cell = layer.campedCell();
    const int level_dbm = whole(measured(layer.campedLevel_dbm(), kNoiseDb, random));
    return Dictionary{{"ARFCN", std::to_string(cell.channel)},
                      {"BSIC", bsicOf(cell)},
                      {"Rx Level", levelOf(level_dbm)},
                      {"C1", std::to_string(level_dbm - kLeastAccessDbm)},
                      {"Area", Dictionary{{"LAC", std::to_string(cell.area)},
                                          {"Cell ID", std::to_string(cell.identity)}}}};
}

/// A header, then the cells; the BSIC of a weak one is not read, and then its channel stands
/// alone.
PropertyList neighbourCells(const Scenario& scenario, Random& random) {
    constexpr int kReadableDbm = -98;
    constexpr std::size_t kMost = 6;
    const RadioLayer& layer = scenario.serving();
    const auto heard = layer.neighbours();
    Array list = {"ARFCN, BSIC, Rx Level"};
    for (const std::size_t index : heard.first(std::min(heard.size(), kMost))) {
        const Cell& cell = layer.cells()[index];
        const int level_dbm = whole(measured(layer.level_dbm(index), kNoiseDb, random));
        if (level_dbm < kReadableDbm) {
            list.push_back(wrapped("ARFCN", std::to_string(cell.channel)));
        } else {
            list.emplace_back(Dictionary{{"ARFCN", std::to_string(cell.channel)},
                                         {"BSIC", bsicOf(cell)},
                                         {"Rx Level", levelOf(level_dbm)}});
        }
    }
    return list;
}

/// Nothing while idle.
PropertyList dedicatedChannel(const Scenario& scenario, Random& random) {
    const Activity& activity = scenario.activity();
    if (!activity.isConnected() && activity.phase() != Phase::Connecting) {
        return Dictionary{};
    }
    constexpr double kPathToPowerDb = -58;
    constexpr double kLeastPowerDbm = 5;
    constexpr double kMostPowerDbm = 33;
    const RadioLayer& layer = scenario.serving();
    const double below_db = layer.total_dbm() - layer.campedLevel_dbm();
    const double power_dbm =
        std::clamp(kPathToPowerDb - layer.campedLevel_dbm(), kLeastPowerDbm, kMostPowerDbm);
    const int quality = std::clamp(whole(below_db + random.normal() / 2), 0, 7);
    Dictionary channel{{"Channel", wrapped("Type", activity.isConnected() ? "TCH/F" : "SDCCH/8")},
                       {"Time Slot", activity.isConnected() ? "3" : "1"},
                       {"Timing Advance", std::to_string(layer.campedLevel_dbm() > -75 ? 1 : 2)},
                       {"Rx Quality", std::to_string(quality)},
                       {"Tx Power", levelOf(whole(power_dbm))}};
    if (activity.isConnected()) {
        constexpr unsigned kHoppingDistance = 9;
        Array hopping = {"MAIO 3, HSN 17"};
        for (unsigned step = 0; step < 4; ++step) {
            hopping.emplace_back(
                std::to_string(layer.campedCell().channel + step * kHoppingDistance));
        }
        channel.set(Text::fixed("Hopping"), std::move(hopping));
    }
    return channel;
}

} // namespace

ScenarioPlan IfxModem::plan() {
    ScenarioPlan plan;
    plan.layers = {{.firstChannel = 11,
                    .channelStep = 4,
                    .channelCount = 25,
                    .codeCount = 64,
                    .firstIdentity = 20817,
                    .identityStep = 11,
                    .firstArea = 6699,
                    .sitesPerSide = 5,
                    .spacing_m = 900,
                    .power_dbm = 42,
                    .least_dbm = -103}};
    return plan;
}

PropertyList IfxModem::picture(const Scenario& scenario, Random& random) {
    const PropertyList registered =
        scenario.activity().isRegistered()
            ? PropertyList(Dictionary{{"Name", "Sample Net"}, {"MCC", "262"}, {"MNC", "42"}})
            : PropertyList("No");
    return Dictionary{
        {"Network", Dictionary{{"Registered", registered}}},
        {"RR", Dictionary{{"State", wrapped("Name", stateOf(scenario.activity()))}}},
        {"Serving Cell", servingCell(scenario, random)},
        {"Neighbour Cells", neighbourCells(scenario, random)},
        {"Dedicated Channel", dedicatedChannel(scenario, random)},
    };
}

/// Nothing: every message tells everything.
void IfxModem::observe(const Scenario& /*scenario*/, RecordQueue& /*queue*/) {}

void IfxModem::report(const Scenario& scenario, Random& random, ByteBuffer& out) {
    constexpr unsigned kFormTurn = 8;
    const PropertyList object = picture(scenario, random);
    if (++_turn % kFormTurn != 0) {
        auto bytes = serializeBinary(object);
        if (!bytes) {
            throw std::logic_error(bytes.error().reason);
        }
        out = std::move(bytes).value();
        return;
    }
    const auto text = serializeXml(object);
    if (!text) {
        throw std::logic_error(text.error().reason);
    }
    out.assign(text->begin(), text->end());
}

} // namespace pallax
