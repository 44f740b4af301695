#include "LogGenerator/ZOR_GSM/ZOR_GSMClassIndex.h"

#include "tests/doubles/FakeStandardOutput.h"
#include "tests/doubles/RecordingLog.h"
#include "tests/doubles/TemplateCheck.h"

#include <gtest/gtest.h>

namespace pallax {
namespace {

using doubles::FakeStandardOutput;
using doubles::RecordingLog;
using Names = std::vector<std::string>;

/// Who gets the packets of a log code, in call order.
const std::map<LogCode, Names> kSubscribers = {
    {0x4005, {"GSM Set", "UMTS Set"}},
    {0x4031, {"UMTS RR Info"}},
    {0x4116, {"BLER"}},
    {0x4125, {"UMTS RR Info"}},
    {0x4127, {"UMTS RR Info"}},
    {0x4157, {"UMTS RR Info"}},
    {0x417A, {"Active Set", "Detected Set", "Monitored Set", "Virtual Active Set"}},
    {0x4221, {"HSDPA Info"}},
    {0x5072, {"GSM RR Info"}},
    {0x5076, {"GSM Serving Cell"}},
    {0x512C, {"GSM RR Info"}},
    {0x5134, {"GSM Serving Cell"}},
    {0x5137, {"GPRS Information", "GSM Serving Cell", "Neighboring Cells", "GSM RR Info"}},
    {0x51F4, {"GPRS Information"}},
    {0x51F5, {"GPRS Information"}},
    {0x51F6, {"GPRS Information", "GSM RR Info"}},
    {0x51F8, {"Mobile Allocation"}},
    {0x51FB, {"GPRS Information"}},
    {0x51FD, {"GPRS Information"}},
    {0x51FF, {"Neighboring Cells"}},
    {0x7130, {"Process PS"}},
    {0x7131, {"Process CO", "Process CS"}},
    {0x7132, {"Process PS", "Process CO", "Serving PLMN", "Process CS"}},
    {0x7135, {"GPRS Information", "Serving PLMN"}},
    {0x7150, {"Equivalent PLMN List"}},
    {0xFF0000, {"SIM Info"}},
    {0xFF0001,
     {"GSM Serving Cell", "Neighboring Cells", "Serving PLMN", "UMTS Set", "UMTS RR Info"}},
    {0xFF0002, {"PDP Context Info"}},
};

class ZOR_GSMClassIndexTest : public testing::Test {
protected:
    Names subscribersOf(LogCode logCode) const {
        Names names;
        for (const Base* record : *_index.getSubscribers(logCode)) {
            names.emplace_back(record->getSectionName());
        }
        return names;
    }

    FakeStandardOutput _output;
    ZOR_GSMClassIndex _index{_output};
};

TEST_F(ZOR_GSMClassIndexTest, SubscribersInCallOrder) {
    for (const auto& [logCode, names] : kSubscribers) {
        ASSERT_NE(_index.getSubscribers(logCode), nullptr) << std::hex << logCode;
        EXPECT_EQ(subscribersOf(logCode), names) << std::hex << logCode;
    }
}

TEST_F(ZOR_GSMClassIndexTest, ItWantsExactlyTheCodesOfItsRecords) {
    std::vector<std::string> codes;
    for (const auto& [logCode, names] : kSubscribers) {
        codes.push_back(std::to_string(logCode));
    }
    EXPECT_EQ(_index.getAllLogCodes(), codes);
    EXPECT_EQ(_index.getSubscribers(0x7133), nullptr);
}

TEST_F(ZOR_GSMClassIndexTest, ItHolds26Sections) {
    Names sections;
    for (const auto& [name, record] : _index.classes()) {
        sections.push_back(name);
    }
    EXPECT_EQ(sections, (Names{"Active Set",
                               "BLER",
                               "Cell Change Counters",
                               "Coding Scheme",
                               "Detected Set",
                               "Equivalent PLMN List",
                               "GPRS Information",
                               "GSM RR Info",
                               "GSM Serving Cell",
                               "GSM Set",
                               "HSDPA Info",
                               "Mobile Allocation",
                               "Monitored Set",
                               "Neighboring Cells",
                               "Non-Ranked GSM Set",
                               "Non-Ranked UMTS Set",
                               "PDP Context Info",
                               "Process CO",
                               "Process CS",
                               "Process PS",
                               "SIM Info",
                               "Serving PLMN",
                               "UMTS RR Info",
                               "UMTS RR Measurement",
                               "UMTS Set",
                               "Virtual Active Set"}));
}

TEST_F(ZOR_GSMClassIndexTest, TemplateAndRecordsMatchBothWays) {
    doubles::expectTemplateMatches(
        doubles::propertyListFile(PALLAX_SOURCE_DIR "/resources/ZOR_GSM.plist"), _index);
}

TEST(ZOR_GSMClassIndex, ItsRecordsRegisterInTheirOrder) {
    FakeStandardOutput output;
    const RecordingLog log;
    const ZOR_GSMClassIndex index(output);
    std::vector<RecordingLog::Line> expected;
    // How many codes each record wants, from ActiveSet to HSDPAInformation.
    for (const int count :
         {1, 0, 7, 4, 1, 3, 1, 2, 0, 0, 1, 1, 0, 2, 3, 2, 1, 4, 1, 0, 2, 5, 1, 1, 1, 1}) {
        expected.push_back({4, "Array Count: " + std::to_string(count)});
    }
    EXPECT_EQ(log.lines(), expected);
}

TEST(ZOR_GSMClassIndex, ItsEndIsPrintedBeforeThatOfItsBase) {
    FakeStandardOutput output;
    { const ZOR_GSMClassIndex index(output); }
    EXPECT_EQ(output.lines, (Names{"Deallocing ZOR_GSMClassIndex", "Deallocing ClassIndex"}));
}

} // namespace
} // namespace pallax
