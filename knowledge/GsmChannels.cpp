#include "knowledge/ChannelRows.h"

#include <array>

namespace pallax {

namespace {

/// Both directions have the same numbers.
consteval ChannelRow gsmRow(std::string_view band, std::uint32_t first, std::uint32_t last,
                            double downlink, double uplink) {
    return {band,
            {first, last, fromMegahertz(downlink)},
            {first, last, fromMegahertz(uplink)},
            200 * kKilohertz};
}

// 3GPP TS 45.005, section 2; frequencies of the first channel, in MHz. P-GSM is part of E-GSM, and
// so on: each channel of 900 MHz is listed once, in the smallest band.
//
// The network assigns the numbers of GSM 710 and T-GSM 810. GSM 710 therefore has no row; the
// numbers of T-GSM 810 are those that other programs assume. In GSM 750, phones send above the
// network.
constexpr auto kRows = std::to_array<ChannelRow>({
    // clang-format off
    gsmRow("GSM 450",    259,  293,  460.6,  450.6),
    gsmRow("GSM 480",    306,  340,  489.0,  479.0),
    gsmRow("GSM 750",    438,  511,  747.2,  777.2),
    gsmRow("T-GSM 810",  350,  425,  851.0,  806.0),
    gsmRow("GSM 850",    128,  251,  869.2,  824.2),
    gsmRow("P-GSM 900",    1,  124,  935.2,  890.2),
    gsmRow("E-GSM 900",    0,    0,  935.0,  890.0),
    gsmRow("E-GSM 900",  975, 1023,  925.2,  880.2),
    gsmRow("R-GSM 900",  955,  974,  921.2,  876.2),
    gsmRow("DCS 1800",   512,  885, 1805.2, 1710.2),
    gsmRow("PCS 1900",   512,  810, 1930.2, 1850.2),
    // clang-format on
});

constexpr auto kUnnumbered = std::to_array<UnnumberedBand>({
    {"GSM 710", {fromMegahertz(728), fromMegahertz(746)}, {fromMegahertz(698), fromMegahertz(716)}},
});

} // namespace

std::span<const ChannelRow> gsmRows() {
    return kRows;
}

std::span<const UnnumberedBand> unnumberedBandsOf(RadioSystem system) {
    return system == RadioSystem::Gsm ? kUnnumbered : std::span<const UnnumberedBand>();
}

} // namespace pallax
