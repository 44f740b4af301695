#pragma once

#include "platform/Bytes.h"

#include <cstdint>
#include <vector>

/// The log records of the CDMA sample, each with the transport prefix, from the values that an
/// engineer would name. Energies are raw.
namespace pallax {

/// The states in the numbering of the record.
enum class OneXState : unsigned { Acquisition = 3, Sync = 4, Paging = 6, Sleep = 7, Traffic = 8 };
enum class EvdoState : unsigned { Inactive, Acquisition, Sync, Idle, Access, Connected };
enum class EvdoSession : unsigned { Closed, AmpSetup, PhoneNegotiates, NetworkNegotiates, Open };

struct CdmaPilot {
    unsigned pn;
    unsigned energy;
};

struct CdmaSystem {
    unsigned systemId;
    unsigned networkId;
    unsigned baseStation;
    unsigned packetZone;
};

/// 0x134F: the system that serves.
ByteBuffer systemIdentityRecord(const CdmaSystem& system);

/// 0x119C: state, radio, active set (the first pilot is the reference) and fingers. Receive gains
/// are raw (a third of a decibel above -63.248 dBm), the transmit gain is in tenths of a dBm.
struct OneXRadio {
    OneXState state;
    int receiveGain;
    int transmitGain_tenthDbm;
};
ByteBuffer oneXStatusRecord(const OneXRadio& radio, const std::vector<CdmaPilot>& activeSet);

/// 0x119D: a frame of the traffic channel.
ByteBuffer trafficFrameRecord(bool inError);

/// 0x1183: state, session, carrier and levels of EV-DO.
struct EvdoRadio {
    EvdoState state;
    EvdoSession session;
    unsigned servingPn;
    int receive_dbm;
    int transmit_dbm;
    std::uint32_t uati24;
};
ByteBuffer evdoStatusRecord(const EvdoRadio& radio);

/// 0x12B6: the pilots of the EV-DO active set.
ByteBuffer evdoActiveSetRecord(const std::vector<CdmaPilot>& pilots);
/// 0x108A: the fingers, by the pilot that each is locked to.
ByteBuffer fingersRecord(const std::vector<CdmaPilot>& fingers);

/// 0x1192: packets of 1024, 2048 and 4096 bits sent over the forward link so far.
struct ForwardPackets {
    std::uint32_t small;
    std::uint32_t middle;
    std::uint32_t large;
};
ByteBuffer forwardRateRecord(std::uint32_t sequence, const ForwardPackets& packets);
/// 0x127E: packets of 1024 and of 4096 bits sent over the reverse link so far.
ByteBuffer reverseRateRecord(std::uint32_t sequence, std::uint32_t small, std::uint32_t large);

} // namespace pallax
