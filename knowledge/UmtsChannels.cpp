#include "knowledge/ChannelRows.h"

#include <array>

namespace pallax {

namespace {

constexpr Hertz kRaster = 200 * kKilohertz;

/// A UARFCN is five times the distance from an offset, in MHz.
consteval ChannelRow::Side sideOf(std::uint32_t first, std::uint32_t last, double offset) {
    // Offsets below 0 are shifted, because fromMegahertz rounds upwards.
    constexpr double kShift = 1000;
    return {first, last, first * kRaster + fromMegahertz(offset + kShift) - fromMegahertz(kShift)};
}

/// First and last number of a direction, and its offset.
struct Range {
    std::uint32_t first;
    std::uint32_t last;
    double offset;
};

consteval ChannelRow general(std::string_view band, Range downlink, Range uplink) {
    return {band, sideOf(downlink.first, downlink.last, downlink.offset),
            sideOf(uplink.first, uplink.last, uplink.offset), kRaster};
}

/// The uplink's numbers of additional channels are those of the downlink less a distance.
consteval ChannelRow additional(std::string_view band, Range downlink, std::uint32_t distance,
                                double uplinkOffset) {
    constexpr std::uint32_t kStep = 25;
    return {band, sideOf(downlink.first, downlink.last, downlink.offset),
            sideOf(downlink.first - distance, downlink.last - distance, uplinkOffset), kRaster,
            kStep};
}

// 3GPP TS 25.101, tables 5.1, 5.1A and 5.2: general channels of each band, then the additional
// ones, which lie 100 kHz beside the raster and 5 MHz apart.
constexpr auto kFddRows = std::to_array<ChannelRow>({
    // clang-format off
    general("I",      {10562, 10838,     0}, {9612, 9888,    0}),
    general("II",     { 9662,  9938,     0}, {9262, 9538,    0}),
    additional("II",  {  412,   687, 1850.1}, 400, 1850.1),
    general("III",    { 1162,  1513,  1575}, { 937, 1288, 1525}),
    general("IV",     { 1537,  1738,  1805}, {1312, 1513, 1450}),
    additional("IV",  { 1887,  2087, 1735.1}, 225, 1380.1),
    general("V",      { 4357,  4458,     0}, {4132, 4233,    0}),
    additional("V",   { 1007,  1032,  670.1}, 225,  670.1),
    additional("V",   { 1012,  1087,  670.1}, 225,  670.1),
    general("VI",     { 4387,  4413,     0}, {4162, 4188,    0}),
    additional("VI",  { 1037,  1062,  670.1}, 225,  670.1),
    general("VII",    { 2237,  2563,  2175}, {2012, 2338, 2100}),
    additional("VII", { 2587,  2912, 2105.1}, 225, 2030.1),
    general("VIII",   { 2937,  3088,   340}, {2712, 2863,  340}),
    general("IX",     { 9237,  9387,     0}, {8762, 8912,    0}),
    general("X",      { 3112,  3388,  1490}, {2887, 3163, 1135}),
    additional("X",   { 3412,  3687, 1430.1}, 225, 1075.1),
    general("XI",     { 3712,  3787,   736}, {3487, 3562,  733}),
    general("XII",    { 3842,  3903,   -37}, {3617, 3678,  -22}),
    additional("XII", { 3932,  3957,  -54.9}, 225,  -39.9),
    additional("XII", { 3962,  3987,  -54.9}, 225,  -39.9),
    additional("XII", { 3992,  3992,  -54.9}, 225,  -39.9),
    general("XIII",   { 4017,  4043,   -55}, {3792, 3818,   21}),
    additional("XIII", {4067,  4092,  -64.9}, 225,   11.1),
    general("XIV",    { 4117,  4143,   -63}, {3892, 3918,   12}),
    additional("XIV", { 4167,  4192,  -72.9}, 225,    2.1),
    general("XIX",    {  712,   763,   735}, { 312,  363,  770}),
    additional("XIX", {  787,   837,  720.1}, 400,  755.1),
    general("XX",     { 4512,  4638,  -109}, {4287, 4413,  -23}),
    general("XXI",    {  862,   912,  1326}, { 462,  512, 1358}),
    general("XXII",   { 4662,  5038,  2580}, {4437, 4813, 2525}),
    general("XXV",    { 5112,  5413,   910}, {4887, 5188,  875}),
    additional("XXV", { 6292,  6592,  674.1}, 225,  639.1),
    general("XXVI",   { 5762,  5913,  -291}, {5537, 5688, -291}),
    additional("XXVI", {5937,  5987, -325.9}, 225, -325.9),
    additional("XXVI", {5992,  6067, -325.9}, 225, -325.9),
    additional("XXVI", {6012,  6087, -325.9}, 225, -325.9),
    {"XXXII", sideOf(6617, 6813, 131), {}, kRaster},
    // clang-format on
});

/// Five times the frequency in MHz, for both directions.
consteval ChannelRow tdd(std::string_view band, std::uint32_t first, std::uint32_t last) {
    return {band, sideOf(first, last, 0), sideOf(first, last, 0), kRaster};
}

// 3GPP TS 25.102, section 5.4.3: the channels of the option with 1.28 Mcps, which contain those of
// the wider ones.
constexpr auto kTddRows = std::to_array<ChannelRow>({
    // clang-format off
    tdd("a",  9504,  9596),
    tdd("a", 10054, 10121),
    tdd("b",  9254,  9546),
    tdd("b",  9654,  9946),
    tdd("c",  9554,  9646),
    tdd("d", 12854, 13096),
    tdd("e", 11504, 11996),
    tdd("f",  9404,  9596),
    // clang-format on
});

} // namespace

std::span<const ChannelRow> umtsRows() {
    return kFddRows;
}

std::span<const ChannelRow> utraTddRows() {
    return kTddRows;
}

} // namespace pallax
