#include "simulator/RecordWriter.h"

namespace pallax {

namespace {

constexpr std::uint8_t kPrefixMark = 0x81;
constexpr std::uint8_t kStandardType = 1;
constexpr std::uint8_t kExtendedType = 0xFF;
constexpr std::uint32_t kExtendedCodes = 0xFF0000;
constexpr std::size_t kLengthOffset = 1;
constexpr std::size_t kCodeOffset = 3;
constexpr std::size_t kStampOffset = 5;
constexpr std::size_t kStampLength = 8;
constexpr unsigned kBitsPerByte = 8;

void store(ByteBuffer& out, std::size_t offset, std::uint64_t value, std::size_t width) {
    for (std::size_t index = 0; index < width; ++index, value >>= kBitsPerByte) {
        out[offset + index] = static_cast<std::uint8_t>(value);
    }
}

} // namespace

RecordWriter::RecordWriter(ByteBuffer& out, std::uint32_t logCode) : _out(out) {
    _out.assign(kPrefixLength + kHeaderLength, 0);
    _out[0] = kPrefixMark;
    _out[kPrefixLength] = logCode >= kExtendedCodes ? kExtendedType : kStandardType;
    store(_out, kPrefixLength + kCodeOffset, logCode, 2);
}

RecordWriter& RecordWriter::append(Bytes bytes) {
    _out.insert(_out.end(), bytes.begin(), bytes.end());
    return *this;
}

RecordWriter& RecordWriter::padTo(std::size_t offset) {
    if (offset > length()) {
        _out.resize(kPrefixLength + offset);
    }
    return *this;
}

RecordWriter& RecordWriter::bits(std::size_t offset, unsigned bit, unsigned width, unsigned value) {
    const std::uint64_t mask = (std::uint64_t{1} << width) - 1;
    std::uint64_t rest = (value & mask) << bit;
    for (std::size_t byte = kPrefixLength + offset; rest != 0; ++byte, rest >>= kBitsPerByte) {
        _out.at(byte) = static_cast<std::uint8_t>(_out[byte] | rest);
    }
    return *this;
}

void stampRecord(ByteBuffer& record, std::uint64_t microseconds) {
    if (record.size() < RecordWriter::kPrefixLength + RecordWriter::kHeaderLength) {
        return;
    }
    constexpr std::size_t kLengthWidth = 2;
    store(record, RecordWriter::kPrefixLength + kLengthOffset,
          record.size() - RecordWriter::kPrefixLength, kLengthWidth);
    store(record, RecordWriter::kPrefixLength + kStampOffset, microseconds, kStampLength);
}

} // namespace pallax
