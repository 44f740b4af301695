#include "query/SqlText.h"

namespace pallax {

namespace {

/// Quotes in the text are doubled.
std::string inQuotes(char quote, std::string_view text) {
    std::string result(1, quote);
    for (const char character : text) {
        result.append(character == quote ? 2 : 1, character);
    }
    return result + quote;
}

} // namespace

std::string quotedText(std::string_view text) {
    return inQuotes('\'', text);
}

std::string quotedName(std::string_view name) {
    return inQuotes('"', name);
}

} // namespace pallax
