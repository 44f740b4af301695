#pragma once

#include <cstdint>
#include <optional>
#include <span>
#include <string>
#include <string_view>
#include <vector>

namespace pallax {

/// The radio systems, each with channel numbers of its own.
enum class RadioSystem { Gsm, UmtsFdd, UtraTdd, Lte, Nr, Cdma };

/// "gsm", "umts", "utran" (UTRA TDD), "lte", "nr" or "cdma".
std::optional<RadioSystem> radioSystemNamed(std::string_view name);
std::string_view nameOf(RadioSystem system);

/// A frequency: in every system a whole number of hertz.
using Hertz = std::int64_t;

struct Channel {
    std::uint32_t number;
    Hertz hertz;

    friend bool operator==(const Channel&, const Channel&) = default;
};

/// One meaning of a channel number.
struct Carrier {
    std::string_view band; ///< "DCS 1800", "3", "n78"; for CDMA the band class, "0"
    std::optional<Channel> downlink{};
    std::optional<Channel> uplink{}; ///< at the band's usual distance; the downlink itself for TDD
    bool isOfUplink = false;         ///< the given number or frequency is the uplink's

    friend bool operator==(const Carrier&, const Carrier&) = default;
};

/// Everything that a channel number can mean, downlinks first; empty if it means nothing. Numbers
/// of CDMA have a meaning in each band class.
std::vector<Carrier> carriersOf(RadioSystem system, std::uint32_t number);
/// Everything that can be transmitted at that frequency, downlinks first.
std::vector<Carrier> carriersAt(RadioSystem system, Hertz hertz);

/// A stretch of a band's channels. A band can have several, and one direction alone.
struct BandPart {
    std::string_view band;
    struct Range {
        Channel first;
        Channel last;

        friend bool operator==(const Range&, const Range&) = default;
    };
    std::optional<Range> downlink;
    std::optional<Range> uplink;
};

/// Every band of a system with fixed channel numbers, in the order of the standards.
std::vector<BandPart> bandsOf(RadioSystem system);

/// A band whose channel numbers the network assigns.
struct UnnumberedBand {
    struct Edges {
        Hertz low;
        Hertz high;
    };

    std::string_view band;
    Edges downlink;
    Edges uplink;
};
std::span<const UnnumberedBand> unnumberedBandsOf(RadioSystem system);

/// The bands of a number, separated by "/": "3", "DCS 1800/PCS 1900". Only those of the downlink,
/// if it has any.
std::string bandText(RadioSystem system, std::uint32_t number);
/// The frequency of a number, if all its meanings agree; of the downlink, if it has any.
std::optional<double> megahertz(RadioSystem system, std::uint32_t number);

/// "1870.0", "889.9875": in MHz.
std::string megahertzText(Hertz hertz);

} // namespace pallax
