#include "fields/IfxSections.h"

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

} // namespace

std::vector<SectionReference> ifxSections(const Resources& /*resources*/) {
    return {
        keys("Network", "The network that the phone is registered with, or \"No\".",
             {{"Name", "Name of the network."},
              {"MCC", "Mobile country code."},
              {"MNC", "Mobile network code."}}),
        keys("RR", "State of the radio resource layer.", {}),
        keys("Serving Cell", "The serving cell.",
             {{"ARFCN", "ARFCN of the cell's BCCH carrier."},
              {"BSIC", kBsic},
              {"Rx Level", "Receive level of the cell."},
              {"C1", "Path loss criterion C1 of cell selection."},
              {"Area", "Where the cell belongs: location area and cell identity."},
              {"LAC", "Code of the location area that the cell belongs to."},
              {"Cell ID", "Identity of the cell in its location area."}}),
        list("Neighbour Cells",
             "The neighbours; an entry whose identity code has not been read is only the ARFCN.",
             {{"ARFCN", "ARFCN of the neighbour's BCCH carrier.", true},
              {"BSIC", kBsic, true},
              {"Rx Level", "Receive level of the neighbour."}}),
        keys("Dedicated Channel", "The dedicated channel of a call; empty without one.",
             {{"Channel", "Type of the channel."},
              {"Time Slot", "Time slot of the channel, 0 to 7."},
              {"Timing Advance", "Timing advance, in bit periods."},
              {"Rx Quality", "Receive quality, 0 (best) to 7."},
              {"Tx Power", "Transmit power of the phone."},
              {"Hopping", "ARFCNs that the channel hops over."}}),
        list("Barred Cells", "ARFCNs of barred cells.", {}),
    };
}

} // namespace pallax
