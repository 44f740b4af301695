#include "LogGenerator/C2K/DataRate.h"

#include "LogGenerator/C2K/C2KLookup.h"

#include <optional>

namespace pallax {

namespace {

constexpr NumberFormat kRate{"%.2f kbps"};

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

/// From one number of a 32-bit sequence to another, the shorter way round.
std::int32_t stepsBetween(std::int64_t before, std::uint32_t now) {
    return static_cast<std::int32_t>(now - static_cast<std::uint32_t>(before));
}

} // namespace

void updateDataRate(const DataRateNames& names, std::uint32_t sequence, std::int64_t sent,
                    Dictionary& state, const Dictionary& lookup) {
    constexpr std::int64_t kUnitsPerKilobit = 1024;
    const auto sequenceBefore = integerUnder(names.sequence, state);
    const auto sentBefore = integerUnder(names.sent, state);
    if (sequenceBefore && sentBefore) {
        const std::int64_t steps = stepsBetween(*sequenceBefore, sequence);
        if (steps >= 1) {
            const auto grown = static_cast<double>(sent - *sentBefore);
            setLookupValue(
                names.rate,
                DisplayNumber(grown / static_cast<double>(steps * kUnitsPerKilobit), kRate),
                lookup);
        }
        setExtraInfo(state, names.sequenceBefore, *sequenceBefore, names.sentBefore, *sentBefore);
    } else {
        setLookupValue(names.rate, Text::fixed(""), lookup);
    }
    state.setFixed(names.sequence, PropertyList::integer(sequence));
    state.setFixed(names.sent, PropertyList::integer(sent));
    setExtraInfo(state, names.sequenceNow, sequence, names.sentNow, sent);
}

FieldDescription describeDataRate(const DataRateNames& names, const Position& sequence,
                                  const Extent& bytes, std::vector<Counter> counters) {
    FieldDescription field =
        describeComputed(names.rate, kRate, "data rate",
                         "growth of the weighted sum of the counters since the packet before, "
                         "divided by 1024 x the growth of the sequence number; empty at the first "
                         "packet, unchanged where the number has not grown",
                         {extentOf(sequence), bytes});
    field.counters = std::move(counters);
    return field;
}

} // namespace pallax
