#include "fields/Meanings.h"

#include <array>

namespace pallax {

namespace {

constexpr std::string_view kServing = "Serving Cell Info";
constexpr std::string_view kServingMeasurements = "Serving Cell Measurements";
constexpr std::string_view kConnected = "Connected mode LTE Intra-frequency Measurement";
constexpr std::string_view kMeasured = "Measured Neighbor Cells";
constexpr std::string_view kDetected = "Detected Cells";
constexpr std::string_view kNeighborMeasurements = "Neighbor Measurements";
constexpr std::string_view kNeighborCells = "Neighbor Cells List";
constexpr std::string_view kCandidates = "Reselection Candidates";
constexpr std::string_view kCandidatesList = "Reselection Candidates List";

// clang-format off
constexpr auto kMeanings = std::to_array<Meaning>({
    {kServing, "", "Identity, carrier and antennas of the serving cell."},
    {kServing, "Physical Cell ID", "Physical cell identity of the serving cell, 0 to 503."},
    {kServing, "Download Frequency", "EARFCN of the downlink carrier."},
    {kServing, "Upload Frequency", "EARFCN of the uplink carrier."},
    {kServing, "Download Bandwidth", "Channel bandwidth of the downlink, reported in resource blocks."},
    {kServing, "Upload Bandwidth", "Channel bandwidth of the uplink, reported in resource blocks."},
    {kServing, "Cell Identity", "E-UTRAN cell identity, 28 bits: the eNodeB and the cell in it."},
    {kServing, "Tracking Area Code", "Code of the tracking area that the cell belongs to."},
    {kServing, "Freq Band Indicator", "Number of the E-UTRA operating band."},
    {kServing, "Num Tx Antennas", "Number of transmit antenna ports of the cell."},
    {kServing, "UARFCN", "Channel number that the telephony service gives for the serving cell."},

    {kServingMeasurements, "", "Idle-mode measurement of the serving cell and the parameters of its cell selection."},
    {kServingMeasurements, "Version", "Version of the log record's layout."},
    {kServingMeasurements, "E-ARFCN", "EARFCN of the serving cell's downlink."},
    {kServingMeasurements, "Physical Cell ID", "Physical cell identity of the serving cell."},
    {kServingMeasurements, "Serving Layer Priority", "Reselection priority of the serving frequency, 0 to 7, 7 being the highest."},
    {kServingMeasurements, "Measured RSRP", "Reference signal received power of the serving cell, as last measured."},
    {kServingMeasurements, "Average RSRP", "Reference signal received power of the serving cell, averaged."},
    {kServingMeasurements, "Measured RSRQ", "Reference signal received quality of the serving cell, as last measured."},
    {kServingMeasurements, "Average RSRQ", "Reference signal received quality of the serving cell, averaged."},
    {kServingMeasurements, "Measured RSSI", "Received signal strength over the carrier's whole bandwidth."},
    {kServingMeasurements, "Qrxlevmin", "Least RSRP that the cell demands of a phone which camps on it."},
    {kServingMeasurements, "P_Max", "Largest transmit power that the cell allows."},
    {kServingMeasurements, "Max UE Tx Power", "Largest transmit power that the phone may use here."},
    {kServingMeasurements, "Srxlev", "Cell-selection receive level: by how much the level exceeds what the cell demands."},
    {kServingMeasurements, "Num of Consecutive DRX Cycles of S < 0", "Number of consecutive DRX cycles in which the selection criterion S was not met."},
    {kServingMeasurements, "S Intra Search", "Srxlev below which cells of the same frequency are measured."},
    {kServingMeasurements, "S Non Intra Search", "Srxlev below which other frequencies and technologies are measured."},
    {kServingMeasurements, "Measurement Rules Updated", "Whether the measurement rules have changed."},
    {kServingMeasurements, "Measurement Rules", "Number of the measurement rules that are in force; the meaning of the values is not known."},

    {kConnected, "", "The serving cell in connected mode."},
    {kConnected, "E-ARFCN", "EARFCN of the measured frequency, which is the serving one."},
    {kConnected, "Serving Physical Cell ID", "Physical cell identity of the serving cell."},
    {kConnected, "Subframe Number", "Number of the subframe in which it was measured."},
    {kConnected, "Serving Filtered RSRP", "Reference signal received power of the serving cell after the layer 3 filter."},
    {kConnected, "Serving Filtered RSRQ", "Reference signal received quality of the serving cell after the layer 3 filter."},

    {kMeasured, "", "The neighbours on the serving frequency that are measured in connected mode."},
    {kMeasured, "Physical Cell ID", "Physical cell identity of the neighbour."},
    {kMeasured, "Filtered RSRP", "Reference signal received power of the neighbour after the layer 3 filter."},
    {kMeasured, "Filtered RSRQ", "Reference signal received quality of the neighbour after the layer 3 filter."},

    {kDetected, "", "The cells on the serving frequency that are detected in connected mode, but not measured."},
    {kDetected, "Physical Cell ID", "Physical cell identity of the detected cell."},

    {kNeighborMeasurements, "", "What the idle-mode measurement of the neighbours has in common."},
    {kNeighborMeasurements, "Version", "Version of the log record's layout."},
    {kNeighborMeasurements, "E-ARFCN", "EARFCN of the measured frequency."},
    {kNeighborMeasurements, "Qrxlevmin", "Least RSRP that the frequency's cells demand."},

    {kNeighborCells, "", "The neighbours measured in idle mode."},
    {kNeighborCells, "Physical Cell ID", "Physical cell identity of the neighbour."},
    {kNeighborCells, "Measured RSSI", "Received signal strength over the carrier's whole bandwidth."},
    {kNeighborCells, "Measured RSRP", "Reference signal received power of the neighbour, as last measured."},
    {kNeighborCells, "Average RSRP", "Reference signal received power of the neighbour, averaged."},
    {kNeighborCells, "Measured RSRQ", "Reference signal received quality of the neighbour, as last measured."},
    {kNeighborCells, "Average RSRQ", "Reference signal received quality of the neighbour, averaged."},
    {kNeighborCells, "Srxlev", "Cell-selection receive level: by how much the level exceeds what the cell demands."},
    {kNeighborCells, "Frequency Offset", "Frequency offset of the neighbour, as the modem counts it; its unit is not known."},
    {kNeighborCells, "Ant 0 Frame Offset", "Frame timing of the neighbour at antenna 0, as the modem counts it."},
    {kNeighborCells, "Ant 0 Sample Offset", "Sample timing of the neighbour at antenna 0, as the modem counts it."},
    {kNeighborCells, "Ant 1 Frame Offset", "Frame timing of antenna 0 again."},
    {kNeighborCells, "Ant 1 Sample Offset", "Sample timing of antenna 0 again."},

    {kCandidates, "", "The serving cell from which the phone may reselect."},
    {kCandidates, "Version", "Version of the log record's layout."},
    {kCandidates, "Serving EARFCN", "EARFCN of the serving cell's downlink."},
    {kCandidates, "Serving Cell ID", "Physical cell identity of the serving cell."},

    {kCandidatesList, "", "The cells, of any technology, that the phone may reselect to in idle mode."},
    {kCandidatesList, "Candidate Priority", "Reselection priority of the candidate."},
    {kCandidatesList, "Candidate RAT Type", "Radio access technology of the candidate."},
    {kCandidatesList, "E ARFCN", "EARFCN of an LTE candidate."},
    {kCandidatesList, "Cell ID", "Physical cell identity of an LTE candidate."},
    {kCandidatesList, "U ARFCN", "UARFCN of a UTRAN candidate."},
    {kCandidatesList, "PSC", "Primary scrambling code of a UTRAN candidate."},
    {kCandidatesList, "ARFCN", "ARFCN of a GSM candidate."},
    {kCandidatesList, "Band", "Band of a GSM candidate, band class of a CDMA one."},
    {kCandidatesList, "BSIC ID", "Base station identity code of a GSM candidate."},
    {kCandidatesList, "Channel", "Channel number of a CDMA candidate."},
    {kCandidatesList, "Pilot", "PN offset of the pilot of a CDMA candidate."},
});

constexpr auto kCodeNames = std::to_array<CodeName>({
    {0xB0C1, "Antennas of the serving cell"},
    {0xB0C2, "Identity of the serving cell"},
    {0xB179, "Connected-mode intra-frequency measurement"},
    {0xB17F, "Idle-mode measurement of the serving cell"},
    {0xB180, "Idle-mode measurement of the neighbours"},
    {0xB186, "Candidates of the idle-mode reselection"},
});
// clang-format on

} // namespace

Meanings lteMeanings() {
    return {kMeanings, kCodeNames};
}

} // namespace pallax
