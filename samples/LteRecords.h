#pragma once

#include "platform/Bytes.h"
#include "platform/PropertyList.h"

#include <vector>

/// The log records of the LTE drive, each with the transport prefix, from the values that an
/// engineer would name.
namespace pallax {

/// An LTE cell as the phone measures it; levels in quarters of a decibel, so that they can move by
/// less than a whole one.
struct LteCell {
    unsigned physicalCellId;
    unsigned earfcn;
    int rsrp_quarterDbm;
    int rsrq_quarterDb;
};

/// 0xB0C2: identity, frequencies and bandwidths of the serving cell.
ByteBuffer lteIdentityRecord(const LteCell& cell, unsigned cellIdentity, unsigned trackingArea);
/// 0xB0C1: its transmit antennas.
ByteBuffer lteAntennasRecord(unsigned count);

/// 0xB17F: the serving cell in idle mode, with the reselection thresholds.
ByteBuffer idleServingRecord(const LteCell& cell, bool searchesOtherFrequencies);
/// 0xB180: the neighbours in idle mode.
ByteBuffer idleNeighboursRecord(unsigned earfcn, const std::vector<LteCell>& cells);
/// 0xB179: serving cell, measured neighbours and detected cells in connected mode.
ByteBuffer connectedRecord(const LteCell& serving, unsigned subframe,
                           const std::vector<LteCell>& measured,
                           const std::vector<unsigned>& detected);

/// A cell that the phone may reselect to; the two words stand at bytes 4 and 6 of its entry. They
/// are read by technology: frequency and cell, frequency and code, channel and band with BSIC.
struct Candidate {
    enum class Technology : unsigned { Lte = 0, Utran = 1, Geran = 2, Cdma1xRtt = 3, CdmaHrpd = 4 };
    unsigned priority;
    Technology technology;
    unsigned frequency;
    unsigned cell;
};
/// 0xB186: one candidate of LTE, UTRAN or GERAN.
ByteBuffer candidateRecord(const LteCell& serving, const Candidate& candidate);
/// 0xB186: a CDMA candidate of that band, channel and pilot.
ByteBuffer cdmaCandidateRecord(const LteCell& serving, unsigned priority, bool hrpd, unsigned band,
                               unsigned channel, unsigned pilot);
/// 0xB186: an LTE candidate and one of GERAN. Entries stand 4 bytes apart, so that the EARFCN of
/// the first is also the priority of the second.
ByteBuffer candidateChainRecord(const LteCell& serving, unsigned earfcn, unsigned arfcn,
                                unsigned bsic);

/// The cell monitor's dictionary of an LTE cell.
PropertyList lteCellEntry(const LteCell& cell, bool serving, unsigned cellIdentity,
                          unsigned trackingArea);

} // namespace pallax
