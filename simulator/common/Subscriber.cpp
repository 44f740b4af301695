#include "simulator/common/Subscriber.h"

#include <utility>

namespace pallax {

namespace {

constexpr unsigned kByte = 8;

/// 262 42, digits in pairs, low digit first.
constexpr std::uint8_t kPlmn1 = 0x62;
constexpr std::uint8_t kPlmn2 = 0xF2;
constexpr std::uint8_t kPlmn3 = 0x24;

PropertyList textOf(std::string_view text) {
    return std::string(text);
}

} // namespace

PropertyList simFiles(std::string_view mode, unsigned area) {
    const auto high = static_cast<std::uint8_t>(area >> kByte);
    const auto low = static_cast<std::uint8_t>(area);
    return Dictionary{
        {"kSimFile_ICCID", "89490200001234567890"},
        {"kSimFile_MSISDN", "+4915112345678"},
        {"kSimFile_MBDN", "3311"},
        {"kSimFile_HPPLMN", PropertyList::integer(6)},
        // Temporary identity, location area, a reserved byte, status "updated".
        {"kSimFile_LOCI", PropertyList::data({0xA1, 0xB2, 0xC3, 0xD4, kPlmn1, kPlmn2, kPlmn3, high,
                                              low, 0xFF, 0x00})},
        // Temporary identity, its signature, routing area, status "updated".
        {"kSimFile_PSLOCI", PropertyList::data({0xE5, 0xF6, 0x07, 0x18, 0x29, 0x3A, 0x4B, kPlmn1,
                                                kPlmn2, kPlmn3, high, low, 0x07, 0x00})},
        {"kSimFile_ACC", "0x0100"},
        {"kSimFile_AD", PropertyList::data({0x00, 0x00, 0x00, 0x02})},
        {"kSimFile_FPLMN", Array{"26201", "26202"}},
        {"kSimFile_AHPLMN", "26242"},
        {"kSimFile_RATMODE", textOf(mode)},
        {"kSimFile_PNN", "Sample Net"},
        {"kSimFile_OPL", Array()},
        {"kSimFile_OPLMNAcT", Array{"26242"}},
    };
}

bool SimReading::isDue(const Scenario& scenario) {
    const Activity::Phase phase = scenario.activity().phase();
    if (phase == Activity::Phase::Registering || phase == Activity::Phase::Updating) {
        _isUpdating = true;
    }
    // Another cell may be in an area that is not yet updated.
    const bool settled = phase == Activity::Phase::Idle && !scenario.hasNewServingCell();
    const bool updated = settled && std::exchange(_isUpdating, false);
    return updated || scenario.now().count() == 0;
}

PropertyList pdpContexts(std::string_view standing, bool session) {
    Array contexts = {Dictionary{{"APN", textOf(standing)}, {"State", "Active"}}};
    if (session) {
        contexts.emplace_back(
            Dictionary{{"APN", "internet"}, {"Address", "10.17.4.21"}, {"State", "Active"}});
    }
    return contexts;
}

} // namespace pallax
