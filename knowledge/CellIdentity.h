#pragma once

#include "knowledge/Channels.h"

#include <cstdint>
#include <optional>
#include <string>

namespace pallax {

/// An E-UTRAN cell identity of 28 bits: 20 for the base station, 8 for its cell.
struct LteCell {
    std::uint32_t eNodeB;
    std::uint32_t sector;

    friend bool operator==(const LteCell&, const LteCell&) = default;
};
std::optional<LteCell> lteCell(std::uint32_t identity);

/// A UTRAN cell identity of 28 bits: 12 for the controller, 16 for the cell.
struct UmtsCell {
    std::uint32_t rnc;
    std::uint32_t cell;

    friend bool operator==(const UmtsCell&, const UmtsCell&) = default;
};
std::optional<UmtsCell> umtsCell(std::uint32_t identity);

/// "104465-1" for a cell of LTE (eNodeB and sector), "408-4353" for one of UMTS (RNC and cell);
/// empty for other systems and for an identity of more than 28 bits.
std::string cellSiteText(RadioSystem system, std::uint32_t identity);

/// Base station identity code of 6 bits: network colour code, base station colour code.
struct ColourCodes {
    std::uint32_t ncc;
    std::uint32_t bcc;

    friend bool operator==(const ColourCodes&, const ColourCodes&) = default;
};
std::optional<ColourCodes> colourCodesOf(std::uint32_t bsic);

/// The distance to the cell in metres for a timing advance of GSM or LTE: half of the way that a
/// signal travels in that time. Nothing for other systems and for steps that the system does not
/// have.
std::optional<double> timingAdvanceMetres(RadioSystem system, std::uint32_t steps);

/// The bandwidth of an LTE carrier with so many resource blocks.
std::optional<double> lteBandwidthMegahertz(std::uint32_t resourceBlocks);

} // namespace pallax
