#include "text/NumberFormat.h"

#include <array>
#include <charconv>
#include <cmath>

namespace pallax {

namespace {

// The largest double has 309 digits before the decimal point; a precision is at most 400.
constexpr std::size_t kLongestNumber = 309 + 1 + 400 + 1;
constexpr int kDefaultPrecision = 6;

void appendUnescaped(std::string& out, std::string_view text) {
    for (std::size_t at = 0; at < text.size(); ++at) {
        out += text[at];
        if (text[at] == '%') {
            ++at; // "%%" is one per cent sign
        }
    }
}

/// Sign and digits, padded to the width with zeros between them or blanks outside.
void appendPadded(std::string& out, const NumberConversion& conversion, std::string_view sign,
                  std::string_view digits, bool zeroPad) {
    const std::size_t length = sign.size() + digits.size();
    const auto width = static_cast<std::size_t>(conversion.width);
    const std::size_t padding = width > length ? width - length : 0;
    if (!conversion.leftAlign && !zeroPad) {
        out.append(padding, ' ');
    }
    out += sign;
    if (!conversion.leftAlign && zeroPad) {
        out.append(padding, '0');
    }
    out += digits;
    if (conversion.leftAlign) {
        out.append(padding, ' ');
    }
}

std::string_view signOf(const NumberConversion& conversion, bool negative) {
    if (negative) {
        return "-";
    }
    if (conversion.plusSign) {
        return "+";
    }
    return conversion.blankSign ? " " : "";
}

void appendInteger(std::string& out, const NumberConversion& conversion, std::uint64_t magnitude,
                   std::string_view sign) {
    std::array<char, 64> buffer{};
    const bool hexadecimal = conversion.conversion == 'x' || conversion.conversion == 'X';
    const auto end = std::to_chars(buffer.data(), buffer.data() + buffer.size(), magnitude,
                                   hexadecimal ? 16 : 10)
                         .ptr;
    std::string digits(buffer.data(), end);
    if (conversion.conversion == 'X') {
        for (char& digit : digits) {
            digit = digit >= 'a' ? static_cast<char>(digit - 'a' + 'A') : digit;
        }
    }
    const auto fewest =
        static_cast<std::size_t>(conversion.precision < 0 ? 0 : conversion.precision);
    if (digits.size() < fewest) {
        digits.insert(0, fewest - digits.size(), '0');
    }
    appendPadded(out, conversion, sign, digits, conversion.zeroPad && conversion.precision < 0);
}

} // namespace

void appendConverted(std::string& out, const NumberConversion& conversion, std::int64_t number) {
    switch (conversion.conversion) {
    case 'd':
    case 'i': {
        const std::int64_t value =
            conversion.wide ? number
                            : static_cast<std::int32_t>(static_cast<std::uint32_t>(number));
        const auto bits = static_cast<std::uint64_t>(value);
        appendInteger(out, conversion, value < 0 ? 0 - bits : bits, signOf(conversion, value < 0));
        return;
    }
    case 'f':
        appendConverted(out, conversion, static_cast<double>(number));
        return;
    case 'c': {
        const char character = static_cast<char>(number);
        appendConverted(out, conversion, std::string_view(&character, 1));
        return;
    }
    default: {
        const auto bits = static_cast<std::uint64_t>(number);
        const std::uint64_t value = conversion.wide ? bits : static_cast<std::uint32_t>(bits);
        const bool marked = conversion.alternate && value != 0 && conversion.conversion != 'u';
        appendInteger(out, conversion, value, marked ? "0x" : "");
        return;
    }
    }
}

void appendConverted(std::string& out, const NumberConversion& conversion, double number) {
    const bool negative = std::signbit(number) && !std::isnan(number);
    const std::string_view sign = signOf(conversion, negative);
    if (!std::isfinite(number)) {
        appendPadded(out, conversion, sign, std::isnan(number) ? "nan" : "inf", false);
        return;
    }
    const int precision = conversion.precision < 0 ? kDefaultPrecision : conversion.precision;
    std::array<char, kLongestNumber> buffer; // NOLINT: written before it is read
    const auto end = std::to_chars(buffer.data(), buffer.data() + buffer.size(), std::fabs(number),
                                   std::chars_format::fixed, precision)
                         .ptr;
    const auto length = static_cast<std::size_t>(end - buffer.data());
    appendPadded(out, conversion, sign, std::string_view(buffer.data(), length),
                 conversion.zeroPad);
}

void appendConverted(std::string& out, const NumberConversion& conversion, std::string_view text) {
    if (conversion.precision >= 0 && conversion.conversion == 's') {
        text = text.substr(0, static_cast<std::size_t>(conversion.precision));
    }
    appendPadded(out, conversion, "", text, false);
}

void NumberFormat::append(std::string& out, std::int64_t number) const {
    appendUnescaped(out, _prefix);
    appendConverted(out, _conversion, number);
    appendUnescaped(out, _suffix);
}

void NumberFormat::append(std::string& out, double number) const {
    appendUnescaped(out, _prefix);
    appendConverted(out, _conversion, number);
    appendUnescaped(out, _suffix);
}

void DisplayNumber::appendText(std::string& out) const {
    if (isReal()) {
        _format->append(out, _real);
    } else {
        _format->append(out, _integer);
    }
}

std::string DisplayNumber::text() const {
    std::string out;
    appendText(out);
    return out;
}

bool DisplayNumber::sameNumberAndFormat(const DisplayNumber& other) const {
    if (_format != other._format) {
        return false;
    }
    if (!isReal()) {
        return _integer == other._integer;
    }
    return _real == other._real && std::signbit(_real) == std::signbit(other._real);
}

} // namespace pallax
