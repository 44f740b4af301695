#pragma once

#include "knowledge/Channels.h"

#include <cstdint>
#include <span>
#include <string_view>

namespace pallax {

/// Channels with equal distances, paired in their order.
struct ChannelRow {
    /// One direction of the row; without channels if the band does not have it.
    struct Side {
        std::uint32_t first = 0;
        std::uint32_t last = 0;
        Hertz hertz = 0; ///< of `first`

        constexpr bool isEmpty() const { return hertz == 0; }
    };

    std::string_view band;
    Side downlink;
    Side uplink;
    Hertz spacing;                ///< between numbers that differ by one
    std::uint32_t numberStep = 1; ///< between the numbers that are channels
};

constexpr Hertz kKilohertz = 1000;

/// A frequency that the standards write in MHz with at most four decimals.
consteval Hertz fromMegahertz(double megahertz) {
    constexpr double kUnitsPerMegahertz = 10'000;
    constexpr double kHalf = 0.5;
    constexpr Hertz kHertzPerUnit = 100;
    return static_cast<Hertz>(megahertz * kUnitsPerMegahertz + kHalf) * kHertzPerUnit;
}

std::span<const ChannelRow> gsmRows();
std::span<const ChannelRow> umtsRows();
std::span<const ChannelRow> utraTddRows();
std::span<const ChannelRow> lteRows();
std::span<const ChannelRow> cdmaRows();

} // namespace pallax
