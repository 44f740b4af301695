#pragma once

#include "text/Bytes.h"

#include <cstdint>
#include <span>

/// Encoders for the GSM/UMTS modem's log records about the network (registration, mobility states,
/// identities), one for each layout.
namespace pallax::gsm {

/// 0x7132: the registration, in the record's numbering.
enum class ServiceState : unsigned {
    Inactive,
    Idle,
    Registering,
    Deregistering,
    ManualSearch,
    AutomaticSearch,
    Offline
};
struct Registration {
    ServiceState state;
    unsigned selectionMode; ///< 0 automatic
};
void encode(const Registration& registration, ByteBuffer& out);

/// 0x7131: the circuit-switched mobility management, in the record's numbering.
struct MobilityState {
    unsigned state;
    unsigned subState;
    unsigned updateStatus;
};
void encode(const MobilityState& state, ByteBuffer& out);

/// 0x7130: the packet-switched one.
struct PacketMobilityState {
    unsigned state;
    unsigned subState;
    unsigned updateStatus;
};
void encode(const PacketMobilityState& state, ByteBuffer& out);

/// 0x7135: the serving network.
struct ServingPlmn {
    unsigned operatingMode; ///< class less one
    unsigned serviceType;
    unsigned country; ///< three digits
    unsigned network; ///< two digits
    unsigned locationArea;
    unsigned routingArea;
};
void encode(const ServingPlmn& plmn, ByteBuffer& out);

/// 0x7150: one equivalent network; entries overlap, so a second one would share half of its digits
/// with the first.
struct EquivalentPlmn {
    unsigned country;
    unsigned network; ///< three digits
};
void encode(const EquivalentPlmn& plmn, ByteBuffer& out);

} // namespace pallax::gsm
