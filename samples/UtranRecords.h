#pragma once

#include "platform/Bytes.h"
#include "platform/PropertyList.h"
#include "samples/DriveRecords.h"

#include <array>
#include <vector>

/// The log records of the UTRAN sample, each with the transport prefix, from the values that an
/// engineer would name.
namespace pallax {

/// The serving cell; both links share its one frequency.
struct UtranServing {
    unsigned uarfcn;
    unsigned scramblingCode;
    unsigned cellId;
    unsigned lac;
    unsigned ura;
};

/// The sets in the numbering of the record.
enum class UtranSet : unsigned { Active, Monitored, Detected };

/// A cell around, as the measurement record tells it.
struct UtranNeighbour {
    unsigned uarfcn;
    unsigned cellParameter; ///< 0 to 127
    unsigned filterRscp;    ///< in 256ths
    UtranSet set;
    bool inDetectedCellSearch;
};

struct TransportChannel {
    unsigned id;
    unsigned blockErrors;
};

struct CompositeChannel {
    unsigned id;
    unsigned timeSlot;
    std::array<unsigned, 6> ratios; ///< signal to interference, raw
};

/// The modes in the numbering of the record.
enum class RrcMode : unsigned { Disconnected, Connecting, Fach, Dch, Pch, UraPch };

/// 0xD0E0: the state of the radio resource control.
ByteBuffer rrcModeRecord(RrcMode mode);
/// 0xD0E2: identity and frequencies of the serving cell.
ByteBuffer utranServingRecord(const UtranServing& cell);
/// 0xD00A: the neighbours of the own technology.
ByteBuffer utranNeighboursRecord(const std::vector<UtranNeighbour>& cells);
/// 0xD00E: the GSM neighbours.
ByteBuffer utranGsmNeighboursRecord(const std::vector<GsmCell>& cells);
/// 0xD00C: block errors, and signal-to-interference ratios.
ByteBuffer channelQualityRecord(const std::vector<TransportChannel>& transport,
                                const std::vector<CompositeChannel>& composite);

/// The cell monitor's dictionaries.
PropertyList utranServingEntry(const UtranServing& cell);
PropertyList utranNeighbourEntry(const UtranNeighbour& cell);

} // namespace pallax
