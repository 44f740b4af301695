#pragma once

#include "tests/doubles/Property.h"
#include "tests/doubles/SubpacketBuilder.h"

namespace pallax::doubles {

/// A subpacket of random bytes. Call it in a property only.
inline Subpacket anySubpacket(unsigned id) {
    constexpr int kMaximumBytes = 60;
    Subpacket subpacket(id);
    for (int count = any::between(0, kMaximumBytes); count > 0; --count) {
        subpacket.u8(any::byte());
    }
    return subpacket;
}

} // namespace pallax::doubles
