#pragma once

#include <span>
#include <string_view>

namespace pallax {

/// The fields that tell where a phone is: identities of cells and areas that are unique in their
/// network. Codes that are used again and again (PCI, scrambling code, BSIC, PN) are not among
/// them.
std::span<const std::string_view> placeFields();

} // namespace pallax
