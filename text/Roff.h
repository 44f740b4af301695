#pragma once

#include <string>
#include <string_view>

namespace pallax {

/// Escapes a text for roff, the language of manual pages: hyphens can be typed as shown, nothing is
/// a request or an escape, and characters beyond ASCII are written by number. Bytes that are not
/// UTF-8 are kept.
std::string roffText(std::string_view text);

/// The same in bold type.
std::string roffBold(std::string_view text);

} // namespace pallax
