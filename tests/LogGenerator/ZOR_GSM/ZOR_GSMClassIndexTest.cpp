#include "LogGenerator/ZOR_GSM/ZOR_GSMClassIndex.h"

#include "tests/doubles/FakeStandardOutput.h"

#include <gtest/gtest.h>

namespace pallax {
namespace {

using doubles::FakeStandardOutput;

std::vector<std::string> subscribersOf(const ClassIndex& index, LogCode logCode) {
    std::vector<std::string> names;
    if (const auto* subscribers = index.getSubscribers(logCode)) {
        for (const Base* record : *subscribers) {
            names.emplace_back(record->getSectionName());
        }
    }
    return names;
}

TEST(ZOR_GSMClassIndex, SubscribersInCallOrder) {
    FakeStandardOutput output;
    const ZOR_GSMClassIndex index(output);
    using Names = std::vector<std::string>;
    EXPECT_EQ(subscribersOf(index, 0x5072), (Names{"GSM RR Info"}));
    EXPECT_EQ(subscribersOf(index, 0x5076), (Names{"GSM Serving Cell"}));
    EXPECT_EQ(subscribersOf(index, 0x512C), (Names{"GSM RR Info"}));
    EXPECT_EQ(subscribersOf(index, 0x5134), (Names{"GSM Serving Cell"}));
    EXPECT_EQ(subscribersOf(index, 0x5137),
              (Names{"GPRS Information", "GSM Serving Cell", "Neighboring Cells", "GSM RR Info"}));
    EXPECT_EQ(subscribersOf(index, 0x51F4), (Names{"GPRS Information"}));
    EXPECT_EQ(subscribersOf(index, 0x51F5), (Names{"GPRS Information"}));
    EXPECT_EQ(subscribersOf(index, 0x51F6), (Names{"GPRS Information", "GSM RR Info"}));
    EXPECT_EQ(subscribersOf(index, 0x51F8), (Names{"Mobile Allocation"}));
    EXPECT_EQ(subscribersOf(index, 0x51FB), (Names{"GPRS Information"}));
    EXPECT_EQ(subscribersOf(index, 0x51FD), (Names{"GPRS Information"}));
    EXPECT_EQ(subscribersOf(index, 0x51FF), (Names{"Neighboring Cells"}));
    EXPECT_EQ(subscribersOf(index, 0x7130), (Names{"Process PS"}));
    EXPECT_EQ(subscribersOf(index, 0x7131), (Names{"Process CO", "Process CS"}));
    EXPECT_EQ(subscribersOf(index, 0x7132),
              (Names{"Process PS", "Process CO", "Serving PLMN", "Process CS"}));
    EXPECT_EQ(subscribersOf(index, 0x7135), (Names{"GPRS Information", "Serving PLMN"}));
    EXPECT_EQ(subscribersOf(index, 0x7150), (Names{"Equivalent PLMN List"}));
    EXPECT_EQ(subscribersOf(index, 0xFF0000), (Names{"SIM Info"}));
    EXPECT_EQ(subscribersOf(index, 0xFF0002), (Names{"PDP Context Info"}));
    EXPECT_EQ(subscribersOf(index, 0x7133), (Names{}));
}

TEST(ZOR_GSMClassIndex, TheCellMonitorArrayReachesTheGSMRecordsFirst) {
    FakeStandardOutput output;
    const ZOR_GSMClassIndex index(output);
    std::vector<std::string> names = subscribersOf(index, 0xFF0001);
    ASSERT_GE(names.size(), 3U);
    names.resize(3);
    EXPECT_EQ(names,
              (std::vector<std::string>{"GSM Serving Cell", "Neighboring Cells", "Serving PLMN"}));
}

TEST(ZOR_GSMClassIndex, ItsEndIsPrintedBeforeThatOfItsBase) {
    FakeStandardOutput output;
    { const ZOR_GSMClassIndex index(output); }
    EXPECT_EQ(output.lines,
              (std::vector<std::string>{"Deallocing ZOR_GSMClassIndex", "Deallocing ClassIndex"}));
}

} // namespace
} // namespace pallax
