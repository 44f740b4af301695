#pragma once

#include <string>
#include <string_view>

namespace pallax {

/// A text as SQL has it: in single quotes.
std::string quotedText(std::string_view text);

/// A name in double quotes, with which it may be any text.
std::string quotedName(std::string_view name);

} // namespace pallax
