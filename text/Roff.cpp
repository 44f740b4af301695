#include "text/Roff.h"

#include "text/Format.h"
#include "text/Utf8.h"

namespace pallax {

namespace {

/// The escape of a character that has a meaning in roff; empty for others.
std::string_view nameOf(char character) {
    switch (character) {
    case '\\':
        return "\\e";
    case '-':
        return "\\-";
    case '"':
        return "\\(dq";
    case '\'':
        return "\\(aq";
    case '^':
        return "\\(ha";
    case '~':
        return "\\(ti";
    default:
        return {};
    }
}

} // namespace

std::string roffText(std::string_view text) {
    std::string result;
    for (std::size_t at = 0; at < text.size(); ++at) {
        const char character = text[at];
        if (const Utf8CodePoint codePoint = utf8At(text, at); codePoint.size > 1) {
            result += formatText("\\[u%04X]", {static_cast<std::uint32_t>(codePoint.value)});
            at += codePoint.size - 1;
            continue;
        }
        const bool lineStarts = result.empty() || result.back() == '\n';
        if (lineStarts && character == '.') {
            result += "\\&"; // otherwise the line would be a request
        }
        if (const std::string_view name = nameOf(character); !name.empty()) {
            result += name;
        } else {
            result += character;
        }
    }
    return result;
}

std::string roffBold(std::string_view text) {
    return "\\fB" + roffText(text) + "\\fR";
}

} // namespace pallax
