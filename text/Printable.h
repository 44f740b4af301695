#pragma once

#include <string>
#include <string_view>

/// Texts from a SIM, a modem or a file name: they may be invalid UTF-8, or written to command the
/// terminal that shows them.
namespace pallax {

/// U+FFFD, which replaces a byte that is not valid UTF-8.
inline constexpr std::string_view kReplacementCharacter = "\xEF\xBF\xBD";

/// Whether the character could command a terminal or change the direction of the text around it: a
/// control character (C0, DEL, C1) or a bidirectional control.
bool commandsTerminal(char32_t codePoint);

/// Appends the escape of such a character: "\x1B" below U+0080, otherwise like "\u202E".
void appendEscape(std::string& out, char32_t codePoint);

/// Appends the text with each invalid byte replaced.
void appendValidUtf8(std::string& out, std::string_view text);

/// Appends the text in a form safe for terminals, in one line: replaces each invalid byte and
/// escapes each character that could command a terminal.
void appendPrintable(std::string& out, std::string_view text);
std::string printable(std::string_view text);

/// The same for a text of several lines: keeps line ends and tabs.
void appendPrintableLines(std::string& out, std::string_view text);

/// The same for lines that arrive in pieces, which may end inside a character.
class PrintablePieces {
public:
    void append(std::string& out, std::string_view piece);

private:
    std::string _begun; ///< the first bytes of a character that the next piece completes
};

} // namespace pallax
