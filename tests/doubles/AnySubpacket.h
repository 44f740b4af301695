#pragma once

#include "tests/doubles/SubpacketBuilder.h"

#include <rapidcheck.h>

#include <cstdint>

namespace pallax::doubles {

/// A subpacket of any bytes; to be called inside a property.
inline Subpacket anySubpacket(unsigned id) {
    constexpr int kMaximumBytes = 60;
    Subpacket subpacket(id);
    for (int count = *rc::gen::inRange(0, kMaximumBytes); count > 0; --count) {
        subpacket.u8(*rc::gen::arbitrary<std::uint8_t>());
    }
    return subpacket;
}

} // namespace pallax::doubles
