#pragma once

#include "plist/PropertyListCodec.h"

#include <cstdint>
#include <cstdlib>
#include <string>

namespace pallax {

/// Ends the process, for the fuzzer to see, unless `object` is written in every form that accepts
/// it and reads back as the same. What was read differs from itself only by a not-a-number real,
/// or by a foreign key, which no writer accepts.
inline void requireSameAfterWriting(const PropertyList& object) {
    const PropertyList copy = object;
    const bool comparable = object == copy;
    if (const auto xml = serializeXml(object)) {
        const auto back = parsePropertyList(ByteBuffer(xml->begin(), xml->end()));
        if (!back || (comparable && !(*back == object)) || *serializeXml(*back) != *xml) {
            std::abort();
        }
    }
    if (const auto bytes = serializeBinary(object)) {
        const auto back = parsePropertyList(*bytes);
        if (!back || (comparable && !(*back == object)) || *serializeBinary(*back) != *bytes) {
            std::abort();
        }
    }
}

} // namespace pallax
