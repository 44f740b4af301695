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
    EXPECT_EQ(subscribersOf(index, 0x7130), (Names{"Process PS"}));
    EXPECT_EQ(subscribersOf(index, 0x7131), (Names{"Process CO", "Process CS"}));
    EXPECT_EQ(subscribersOf(index, 0x7132), (Names{"Process PS", "Process CO", "Process CS"}));
    EXPECT_EQ(subscribersOf(index, 0x7133), (Names{}));
}

TEST(ZOR_GSMClassIndex, ItsEndIsPrintedBeforeThatOfItsBase) {
    FakeStandardOutput output;
    { const ZOR_GSMClassIndex index(output); }
    EXPECT_EQ(output.lines,
              (std::vector<std::string>{"Deallocing ZOR_GSMClassIndex", "Deallocing ClassIndex"}));
}

TEST(ZOR_GSMClassIndex, SubscribersOfTheUMTSCodesInCallOrder) {
    FakeStandardOutput output;
    const ZOR_GSMClassIndex index(output);
    using Names = std::vector<std::string>;
    EXPECT_EQ(subscribersOf(index, 0x4005), (Names{"GSM Set", "UMTS Set"}));
    for (const LogCode code : {0x4031U, 0x4125U, 0x4127U, 0x4157U}) {
        EXPECT_EQ(subscribersOf(index, code), (Names{"UMTS RR Info"}));
    }
    EXPECT_EQ(subscribersOf(index, 0x4116), (Names{"BLER"}));
    EXPECT_EQ(subscribersOf(index, 0x417A),
              (Names{"Active Set", "Detected Set", "Monitored Set", "Virtual Active Set"}));
    EXPECT_EQ(subscribersOf(index, 0x4221), (Names{"HSDPA Info"}));
    const Names ofCellMonitor = subscribersOf(index, 0xFF0001);
    ASSERT_GE(ofCellMonitor.size(), 2U);
    EXPECT_EQ(Names(ofCellMonitor.end() - 2, ofCellMonitor.end()),
              (Names{"UMTS Set", "UMTS RR Info"}));
}

} // namespace
} // namespace pallax
