#include "LogGenerator/Records/LogRecord.h"

namespace pallax {

PropertyListResult LogRecord::payloadAsPropertyList() const {
    if (_shared == nullptr) {
        return parsePropertyList(payload());
    }
    if (!_shared->list) {
        _shared->list = parsePropertyList(payload());
    }
    return *_shared->list;
}

std::uint64_t LogRecord::gatherLast(std::size_t at) const {
    const std::size_t count = at < _bytes.size() ? _bytes.size() - at : 0;
    if (count >= sizeof(std::uint32_t)) {
        const std::size_t second = count - sizeof(std::uint32_t); // may overlap the first
        return load<std::uint32_t>(at) | load<std::uint32_t>(at + second) << (second * kByteBits);
    }
    if (count >= sizeof(std::uint16_t)) {
        const std::size_t last = count - 1;
        return load<std::uint16_t>(at) | std::uint64_t{_bytes[at + last]} << (last * kByteBits);
    }
    return u8(at);
}

std::uint64_t LogRecord::gatherEach(const Position& position) const {
    const unsigned count = (position.bit + position.width + kByteBits - 1) / kByteBits;
    std::uint64_t value = 0;
    for (unsigned index = 0; index < count; ++index) {
        const unsigned place = position.bigEndian ? count - 1 - index : index;
        value |= static_cast<std::uint64_t>(u8(position.byte + index)) << (place * kByteBits);
    }
    return value;
}

} // namespace pallax
