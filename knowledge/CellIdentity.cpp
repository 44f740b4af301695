#include "knowledge/CellIdentity.h"

#include <array>
#include <utility>

namespace pallax {

namespace {

constexpr unsigned kIdentityBits = 28;
constexpr unsigned kSectorBits = 8;
constexpr unsigned kCellBits = 16;

constexpr std::uint32_t lowBits(std::uint32_t number, unsigned bits) {
    return number & ((1U << bits) - 1);
}

constexpr bool fits(std::uint32_t number, unsigned bits) {
    return number == lowBits(number, bits);
}

} // namespace

std::optional<LteCell> lteCell(std::uint32_t identity) {
    if (!fits(identity, kIdentityBits)) {
        return std::nullopt;
    }
    return LteCell{identity >> kSectorBits, lowBits(identity, kSectorBits)};
}

std::optional<UmtsCell> umtsCell(std::uint32_t identity) {
    if (!fits(identity, kIdentityBits)) {
        return std::nullopt;
    }
    return UmtsCell{identity >> kCellBits, lowBits(identity, kCellBits)};
}

std::string cellSiteText(RadioSystem system, std::uint32_t identity) {
    const auto pair = [](std::uint32_t site, std::uint32_t cell) {
        return std::to_string(site) + "-" + std::to_string(cell);
    };
    const auto lte = lteCell(identity);
    const auto umts = umtsCell(identity);
    if (system == RadioSystem::Lte && lte) {
        return pair(lte->eNodeB, lte->sector);
    }
    return system == RadioSystem::UmtsFdd && umts ? pair(umts->rnc, umts->cell) : "";
}

std::optional<ColourCodes> colourCodesOf(std::uint32_t bsic) {
    constexpr unsigned kBsicBits = 6;
    constexpr unsigned kColourBits = 3;
    if (!fits(bsic, kBsicBits)) {
        return std::nullopt;
    }
    return ColourCodes{bsic >> kColourBits, lowBits(bsic, kColourBits)};
}

std::optional<double> timingAdvanceMetres(RadioSystem system, std::uint32_t steps) {
    // Half of the way in a bit of GSM (48/13 us), and in 16 of LTE's time units (16 / 30.72 us).
    constexpr double kGsmStep = 553.46;
    constexpr std::uint32_t kMostGsmSteps = 219; // above 63 only in GSM 400
    constexpr double kLteStep = 78.12;
    constexpr std::uint32_t kMostLteSteps = 1282;
    if (system == RadioSystem::Gsm && steps <= kMostGsmSteps) {
        return steps * kGsmStep;
    }
    if (system == RadioSystem::Lte && steps <= kMostLteSteps) {
        return steps * kLteStep;
    }
    return std::nullopt;
}

std::optional<double> lteBandwidthMegahertz(std::uint32_t resourceBlocks) {
    constexpr auto kBandwidths = std::to_array<std::pair<std::uint32_t, double>>(
        {{6, 1.4}, {15, 3}, {25, 5}, {50, 10}, {75, 15}, {100, 20}});
    for (const auto& [blocks, megahertz] : kBandwidths) {
        if (blocks == resourceBlocks) {
            return megahertz;
        }
    }
    return std::nullopt;
}

} // namespace pallax
