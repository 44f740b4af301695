#pragma once

#include "tests/doubles/RecordBuilder.h"

#include <cstdint>
#include <vector>

namespace pallax::doubles {

/// Builds a subpacket byte by byte after its id and size; multi-byte numbers are little-endian.
class Subpacket {
public:
    explicit Subpacket(unsigned id) : _bytes({static_cast<std::uint8_t>(id), 0, 0, 0}) {}

    Subpacket& u8(unsigned value) {
        _bytes.push_back(static_cast<std::uint8_t>(value));
        return *this;
    }
    Subpacket& u16(unsigned value) { return u8(value).u8(value >> 8U); }
    Subpacket& s8(int value) { return u8(static_cast<unsigned>(value)); }
    Subpacket& s16(int value) { return u16(static_cast<unsigned>(value)); }
    /// Zeros up to an offset from the subpacket's start.
    Subpacket& padTo(std::size_t end) {
        _bytes.resize(end > _bytes.size() ? end : _bytes.size());
        return *this;
    }
    /// Sets a 16-bit number at an offset from the subpacket's start, which grows if necessary.
    Subpacket& putU16(std::size_t offset, unsigned value) {
        padTo(offset + 2);
        _bytes[offset] = static_cast<std::uint8_t>(value);
        _bytes[offset + 1] = static_cast<std::uint8_t>(value >> 8U);
        return *this;
    }
    /// Claims another size than its own from now on.
    Subpacket& claim(unsigned size) {
        _claimed = size;
        _claims = true;
        return *this;
    }

    ByteBuffer bytes() const {
        ByteBuffer bytes = _bytes;
        const std::size_t size = _claims ? _claimed : bytes.size();
        bytes[2] = static_cast<std::uint8_t>(size);
        bytes[3] = static_cast<std::uint8_t>(size >> 8U);
        return bytes;
    }

private:
    ByteBuffer _bytes;
    unsigned _claimed = 0;
    bool _claims = false;
};

/// A packet with these subpackets.
inline Record packetOf(LogCode logCode, const std::vector<Subpacket>& subpackets) {
    Record record(logCode);
    record.u8(0).u8(static_cast<unsigned>(subpackets.size())).padTo(17);
    for (const Subpacket& subpacket : subpackets) {
        const ByteBuffer bytes = subpacket.bytes();
        record.append(Bytes(bytes));
    }
    return record;
}

} // namespace pallax::doubles
