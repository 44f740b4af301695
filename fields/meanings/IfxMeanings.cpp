#include "fields/Meanings.h"

#include <array>

namespace pallax {

namespace {

constexpr std::string_view kNetwork = "Network";
constexpr std::string_view kServing = "Serving Cell";
constexpr std::string_view kNeighbours = "Neighbour Cells";
constexpr std::string_view kDedicated = "Dedicated Channel";

// clang-format off
constexpr auto kMeanings = std::to_array<Meaning>({
    {kNetwork, "", "The network that the phone is registered with, or \"No\"."},
    {kNetwork, "Name", "Name of the network."},
    {kNetwork, "MCC", "Mobile country code."},
    {kNetwork, "MNC", "Mobile network code."},

    {"RR", "", "State of the radio resource layer."},

    {kServing, "", "The serving cell."},
    {kServing, "ARFCN", "ARFCN of the cell's BCCH carrier."},
    {kServing, "BSIC", "Base station identity code: network colour code, base station colour code."},
    {kServing, "Rx Level", "Receive level of the cell."},
    {kServing, "C1", "Path loss criterion C1 of cell selection."},
    {kServing, "Area", "Where the cell belongs: location area and cell identity."},
    {kServing, "LAC", "Code of the location area that the cell belongs to."},
    {kServing, "Cell ID", "Identity of the cell in its location area."},

    {kNeighbours, "", "The neighbours; an entry whose identity code has not been read is only the ARFCN."},
    {kNeighbours, "ARFCN", "ARFCN of the neighbour's BCCH carrier."},
    {kNeighbours, "BSIC", "Base station identity code: network colour code, base station colour code."},
    {kNeighbours, "Rx Level", "Receive level of the neighbour."},

    {kDedicated, "", "The dedicated channel of a call; empty without one."},
    {kDedicated, "Channel", "Type of the channel."},
    {kDedicated, "Time Slot", "Time slot of the channel, 0 to 7."},
    {kDedicated, "Timing Advance", "Timing advance, in bit periods."},
    {kDedicated, "Rx Quality", "Receive quality, 0 (best) to 7."},
    {kDedicated, "Tx Power", "Transmit power of the phone."},
    {kDedicated, "Hopping", "ARFCNs that the channel hops over."},

    {"Barred Cells", "", "ARFCNs of barred cells."},
});
// clang-format on

} // namespace

Meanings ifxMeanings() {
    return {kMeanings, {}};
}

} // namespace pallax
