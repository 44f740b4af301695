#include "plist/PropertyListCodec.h"
#include "plist/Refusal.h"
#include "text/Utf8.h"

#include <algorithm>
#include <optional>
#include <utility>

namespace pallax {

namespace {

constexpr char32_t kLargestOctal = 0xFF;

bool isSeparator(char letter) {
    return letter == ' ' || (letter >= '\t' && letter <= '\r');
}

bool isBare(char letter) {
    return (letter >= 'A' && letter <= 'Z') || (letter >= 'a' && letter <= 'z') ||
           (letter >= '0' && letter <= '9') ||
           std::string_view("_$/:.-").find(letter) != std::string_view::npos;
}

std::optional<unsigned> hexDigit(char letter) {
    if (letter >= '0' && letter <= '9') {
        return static_cast<unsigned>(letter - '0');
    }
    if (letter >= 'a' && letter <= 'f') {
        return static_cast<unsigned>(letter - 'a' + 10);
    }
    if (letter >= 'A' && letter <= 'F') {
        return static_cast<unsigned>(letter - 'A' + 10);
    }
    return std::nullopt;
}

bool isOctal(char letter) {
    return letter >= '0' && letter <= '7';
}

/// The character for a backslash and `letter`, if any.
std::optional<char> simpleEscape(char letter) {
    constexpr std::string_view kLetters = "abfnrtv\"'\\\n";
    constexpr std::string_view kMeanings = "\a\b\f\n\r\t\v\"'\\\n";
    static_assert(kLetters.size() == kMeanings.size());
    const std::size_t found = kLetters.find(letter);
    return found != std::string_view::npos ? std::optional<char>(kMeanings[found]) : std::nullopt;
}

class TextReader {
public:
    explicit TextReader(std::string_view text)
        : _text(text), _at(text.starts_with(kUtf8Mark) ? kUtf8Mark.size() : 0) {}

    PropertyList document();

private:
    bool atEnd() const { return _at >= _text.size(); }
    char peek() const { return atEnd() ? '\0' : _text[_at]; }
    bool take(char letter);
    void skipSpace();
    bool skipComment();

    PropertyList value(std::size_t depth);
    PropertyList dictionary(std::size_t depth);
    PropertyList array(std::size_t depth);
    PropertyList data();
    std::string string();
    std::string bareString();
    std::string quotedString();
    void escape(std::string& out);
    char32_t octal();
    char32_t unicode();
    char32_t unicodeUnit();

