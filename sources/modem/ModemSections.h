#pragma once

#include "plist/PropertyList.h"

#include <string_view>

namespace pallax {

struct ModemView;

/// The sections of a picture (see ModemPicture.h) that are not about the radio.
Array connectionsOf(const ModemView& view);
Dictionary simOf(const ModemView& view, bool withIdentities);
Dictionary modemOf(const ModemView& view, bool withIdentities);

/// What every section is made with. Keys without a value are left out.
namespace modem_sections {

inline constexpr std::string_view kUnknown = "unknown";

/// The properties of an interface; never null.
DictionaryRef interfaceNamed(const ModemView& view, std::string_view name);
/// Why nothing is known of the modem.
std::string_view absenceOf(const ModemView& view);

/// Sets a text of the bus, if there is one.
void add(Dictionary& section, std::string_view key, const Dictionary& values,
         std::string_view property);
void addWord(Dictionary& section, std::string_view key, std::string_view word);
/// A number of at least 0.
void addNumber(Dictionary& section, std::string_view key, const Dictionary& values,
               std::string_view property, const char* format);

} // namespace modem_sections
} // namespace pallax
