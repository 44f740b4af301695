#include "knowledge/ChannelRows.h"

#include <array>

namespace pallax {

namespace {

constexpr Hertz kStep12 = 12'500;
constexpr Hertz kStep20 = 20 * kKilohertz;
constexpr Hertz kStep25 = 25 * kKilohertz;
constexpr Hertz kStep30 = 30 * kKilohertz;
constexpr Hertz kStep50 = 50 * kKilohertz;

/// Both directions have the same numbers; frequencies of the first channel, in MHz.
consteval ChannelRow cdmaRow(std::string_view bandClass, std::uint32_t first, std::uint32_t last,
                             Hertz spacing, double downlink, double uplink) {
    return {bandClass,
            {first, last, fromMegahertz(downlink)},
            {first, last, fromMegahertz(uplink)},
            spacing};
}

consteval ChannelRow downlinkOnly(std::string_view bandClass, std::uint32_t first,
                                  std::uint32_t last, Hertz spacing, double downlink) {
    return {bandClass, {first, last, fromMegahertz(downlink)}, {}, spacing};
}

// 3GPP2 C.S0057, section 2.
constexpr auto kRows = std::to_array<ChannelRow>({
    // clang-format off
    cdmaRow("0",     1,  799, kStep30,  870.030,   825.030),
    cdmaRow("0",   991, 1023, kStep30,  869.040,   824.040),
    cdmaRow("0",  1024, 1323, kStep30,  860.040,   815.040),
    cdmaRow("1",     0, 1199, kStep50, 1930.000,  1850.000),
    cdmaRow("2",     0, 1000, kStep25,  934.9875,  889.9875),
    cdmaRow("2",  1329, 2047, kStep25,  917.0125,  872.0125),
    cdmaRow("3",     1,  799, kStep12,  860.0125,  915.0125),
    cdmaRow("3",   801, 1039, kStep12,  843.0125,  898.0125),
    cdmaRow("3",  1041, 1199, kStep12,  832.0125,  887.0125),
    cdmaRow("3",  1201, 1600, kStep12,  838.0125,  893.0125),
    cdmaRow("4",     0,  599, kStep50, 1840.000,  1750.000),
    cdmaRow("5",     1,  300, kStep25,  460.000,   450.000),
    cdmaRow("5",   539,  871, kStep25,  421.675,   411.675),
    cdmaRow("5",  1039, 1473, kStep20,  461.310,   451.310),
    cdmaRow("5",  1792, 2016, kStep20,  489.000,   479.000),
    cdmaRow("6",     0, 1199, kStep50, 2110.000,  1920.000),
    cdmaRow("7",     0,  240, kStep50,  746.000,   776.000),
    cdmaRow("8",     0, 1499, kStep50, 1805.000,  1710.000),
    cdmaRow("9",     0,  699, kStep50,  925.000,   880.000),
    cdmaRow("10",    0,  719, kStep25,  851.000,   806.000),
    cdmaRow("10",  720,  919, kStep25,  935.000,   896.000),
    cdmaRow("11",    1,  400, kStep25,  460.000,   450.000),
    cdmaRow("11", 1001, 1400, kStep25,  420.000,   410.000),
    cdmaRow("12",    0,  239, kStep25,  915.0125,  870.0125),
    cdmaRow("13",    0, 1399, kStep50, 2620.000,  2500.000),
    cdmaRow("14",    0, 1299, kStep50, 1930.000,  1850.000),
    cdmaRow("15",    0,  899, kStep50, 2110.000,  1710.000),
    cdmaRow("16",  140, 1459, kStep50, 2624.000,  2502.000),
    downlinkOnly("17", 140, 1459, kStep50, 2624.000),
    cdmaRow("18",    0,  240, kStep50,  757.000,   787.000),
    cdmaRow("19",    0,  360, kStep50,  728.000,   698.000),
    cdmaRow("20",    0,  680, kStep50, 1525.000,  1626.500),
    cdmaRow("21",    0,  399, kStep50, 2180.000,  2000.000),
    // clang-format on
});

} // namespace

std::span<const ChannelRow> cdmaRows() {
    return kRows;
}

} // namespace pallax
