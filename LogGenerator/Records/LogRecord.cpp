#include "LogGenerator/Records/LogRecord.h"

namespace pallax {

namespace {

constexpr unsigned kByteBits = 8;

std::uint64_t gather(const LogRecord& record, const Position& position) {
    const unsigned count = (position.bit + position.width + kByteBits - 1) / kByteBits;
    std::uint64_t value = 0;
    for (unsigned index = 0; index < count; ++index) {
        const unsigned place = position.bigEndian ? count - 1 - index : index;
        value |= static_cast<std::uint64_t>(record.u8(position.byte + index))
                 << (place * kByteBits);
    }
    return value;
}

} // namespace

std::int64_t LogRecord::read(const Position& position) const {
    const std::uint64_t mask = (std::uint64_t{1} << position.width) - 1;
    const std::uint64_t raw = (gather(*this, position) >> position.bit) & mask;
    const std::uint64_t signBit = std::uint64_t{1} << (position.width - 1);
    if (position.isSigned && (raw & signBit) != 0) {
        return static_cast<std::int64_t>(raw) - static_cast<std::int64_t>(mask) - 1;
    }
    return static_cast<std::int64_t>(raw);
}

} // namespace pallax
