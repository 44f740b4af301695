#pragma once

#include "plist/PropertyList.h"

#include <cstdint>
#include <optional>
#include <string>
#include <string_view>

/// Reads values from the bus, which are kept as property lists: a number of any D-Bus type is an
/// integer or a real, a struct is an array, a key that is a number is its decimal text. Each
/// function returns nothing if the value is missing or has another type.
namespace pallax::bus_values {

/// A text that is not empty.
std::optional<std::string> textIn(const Dictionary& values, std::string_view key);
std::optional<std::int64_t> integerIn(const Dictionary& values, std::string_view key);
/// Also of an integer; only a finite number.
std::optional<double> realIn(const Dictionary& values, std::string_view key);
std::optional<bool> truthIn(const Dictionary& values, std::string_view key);
/// Null if it is missing.
DictionaryRef dictionaryIn(const Dictionary& values, std::string_view key);
ArrayRef arrayIn(const Dictionary& values, std::string_view key);
/// A hexadecimal number without "0x".
std::optional<std::int64_t> hexadecimalIn(std::string_view text);

} // namespace pallax::bus_values
