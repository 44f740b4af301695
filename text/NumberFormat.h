#pragma once

#include <cstdint>
#include <stdexcept>
#include <string>
#include <string_view>

namespace pallax {

/// One conversion of a printf format ("%+5.2lf"), parsed.
struct NumberConversion {
    bool leftAlign = false;
    bool plusSign = false;
    bool zeroPad = false;
    bool blankSign = false;
    bool alternate = false;
    bool wide = false; ///< l, ll, z or j: 64 bits instead of 32
    int width = 0;
    int precision = -1;   ///< -1: none given
    char conversion = 0;  ///< d i u x X f c s p @
    std::size_t size = 0; ///< its length in the format text, including "%"
};

/// Sets the flag of a conversion; false if the character is not a flag.
constexpr bool takeFlag(NumberConversion& conversion, char flag) {
    switch (flag) {
    case '-':
        conversion.leftAlign = true;
        return true;
    case '+':
        conversion.plusSign = true;
        return true;
    case '0':
        conversion.zeroPad = true;
        return true;
    case ' ':
        conversion.blankSign = true;
        return true;
    case '#':
        conversion.alternate = true;
        return true;
    default:
        return false;
    }
}

/// Reads the conversion that starts at the "%" at `start`. Throws std::invalid_argument (a compile
/// error in a constant expression) for a conversion that this project does not use.
constexpr NumberConversion parseConversion(std::string_view format, std::size_t start) {
    NumberConversion result;
    std::size_t at = start + 1;
    const auto peek = [&] { return at < format.size() ? format[at] : '\0'; };
    const auto number = [&] {
        constexpr int kLargest = 400;
        int value = 0;
        while (peek() >= '0' && peek() <= '9') {
            value = value * 10 + (peek() - '0');
            if (value > kLargest) {
                throw std::invalid_argument("a width or precision above 400");
            }
            ++at;
        }
        return value;
    };
    while (takeFlag(result, peek())) {
        ++at;
    }
    result.width = number();
    if (peek() == '.') {
        ++at;
        result.precision = number();
    }
    while (peek() == 'l' || peek() == 'z' || peek() == 'j') {
        result.wide = true;
        ++at;
    }
    result.conversion = peek();
    if (std::string_view("diuxXfcsp@").find(result.conversion) == std::string_view::npos ||
        result.conversion == '\0') {
        throw std::invalid_argument("an unknown conversion");
    }
    result.size = at + 1 - start;
    return result;
}

/// A printf format for exactly one number ("%4.2f dBm"), parsed at compile time, with the unit of
/// the number. Its texts are those of printf in the C locale, independent of the user's locale;
/// not-a-number prints "nan", never "-nan".
class NumberFormat {
public:
    /// The unit is the text after the number if a blank separates it ("dBm"), or "%". The text must
    /// live as long as the program.
    consteval explicit NumberFormat(std::string_view printfText)
        : NumberFormat(printfText, unitOf(suffixOf(printfText))) {}

    consteval NumberFormat(std::string_view printfText, std::string_view unit) : _unit(unit) {
        const std::size_t start = conversionStart(printfText);
        _conversion = parseConversion(printfText, start);
        if (std::string_view("diuxXf").find(_conversion.conversion) == std::string_view::npos) {
            throw std::invalid_argument("not a number's conversion");
        }
        _prefix = printfText.substr(0, start);
        _suffix = printfText.substr(start + _conversion.size);
    }

    constexpr bool isReal() const { return _conversion.conversion == 'f'; }
    constexpr std::string_view unit() const { return _unit; }
    constexpr const NumberConversion& conversion() const { return _conversion; }
    /// The texts before and after the number, as in the format: "%%" is one per cent sign.
    constexpr std::string_view prefix() const { return _prefix; }
    constexpr std::string_view suffix() const { return _suffix; }

    void append(std::string& out, std::int64_t number) const;
    void append(std::string& out, double number) const;

private:
    static constexpr std::size_t conversionStart(std::string_view text) {
        std::size_t at = text.find('%');
        while (at != std::string_view::npos && at + 1 < text.size() && text[at + 1] == '%') {
            at = text.find('%', at + 2);
        }
        if (at == std::string_view::npos) {
            throw std::invalid_argument("a number format without a conversion");
        }
        return at;
    }
    static constexpr std::string_view suffixOf(std::string_view text) {
        const std::size_t start = conversionStart(text);
        return text.substr(start + parseConversion(text, start).size);
    }
    static constexpr std::string_view unitOf(std::string_view suffix) {
        if (suffix == "%%") {
            return suffix.substr(1);
        }
        return suffix.size() > 1 && suffix.front() == ' ' ? suffix.substr(1) : std::string_view();
    }

    std::string_view _prefix; // like the suffix, may contain "%%"
    std::string_view _suffix;
    std::string_view _unit;
    NumberConversion _conversion;
};

/// Appends one number formatted by `conversion`, in the C locale.
void appendConverted(std::string& out, const NumberConversion& conversion, std::int64_t number);
void appendConverted(std::string& out, const NumberConversion& conversion, double number);

/// Appends `text` padded to the conversion's width and cut to its precision.
void appendConverted(std::string& out, const NumberConversion& conversion, std::string_view text);

/// A number with its format: the value of a display row, formatted when it is read.
class DisplayNumber {
public:
    /// `format` must live as long as the program; a temporary is refused.
    DisplayNumber(std::int64_t number, const NumberFormat& format) : _format(&format) {
        if (format.isReal()) {
            _real = static_cast<double>(number);
        } else {
            _integer = number;
        }
    }
    /// With an integer's format, a real is truncated toward zero.
    DisplayNumber(double number, const NumberFormat& format) : _format(&format) {
        if (format.isReal()) {
            _real = number;
        } else {
            _integer = static_cast<std::int64_t>(number);
        }
    }
    DisplayNumber(std::int64_t number, const NumberFormat&& format) = delete;
    DisplayNumber(double number, const NumberFormat&& format) = delete;

    std::string text() const;
    void appendText(std::string& out) const;

    const NumberFormat& format() const { return *_format; }
    std::string_view unit() const { return _format->unit(); }
    bool isReal() const { return _format->isReal(); }
    std::int64_t integer() const { return _integer; } ///< only when not isReal()
    double real() const { return _real; }             ///< only when isReal()

    /// True only if both print the same text; false does not mean that the texts differ.
    bool sameNumberAndFormat(const DisplayNumber& other) const;

private:
    union {
        std::int64_t _integer;
        double _real;
    };
    const NumberFormat* _format;
};

} // namespace pallax
