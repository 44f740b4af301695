#pragma once

#include <string>
#include <string_view>

namespace pallax {

/// A text as roff, the language of manual pages, shows it again: a hyphen stays what is typed,
/// nothing is a request or an escape, and what is beyond ASCII is named by its number. Bytes that
/// are no UTF-8 stay as they are.
std::string roffText(std::string_view text);

/// The same in bold type.
std::string roffBold(std::string_view text);

} // namespace pallax
