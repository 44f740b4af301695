#pragma once

#include <cstdint>
#include <string>
#include <string_view>

/// ModemManager's numbers in words, as the display shows them. A number that is not known is
/// "unknown".
namespace pallax::modem_words {

std::string_view ofState(std::int64_t state);
std::string_view ofFailure(std::int64_t reason);
std::string_view ofLock(std::int64_t lock); ///< "SIM PIN"; empty if nothing is locked
std::string_view ofPower(std::int64_t power);
std::string_view ofRegistration(std::int64_t state);
std::string_view ofCdmaRegistration(std::int64_t state);
std::string_view ofPacketService(std::int64_t state);
std::string_view ofBearerType(std::int64_t type);
std::string_view ofIpType(std::int64_t family);

/// "LTE, NR" of a set of MMModemAccessTechnology. A set that no modem can use at once, such as GSM
/// with LTE, is what the modem could use, and empty as zero is.
std::string ofTechnologies(std::int64_t set);
/// The technology of the serving cell: "LTE" of LTE with NR; empty if the set does not tell.
std::string_view systemOf(std::int64_t set);

} // namespace pallax::modem_words
