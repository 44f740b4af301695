#pragma once

#include "plist/PropertyList.h"

#include <string>
#include <string_view>

/// Property lists as compact JSON, appended to a text that the caller owns. Written straight out:
/// a recording of millions of packets asks for a display after each.
namespace pallax {

/// Containers nested deeper are written as null.
inline constexpr int kDeepestJson = 512;

/// A string (a display number too) becomes its text, data base64, a date its ISO 8601 text, a real
/// the shortest number that reads back the same (null when it is not finite). Keys keep their
/// order; an entry whose key is no string is left out.
void appendJson(std::string& out, const PropertyList& object);

/// One quoted JSON string. Each byte that is not part of valid UTF-8 becomes U+FFFD.
void appendJsonString(std::string& out, std::string_view text);

} // namespace pallax
