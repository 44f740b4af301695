#include "decoding/DisplayJson.h"

#include "text/Base64.h"
#include "text/Printable.h"
#include "text/Utf8.h"

#include <algorithm>
#include <array>
#include <charconv>
#include <cmath>

namespace pallax {

namespace {

constexpr std::string_view kHexDigits = "0123456789abcdef";
constexpr unsigned char kFirstPrintable = 0x20;
constexpr unsigned char kDelete = 0x7F;
constexpr unsigned char kFirstBeyondAscii = 0x80;
constexpr char32_t kFirstBehindC1 = 0xA0;

bool isPlain(char character) {
    const auto byte = static_cast<unsigned char>(character);
    return byte >= kFirstPrintable && byte < kDelete && character != '"' && character != '\\';
}

void appendEscapedControl(std::string& out, char32_t code) {
    out += "\\u00";
    out += kHexDigits[code >> 4U];
    out += kHexDigits[code & 0xFU];
}

void appendEscapedAscii(std::string& out, char character) {
    constexpr std::string_view kNamed = "\"\\\b\f\n\r\t";
    constexpr std::string_view kNames = "\"\\bfnrt";
    const std::size_t named = kNamed.find(character);
    if (named != std::string_view::npos) {
        out += '\\';
        out += kNames[named];
        return;
    }
    appendEscapedControl(out, static_cast<unsigned char>(character));
}

void appendEscaped(std::string& out, std::string_view text) {
    while (!text.empty()) {
        std::size_t taken = 1;
        if (isPlain(text.front())) {
            out += text.front();
        } else if (static_cast<unsigned char>(text.front()) < kFirstBeyondAscii) {
            appendEscapedAscii(out, text.front());
        } else if (const Utf8CodePoint character = utf8At(text, 0); character.size == 0) {
            out += kReplacementCharacter;
        } else {
            taken = character.size;
            if (character.value < kFirstBehindC1) {
                appendEscapedControl(out, character.value);
            } else {
                out += text.substr(0, taken);
            }
        }
        text.remove_prefix(taken);
    }
}

/// Appends the value first and checks it in place, because almost every text needs no escape.
void appendStringValue(std::string& out, const PropertyList& object) {
    out += '"';
    const std::size_t start = out.size();
    (void)object.appendString(out);
    if (!std::all_of(out.begin() + static_cast<std::ptrdiff_t>(start), out.end(), isPlain)) {
        const std::string text = out.substr(start);
        out.resize(start);
        appendEscaped(out, text);
    }
    out += '"';
}

template <class Number>
void appendNumber(std::string& out, Number number) {
    constexpr std::size_t kLongest = 32; // "-2.2250738585072014e-308" has 24 characters
    std::array<char, kLongest> buffer{};
    const auto result = std::to_chars(buffer.data(), buffer.data() + buffer.size(), number);
    out.append(buffer.data(), result.ptr);
}

void appendReal(std::string& out, double number) {
    if (std::isfinite(number)) {
        appendNumber(out, number);
    } else {
        out += "null";
    }
}

void appendTyped(std::string& out, const DisplayNumber& number) {
    out += "{\"number\":";
    const std::size_t start = out.size();
    appendBareNumber(out, number);
    out += out.size() == start ? "null,\"unit\":" : ",\"unit\":";
    if (number.unit().empty()) {
        out += "null";
    } else {
        appendJsonString(out, number.unit());
    }
    out += ",\"text\":";
    appendJsonString(out, number.text());
    out += '}';
}

/// Where a value stands, and how numbers are written.
struct Writing {
    JsonNumbers numbers;
    int depth = 0;

    Writing inside() const { return {numbers, depth + 1}; }
};

void appendValue(std::string& out, const PropertyList& object, const Writing& writing);

void appendArray(std::string& out, const Array& elements, const Writing& writing) {
    out += '[';
    for (const PropertyList& element : elements) {
        out += &element == elements.data() ? "" : ",";
        appendValue(out, element, writing);
    }
    out += ']';
}

void appendDictionary(std::string& out, const Dictionary& entries, const Writing& writing) {
    out += '{';
    bool first = true;
    for (const Dictionary::Entry& entry : entries) {
        if (!entry.hasStringKey) {
            continue;
        }
        out += first ? "" : ",";
        first = false;
        appendJsonString(out, entry.key.view());
        out += ':';
        appendValue(out, entry.value, writing);
    }
    out += '}';
}

void appendValue(std::string& out, const PropertyList& object, const Writing& writing) {
    using Type = PropertyList::Type;
    switch (object.type()) {
    case Type::kNull:
        out += "null";
        return;
    case Type::kString:
        if (writing.numbers == JsonNumbers::Typed && object.displayNumber() != nullptr) {
            appendTyped(out, *object.displayNumber());
        } else {
            appendStringValue(out, object);
        }
        return;
    case Type::kInteger:
        if (const auto large = object.largeInteger()) {
            appendNumber(out, *large);
        } else {
            appendNumber(out, *object.integer());
        }
        return;
    case Type::kReal:
        appendReal(out, *object.real());
        return;
    case Type::kBoolean:
        out += *object.boolean() ? "true" : "false";
        return;
    case Type::kData:
        out += '"';
        out += base64Text(*object.data());
        out += '"';
        return;
    case Type::kDate:
        appendJsonString(out, isoDateText(*object.date()).value_or(dateText(*object.date())));
        return;
    case Type::kArray:
    case Type::kDictionary:
        break;
    }
    if (writing.depth >= kDeepestJson) {
        out += "null";
    } else if (const DictionaryRef dictionary = object.dictionary()) {
        appendDictionary(out, *dictionary, writing.inside());
    } else {
        appendArray(out, *object.array(), writing.inside());
    }
}

} // namespace

void appendJson(std::string& out, const PropertyList& object, JsonNumbers numbers) {
    appendValue(out, object, {numbers});
}

void appendBareNumber(std::string& out, const DisplayNumber& number) {
    const NumberConversion& shown = number.format().conversion();
    NumberConversion bare;
    bare.wide = shown.wide;
    bare.conversion = shown.conversion;
    if (number.isReal()) {
        bare.precision = shown.precision;
        if (std::isfinite(number.real())) {
            appendConverted(out, bare, number.real());
        }
        return;
    }
    if (bare.conversion == 'x' || bare.conversion == 'X') {
        bare.conversion = 'u';
    }
    appendConverted(out, bare, number.integer());
}

void appendJsonString(std::string& out, std::string_view text) {
    out += '"';
    if (std::all_of(text.begin(), text.end(), isPlain)) {
        out += text;
    } else {
        appendEscaped(out, text);
    }
    out += '"';
}

} // namespace pallax
