#pragma once

#include "plist/PropertyListCodec.h"
#include "tests/doubles/Property.h"
#include "tests/doubles/TextPropertyList.h"

#include <string>
#include <string_view>

/// Messages of the object stream.
namespace pallax {

inline ByteBuffer bytesOf(std::string_view text) {
    return {text.begin(), text.end()};
}

inline ByteBuffer xmlMessage(const PropertyList& object) {
    return bytesOf(*serializeXml(object));
}

inline ByteBuffer binaryMessage(const PropertyList& object) {
    return *serializeBinary(object);
}

inline ByteBuffer textMessage(const PropertyList& object) {
    return bytesOf(doubles::textForm(object));
}

/// A random object of strings, dictionaries and, with `withArrays`, arrays. Small containers are
/// frequent, because only they collapse.
inline PropertyList anyObject(int depth, bool withArrays = true) {
    constexpr int kMostEntries = 4;
    static const std::string kLetters = [] {
        std::string letters;
        for (char letter = ' '; letter < '~'; ++letter) {
            letters += letter;
        }
        return letters;
    }();
    const int kind = doubles::any::between(0, depth > 0 ? 6 : 1);
    if (kind == 0) {
        return doubles::any::textOf(kLetters);
    }
    const int count = doubles::any::between(0, kMostEntries);
    if (kind < 3 && withArrays) {
        Array elements;
        for (int index = 0; index < count; ++index) {
            elements.push_back(anyObject(depth - 1, withArrays));
        }
        return elements;
    }
    Dictionary entries;
    for (int index = 0; index < count; ++index) {
        entries.set(Text(std::string(1, static_cast<char>('A' + doubles::any::between(0, 26)))),
                    anyObject(depth - 1, withArrays));
    }
    return entries;
}

/// The same with a dictionary at the top, as the modem sends it.
inline PropertyList anyMessage(bool withArrays = true) {
    constexpr int kDepth = 4;
    Dictionary entries;
    for (const char* key : {"Cell", "List", "State"}) {
        entries.set(key, anyObject(kDepth, withArrays));
    }
    return entries;
}

} // namespace pallax
