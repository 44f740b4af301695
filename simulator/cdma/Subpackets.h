#pragma once

#include "simulator/RecordWriter.h"

/// The common layout of log records with subpackets.
///
///   byte  width  record
///   14    8      number of subpackets
///   17           subpackets, each with its number (8), a byte, and its size with this header (16)
namespace pallax::cdma {

inline void putHead(RecordWriter& record, unsigned count) {
    constexpr std::size_t kFirstSubpacket = 17;
    record.u8(1).u8(count).padTo(kFirstSubpacket);
}

inline RecordWriter& subpacket(RecordWriter& record, unsigned number, std::size_t size) {
    return record.u8(number).u8(1).u16(static_cast<unsigned>(size));
}

} // namespace pallax::cdma
