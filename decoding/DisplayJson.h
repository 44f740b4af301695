#pragma once

#include "plist/PropertyList.h"

#include <string>
#include <string_view>

/// Property lists as compact JSON, appended to a text that the caller owns. Streamed without a
/// document tree: a recording of millions of packets can have a display for each.
namespace pallax {

/// Containers nested deeper become null.
inline constexpr int kDeepestJson = 512;

enum class JsonNumbers {
    AsTexts,
    Typed, ///< {"number":-94.75,"unit":"dBm","text":"-94.75 dBm"}; without a unit it is null
};

/// A string becomes its text, as does a display number unless it is to be typed, data base64, a
/// date its ISO 8601 text, a real the shortest number that reads back the same (null if not
/// finite). Keys keep their order; entries with a key that is not a string are omitted.
void appendJson(std::string& out, const PropertyList& object,
                JsonNumbers numbers = JsonNumbers::AsTexts);

/// The number as in its text, without padding and plus sign; a hexadecimal one in decimal. Nothing
/// if it is not finite.
void appendBareNumber(std::string& out, const DisplayNumber& number);

/// One quoted JSON string. Each invalid UTF-8 byte becomes U+FFFD.
void appendJsonString(std::string& out, std::string_view text);

} // namespace pallax
