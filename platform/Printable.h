#pragma once

#include <string>
#include <string_view>

/// Texts that may come from a SIM or a modem: not always the UTF-8 that they should be.
namespace pallax {

/// U+FFFD, which stands for a byte that is not part of valid UTF-8.
inline constexpr std::string_view kReplacementCharacter = "\xEF\xBF\xBD";

/// Appends the text with each invalid byte replaced.
void appendValidUtf8(std::string& out, std::string_view text);

/// Appends the text as a terminal may get it: each invalid byte and each control character (which
/// could be taken for a command) is replaced.
void appendPrintable(std::string& out, std::string_view text);

/// The same for a text of several lines: ends of lines and tabulators stay.
void appendPrintableLines(std::string& out, std::string_view text);

} // namespace pallax
