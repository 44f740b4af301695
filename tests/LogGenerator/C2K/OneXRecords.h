#pragma once

#include "tests/doubles/AnySubpacket.h"

namespace pallax::doubles {

inline constexpr unsigned kTrafficState = 8;

inline Subpacket systemState(unsigned state) {
    return Subpacket(1).u8(state);
}

/// Cellular and PCS band, channels 283 and 25.
inline Subpacket radio() {
    return Subpacket(2).u8(0).u8(1).u16(283).u16(25).s8(-40).s8(40).s16(-125);
}

/// An active set without pilots, with N, g and e of the formula.
inline Subpacket noPilots(unsigned divisor = 64, unsigned gain = 1, unsigned exponent = 2) {
    return Subpacket(3).u16(divisor).u8(gain).u8(exponent).u8(0).u8(0).u16(0);
}

/// Two pilots of size 1, 20 bytes apart; 168 is the reference.
inline Subpacket twoPilots() {
    return Subpacket(3)
        .u16(64)    // N
        .u8(1)      // g
        .u8(2)      // e
        .u8(2)      // pilots
        .u8(1)      // m
        .u16(168)   // reference
        .u16(4)     // pilot 0
        .padTo(28)  //
        .u16(900)   // its energy
        .padTo(32)  //
        .u16(168)   // pilot 1
        .padTo(48)  //
        .u16(6000); // its energy
}

inline Subpacket noFingers() {
    return Subpacket(4);
}

/// 0x119C with that state and that active set.
inline Record oneXStatus(unsigned state, const Subpacket& activeSet = noPilots()) {
    return packetOf(0x119C, {systemState(state), radio(), activeSet, noFingers()});
}

/// 0x119D: a frame of the traffic channel.
inline Record trafficFrame(unsigned inError) {
    return packetOf(0x119D, {Subpacket(5), Subpacket(11).padTo(24).u8(inError)});
}

} // namespace pallax::doubles
