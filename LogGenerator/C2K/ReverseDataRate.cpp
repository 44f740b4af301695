#include "LogGenerator/C2K/ReverseDataRate.h"

#include "LogGenerator/C2K/DataRate.h"
#include "LogGenerator/C2K/PacketLength.h"

#include <array>

namespace pallax {

namespace {

constexpr Position kSequence = u32At(14);
constexpr std::size_t kCountersStart = 18;
constexpr std::size_t kCounterLength = 4;

constexpr std::size_t kBlocks = 3;
constexpr std::size_t kBlockLength = 576;
constexpr std::size_t kRows = 2;
constexpr std::size_t kRowLength = 288;
constexpr std::size_t kRateLength = 24;
constexpr std::size_t kCountersInARow = 4;

/// The weight of each rate's counters in the total.
constexpr auto kWeights = std::to_array<std::uint16_t>(
    {128, 256, 512, 768, 1024, 1536, 2048, 3072, 4096, 6144, 8192, 12288});
static_assert(kWeights.size() == 12);

/// The counters by rate, in all blocks and both rows.
constexpr auto kCounters = [] {
    constexpr std::size_t kCountersOfARate = kBlocks * kRows * kCountersInARow;
    std::array<Counter, kWeights.size() * kCountersOfARate> counters{};
    for (std::size_t index = 0; index < counters.size(); ++index) {
        const std::size_t rate = index / kCountersOfARate;
        const std::size_t row = index % kCountersOfARate / kCountersInARow;
        counters[index] = {kCountersStart + rate * kRateLength + row / kRows * kBlockLength +
                               row % kRows * kRowLength + index % kCountersInARow * kCounterLength,
                           kWeights[rate]};
    }
    return counters;
}();
constexpr std::size_t kCountersEnd = kCounters.back().byte + kCounterLength;

constexpr DataRateNames kNames = {"RLDataSeqNum", "RLDataSent",    "RLDataSeqNum1",
                                  "RLDataSent1",  "RLDataSeqNum2", "RLDataSent2"};

PropertyList rateSince(const Place& place) {
    return dataRateSince(kNames, static_cast<std::uint32_t>(place.here.read(kSequence)),
                         weightedSum(kCounters, place.here), *place.memory->state);
}

constexpr auto kRateBytes =
    std::to_array<Extent>({extentOf(kSequence), {kCountersStart, kCountersEnd - kCountersStart}});
constexpr Computation kRate{
    .name = "data rate",
    .formula = kDataRateFormula,
    .read = kRateBytes,
    .compute = rateSince,
    .counters = kCounters,
    .isRunning = true,
};

constexpr auto kFields =
    std::to_array<Field>({computed("kRLDataRate", kDataRateFormat, kRate,
                                   "Data rate of the reverse link since the report before.")});

} // namespace

constexpr CodeLayout kReverseDataRate{
    .logCode = 0x127E,
    .name = "Counters of the EV-DO reverse link",
    .minimumLength = 1750,
    .fields = kFields,
    .accepts = hasLength,
};

} // namespace pallax
