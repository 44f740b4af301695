#pragma once

#include <string>
#include <string_view>

/// Texts that may come from a SIM, a modem or a file name: not always the UTF-8 that they should
/// be, and perhaps made to command the terminal that shows them.
namespace pallax {

/// U+FFFD, which stands for a byte that is not part of valid UTF-8.
inline constexpr std::string_view kReplacementCharacter = "\xEF\xBF\xBD";

/// Whether a terminal may take the character for a command, or turn the direction of the text
/// around it: a control character (C0, DEL, C1) or a bidirectional control.
bool commandsTerminal(char32_t codePoint);

/// Appends what is shown for such a character: "\x1B" below U+0080, "\u202E" from there on.
void appendEscape(std::string& out, char32_t codePoint);

/// Appends the text with each invalid byte replaced.
void appendValidUtf8(std::string& out, std::string_view text);

/// Appends the text as a terminal may get it, in one line: each invalid byte is replaced, and each
/// character that commands a terminal stands as its escape.
void appendPrintable(std::string& out, std::string_view text);

/// The same for a text of several lines: ends of lines and tabulators stay.
void appendPrintableLines(std::string& out, std::string_view text);

/// The same for lines that come in pieces, any of which may end inside a character.
class PrintablePieces {
public:
    void append(std::string& out, std::string_view piece);

private:
    std::string _begun; ///< the bytes of a character whose rest the next piece brings
};

} // namespace pallax
