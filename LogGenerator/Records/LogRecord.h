#pragma once

#include "plist/PropertyListCodec.h"
#include "text/Bytes.h"

#include <bit>
#include <cstddef>
#include <cstdint>
#include <cstring>
#include <optional>

namespace pallax {

/// The position of a number in a record: it begins at bit `bit` of byte `byte` (bit 0 is the least
/// significant) and has `width` bits (1 to 32), the low bits in the lower bytes.
struct Position {
    std::size_t byte = 0;
    unsigned bit = 0;
    unsigned width = 8;
    bool isSigned = false;
    /// High byte first; whole bytes only.
    bool bigEndian = false;
};

constexpr Position u8At(std::size_t byte) {
    return {byte, 0, 8};
}
constexpr Position s8At(std::size_t byte) {
    return {byte, 0, 8, true};
}
constexpr Position u16At(std::size_t byte) {
    return {byte, 0, 16};
}
constexpr Position s16At(std::size_t byte) {
    return {byte, 0, 16, true};
}
constexpr Position u32At(std::size_t byte) {
    return {byte, 0, 32};
}
constexpr Position s32At(std::size_t byte) {
    return {byte, 0, 32, true};
}
constexpr Position bigEndianU16At(std::size_t byte) {
    return {byte, 0, 16, false, true};
}
constexpr Position bitsAt(std::size_t byte, unsigned bit, unsigned width) {
    return {byte, bit, width};
}

/// The payload of a record as a property list, parsed once for all subscribers, at the first use.
/// (When each parsed it, this took half the time of decoding a GSM drive.)
struct SharedPayload {
    std::optional<PropertyListResult> list;
};

/// A bounds-checked view of one log record, or of an entry in one. Offsets count from its
/// first byte; bytes past the end read as zero. It does not own the bytes.
///
///   byte  width  field
///   0     8      log type: 1, or 0xFF for an extended record
///   3     16     log code, little-endian
///   13           payload
class LogRecord {
public:
    static constexpr std::size_t kHeaderLength = 13;
    static constexpr std::uint8_t kStandardType = 1;
    static constexpr std::uint8_t kExtendedType = 0xFF;

    LogRecord() = default;
    explicit LogRecord(Bytes bytes) : _bytes(bytes) {}
    /// A record for several subscribers; `shared` must outlive it.
    LogRecord(Bytes bytes, SharedPayload& shared) : _bytes(bytes), _shared(&shared) {}

    std::size_t length() const { return _bytes.size(); }
    Bytes bytes() const { return _bytes; }
    /// True when every byte below `end` lies inside.
    bool has(std::size_t end) const { return end <= _bytes.size(); }
    /// The bytes after the header; empty when there are none.
    Bytes payload() const { return from(kHeaderLength).bytes(); }
    PropertyListResult payloadAsPropertyList() const;
    /// The view that begins at `start`; empty when that is past the end.
    LogRecord from(std::size_t start) const {
        return LogRecord(start < _bytes.size() ? _bytes.subspan(start) : Bytes());
    }

    std::uint8_t u8(std::size_t at) const { return at < _bytes.size() ? _bytes[at] : 0; }
    std::uint16_t u16(std::size_t at) const {
        return static_cast<std::uint16_t>(u8(at) | (u8(at + 1) << 8U));
    }
    std::uint32_t u32(std::size_t at) const {
        return u16(at) | (static_cast<std::uint32_t>(u16(at + 2)) << 16U);
    }
    std::int16_t s16(std::size_t at) const { return static_cast<std::int16_t>(u16(at)); }

    /// The number at `position`, sign-extended if it is signed.
    std::int64_t read(const Position& position) const {
        constexpr unsigned kBits = 64;
        const unsigned above = kBits - position.width;
        const std::uint64_t top = gather(position) << (above - position.bit);
        return position.isSigned ? static_cast<std::int64_t>(top) >> above
                                 : static_cast<std::int64_t>(top >> above);
    }

private:
    /// The bytes from `position.byte` on as one number; the caller drops the high bits. If 8 bytes
    /// are available, they are loaded at once.
    std::uint64_t gather(const Position& position) const {
        if (std::endian::native != std::endian::little || position.bigEndian) {
            return gatherEach(position);
        }
        constexpr std::size_t kLoaded = sizeof(std::uint64_t);
        if (has(position.byte + kLoaded)) {
            return load<std::uint64_t>(position.byte);
        }
        if (has(kLoaded) && has(position.byte)) {
            const std::size_t last = length() - kLoaded;
            const std::size_t before = position.byte - last;
            return before < kLoaded ? load<std::uint64_t>(last) >> (before * kByteBits) : 0;
        }
        return gatherLast(position.byte);
    }
    /// For little-endian machines. The bytes must be available.
    template <class Number>
    std::uint64_t load(std::size_t at) const {
        Number number = 0;
        std::memcpy(&number, _bytes.data() + at, sizeof(number));
        return number;
    }
    /// The bytes from there to the end, fewer than 8.
    std::uint64_t gatherLast(std::size_t at) const;
    /// For big-endian positions and machines.
    std::uint64_t gatherEach(const Position& position) const;

    Bytes _bytes;
    SharedPayload* _shared = nullptr;
};

} // namespace pallax
