#include "LogGenerator/C2K/ForwardDataRate.h"

#include "LogGenerator/C2K/DataRate.h"
#include "LogGenerator/Records/Description.h"
#include "platform/SystemLog.h"

#include <array>

namespace pallax {

namespace {

constexpr std::size_t kMinimumLength = 241;
constexpr std::size_t kSequence = 13;
constexpr std::size_t kCounters = 17;
constexpr std::size_t kCounterLength = 4;

/// What one step of each counter adds to the total; nothing where it is 0.
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
static_assert(kCounters + kWeights.size() * kCounterLength == kMinimumLength);

constexpr DataRateNames kNames = {"kFLDataRate", "FLDataSeqNum",  "FLDataSent", "FLDataSeqNum1",
                                  "FLDataSent1", "FLDataSeqNum2", "FLDataSent2"};

std::int64_t totalOf(const LogRecord& packet) {
    std::int64_t sum = 0;
    for (std::size_t counter = 0; counter < kWeights.size(); ++counter) {
        sum += std::int64_t{packet.u32(kCounters + counter * kCounterLength)} * kWeights[counter];
    }
    return sum;
}

} // namespace

void parseForwardDataRate(const LogRecord& packet, Dictionary& state, const Dictionary& lookup) {
    if (!packet.has(kMinimumLength)) {
        systemLog(LogPriority::Error,
                  "Log code 0x1192 is %d bytes long but must be at least %ld bytes.",
                  packet.length(), kMinimumLength);
        return;
    }
    updateDataRate(kNames, packet.u32(kSequence), totalOf(packet), state, lookup);
}

CodeDescription describeForwardDataRate(LogCode logCode) {
    std::vector<Counter> counters;
    for (std::size_t counter = 0; counter < kWeights.size(); ++counter) {
        if (kWeights[counter] != 0) {
            counters.push_back({kCounters + counter * kCounterLength, kWeights[counter]});
        }
    }
    CodeDescription code{logCode, kMinimumLength};
    code.fields = {describeDataRate(kNames, u32At(kSequence),
                                    {kCounters, kWeights.size() * kCounterLength},
                                    std::move(counters))};
    return code;
}

} // namespace pallax
