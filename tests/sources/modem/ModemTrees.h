#pragma once

#include "plist/PropertyList.h"
#include "sources/modem/ModemNames.h"

#include <string>
#include <utility>

/// What ModemManager tells of a modem, as the bus gives it.
namespace pallax::doubles {

inline PropertyList number(std::int64_t value) {
    return PropertyList::integer(value);
}
inline PropertyList real(double value) {
    return PropertyList::real(value);
}
inline PropertyList truth(bool value) {
    return PropertyList::boolean(value);
}

/// The properties of an LTE modem that is registered at home.
inline Dictionary lteModem(const char* device = "/sys/devices/usb1", const char* model = "AT-9") {
    return {{"Device", device},
            {"Model", model},
            {"Manufacturer", "Pallax Works"},
            {"Revision", "1.0"},
            {"EquipmentIdentifier", "490154203237518"},
            {"OwnNumbers", Array{"+4915112345678"}},
            {"State", number(8)},
            {"PowerState", number(3)},
            {"AccessTechnologies", number(1 << 14)},
            {"SignalQuality", Array{number(64), truth(true)}},
            {"Sim", "/org/freedesktop/ModemManager1/SIM/0"},
            {"Bearers", Array{}}};
}
inline Dictionary gppAtHome() {
    return {{"Imei", "490154203237518"},
            {"RegistrationState", number(1)},
            {"OperatorName", "SampleNet"},
            {"OperatorCode", "26242"},
            {"PacketServiceState", number(2)}};
}
inline Dictionary levelsOfLte(double rsrp, std::int64_t rate = 0) {
    return {{"Rate", number(rate)}, {"Lte", Dictionary{{"rsrp", real(rsrp)}, {"rsrq", real(-11)}}}};
}
inline Dictionary locationOf(const char* text, bool isSignalled = true) {
    return {{"Capabilities", number(1)},
            {"Enabled", number(1)},
            {"SignalsLocation", truth(isSignalled)},
            {"Location", Dictionary{{"1", text}}}};
}
/// The interfaces of that modem, levels and location included.
inline Dictionary interfacesOfLte(Dictionary modem = lteModem()) {
    Dictionary interfaces;
    interfaces.setFixed(modem_names::kModem, std::move(modem));
    interfaces.setFixed(modem_names::kModem3gpp, gppAtHome());
    interfaces.setFixed(modem_names::kSignal, levelsOfLte(-95));
    interfaces.setFixed(modem_names::kLocation, locationOf("262,42,0,D30156,84CD"));
    return interfaces;
}

/// A cell of GetCellInfo, of LTE and of NR as ModemManager 1.20 gives it over MBIM.
inline Dictionary lteCell(const char* physicalCell, bool isServing) {
    return {{"cell-type", number(5)}, {"serving", truth(isServing)}, {"physical-ci", physicalCell},
            {"earfcn", number(1850)}, {"rsrp", real(-95)},           {"rsrq", real(-10)}};
}

} // namespace pallax::doubles
