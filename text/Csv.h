#pragma once

#include <string>
#include <string_view>

namespace pallax {

/// Appends one cell of CSV (RFC 4180), quoted if it must be. Each invalid UTF-8 byte becomes
/// U+FFFD.
void appendCsvCell(std::string& out, std::string_view text);

} // namespace pallax
