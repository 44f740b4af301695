#include "fields/Meanings.h"

#include <array>

namespace pallax {

namespace {

constexpr std::string_view kPlmn = "Serving PLMN";
constexpr std::string_view kEquivalent = "Equivalent PLMN List";
constexpr std::string_view kCo = "Process CO";
constexpr std::string_view kCs = "Process CS";
constexpr std::string_view kPs = "Process PS";
constexpr std::string_view kServing = "GSM Serving Cell";
constexpr std::string_view kRr = "GSM RR Info";
constexpr std::string_view kNeighbors = "Neighboring Cells";
constexpr std::string_view kAllocation = "Mobile Allocation";
constexpr std::string_view kGprs = "GPRS Information";
constexpr std::string_view kUmtsRr = "UMTS RR Info";
constexpr std::string_view kActive = "Active Set";
constexpr std::string_view kUmtsSet = "UMTS Set";
constexpr std::string_view kGsmSet = "GSM Set";
constexpr std::string_view kBler = "BLER";
constexpr std::string_view kHsdpa = "HSDPA Info";

// clang-format off
constexpr auto kMeanings = std::to_array<Meaning>({
    {kPlmn, "", "The network that the phone is on."},
    {kPlmn, "Mobile Country Code", "Mobile country code of the network."},
    {kPlmn, "Mobile Network Code", "Mobile network code of the network."},
    {kPlmn, "Location Area Code", "Code of the location area."},
    {kPlmn, "Routing Area Code", "Code of the routing area in the location area."},
    {kPlmn, "Service Type", "Domains in which the phone has service: circuit-switched (CS), packet-switched (PS)."},
    {kPlmn, "PLMN Sel Mod", "How the network is selected."},

    {kEquivalent, "", "Networks that the current one treats as equivalent."},
    {kEquivalent, "Mobile Country Code", "Mobile country code of the equivalent network."},
    {kEquivalent, "Mobile Network Code", "Mobile network code of the equivalent network."},

    {kCo, "", "Registration and mobility management as Process CS shows them, without sub-state and cause."},
    {kCo, "MM Service State", "State of the registration."},
    {kCo, "MM State", "State of the mobility management entity (MM)."},

    {kCs, "", "State of the mobility management of the circuit-switched domain."},
    {kCs, "MM Service State", "State of the registration."},
    {kCs, "MM State", "State of the mobility management entity (MM)."},
    {kCs, "MM Sub State", "Sub-state of the mobility management entity."},
    {kCs, "LU Reject Cause", "Update status: how the last location update ended."},

    {kPs, "", "State of the mobility management of the packet-switched domain."},
    {kPs, "MM Service State", "State of the registration."},
    {kPs, "MM State", "State of the GPRS mobility management entity (GMM)."},
    {kPs, "MM Sub State", "Sub-state of the GPRS mobility management entity."},
    {kPs, "Attach Reject Cause", "GPRS update status: how the last attach or routing area update ended."},

    {kServing, "", "Identity and levels of the GSM serving cell."},
    {kServing, "Cell ID", "Identity of the cell in its location area."},
    {kServing, "ARFCN", "ARFCN of the cell's BCCH carrier."},
    {kServing, "BSIC", "Base station identity code."},
    {kServing, "RSSI", "Receive level of the serving cell: the byte as it is, so a positive number."},
    {kServing, "C1 Value", "Path loss criterion C1 of cell selection; negative values show as large numbers."},
    {kServing, "C2 Value", "Reselection criterion C2; negative values show as large numbers."},
    {kServing, "MA Dedicated ARFCN", "ARFCN of the dedicated channel, of which the low 8 bits are shown."},

    {kRr, "", "State of the GSM radio resource layer, and its levels."},
    {kRr, "RR State", "State of the radio resource layer."},
    {kRr, "RR Sub State", "Sub-state of the radio resource layer, as a number."},
    {kRr, "RR Status", "Status of the radio resource layer, as a number."},
    {kRr, "RR Mode", "Whether the connection is for voice or for data."},
    {kRr, "Serving Rx Level", "Receive level of the serving cell, as the modem counts it."},
    {kRr, "Rx Quality Full", "Receive quality over all frames; the record holds C1 in the same place."},
    {kRr, "Rx Quality Sub", "Receive quality over the frames that are always sent; the record holds C2 in the same place."},
    {kRr, "DTX Used", "Whether discontinuous transmission is in use."},
    {kRr, "DRX Used", "Discontinuous reception: how long the phone keeps listening."},

    {kNeighbors, "", "The GSM neighbours."},
    {kNeighbors, "ARFCN", "ARFCN of the neighbour's BCCH carrier."},
    {kNeighbors, "RSSI", "Receive level of the neighbour: as the modem counts it, or in dBm from the cell monitor."},
    {kNeighbors, "C1 Value", "Path loss criterion C1 of the neighbour."},
    {kNeighbors, "BSIC", "Base station identity code of the neighbour, where it is known."},

    {kAllocation, "", "The hopping sequence of the serving cell."},
    {kAllocation, "HSN", "Hopping sequence number."},
    {kAllocation, "ARFCNs", "ARFCNs that the channel hops over."},

    {kGprs, "", "Packet-data parameters that the GSM serving cell broadcasts."},
    {kGprs, "Network Control Order", "Who decides on reselection: NC0 the phone, NC1 the phone with reports, NC2 the network."},
    {kGprs, "PFC Supported", "Whether the network supports packet flow contexts."},
    {kGprs, "Priority Access Threshold", "Radio priorities whose packet access is allowed."},
    {kGprs, "Network Operating Mode", "Network mode of operation: how paging of both domains is coordinated."},
    {kGprs, "T3192", "Timer T3192: how long the phone stays on the packet channel after the last block."},
    {kGprs, "Access Burst Type", "Length of the access burst."},
    {kGprs, "DRX Timer Max", "Largest time of non-DRX mode after packet transfer, as the cell broadcasts it."},
    {kGprs, "PBCCH Present", "Whether the cell has a packet broadcast control channel, as a number."},
    {kGprs, "Ext Measurement Order", "Extended measurement order of the network, as a number."},
    {kGprs, "Packet PSI Status", "Whether the network supports the packet PSI status message, as a number."},
    {kGprs, "Packet SI Status", "Whether the network supports the packet SI status message."},
    {kGprs, "Count LR", "A count of the record: it gives only the name."},
    {kGprs, "Count HR", "A count of the record: it gives only the name."},
    {kGprs, "SI13 Position", "On which channel system information 13 is sent."},
    {kGprs, "Cell Reselect Hysteresis", "Whether the reselection hysteresis is applied."},

    {"Coding Scheme", "", "GPRS coding schemes; no log code is known to carry them."},
    {"Cell Change Counters", "", "Counters of cell changes; no log code is known to carry them."},

    {kUmtsRr, "", "State of the UMTS radio link, and the identity of its serving cell."},
    {kUmtsRr, "RRC State", "State of the RRC connection."},
    {kUmtsRr, "Cell ID", "Identity of the serving cell."},
    {kUmtsRr, "Downlink Frequency", "UARFCN of the downlink carrier."},
    {kUmtsRr, "Uplink Frequency", "UARFCN of the uplink carrier."},
    {kUmtsRr, "URA ID", "Identity of the UTRAN registration area."},
    {kUmtsRr, "Ciphering", "Whether the radio link is ciphered."},
    {kUmtsRr, "Transmit Power", "Mean transmit power of the phone."},
    {kUmtsRr, "UARFCN", "UARFCN that the telephony service gives for the serving cell."},
    {kUmtsRr, "Scrambling Code", "Primary scrambling code of the serving cell."},

    {"UMTS RR Measurement", "", "Measurements of the UMTS radio resource layer; no log code is known to carry them."},

    {kActive, "", "The UMTS cells that the phone is connected through."},
    {kActive, "Scrambling Code", "Primary scrambling code of the cell."},
    {kActive, "RSCP", "Received signal code power of the cell's pilot, computed from receiver gain and Ec/Io."},
    {kActive, "Energy Per Chip", "Ec/Io of the cell's pilot: energy per chip over the whole received power."},

    {"Monitored Set", "", "The UMTS cells that the network tells the phone to measure; the list is always empty."},
    {"Detected Set", "", "The UMTS cells that the phone has found by itself; the list is always empty."},
    {"Virtual Active Set", "", "The active set on a frequency that the phone is not on; the list is always empty."},

    {kUmtsSet, "", "The UMTS neighbours: ranked for reselection, or from the cell monitor, whichever came last."},
    {kUmtsSet, "Scrambling Code", "Primary scrambling code of the cell."},
    {kUmtsSet, "RSCP", "Received signal code power of the cell's pilot."},
    {kUmtsSet, "Energy Per Chip", "Ec/No of the cell's pilot: energy per chip over noise."},
    {kUmtsSet, "Downlink Frequency", "UARFCN of the cell's downlink carrier."},
    {kUmtsSet, "Ranking Value", "Rank of the cell in reselection."},
    {kUmtsSet, "Rank Cell RSCP", "Received signal code power by which the cell is ranked."},
    {kUmtsSet, "UARFCN", "UARFCN of the cell."},

    {kGsmSet, "", "The GSM cells that are ranked for reselection."},
    {kGsmSet, "ARFCN", "ARFCN of the cell's BCCH carrier."},
    {kGsmSet, "BSIC", "Base station identity code."},
    {kGsmSet, "RSSI", "Receive level of the cell."},
    {kGsmSet, "Ranking Value", "Rank of the cell in reselection."},

    {"Non-Ranked UMTS Set", "", "The UMTS cells that are not ranked; no log code is known to carry them."},
    {"Non-Ranked GSM Set", "", "The GSM cells that are not ranked; no log code is known to carry them."},

    {kBler, "", "Block errors of the UMTS transport channels."},
    {kBler, "Window Size", "Window over which blocks are counted, as the modem counts it."},
    {kBler, "Transport Channels", "The transport channels."},
    {kBler, "Transport Channel ID", "Identity of the transport channel."},
    {kBler, "CRC Received", "Number of blocks received with a checksum."},
    {kBler, "CRC Received in Error", "Number of those whose checksum was wrong."},

    {kHsdpa, "", "HARQ statistics of the high-speed downlink."},
    {kHsdpa, "Version", "Version of the log record's layout."},
    {kHsdpa, "Sub Frames", "Number of sub-frames that the statistics are over."},
    {kHsdpa, "Carrier Info", "Whether one carrier, two, or MIMO is in use."},
    {kHsdpa, "Primary HARQ Process", "The HARQ processes of the primary carrier or stream."},
    {kHsdpa, "Secondary HARQ Process", "The HARQ processes of the secondary carrier or stream."},
    {kHsdpa, "Process ID", "Number of the HARQ process."},
    {kHsdpa, "No Rx Bits", "Number of bits received."},
    {kHsdpa, "New Tx", "Number of new transmissions, as opposed to repetitions."},
    {kHsdpa, "Block Errors", "Number of block errors."},
});

constexpr auto kCodeNames = std::to_array<CodeName>({
    {0x4005, "Ranking of UMTS and GSM cells"},
    {0x4031, "Transmit power of UMTS"},
    {0x4116, "Block errors of the transport channels"},
    {0x4125, "State of the RRC connection"},
    {0x4127, "Identity of the UMTS serving cell"},
    {0x4157, "Ciphering of UMTS"},
    {0x417A, "Cells of the UMTS searcher"},
    {0x4221, "HARQ processes of HSDPA"},
    {0x5072, "Discontinuous transmission"},
    {0x5076, "Dedicated channel of GSM"},
    {0x512C, "State of the GSM radio resource layer"},
    {0x5134, "Identity of the GSM serving cell"},
    {0x5137, "Measurement of the GSM serving cell and its neighbours"},
    {0x51F4, "Position of system information 13"},
    {0x51F5, "Packet control parameters"},
    {0x51F6, "Packet timers and discontinuous reception"},
    {0x51F8, "Mobile allocation"},
    {0x51FB, "Packet broadcast channel"},
    {0x51FD, "Extended measurement and packet status"},
    {0x51FF, "Identity codes of the GSM neighbours"},
    {0x7130, "State of GPRS mobility management"},
    {0x7131, "State of mobility management"},
    {0x7132, "State of the registration"},
    {0x7135, "Serving network"},
    {0x7150, "Equivalent networks"},
});
// clang-format on

} // namespace

Meanings gsmMeanings() {
    return {kMeanings, kCodeNames};
}

} // namespace pallax
