#pragma once

#include "text/Bytes.h"

#include <cstdint>
#include <span>

/// Encoders for the log records of the LTE modem, one for each layout, from values in engineering
/// units. A value that its field cannot hold is replaced by the nearest possible one.
namespace pallax::lte {

/// 0xB0C2: identity, frequencies and bandwidths of the serving cell.
struct ServingCellInfo {
    unsigned physicalCellId;
    unsigned downlinkEarfcn;
    unsigned uplinkEarfcn;
    unsigned downlinkResourceBlocks;
    unsigned uplinkResourceBlocks;
    std::uint32_t cellIdentity;
    unsigned trackingArea;
    unsigned band;
};
void encode(const ServingCellInfo& info, ByteBuffer& out);

/// 0xB0C1: the transmit antennas of the serving cell.
struct AntennaReport {
    unsigned count;
};
void encode(const AntennaReport& report, ByteBuffer& out);

/// 0xB17F: the serving cell in idle mode.
struct IdleServing {
    unsigned earfcn;
    unsigned physicalCellId;
    unsigned layerPriority;
    double rsrp_dbm;
    double averageRsrp_dbm;
    double rsrq_db;
    double averageRsrq_db;
    double rssi_dbm;
    int qrxlevmin_dbm;
    int largestPower_dbm;
    int ownLargestPower_dbm;
    int srxlev_db;
    unsigned cyclesBelow;  ///< consecutive DRX cycles with a negative Srxlev
    int intraSearch_db;    ///< negative: not present
    int nonIntraSearch_db; ///< negative: not present
    bool rulesUpdated;
    unsigned rules;
};
void encode(const IdleServing& serving, ByteBuffer& out);

/// 0xB180: the neighbours in idle mode, 1 to 32 of them.
struct IdleNeighbour {
    unsigned physicalCellId;
    double rssi_dbm;
    double rsrp_dbm;
    double averageRsrp_dbm;
    double rsrq_db;
    double averageRsrq_db;
    int srxlev_db;
    unsigned frequencyOffset;
    unsigned frameOffset;
    unsigned sampleOffset;
};
struct IdleNeighbours {
    unsigned earfcn;
    int qrxlevmin_dbm;
    std::span<const IdleNeighbour> cells;
};
void encode(const IdleNeighbours& neighbours, ByteBuffer& out);

/// 0xB179: serving cell, measured neighbours and detected cells in connected mode.
struct ConnectedCell {
    unsigned physicalCellId;
    double rsrp_dbm;
    double rsrq_db;
};
struct ConnectedMeasurement {
    unsigned earfcn;
    unsigned subframe;
    ConnectedCell serving;
    std::span<const ConnectedCell> measured;
    std::span<const unsigned> detected; ///< physical cell IDs
};
void encode(const ConnectedMeasurement& measurement, ByteBuffer& out);

/// 0xB186: the best candidate for reselection; at most one, because entries overlap and a second
/// one would share its numbers with the first.
struct ReselectionCandidate {
    enum class Technology : unsigned { Lte = 0, Utran = 1, Geran = 2, Cdma1xRtt = 3, CdmaHrpd = 4 };
    Technology technology;
    unsigned priority;
    unsigned channel;
    unsigned code; ///< cell ID, scrambling code, BSIC or pilot
    unsigned band; ///< of GERAN and CDMA
};
struct ReselectionCandidates {
    unsigned servingEarfcn;
    unsigned servingCellId;
    std::span<const ReselectionCandidate> candidates; ///< none or one
};
void encode(const ReselectionCandidates& candidates, ByteBuffer& out);

} // namespace pallax::lte
