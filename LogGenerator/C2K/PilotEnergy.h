#pragma once

#include "LogGenerator/C2K/C2KFormats.h"
#include "LogGenerator/Records/Layout.h"

#include <array>
#include <cmath>

namespace pallax {

/// Shown for an empty list by pilot.
inline constexpr std::string_view kNoPilots = "(none)";

/// The energy of a pilot, 16 bits at `Byte` of its entry; minus infinity for 0.
template <std::size_t Byte>
PropertyList pilotEnergy(const Place& place) {
    constexpr double kFullScale = 512.0;
    return DisplayNumber(10.0 * std::log10(place.here.u16(Byte) / kFullScale), kSignedLevelDb);
}
template <std::size_t Byte>
inline constexpr std::array<Extent, 1> kPilotEnergyBytes{extentOf(u16At(Byte))};
template <std::size_t Byte>
inline constexpr Computation kPilotEnergy{"energy", "10 x log10(raw / 512)",
                                          kPilotEnergyBytes<Byte>, pilotEnergy<Byte>};

} // namespace pallax
