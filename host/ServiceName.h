#pragma once

#include <string>
#include <string_view>

namespace pallax {

/// Whether a telephony service can have this name, which is also that of its folder: 1 to 32
/// letters, digits, "-", "_" and ".", beginning with neither "-" nor ".".
bool isServiceName(std::string_view text);

/// What users read of the modem behind a service: the service's name, or "live modem" if it is
/// empty.
std::string liveModemName(std::string_view service);

} // namespace pallax
