#pragma once

#include "text/Bytes.h"

#include <array>
#include <cstdint>
#include <span>

/// Encoders for the log records of the UTRAN modem, one for each layout, from values in engineering
/// units.
namespace pallax::utran {

/// 0xD0E0: the state of the radio resource control, in the record's numbering.
enum class RrcMode : unsigned { Disconnected, Connecting, Fach, Dch, Pch, UraPch };
void encode(RrcMode mode, ByteBuffer& out);

/// 0xD0E2: identity and frequencies of the serving cell.
struct ServingCell {
    unsigned accessRestrictions;
    unsigned ura;
    unsigned uplinkUarfcn;
    unsigned downlinkUarfcn;
    std::uint32_t cellId;
    bool emergencyCallsOnly;
};
void encode(const ServingCell& cell, ByteBuffer& out);

/// 0xD00A: the surrounding cells, including the serving one; up to 127.
enum class Set : unsigned { Active, Monitored, Detected };
struct MeasuredCell {
    unsigned uarfcn;        ///< up to 16383
    unsigned cellParameter; ///< up to 127
    unsigned filteredRscp;  ///< in 256ths, up to 255
    Set set;
    bool inDetectedCellSearch;
};
void encode(std::span<const MeasuredCell> cells, ByteBuffer& out);

/// 0xD00E: the GSM neighbours.
struct GsmNeighbour {
    unsigned number; ///< its number in the network's list, up to 16383
    unsigned bandIndicator;
    bool bsicValid;
    unsigned ncc;
    unsigned bcc;
    unsigned arfcn;
    int rssi_dbm;
};
void encode(std::span<const GsmNeighbour> cells, ByteBuffer& out);

/// 0xD00C: block errors of transport channels, and signal-to-interference ratios of composite
/// ones.
struct TransportChannel {
    unsigned id;
    unsigned blockErrors;
};
struct CompositeChannel {
    unsigned id;
    unsigned timeSlot;
    std::array<unsigned, 6> ratios;
};
struct ChannelQuality {
    std::span<const TransportChannel> transport; ///< up to 63
    std::span<const CompositeChannel> composite; ///< up to 15
};
void encode(const ChannelQuality& quality, ByteBuffer& out);

} // namespace pallax::utran
