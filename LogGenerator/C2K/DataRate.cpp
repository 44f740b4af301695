#include "LogGenerator/C2K/DataRate.h"

#include <optional>

namespace pallax {

namespace {

std::optional<std::int64_t> integerUnder(std::string_view key, const Dictionary& state) {
    const PropertyList* found = state.find(key);
    return found != nullptr ? found->integer() : std::nullopt;
}

/// Writes a pair into the state's "ExtraInfo", if there is one.
void setExtraInfo(const Dictionary& state, std::string_view sequenceKey, std::int64_t sequence,
                  std::string_view sentKey, std::int64_t sent) {
    const PropertyList* found = state.find("ExtraInfo");
    const DictionaryRef extraInfo = found != nullptr ? found->dictionary() : nullptr;
    if (extraInfo != nullptr) {
        extraInfo->setFixed(sequenceKey, PropertyList::integer(sequence));
        extraInfo->setFixed(sentKey, PropertyList::integer(sent));
    }
}

/// The steps from one number of a 32-bit sequence to another, in the shorter direction.
std::int32_t stepsBetween(std::int64_t before, std::uint32_t now) {
    return static_cast<std::int32_t>(now - static_cast<std::uint32_t>(before));
}

} // namespace

PropertyList dataRateSince(const DataRateNames& names, std::uint32_t sequence, std::int64_t sent,
                           Dictionary& state) {
    constexpr std::int64_t kUnitsPerKilobit = 1024;
    const auto sequenceBefore = integerUnder(names.sequence, state);
    const auto sentBefore = integerUnder(names.sent, state);
    PropertyList rate;
    if (sequenceBefore && sentBefore) {
        const std::int64_t steps = stepsBetween(*sequenceBefore, sequence);
        if (steps >= 1) {
            const auto grown = static_cast<double>(sent - *sentBefore);
            rate = DisplayNumber(grown / static_cast<double>(steps * kUnitsPerKilobit),
                                 kDataRateFormat);
        }
        setExtraInfo(state, names.sequenceBefore, *sequenceBefore, names.sentBefore, *sentBefore);
    } else {
        rate = Text::fixed("");
    }
    state.setFixed(names.sequence, PropertyList::integer(sequence));
    state.setFixed(names.sent, PropertyList::integer(sent));
    setExtraInfo(state, names.sequenceNow, sequence, names.sentNow, sent);
    return rate;
}

std::int64_t weightedSum(std::span<const Counter> counters, const LogRecord& packet) {
    constexpr std::size_t kCounterLength = 4;
    const Bytes bytes = packet.bytes();
    std::int64_t sum = 0;
    for (const Counter& counter : counters) {
        if (packet.has(counter.byte + kCounterLength)) { // checked once, for a single load
            const auto* at = bytes.data() + counter.byte;
            const std::uint32_t count = at[0] | std::uint32_t{at[1]} << 8U |
                                        std::uint32_t{at[2]} << 16U | std::uint32_t{at[3]} << 24U;
            sum += std::int64_t{count} * counter.weight;
        }
    }
    return sum;
}

} // namespace pallax
