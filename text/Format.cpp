#include "text/Format.h"

#include "text/NumberFormat.h"
#include "text/Text.h"

#include <stdexcept>

namespace pallax {

namespace {

std::string addressText(const void* address) {
    if (address == nullptr) {
        return "(nil)";
    }
    std::string out;
    NumberConversion conversion;
    conversion.conversion = 'x';
    conversion.wide = true;
    conversion.alternate = true;
    // An address is printed, never followed.
    const auto bits = reinterpret_cast<std::uintptr_t>(address); // NOLINT
    appendConverted(out, conversion, static_cast<std::int64_t>(bits));
    return out;
}

void appendArgument(std::string& out, const NumberConversion& conversion,
                    const FormatArgument& argument) {
    const char kind = conversion.conversion;
    const bool textual = kind == 's' || kind == '@' || kind == 'p';
    if (const auto* integer = std::get_if<std::int64_t>(&argument.value())) {
        NumberConversion fitting = conversion;
        if (textual) {
            fitting.conversion = 'd';
            fitting.wide = true;
        }
        appendConverted(out, fitting, *integer);
    } else if (const auto* real = std::get_if<double>(&argument.value())) {
        NumberConversion fitting = conversion;
        fitting.conversion = 'f';
        appendConverted(out, fitting, *real);
    } else {
        NumberConversion fitting = conversion;
        fitting.conversion = 's';
        if (const auto* text = std::get_if<std::string_view>(&argument.value())) {
            appendConverted(out, fitting, *text);
        } else if (const auto* address = std::get_if<const void*>(&argument.value())) {
            appendConverted(out, fitting, std::string_view(addressText(*address)));
        } else {
            const auto& [object, description] = std::get<FormatArgument::Object>(argument.value());
            appendConverted(out, fitting, std::string_view(description(object)));
        }
    }
}

} // namespace

FormatArgument::FormatArgument(const Text& text) : _value(text.view()) {}

std::string formatText(std::string_view format, std::initializer_list<FormatArgument> arguments) {
    std::string out;
    out.reserve(format.size() + 16 * arguments.size());
    const auto* next = arguments.begin();
    for (std::size_t at = 0; at < format.size();) {
        if (format[at] != '%') {
            out += format[at++];
            continue;
        }
        if (at + 1 < format.size() && format[at + 1] == '%') {
            out += '%';
            at += 2;
            continue;
        }
        const NumberConversion conversion = parseConversion(format, at);
        at += conversion.size;
        if (next != arguments.end()) {
            appendArgument(out, conversion, *next++);
        }
    }
    return out;
}

std::string dumpOf(const std::uint8_t* data, std::size_t size) {
    constexpr std::string_view kHexDigits = "0123456789abcdef";
    constexpr std::size_t kGroup = 4;
    std::string out = "<";
    for (std::size_t at = 0; at < size; ++at) {
        if (at != 0 && at % kGroup == 0) {
            out += ' ';
        }
        out += kHexDigits[data[at] >> 4U];
        out += kHexDigits[data[at] & 0x0FU];
    }
    out += '>';
    return out;
}

} // namespace pallax
