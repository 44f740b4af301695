#pragma once

#include "plist/PropertyListCodec.h"

#include <cstdint>
#include <cstdlib>
#include <string>

namespace pallax {

/// Aborts unless `object` is written in every form that accepts it and reads back equal. An object
/// that was read differs from itself only if it contains a not-a-number real or a foreign key,
/// which no writer accepts.
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
