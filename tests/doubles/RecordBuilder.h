#pragma once

#include "LogGenerator/Records/LogCode.h"
#include "LogGenerator/Records/LogRecord.h"
#include "text/Bytes.h"

#include <algorithm>
#include <cstdint>
#include <initializer_list>

namespace pallax::doubles {

/// Builds a log record byte by byte after its header; multi-byte numbers are little-endian.
class Record {
public:
    /// The header of a log record with this effective code: log type 1, or 0xFF for an extended
    /// one.
    explicit Record(LogCode logCode) : _bytes(LogRecord::kHeaderLength) {
        constexpr std::size_t kCodeOffset = 3;
        const bool extended = logCode >= kExtendedLogCodes;
        _bytes[0] = extended ? LogRecord::kExtendedType : LogRecord::kStandardType;
        _bytes[kCodeOffset] = static_cast<std::uint8_t>(logCode);
        _bytes[kCodeOffset + 1] = static_cast<std::uint8_t>(logCode >> 8U);
    }

    Record& u8(unsigned value) { return little(value, 1); }
    Record& s8(int value) { return little(static_cast<unsigned>(value), 1); }
    Record& u16(unsigned value) { return little(value, 2); }
    Record& s16(int value) { return little(static_cast<unsigned>(value), 2); }
    Record& u32(std::uint32_t value) { return little(value, 4); }
    Record& s32(std::int32_t value) { return little(static_cast<std::uint32_t>(value), 4); }
    Record& append(Bytes bytes) {
        _bytes.insert(_bytes.end(), bytes.begin(), bytes.end());
        return *this;
    }
    Record& append(std::initializer_list<unsigned> bytes) {
        for (const unsigned byte : bytes) {
            u8(byte);
        }
        return *this;
    }
    /// Zeros up to offset `end`, counted from byte 0 of the log record.
    Record& padTo(std::size_t end) {
        _bytes.resize(end > _bytes.size() ? end : _bytes.size());
        return *this;
    }
    /// Sets one byte at an offset from byte 0 of the log record, which grows if necessary.
    Record& at(std::size_t offset, unsigned value) {
        padTo(offset + 1);
        _bytes[offset] = static_cast<std::uint8_t>(value);
        return *this;
    }

    const ByteBuffer& bytes() const { return _bytes; }
    /// As the log channel delivers it, after the 2-byte transport prefix.
    ByteBuffer prefixed() const {
        ByteBuffer message(2 + _bytes.size());
        message[0] = 0x81;
        std::copy(_bytes.begin(), _bytes.end(), message.begin() + 2);
        return message;
    }

private:
    Record& little(std::uint32_t value, unsigned width) {
        for (unsigned index = 0; index < width; ++index, value >>= 8U) {
            _bytes.push_back(static_cast<std::uint8_t>(value));
        }
        return *this;
    }

    ByteBuffer _bytes;
};

} // namespace pallax::doubles
