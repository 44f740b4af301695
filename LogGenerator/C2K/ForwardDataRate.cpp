#include "LogGenerator/C2K/ForwardDataRate.h"

#include "LogGenerator/C2K/DataRate.h"
#include "LogGenerator/C2K/PacketLength.h"

#include <algorithm>
#include <array>

namespace pallax {

namespace {

constexpr std::size_t kMinimumLength = 241;
constexpr Position kSequence = u32At(13);
constexpr std::size_t kCountersStart = 17;
constexpr std::size_t kCounterLength = 4;

/// The weight of each counter in the total; 0: it does not count.
constexpr auto kWeights = std::to_array<std::uint16_t>({
    128,  256,  512,  1024, 0, //
    128,  256,  512,  1024, 0, //
    128,  256,  512,  1024, 0, //
    128,  256,  512,  1024, 0, //
    128,  256,  512,  1024, 0, //
    512,  1024, 2048, 0,       //
    128,  256,  512,  1024, 0, //
    512,  1024, 2048, 0,       //
    1024, 3072, 0,             //
    512,  1024, 2048, 0,       //
    4096, 0,                   //
    1024, 3072, 0,             //
    4096, 0,                   //
    5120, 0,                   //
    5120, 0,                   //
});
static_assert(kWeights.size() == 56);
static_assert(kCountersStart + kWeights.size() * kCounterLength == kMinimumLength);

/// The counters with a weight.
constexpr auto kCounters = [] {
    constexpr std::size_t kWithoutWeight =
        static_cast<std::size_t>(std::count(kWeights.begin(), kWeights.end(), 0));
    std::array<Counter, kWeights.size() - kWithoutWeight> counters{};
    std::size_t next = 0;
    for (std::size_t index = 0; index < kWeights.size(); ++index) {
        if (kWeights[index] != 0) {
            counters[next++] = {kCountersStart + index * kCounterLength, kWeights[index]};
        }
    }
    return counters;
}();

constexpr DataRateNames kNames = {"FLDataSeqNum", "FLDataSent",    "FLDataSeqNum1",
                                  "FLDataSent1",  "FLDataSeqNum2", "FLDataSent2"};

PropertyList rateSince(const Place& place) {
    return dataRateSince(kNames, static_cast<std::uint32_t>(place.here.read(kSequence)),
                         weightedSum(kCounters, place.here), *place.memory->state);
}

constexpr auto kRateBytes = std::to_array<Extent>(
    {extentOf(kSequence), {kCountersStart, kWeights.size() * kCounterLength}});
constexpr Computation kRate{
    .name = "data rate",
    .formula = kDataRateFormula,
    .read = kRateBytes,
    .compute = rateSince,
    .counters = kCounters,
    .isRunning = true,
};

constexpr auto kFields =
    std::to_array<Field>({computed("kFLDataRate", kDataRateFormat, kRate,
                                   "Data rate of the forward link since the report before.")});

} // namespace

constexpr CodeLayout kForwardDataRate{
    .logCode = 0x1192,
    .name = "Counters of the EV-DO forward link",
    .minimumLength = kMinimumLength,
    .fields = kFields,
    .accepts = hasLength,
};

} // namespace pallax
