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
