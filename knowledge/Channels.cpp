#include "knowledge/Channels.h"

#include "knowledge/ChannelRows.h"
#include "knowledge/NrBands.h"

#include <algorithm>
#include <array>
#include <span>
#include <utility>

namespace pallax {

namespace {

constexpr auto kNames = std::to_array<std::pair<std::string_view, RadioSystem>>({
    {"gsm", RadioSystem::Gsm},
    {"umts", RadioSystem::UmtsFdd},
    {"utran", RadioSystem::UtraTdd},
    {"lte", RadioSystem::Lte},
    {"nr", RadioSystem::Nr},
    {"cdma", RadioSystem::Cdma},
});

/// NR has no rows (NrBands.h).
std::span<const ChannelRow> rowsOf(RadioSystem system) {
    switch (system) {
    case RadioSystem::Gsm:
        return gsmRows();
    case RadioSystem::UmtsFdd:
        return umtsRows();
    case RadioSystem::UtraTdd:
        return utraTddRows();
    case RadioSystem::Lte:
        return lteRows();
    case RadioSystem::Cdma:
        return cdmaRows();
    case RadioSystem::Nr:
        break;
    }
    return {};
}

/// The channel at that distance from the side's first number, if the side has it.
std::optional<Channel> channelIn(const ChannelRow::Side& side, std::uint32_t distance,
                                 Hertz spacing) {
    if (side.isEmpty() || distance > side.last - side.first) {
        return std::nullopt;
    }
    return Channel{side.first + distance, side.hertz + distance * spacing};
}

/// Adds the carrier whose `side` of the row is at that distance from its first channel, unless the
/// row has no such channel.
void addCarrier(std::vector<Carrier>& carriers, const ChannelRow& row, const ChannelRow::Side& side,
                std::int64_t distance) {
    if (side.isEmpty() || distance < 0 || distance > side.last - side.first ||
        distance % row.numberStep != 0) {
        return;
    }
    const auto offset = static_cast<std::uint32_t>(distance);
    carriers.push_back({row.band, channelIn(row.downlink, offset, row.spacing),
                        channelIn(row.uplink, offset, row.spacing), &side == &row.uplink});
}

bool hasEqualSides(const ChannelRow& row) {
    return row.downlink.first == row.uplink.first && row.downlink.last == row.uplink.last;
}

bool isTdd(const ChannelRow& row) {
    return hasEqualSides(row) && row.downlink.hertz == row.uplink.hertz;
}

std::optional<BandPart::Range> rangeOf(const ChannelRow& row, const ChannelRow::Side& side) {
    if (side.isEmpty()) {
        return std::nullopt;
    }
    return BandPart::Range{*channelIn(side, 0, row.spacing),
                           *channelIn(side, side.last - side.first, row.spacing)};
}

} // namespace

std::optional<RadioSystem> radioSystemNamed(std::string_view name) {
    for (const auto& [each, system] : kNames) {
        if (each == name) {
            return system;
        }
    }
    return std::nullopt;
}

std::string_view nameOf(RadioSystem system) {
    const auto* found = std::find_if(kNames.begin(), kNames.end(),
                                     [system](const auto& each) { return each.second == system; });
    return found->first;
}

std::vector<Carrier> carriersOf(RadioSystem system, std::uint32_t number) {
    if (system == RadioSystem::Nr) {
        return nrCarriersOf(number);
    }
    std::vector<Carrier> carriers;
    for (const ChannelRow& row : rowsOf(system)) {
        addCarrier(carriers, row, row.downlink, std::int64_t{number} - row.downlink.first);
    }
    for (const ChannelRow& row : rowsOf(system)) {
        if (!hasEqualSides(row)) { // otherwise it is the downlink's number too
            addCarrier(carriers, row, row.uplink, std::int64_t{number} - row.uplink.first);
        }
    }
    return carriers;
}

std::vector<Carrier> carriersAt(RadioSystem system, Hertz hertz) {
    if (system == RadioSystem::Nr) {
        return nrCarriersAt(hertz);
    }
    std::vector<Carrier> carriers;
    const auto add = [&carriers, hertz](const ChannelRow& row, const ChannelRow::Side& side) {
        if ((hertz - side.hertz) % row.spacing == 0) {
            addCarrier(carriers, row, side, (hertz - side.hertz) / row.spacing);
        }
    };
    for (const ChannelRow& row : rowsOf(system)) {
        add(row, row.downlink);
    }
    for (const ChannelRow& row : rowsOf(system)) {
        if (!isTdd(row)) {
            add(row, row.uplink);
        }
    }
    return carriers;
}

std::vector<BandPart> bandsOf(RadioSystem system) {
    if (system == RadioSystem::Nr) {
        return nrBands();
    }
    std::vector<BandPart> parts;
    for (const ChannelRow& row : rowsOf(system)) {
        parts.push_back({row.band, rangeOf(row, row.downlink), rangeOf(row, row.uplink)});
    }
    return parts;
}

namespace {

/// Phones report downlinks; the uplinks count only if no downlink has the number.
std::vector<Carrier> likelyCarriersOf(RadioSystem system, std::uint32_t number) {
    std::vector<Carrier> carriers = carriersOf(system, number);
    if (!carriers.empty() && !carriers.front().isOfUplink) {
        std::erase_if(carriers, [](const Carrier& carrier) { return carrier.isOfUplink; });
    }
    return carriers;
}

} // namespace

std::string bandText(RadioSystem system, std::uint32_t number) {
    std::string text;
    for (const Carrier& carrier : likelyCarriersOf(system, number)) {
        text.append(text.empty() ? "" : "/").append(carrier.band);
    }
    return text;
}

std::optional<double> megahertz(RadioSystem system, std::uint32_t number) {
    constexpr double kHertzPerMegahertz = 1e6;
    std::optional<Hertz> agreed;
    for (const Carrier& carrier : likelyCarriersOf(system, number)) {
        const Hertz hertz = (carrier.isOfUplink ? carrier.uplink : carrier.downlink)->hertz;
        if (agreed && *agreed != hertz) {
            return std::nullopt;
        }
        agreed = hertz;
    }
    return agreed ? std::optional(static_cast<double>(*agreed) / kHertzPerMegahertz) : std::nullopt;
}

std::string megahertzText(Hertz hertz) {
    constexpr Hertz kHertzPerMegahertz = 1'000'000;
    constexpr std::size_t kDecimals = 6;
    std::string decimals = std::to_string(kHertzPerMegahertz + hertz % kHertzPerMegahertz);
    decimals = decimals.substr(1, kDecimals);
    decimals.resize(std::max<std::size_t>(decimals.find_last_not_of('0') + 1, 1), '0');
    return std::to_string(hertz / kHertzPerMegahertz) + "." + decimals;
}

} // namespace pallax
