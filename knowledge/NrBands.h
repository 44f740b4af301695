#pragma once

#include "knowledge/Channels.h"

#include <cstdint>
#include <vector>

namespace pallax {

/// NR numbers frequencies, not the channels of a band: a number is in each band that contains its
/// frequency.
std::vector<Carrier> nrCarriersOf(std::uint32_t number);
std::vector<Carrier> nrCarriersAt(Hertz hertz);
std::vector<BandPart> nrBands();

} // namespace pallax
