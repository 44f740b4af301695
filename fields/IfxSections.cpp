#include "fields/IfxSections.h"

#include <utility>

namespace pallax {

namespace {

SectionReference keys(std::string name, std::string_view meaning,
                      std::vector<ObjectKey> objectKeys) {
    const std::string path = "/" + name;
    return {std::move(name), path, false, {}, meaning, std::move(objectKeys)};
}

SectionReference list(std::string name, std::string_view meaning,
                      std::vector<ObjectKey> objectKeys) {
    SectionReference section = keys(std::move(name), meaning, std::move(objectKeys));
    section.isList = true;
    return section;
}

constexpr std::string_view kBsic =
    "Base station identity code: network colour code, base station colour code.";

constexpr std::string_view kDbm = "dBm";
constexpr std::string_view kDb = "dB";

ObjectKey identifying(std::string name, std::string_view meaning) {
    return {std::move(name), meaning, true};
}
ObjectKey personal(std::string name, std::string_view meaning) {
    return {std::move(name), meaning, false, true};
}
ObjectKey measured(std::string name, std::string_view meaning, std::string_view unit) {
    return {std::move(name), meaning, false, false, unit};
}

/// What a modem that ModemManager watches tells of a cell; in a list, some keys identify the entry.
void addCellKeys(std::vector<ObjectKey>& objectKeys, bool isList) {
    const std::vector<ObjectKey> cell{
        {"Technology", "The cell's system: GSM, UMTS, TD-SCDMA, LTE, NR or CDMA."},
        {"Operator Code", "Country and network code of the cell's network."},
        {"TAC", "Code of the tracking area that the cell belongs to."},
        {"UARFCN", "Channel of a UMTS cell.", isList},
        {"EARFCN", "Channel of an LTE cell.", isList},
        {"NR-ARFCN", "Channel of an NR cell.", isList},
        {"Scrambling Code", "Primary scrambling code of a UMTS cell.", isList},
        {"Cell Parameter ID", "Code of a TD-SCDMA cell.", isList},
        {"Physical Cell ID", "Physical cell identity of an LTE or NR cell.", isList},
        {"Base Station ID", "Identity of a CDMA base station."},
        {"SID", "CDMA system that the cell belongs to."},
        {"NID", "CDMA network that the cell belongs to."},
        {"PN", "Pilot offset of a CDMA cell.", isList},
        measured("RSRP", "Reference signal received power of an LTE or NR cell.", kDbm),
        measured("RSRQ", "Reference signal received quality of an LTE or NR cell.", kDb),
        measured("SINR", "Signal to interference and noise ratio of an LTE or NR cell.", kDb),
        measured("RSCP", "Received signal code power of a UMTS cell.", kDbm),
        measured("Ec/Io", "Chip energy of a UMTS or CDMA cell over all that is received.", kDb),
        measured("RSSI", "All that is received on the cell's carrier.", kDbm),
        measured("Path Loss", "Path loss of a UMTS cell.", kDb),
        {"Bandwidth", "Width of the cell's carrier, in MHz or resource blocks."},
    };
    objectKeys.insert(objectKeys.end(), cell.begin(), cell.end());
}

std::vector<ObjectKey> cellKeys(std::vector<ObjectKey> objectKeys, bool isList) {
    addCellKeys(objectKeys, isList);
    return objectKeys;
}

/// The keys of a cell of GSM, which other IFX modems tell, too.
std::vector<ObjectKey> gsmKeys() {
    return {identifying("ARFCN", "ARFCN of the cell's BCCH carrier."),
            identifying("BSIC", kBsic),
            {"LAC", "Code of the location area that the cell belongs to."},
            {"Cell ID", "Identity of the cell in its network or area."},
            {"Rx Level", "Receive level of a GSM cell."},
            {"Timing Advance", "Timing advance, in steps of the cell's system."}};
}

/// The further sections of a modem that ModemManager watches.
std::vector<SectionReference> modemSections() {
    std::vector<ObjectKey> levels{
        measured("Quality", "Signal quality as ModemManager rates it.", "%"),
        {"Recent", "Whether the quality was taken recently."},
        {"Levels", "Why there are no levels."}};
    for (const auto& [name, unit] :
         {std::pair("GSM RSSI", kDbm), std::pair("UMTS RSSI", kDbm), std::pair("UMTS RSCP", kDbm),
          std::pair("UMTS Ec/Io", kDb), std::pair("LTE RSSI", kDbm), std::pair("LTE RSRP", kDbm),
          std::pair("LTE RSRQ", kDb), std::pair("LTE SINR", kDb), std::pair("NR RSRP", kDbm),
          std::pair("NR RSRQ", kDb), std::pair("NR SINR", kDb), std::pair("1x RSSI", kDbm),
          std::pair("1x Ec/Io", kDb), std::pair("EV-DO RSSI", kDbm), std::pair("EV-DO Ec/Io", kDb),
          std::pair("EV-DO SINR", kDb), std::pair("EV-DO Io", kDbm)}) {
        levels.push_back(measured(name, "Level of that system's serving cell.", unit));
    }
    return {
        keys("Registration", "The registration with a network.",
             {{"State",
               "State of the registration; without a modem, the reason.",
               false,
               false,
               {},
               {"home", "roaming", "registered", "home, SMS only", "roaming, SMS only",
                "home, CSFB not preferred", "roaming, CSFB not preferred", "emergency only",
                "restricted local operator services", "idle", "searching", "denied", "unknown",
                "no modem", "unplugged", "no system bus", "ModemManager is not running",
                "ModemManager does not answer"}},
              {"Technology", "Radio technologies in use."},
              {"Operator", "Name of the network."},
              {"Operator Code", "Country and network code of the network."},
              {"LAC", "Code of the location area."},
              {"TAC", "Code of the tracking area."},
              {"Cell ID", "Identity of the serving cell in its network."},
              {"1x", "State of the CDMA 1x registration."},
              {"EV-DO", "State of the EV-DO registration."},
              {"SID", "CDMA system."},
              {"NID", "CDMA network."},
              {"Packet Service", "Whether packet service is attached."},
              {"Rejection", "Cause with which the network rejected the registration."}}),
        keys("Signal", "Signal quality and the levels of each system in use.", std::move(levels)),
        list("Further Serving Cells", "Cells that serve beside the serving cell.",
             cellKeys(gsmKeys(), true)),
        list("Data Connections", "Data connections of the modem.",
             {{"State", "Connected, not connected or suspended."},
              {"Type", "Default, initial (made when attaching) or dedicated."},
              {"Interface", "Network interface of the connection."},
              {"APN", "Access point name."},
              {"IP Type", "IP versions of the connection."},
              measured("Duration", "Time since it was connected.", "s"),
              measured("Received", "Bytes received since it was connected.", "bytes"),
              measured("Sent", "Bytes sent since it was connected.", "bytes")}),
        keys("SIM", "The SIM card in use.",
             {{"State", "Ready, locked or none."},
              {"Active", "Whether the card is in use."},
              {"Lock", "What must be entered to unlock it."},
              {"Operator", "Name of the card's network."},
              {"Operator Code", "Country and network code of the card's network."},
              personal("IMSI", "International mobile subscriber identity."),
              personal("ICCID", "Number of the card."),
              personal("EID", "Number of the embedded card.")}),
        keys("Modem", "The modem itself.",
             {{"State", "State of the modem; if it is missing, the reason."},
              {"Model", "Model of the modem."},
              {"Manufacturer", "Its maker."},
              {"Revision", "Revision of its firmware."},
              {"Failure", "Why it failed."},
              {"Power", "State of its power supply."},
              {"Plugin", "ModemManager's plugin for it."},
              {"Port", "Its port."},
              personal("Equipment ID", "Number of the device."),
              personal("IMEI", "International mobile equipment identity."),
              personal("MEID", "Mobile equipment identifier."),
              personal("ESN", "Electronic serial number."),
              personal("Own Number", "Telephone number of the card.")}),
    };
}

} // namespace

std::vector<SectionReference> ifxSections(const Resources& /*resources*/) {
    std::vector<SectionReference> sections{
        keys("Network", "The network that the phone is registered with, or \"No\".",
             {{"Name", "Name of the network."},
              {"MCC", "Mobile country code."},
              {"MNC", "Mobile network code."}}),
        keys("RR", "State of the radio resource layer.", {}),
        keys("Serving Cell", "The serving cell.",
             cellKeys({{"ARFCN", "ARFCN of the cell's BCCH carrier."},
                       {"BSIC", kBsic},
                       {"Rx Level", "Receive level of the cell."},
                       {"C1", "Path loss criterion C1 of cell selection."},
                       {"Area", "Where the cell belongs: location area and cell identity."},
                       {"LAC", "Code of the location area that the cell belongs to."},
                       {"Cell ID", "Identity of the cell in its location area."},
                       {"Source", "What tells of the cell, or why nothing does."},
                       {"Cell Information", "Why only the location tells of the cell."},
                       {"Timing Advance", "Timing advance, in steps of the cell's system."}},
                      false)),
        list("Neighbour Cells",
             "The neighbours; an entry whose identity code has not been read is only the ARFCN.",
             cellKeys({{"ARFCN", "ARFCN of the neighbour's BCCH carrier.", true},
                       {"BSIC", kBsic, true},
                       {"Rx Level", "Receive level of the neighbour."},
                       {"LAC", "Code of the location area that the cell belongs to."},
                       {"Cell ID", "Identity of the cell in its network or area."},
                       {"Timing Advance", "Timing advance, in steps of the cell's system."}},
                      true)),
        keys("Dedicated Channel", "The dedicated channel of a call; empty without one.",
             {{"Channel", "Type of the channel."},
              {"Time Slot", "Time slot of the channel, 0 to 7."},
              {"Timing Advance", "Timing advance, in bit periods."},
              {"Rx Quality", "Receive quality, 0 (best) to 7."},
              {"Tx Power", "Transmit power of the phone."},
              {"Hopping", "ARFCNs that the channel hops over."}}),
        list("Barred Cells", "ARFCNs of barred cells.", {}),
    };
    for (SectionReference& section : modemSections()) {
        sections.push_back(std::move(section));
    }
    return sections;
}

} // namespace pallax
