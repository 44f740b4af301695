#include "knowledge/NrBands.h"

#include "knowledge/ChannelRows.h"

#include <array>
#include <utility>

namespace pallax {

namespace {

/// The global frequency raster: 3GPP TS 38.104, table 5.4.2.1-1.
struct RasterPart {
    std::uint32_t first;
    std::uint32_t last;
    Hertz hertz; ///< of `first`
    Hertz spacing;
};

constexpr auto kRaster = std::to_array<RasterPart>({
    {0, 599'999, 0, 5 * kKilohertz},
    {600'000, 2'016'666, fromMegahertz(3000), 15 * kKilohertz},
    {2'016'667, 3'279'165, fromMegahertz(24'250.08), 60 * kKilohertz},
});

struct Range {
    Hertz first = 0;
    Hertz last = 0;

    constexpr bool contains(Hertz hertz) const {
        return !isEmpty() && hertz >= first && hertz <= last;
    }
    constexpr bool isEmpty() const { return last == 0; }
};

struct NrBand {
    std::string_view name;
    Range downlink;
    Range uplink;
};

consteval Range rangeOf(double first, double last) {
    return {fromMegahertz(first), fromMegahertz(last)};
}

consteval NrBand fdd(std::string_view name, Range downlink, Range uplink) {
    return {name, downlink, uplink};
}

consteval NrBand tdd(std::string_view name, double first, double last) {
    return {name, rangeOf(first, last), rangeOf(first, last)};
}

consteval NrBand downlinkOnly(std::string_view name, double first, double last) {
    return {name, rangeOf(first, last), {}};
}

consteval NrBand uplinkOnly(std::string_view name, double first, double last) {
    return {name, {}, rangeOf(first, last)};
}

// 3GPP TS 38.101-1, table 5.2-1, and TS 38.101-2, table 5.2-1, release 16. The distance of the
// directions varies in n91 to n94, so their sides stand alone.
constexpr auto kBands = std::to_array<NrBand>({
    // clang-format off
    fdd("n1",  rangeOf(2110, 2170), rangeOf(1920, 1980)),
    fdd("n2",  rangeOf(1930, 1990), rangeOf(1850, 1910)),
    fdd("n3",  rangeOf(1805, 1880), rangeOf(1710, 1785)),
    fdd("n5",  rangeOf( 869,  894), rangeOf( 824,  849)),
    fdd("n7",  rangeOf(2620, 2690), rangeOf(2500, 2570)),
    fdd("n8",  rangeOf( 925,  960), rangeOf( 880,  915)),
    fdd("n12", rangeOf( 729,  746), rangeOf( 699,  716)),
    fdd("n14", rangeOf( 758,  768), rangeOf( 788,  798)),
    fdd("n18", rangeOf( 860,  875), rangeOf( 815,  830)),
    fdd("n20", rangeOf( 791,  821), rangeOf( 832,  862)),
    fdd("n25", rangeOf(1930, 1995), rangeOf(1850, 1915)),
    fdd("n26", rangeOf( 859,  894), rangeOf( 814,  849)),
    fdd("n28", rangeOf( 758,  803), rangeOf( 703,  748)),
    downlinkOnly("n29", 717, 728),
    fdd("n30", rangeOf(2350, 2360), rangeOf(2305, 2315)),
    tdd("n34", 2010, 2025),
    tdd("n38", 2570, 2620),
    tdd("n39", 1880, 1920),
    tdd("n40", 2300, 2400),
    tdd("n41", 2496, 2690),
    tdd("n46", 5150, 5925),
    tdd("n47", 5855, 5925),
    tdd("n48", 3550, 3700),
    tdd("n50", 1432, 1517),
    tdd("n51", 1427, 1432),
    tdd("n53", 2483.5, 2495),
    fdd("n65", rangeOf(2110, 2200), rangeOf(1920, 2010)),
    fdd("n66", rangeOf(2110, 2200), rangeOf(1710, 1780)),
    fdd("n70", rangeOf(1995, 2020), rangeOf(1695, 1710)),
    fdd("n71", rangeOf( 617,  652), rangeOf( 663,  698)),
    fdd("n74", rangeOf(1475, 1518), rangeOf(1427, 1470)),
    downlinkOnly("n75", 1432, 1517),
    downlinkOnly("n76", 1427, 1432),
    tdd("n77", 3300, 4200),
    tdd("n78", 3300, 3800),
    tdd("n79", 4400, 5000),
    uplinkOnly("n80", 1710, 1785),
    uplinkOnly("n81",  880,  915),
    uplinkOnly("n82",  832,  862),
    uplinkOnly("n83",  703,  748),
    uplinkOnly("n84", 1920, 1980),
    uplinkOnly("n86", 1710, 1780),
    uplinkOnly("n89",  824,  849),
    tdd("n90", 2496, 2690),
    downlinkOnly("n91", 1427, 1432),
    uplinkOnly("n91",    832,  862),
    downlinkOnly("n92", 1432, 1517),
    uplinkOnly("n92",    832,  862),
    downlinkOnly("n93", 1427, 1432),
    uplinkOnly("n93",    880,  915),
    downlinkOnly("n94", 1432, 1517),
    uplinkOnly("n94",    880,  915),
    uplinkOnly("n95", 2010, 2025),
    tdd("n96", 5925, 7125),
    tdd("n257", 26'500, 29'500),
    tdd("n258", 24'250, 27'500),
    tdd("n259", 39'500, 43'500),
    tdd("n260", 37'000, 40'000),
    tdd("n261", 27'500, 28'350),
    // clang-format on
});

std::optional<Hertz> hertzOf(std::uint32_t number) {
    for (const RasterPart& part : kRaster) {
        if (number >= part.first && number <= part.last) {
            return part.hertz + (number - part.first) * part.spacing;
        }
    }
    return std::nullopt;
}

/// Only a frequency that is on the raster has a number.
std::optional<Channel> channelAt(Hertz hertz) {
    for (const RasterPart& part : kRaster) {
        const Hertz distance = hertz - part.hertz;
        const Hertz most = (part.last - part.first) * part.spacing;
        if (distance >= 0 && distance <= most && distance % part.spacing == 0) {
            return Channel{part.first + static_cast<std::uint32_t>(distance / part.spacing), hertz};
        }
    }
    return std::nullopt;
}

/// The channel that is paired with one of `from`.
std::optional<Channel> pairedChannel(Hertz hertz, const Range& from, const Range& to) {
    const Hertz paired = hertz - from.first + to.first;
    return !to.isEmpty() && to.contains(paired) ? channelAt(paired) : std::nullopt;
}

/// The first channel of the raster in the range and the last one.
std::optional<BandPart::Range> channelsIn(const Range& range) {
    if (range.isEmpty()) {
        return std::nullopt;
    }
    const auto nearest = [](Hertz hertz, Hertz step) {
        while (!channelAt(hertz)) {
            hertz += step;
        }
        return *channelAt(hertz);
    };
    return BandPart::Range{nearest(range.first, kKilohertz), nearest(range.last, -kKilohertz)};
}

} // namespace

std::vector<Carrier> nrCarriersOf(std::uint32_t number) {
    const std::optional<Hertz> hertz = hertzOf(number);
    return hertz ? nrCarriersAt(*hertz) : std::vector<Carrier>();
}

std::vector<Carrier> nrCarriersAt(Hertz hertz) {
    std::vector<Carrier> carriers;
    const std::optional<Channel> channel = channelAt(hertz);
    if (!channel) {
        return carriers;
    }
    for (const NrBand& band : kBands) {
        if (band.downlink.contains(hertz)) {
            carriers.push_back(
                {band.name, channel, pairedChannel(hertz, band.downlink, band.uplink), false});
        }
    }
    for (const NrBand& band : kBands) {
        if (band.uplink.contains(hertz) && !band.downlink.contains(hertz)) {
            carriers.push_back(
                {band.name, pairedChannel(hertz, band.uplink, band.downlink), channel, true});
        }
    }
    return carriers;
}

std::vector<BandPart> nrBands() {
    std::vector<BandPart> parts;
    parts.reserve(kBands.size());
    for (const NrBand& band : kBands) {
        parts.push_back({band.name, channelsIn(band.downlink), channelsIn(band.uplink)});
    }
    return parts;
}

} // namespace pallax
