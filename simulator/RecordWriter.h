#pragma once

#include "text/Bytes.h"

#include <cstddef>
#include <cstdint>

namespace pallax {

/// Writes one log record into a buffer as the log channel delivers it: the 2-byte transport prefix,
/// the 13-byte header, and the body. Numbers are little-endian; offsets count from byte 0 of the
/// log record, after the prefix.
class RecordWriter {
public:
    static constexpr std::size_t kPrefixLength = 2;
    static constexpr std::size_t kHeaderLength = 13;

    /// Clears `out`, which must outlive the writer. Codes from 0xFF0000 are extended.
    RecordWriter(ByteBuffer& out, std::uint32_t logCode);

    RecordWriter& u8(unsigned value) { return put(value, 1); }
    RecordWriter& u16(unsigned value) { return put(value, 2); }
    RecordWriter& u24(unsigned value) { return put(value, 3); }
    RecordWriter& u32(std::uint32_t value) { return put(value, 4); }
    RecordWriter& s8(int value) { return put(static_cast<unsigned>(value), 1); }
    RecordWriter& s16(int value) { return put(static_cast<unsigned>(value), 2); }
    RecordWriter& s32(std::int32_t value) { return put(static_cast<std::uint32_t>(value), 4); }
    RecordWriter& append(Bytes bytes);
    /// Appends zeros up to the offset, if the log record is shorter.
    RecordWriter& padTo(std::size_t offset);
    RecordWriter& skip(std::size_t bytes) { return padTo(length() + bytes); }

    /// The current length of the log record.
    std::size_t length() const { return _out.size() - kPrefixLength; }

    /// Sets the low `width` bits (at most 32) of `value` in existing bytes, starting at bit `bit`
    /// of the byte at `offset`: low bits in lower bytes.
    RecordWriter& bits(std::size_t offset, unsigned bit, unsigned width, unsigned value);

private:
    RecordWriter& put(std::uint32_t value, std::size_t width) {
        constexpr unsigned kBitsPerByte = 8;
        const std::size_t offset = _out.size();
        _out.resize(offset + width);
        for (std::size_t index = 0; index < width; ++index, value >>= kBitsPerByte) {
            _out[offset + index] = static_cast<std::uint8_t>(value);
        }
        return *this;
    }

    ByteBuffer& _out;
};

/// Sets the header fields that no display shows: length and time stamp.
void stampRecord(ByteBuffer& record, std::uint64_t microseconds);

} // namespace pallax