    std::string_view _text;
    std::size_t _at;
};

bool TextReader::take(char letter) {
    skipSpace();
    const bool there = !atEnd() && peek() == letter;
    _at += there ? 1 : 0;
    return there;
}

void TextReader::skipSpace() {
    while (!atEnd()) {
        if (isSeparator(peek())) {
            ++_at;
        } else if (!skipComment()) {
            return;
        }
    }
}

/// False if there is no comment; afterwards the reader may be at the end.
bool TextReader::skipComment() {
    const std::string_view rest = _text.substr(_at);
    if (rest.starts_with("//")) {
        _at = std::min(_text.find_first_of("\r\n", _at), _text.size());
        return true;
    }
    if (rest.starts_with("/*")) {
        const std::size_t end = _text.find("*/", _at + 2);
        if (end == std::string_view::npos) {
            refuse(_at, "a comment without its end");
        }
        _at = end + 2;
        return true;
    }
    return false;
}

PropertyList TextReader::document() {
    skipSpace();
    if (atEnd()) {
        refuse(0, "an empty input");
    }
    PropertyList result = value(1);
    skipSpace();
    if (!atEnd()) {
        refuse(_at, "something after the value");
    }
    return result;
}

PropertyList TextReader::value(std::size_t depth) {
    skipSpace();
    switch (peek()) {
    case '{':
        return dictionary(depth);
    case '(':
        return array(depth);
    case '<':
        return data();
    default:
        return string();
    }
}

PropertyList TextReader::dictionary(std::size_t depth) {
    const std::size_t start = _at;
    requireDepth(start, depth);
    ++_at;
    Dictionary entries;
    while (!take('}')) {
        if (atEnd()) {
            refuse(start, "a dictionary without its \"}\"");
        }
        if (peek() == '{' || peek() == '(' || peek() == '<') {
            refuse(_at, "a key that is no string");
        }
        std::string key = string();
        if (!take('=')) {
            refuse(_at, "a key without \"=\"");
        }
        entries.set(std::move(key), value(depth + 1));
        if (!take(';')) {
            skipSpace();
            if (!atEnd() && peek() != '}') {
                refuse(_at, "an entry without \";\"");
            }
        }
    }
    return entries;
}

PropertyList TextReader::array(std::size_t depth) {
    const std::size_t start = _at;
    requireDepth(start, depth);
    ++_at;
    Array elements;
    while (!take(')')) {
        if (atEnd()) {
            refuse(start, "an array without its \")\"");
        }
        elements.push_back(value(depth + 1));
        if (!take(',')) {
            skipSpace();
            if (!atEnd() && peek() != ')') {
                refuse(_at, "an element without \",\"");
            }
        }
    }
    return elements;
}

PropertyList TextReader::data() {
    const std::size_t start = _at++;
    ByteBuffer bytes;
    unsigned high = 0;
    bool half = false;
    for (; peek() != '>'; ++_at) {
        if (atEnd()) {
            refuse(start, "data without its \">\"");
        }
        if (isSeparator(peek())) {
            continue;
        }
        const auto digit = hexDigit(peek());
        if (!digit) {
            refuse(_at, "data with something other than hex digits");
        }
        if (half) {
            bytes.push_back(static_cast<std::uint8_t>(high * 16 + *digit));
        }
        high = *digit;
        half = !half;
    }
    if (half) {
        refuse(start, "data with half a byte");
    }
    ++_at;
    return PropertyList::data(std::move(bytes));
}

std::string TextReader::string() {
    return peek() == '"' || peek() == '\'' ? quotedString() : bareString();
}

std::string TextReader::bareString() {
    const std::size_t start = _at;
    while (!atEnd() && isBare(peek())) {
        ++_at;
    }
    if (_at == start) {
        refuse(start, atEnd() ? "no value where one is due" : "a character outside quotes");
    }
    return std::string(_text.substr(start, _at - start));
}

std::string TextReader::quotedString() {
    const std::size_t start = _at;
    const char quote = peek();
    std::string out;
    for (++_at; atEnd() || peek() != quote;) {
        if (atEnd()) {
            refuse(start, "a string without its closing quote");
        }
        if (peek() == '\\') {
            escape(out);
        } else {
            out += _text[_at++];
        }
    }
    ++_at;
    return out;
}

void TextReader::escape(std::string& out) {
    const std::size_t start = _at++;
    if (const auto letter = atEnd() ? std::nullopt : simpleEscape(peek())) {
        out += *letter;
        ++_at;
    } else if (isOctal(peek())) {
        appendUtf8(out, octal());
    } else if (peek() == 'U' || peek() == 'u') {
        ++_at;
        appendUtf8(out, unicode());
    } else {
        refuse(start, "an unknown escape");
    }
}

/// One to three octal digits: the number of a code point up to U+00FF.
char32_t TextReader::octal() {
    constexpr std::size_t kMostDigits = 3;
    const std::size_t start = _at;
    char32_t number = 0;
    while (_at - start < kMostDigits && !atEnd() && isOctal(peek())) {
        number = number * 8 + static_cast<char32_t>(_text[_at++] - '0');
    }
    if (number > kLargestOctal) {
        refuse(start - 1, "an octal escape beyond 377");
    }
    return number;
}

/// The code point after "\U"; two escapes together if they are a surrogate pair.
char32_t TextReader::unicode() {
    const std::size_t start = _at - 2;
    const char32_t unit = unicodeUnit();
    if (!isSurrogate(unit)) {
        return unit;
    }
    const std::string_view next = _text.substr(_at, 2);
    if (isHighSurrogate(unit) && (next == "\\U" || next == "\\u")) {
        _at += 2;
        const char32_t low = unicodeUnit();
        if (isLowSurrogate(low)) {
            return joinSurrogates(unit, low);
        }
    }
    refuse(start, "half a surrogate pair");
}

char32_t TextReader::unicodeUnit() {
    constexpr int kDigits = 4;
    const std::size_t start = _at - 2;
    char32_t unit = 0;
    for (int count = 0; count < kDigits; ++count) {
        const auto digit = hexDigit(peek());
        if (!digit) {
            refuse(start, "a Unicode escape without four hex digits");
        }
        unit = unit * 16 + *digit;
        ++_at;
    }
    return unit;
}

PropertyList readText(Bytes bytes) {
    requireReadableSize(bytes);
    const std::string text(bytes.begin(), bytes.end());
    if (const auto invalid = invalidUtf8At(text)) {
        refuse(*invalid, "a byte that is no UTF-8");
    }
    return TextReader(text).document();
}

} // namespace

PropertyListResult parseTextPropertyList(Bytes bytes) {
    return refusedOr<PropertyList>([&]() -> PropertyListResult { return readText(bytes); });
}

} // namespace pallax
