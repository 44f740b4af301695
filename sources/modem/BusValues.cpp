#include "sources/modem/BusValues.h"

#include <charconv>
#include <cmath>

namespace pallax::bus_values {

std::optional<std::string> textIn(const Dictionary& values, std::string_view key) {
    const PropertyList* value = values.find(key);
    auto text = value != nullptr ? value->string() : std::nullopt;
    return text && !text->empty() ? text : std::nullopt;
}

std::optional<std::int64_t> integerIn(const Dictionary& values, std::string_view key) {
    const PropertyList* value = values.find(key);
    return value != nullptr ? value->integer() : std::nullopt;
}

std::optional<double> realIn(const Dictionary& values, std::string_view key) {
    const PropertyList* value = values.find(key);
    if (value == nullptr) {
        return std::nullopt;
    }
    if (const auto integer = value->integer()) {
        return static_cast<double>(*integer);
    }
    const auto real = value->real();
    return real && std::isfinite(*real) ? real : std::nullopt;
}

std::optional<bool> truthIn(const Dictionary& values, std::string_view key) {
    const PropertyList* value = values.find(key);
    return value != nullptr ? value->boolean() : std::nullopt;
}

DictionaryRef dictionaryIn(const Dictionary& values, std::string_view key) {
    const PropertyList* value = values.find(key);
    return value != nullptr ? value->dictionary() : nullptr;
}

ArrayRef arrayIn(const Dictionary& values, std::string_view key) {
    const PropertyList* value = values.find(key);
    return value != nullptr ? value->array() : nullptr;
}

std::optional<std::int64_t> hexadecimalIn(std::string_view text) {
    constexpr int kBase = 16;
    std::uint64_t number = 0;
    const char* end = text.data() + text.size();
    const auto result = std::from_chars(text.data(), end, number, kBase);
    const bool isWhole = result.ec == std::errc() && result.ptr == end;
    return isWhole && number <= INT64_MAX ? std::optional(static_cast<std::int64_t>(number))
                                          : std::nullopt;
}

} // namespace pallax::bus_values
