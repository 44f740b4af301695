#pragma once

#include <string_view>
#include <vector>

namespace pallax {

/// The countries that use a mobile country code of three digits, by their codes of ISO 3166 in
/// lower case ("de"), the main one first; empty for an unassigned or an international code.
std::vector<std::string_view> countryCodesOf(std::string_view mcc);

} // namespace pallax
