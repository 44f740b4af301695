#pragma once

#include "text/Bytes.h"

#include <array>
#include <cstdint>
#include <span>

/// Encoders for the log records of the CDMA modem (1x and EV-DO), one for each layout, from values
/// in engineering units.
namespace pallax::cdma {

/// 0x1183: state, session, carrier and levels of EV-DO.
enum class EvdoState : unsigned { Inactive, Acquisition, Sync, Idle, Access, Connected };
enum class EvdoSession : unsigned { Closed, AmpSetup, PhoneNegotiates, NetworkNegotiates, Open };
struct EvdoStatus {
    static constexpr unsigned kNoPn = 0xFFFF;

    unsigned channel; ///< up to 2047
    unsigned bandClass;
    int receive0_dbm;
    int receive1_dbm;
    int transmit_dbm;
    unsigned servingPn; ///< or kNoPn
    EvdoState state;
    EvdoSession session;
    std::uint32_t uati24;
    unsigned colorCode;
};
void encode(const EvdoStatus& status, ByteBuffer& out);

/// A pilot with its share of the received power.
struct Pilot {
    unsigned pn;
    double part_db;
};

/// 0x12B6: the pilots of the EV-DO active set.
struct EvdoActiveSet {
    std::span<const Pilot> pilots;
};
void encode(const EvdoActiveSet& set, ByteBuffer& out);

/// 0x108A: the fingers, each locked to a pilot, and one that is not locked.
struct Fingers {
    std::span<const Pilot> locked;
};
void encode(const Fingers& fingers, ByteBuffer& out);

/// 0x119C: state, radio and active set of 1x, in the record's numbering.
enum class OneXState : unsigned {
    Inactive = 0,
    Acquisition = 3,
    Sync = 4,
    Paging = 6,
    Sleep = 7,
    Traffic = 8
};
struct OneXStatus {
    OneXState state;
    unsigned bandClass;
    unsigned channel;
    double receive0_dbm;
    double receive1_dbm;
    double transmit_dbm;
    std::span<const Pilot> activeSet; ///< the first is the reference
};
void encode(const OneXStatus& status, ByteBuffer& out);

/// 0x119D: a frame of the traffic channel.
struct TrafficFrame {
    bool inError;
};
void encode(const TrafficFrame& frame, ByteBuffer& out);

/// 0x1192 and 0x127E: packets sent over a link so far, by their size in bits; a sequence number
/// lasts one second.
struct ForwardPackets {
    std::uint32_t sequence;
    std::uint32_t of1024;
    std::uint32_t of2048;
    std::uint32_t of4096;
};
void encode(const ForwardPackets& packets, ByteBuffer& out);
struct ReversePackets {
    std::uint32_t sequence;
    std::uint32_t of1024;
    std::uint32_t of4096;
};
void encode(const ReversePackets& packets, ByteBuffer& out);

/// 0x134F: the serving 1x system.
struct SystemIdentity {
    unsigned roaming; ///< indicator: 0 off
    unsigned systemId;
    unsigned networkId;
    unsigned packetZone;
    unsigned protocolRevision;
    unsigned baseStation;
};
void encode(const SystemIdentity& identity, ByteBuffer& out);

} // namespace pallax::cdma
