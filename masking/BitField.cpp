#include "masking/BitField.h"

#include "text/Bytes.h"

namespace pallax {

void writeNumber(std::span<std::uint8_t> record, const Position& position, std::uint64_t number) {
    const std::size_t last = (position.bit + position.width - 1) / kByteBits;
    for (unsigned index = 0; index < position.width; ++index) {
        const unsigned bit = position.bit + index;
        const std::size_t offset = bit / kByteBits;
        const std::size_t byte = position.byte + (position.bigEndian ? last - offset : offset);
        if (byte >= record.size()) {
            continue;
        }
        const auto mask = static_cast<std::uint8_t>(1U << (bit % kByteBits));
        const bool isSet = (number >> index & 1U) != 0;
        record[byte] =
            static_cast<std::uint8_t>(isSet ? record[byte] | mask : record[byte] & ~mask);
    }
}

} // namespace pallax
