#pragma once

#include "text/Bytes.h"

#include <array>
#include <cstdint>
#include <span>

/// Encoders for the GSM and GPRS log records of the GSM/UMTS modem, one for each layout, from
/// values in engineering units.
namespace pallax::gsm {

/// 0x5134: identity of the serving cell.
struct ServingIdentity {
    unsigned arfcn;
    unsigned bsic;
    unsigned cellId;
};
void encode(const ServingIdentity& identity, ByteBuffer& out);

/// 0x5137: levels of the serving cell and its neighbours. Levels have no sign.
struct NeighbourLevel {
    unsigned arfcn;
    int level_dbm;
    std::int32_t c1;
};
struct CellMeasurement {
    int level_dbm;
    std::int32_t c1; ///< also read as a quality
    std::int32_t c2;
    bool hysteresisApplied;
    std::span<const NeighbourLevel> neighbours;
};
void encode(const CellMeasurement& measurement, ByteBuffer& out);

/// 0x51FF: the colour codes of the neighbours.
struct NeighbourBsic {
    unsigned arfcn;
    unsigned bsic;
};
struct BsicList {
    std::span<const NeighbourBsic> cells;
};
void encode(const BsicList& list, ByteBuffer& out);

/// 0x5076: the ARFCN of the dedicated channel, of which only the low byte is shown.
struct DedicatedChannel {
    unsigned arfcn;
};
void encode(const DedicatedChannel& channel, ByteBuffer& out);

/// 0x512C: the state of the radio resource control, in the record's numbering.
enum class RrState : unsigned {
    Inactive = 0,
    Idle = 5,
    CellReselection = 6,
    ConnectionPending = 7,
    DataTransfer = 9,
    ConnectionRelease = 11,
    FromUmts = 14,
    ToUmts = 18
};
struct RrInfo {
    RrState state;
    unsigned subState;
    unsigned status;
    bool data;
};
void encode(const RrInfo& info, ByteBuffer& out);

/// 0x5072: discontinuous transmission.
struct Dtx {
    bool used;
};
void encode(const Dtx& dtx, ByteBuffer& out);

/// 0x51F8: the frequencies of the dedicated channel's hopping sequence.
struct MobileAllocation {
    unsigned hoppingSequence;
    std::span<const unsigned> arfcns;
};
void encode(const MobileAllocation& allocation, ByteBuffer& out);

/// 0x51F4: the position of the packet system information.
struct Si13Position {
    bool extended;
};
void encode(const Si13Position& position, ByteBuffer& out);

/// 0x51F5: packet control options of the cell.
struct PacketControl {
    unsigned pfcSupported;
    unsigned priorityThreshold;
    unsigned networkControlOrder;
};
void encode(const PacketControl& control, ByteBuffer& out);

/// 0x51F6: packet timers and bursts.
struct PacketTimers {
    unsigned t3192; ///< index of the duration
    unsigned drxTimer_s;
    bool elevenBitBursts;
};
void encode(const PacketTimers& timers, ByteBuffer& out);

/// 0x51FB: whether the cell has a packet broadcast channel.
struct PacketBroadcast {
    bool present;
};
void encode(const PacketBroadcast& broadcast, ByteBuffer& out);

/// 0x51FD: extended measurements and packet system information.
struct ExtendedMeasurement {
    unsigned psiStatus;
    unsigned countLr;
    unsigned countHr;
    unsigned order;
    bool siStatus;
};
void encode(const ExtendedMeasurement& measurement, ByteBuffer& out);

} // namespace pallax::gsm
