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

} // namespace
} // namespace pallax
