#include "sources/modem/ModemWords.h"

#include <array>
#include <cstddef>
#include <span>

namespace pallax::modem_words {

namespace {

using Words = std::span<const std::string_view>;

constexpr std::string_view kUnknown = "unknown";

constexpr auto kStates = std::to_array<std::string_view>(
    {"failed", "unknown", "initializing", "locked", "disabled", "disabling", "enabling", "enabled",
     "searching", "registered", "disconnecting", "connecting", "connected"});
constexpr auto kFailures = std::to_array<std::string_view>(
    {"", "unknown", "SIM missing", "SIM error", "unknown capabilities", "eSIM without profiles"});
constexpr auto kLocks = std::to_array<std::string_view>(
    {"", "", "SIM PIN", "SIM PIN2", "SIM PUK", "SIM PUK2", "service provider PIN",
     "service provider PUK", "network PIN", "network PUK", "phone PIN", "corporate PIN",
     "corporate PUK", "first SIM PIN", "first SIM PUK", "network subset PIN",
     "network subset PUK"});
constexpr auto kPowers = std::to_array<std::string_view>({"unknown", "off", "low", "on"});
constexpr auto kRegistrations = std::to_array<std::string_view>(
    {"idle", "home", "searching", "denied", "unknown", "roaming", "home, SMS only",
     "roaming, SMS only", "emergency only", "home, CSFB not preferred",
     "roaming, CSFB not preferred", "restricted local operator services"});
constexpr auto kCdmaRegistrations =
    std::to_array<std::string_view>({"unknown", "registered", "home", "roaming"});
constexpr auto kPacketServices =
    std::to_array<std::string_view>({"unknown", "detached", "attached"});
constexpr auto kBearerTypes =
    std::to_array<std::string_view>({"unknown", "default", "initial", "dedicated"});

std::string_view wordIn(Words words, std::int64_t number) {
    const bool isThere = number >= 0 && static_cast<std::uint64_t>(number) < words.size();
    return isThere ? words[static_cast<std::size_t>(number)] : kUnknown;
}

struct Technology {
    unsigned bit;
    std::string_view name;
    std::string_view system;
};

/// The bits of MMModemAccessTechnology that a mobile modem uses.
constexpr auto kTechnologies = std::to_array<Technology>({
    {1, "GSM", "GSM"},
    {2, "GSM", "GSM"},
    {3, "GPRS", "GSM"},
    {4, "EDGE", "GSM"},
    {5, "UMTS", "UMTS"},
    {6, "HSDPA", "UMTS"},
    {7, "HSUPA", "UMTS"},
    {8, "HSPA", "UMTS"},
    {9, "HSPA+", "UMTS"},
    {10, "1xRTT", "CDMA"},
    {11, "EV-DO", "CDMA"},
    {12, "EV-DO A", "CDMA"},
    {13, "EV-DO B", "CDMA"},
    {14, "LTE", "LTE"},
    {15, "NR", "NR"},
    {16, "LTE-M", "LTE"},
    {17, "NB-IoT", "LTE"},
});

bool isIn(std::int64_t set, const Technology& technology) {
    return ((static_cast<std::uint64_t>(set) >> technology.bit) & 1U) != 0;
}

/// LTE with NR (a 5G phone with an LTE anchor) is the only pair of systems that serve at once.
bool isPair(std::string_view a, std::string_view b) {
    return a == "LTE" && b == "NR";
}

} // namespace

std::string_view ofState(std::int64_t state) {
    constexpr std::int64_t kFirst = -1;
    return state >= kFirst && state < static_cast<std::int64_t>(kStates.size())
               ? wordIn(kStates, state - kFirst)
               : kUnknown;
}

std::string_view ofFailure(std::int64_t reason) {
    return wordIn(kFailures, reason);
}
std::string_view ofLock(std::int64_t lock) {
    return wordIn(kLocks, lock);
}
std::string_view ofPower(std::int64_t power) {
    return wordIn(kPowers, power);
}
std::string_view ofRegistration(std::int64_t state) {
    return wordIn(kRegistrations, state);
}
std::string_view ofCdmaRegistration(std::int64_t state) {
    return wordIn(kCdmaRegistrations, state);
}
std::string_view ofPacketService(std::int64_t state) {
    return wordIn(kPacketServices, state);
}
std::string_view ofBearerType(std::int64_t type) {
    return wordIn(kBearerTypes, type);
}

std::string_view ofIpType(std::int64_t family) {
    switch (family) {
    case 1:
        return "IPv4";
    case 2:
        return "IPv6";
    case 4:
        return "IPv4v6";
    default:
        return "";
    }
}

std::string_view systemOf(std::int64_t set) {
    std::string_view system;
    for (const Technology& technology : kTechnologies) {
        if (!isIn(set, technology) || technology.system == system ||
            isPair(system, technology.system)) {
            continue;
        }
        // NB-IoT and LTE-M stand behind NR.
        if (!system.empty() && !isPair(technology.system, system)) {
            return {};
        }
        system = technology.system;
    }
    return system;
}

std::string ofTechnologies(std::int64_t set) {
    std::string names;
    if (systemOf(set).empty()) {
        return names;
    }
    std::string_view latest;
    for (const Technology& technology : kTechnologies) {
        if (isIn(set, technology) && technology.name != latest) {
            names.append(names.empty() ? "" : ", ").append(technology.name);
            latest = technology.name;
        }
    }
    return names;
}

} // namespace pallax::modem_words
