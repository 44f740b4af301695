#pragma once

#include "tests/doubles/RecordBuilder.h"

/// The connected-mode measurement; three records read a part of it.
namespace pallax::doubles {

/// The fixed part, which claims these numbers of entries.
inline Record connectedModeHead(unsigned measured, unsigned detected) {
    return Record(0xB179).padTo(27).u8(measured).u8(detected);
}

/// Two measured neighbours, the second with the greatest values, and one detected cell: 43 bytes.
inline Record twoMeasuredOneDetected() {
    return connectedModeHead(2, 1)
        .u16(275)
        .u16(167) // 167 x 0.25 - 140
        .u16(70)  // 70 x 0.125 - 20
        .u16(0xFFFF)
        .u16(0xFFFF)
        .u16(0xFFFF)
        .u16(301);
}

} // namespace pallax::doubles
