#pragma once

#include "plist/PropertyList.h"

#include <string>
#include <string_view>

/// Property lists as compact JSON, appended to a text that the caller owns. Streamed without a
/// document tree: a recording of millions of packets can have a display for each.
namespace pallax {

/// Containers nested deeper become null.
inline constexpr int kDeepestJson = 512;

/// A string (including a display number) becomes its text, data base64, a date its ISO 8601 text, a
/// real the shortest number that reads back the same (null if not finite). Keys keep their order;
/// entries with a key that is not a string are omitted.
void appendJson(std::string& out, const PropertyList& object);

/// One quoted JSON string. Each invalid UTF-8 byte becomes U+FFFD.
void appendJsonString(std::string& out, std::string_view text);

} // namespace pallax
