#include "fields/Meanings.h"

#include <array>

namespace pallax {

namespace {

constexpr std::string_view kRrc = "RRC Info";
constexpr std::string_view kServing = "Serving Cell Info";
constexpr std::string_view kNeighbors = "Neighbor Cell List";
constexpr std::string_view kGsmNeighbors = "GSM Neighbor Cell List";
constexpr std::string_view kBler = "TRCH BLER";
constexpr std::string_view kSir = "CCTRCH SIR";

// clang-format off
constexpr auto kMeanings = std::to_array<Meaning>({
    {kRrc, "", "State of the radio resource control."},
    {kRrc, "State", "State of the RRC connection."},

    {kServing, "", "Identity, carrier and access rules of the serving cell."},
    {kServing, "Cell Access Restrictions", "Access restrictions of the cell, as one number; the meaning of the values is not known."},
    {kServing, "Cell ID", "Identity of the serving cell."},
    {kServing, "Downlink UARFCN", "UARFCN of the downlink carrier."},
    {kServing, "Uplink UARFCN", "UARFCN of the uplink carrier."},
    {kServing, "URA ID", "Identity of the UTRAN registration area."},
    {kServing, "Allowed Access", "Whether the cell accepts all calls or emergency calls only."},
    {kServing, "Local Area Code", "Code of the location area that the cell belongs to."},
    {kServing, "Freq Band Indicator", "Number of the operating band."},
    {kServing, "Cell Scrambling Code", "Scrambling code of the serving cell."},

    {kNeighbors, "", "The UTRAN neighbours."},
    {kNeighbors, "UARFCN", "UARFCN of the neighbour."},
    {kNeighbors, "Cell ID", "Identity of the neighbour for the modem, 7 bits; not the network's cell identity."},
    {kNeighbors, "Filter RSCP", "Received signal code power after the filter, as the modem counts it; its unit is not known."},
    {kNeighbors, "Status", "Set that the cell belongs to: active (ASET), monitored (MSET) or detected (DSET)."},
    {kNeighbors, "inJDCS", "Whether the cell is in the JDCS; the record gives only the name."},

    {kGsmNeighbors, "", "The GSM neighbours; they are read but not displayed, so the list stays empty."},
    {kGsmNeighbors, "Cell ID", "Number of the neighbour in the record, 14 bits."},
    {kGsmNeighbors, "Band Indicator", "Band of the ARFCN, where bands share channel numbers."},
    {kGsmNeighbors, "BSIC Valid", "Whether the base station identity code has been read."},
    {kGsmNeighbors, "NCC", "Network colour code."},
    {kGsmNeighbors, "BCC", "Base station colour code."},
    {kGsmNeighbors, "ARFCN", "ARFCN of the neighbour."},
    {kGsmNeighbors, "RSSI", "Received signal strength of the neighbour, as the modem counts it."},

    {kBler, "", "Block errors of the transport channels."},
    {kBler, "TRCH ID", "Identity of the transport channel."},
    {kBler, "TRCH BLER Measurement", "Block error rate of the transport channel, as the modem counts it."},

    {kSir, "", "Signal-to-interference ratios of the coded composite transport channels."},
    {kSir, "CCTRCH ID", "Identity of the coded composite transport channel."},
    {kSir, "TSNUM", "Number of time slots, or of the time slot: the record gives only the name."},
    {kSir, "SIR", "Six signal-to-interference ratios, as the modem counts them."},
});

constexpr auto kCodeNames = std::to_array<CodeName>({
    {0xD00A, "Measurement of the UTRAN neighbours"},
    {0xD00C, "Quality of the transport channels"},
    {0xD00E, "Measurement of the GSM neighbours"},
    {0xD0E0, "State of the RRC connection"},
    {0xD0E2, "Serving cell"},
});
// clang-format on

} // namespace

Meanings utranMeanings() {
    return {kMeanings, kCodeNames};
}

} // namespace pallax
