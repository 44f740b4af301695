#include "LogGenerator/C2K/ReverseDataRate.h"

#include "LogGenerator/C2K/DataRate.h"
#include "LogGenerator/Records/Description.h"
#include "platform/SystemLog.h"

#include <array>

namespace pallax {

namespace {

constexpr std::size_t kMinimumLength = 1750;
constexpr std::size_t kSequence = 14;
constexpr std::size_t kCounters = 18;
constexpr std::size_t kCounterLength = 4;

constexpr std::size_t kBlocks = 3;
constexpr std::size_t kBlockLength = 576;
constexpr std::size_t kRows = 2;
constexpr std::size_t kRowLength = 288;
constexpr std::size_t kRateLength = 24;
constexpr std::size_t kCountersInARow = 4;

/// What one step of a rate's counters adds to the total.
constexpr auto kWeights = std::to_array<std::uint16_t>(
    {128, 256, 512, 768, 1024, 1536, 2048, 3072, 4096, 6144, 8192, 12288});
static_assert(kWeights.size() == 12);

constexpr DataRateNames kNames = {"kRLDataRate", "RLDataSeqNum",  "RLDataSent", "RLDataSeqNum1",
                                  "RLDataSent1", "RLDataSeqNum2", "RLDataSent2"};

/// Where the counters of one rate start in one of the rows of all blocks.
std::size_t rowStart(std::size_t rate, std::size_t row) {
    return kCounters + rate * kRateLength + row / kRows * kBlockLength + row % kRows * kRowLength;
}

/// The counters of one rate, over all blocks.
std::int64_t countOf(std::size_t rate, const LogRecord& packet) {
    std::int64_t sum = 0;
    for (std::size_t row = 0; row < kBlocks * kRows; ++row) {
        const std::size_t start = rowStart(rate, row);
        for (std::size_t counter = 0; counter < kCountersInARow; ++counter) {
            sum += packet.u32(start + counter * kCounterLength);
        }
    }
    return sum;
}

std::int64_t totalOf(const LogRecord& packet) {
    std::int64_t sum = 0;
    for (std::size_t rate = 0; rate < kWeights.size(); ++rate) {
        sum += countOf(rate, packet) * kWeights[rate];
    }
    return sum;
}

} // namespace

void parseReverseDataRate(const LogRecord& packet, Dictionary& state, const Dictionary& lookup) {
    if (!packet.has(kMinimumLength)) {
        systemLog(LogPriority::Error,
                  "Log code 0x127e is %d bytes long but must be at least %ld bytes.",
                  packet.length(), kMinimumLength);
        return;
    }
    updateDataRate(kNames, packet.u32(kSequence), totalOf(packet), state, lookup);
}

CodeDescription describeReverseDataRate(LogCode logCode) {
    std::vector<Counter> counters;
    for (std::size_t rate = 0; rate < kWeights.size(); ++rate) {
        for (std::size_t row = 0; row < kBlocks * kRows; ++row) {
            for (std::size_t counter = 0; counter < kCountersInARow; ++counter) {
                counters.push_back(
                    {rowStart(rate, row) + counter * kCounterLength, kWeights[rate]});
            }
        }
    }
    const std::size_t lastRow = rowStart(kWeights.size() - 1, kBlocks * kRows - 1);
    const std::size_t end = lastRow + kCountersInARow * kCounterLength;
    CodeDescription code{logCode, kMinimumLength};
    code.fields = {describeDataRate(kNames, u32At(kSequence), {kCounters, end - kCounters},
                                    std::move(counters))};
    return code;
}

} // namespace pallax
