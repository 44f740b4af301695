#include "LogGenerator/ZOR_GSM/ZOR_GSMClassIndex.h"

#include "tests/doubles/ClassIndexFixture.h"

#include <gtest/gtest.h>

namespace pallax {
namespace {

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

class ZOR_GSMClassIndexTest : public doubles::ClassIndexFixture<ZOR_GSMClassIndex> {};

TEST_F(ZOR_GSMClassIndexTest, SubscribersInCallOrderAndExactlyTheCodesOfItsRecords) {
    expectSubscribers(kSubscribers, 0x7133);
}

TEST_F(ZOR_GSMClassIndexTest, ItHolds26Sections) {
    EXPECT_EQ(sections(), (Names{"Active Set",
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
    expectTemplateMatches("ZOR_GSM.plist");
}

TEST_F(ZOR_GSMClassIndexTest, ItsRecordsRegisterInTheirOrder) {
    // From ActiveSet to HSDPAInformation.
    expectRegistration(
        {1, 0, 7, 4, 1, 3, 1, 2, 0, 0, 1, 1, 0, 2, 3, 2, 1, 4, 1, 0, 2, 5, 1, 1, 1, 1});
}

TEST_F(ZOR_GSMClassIndexTest, ItsEndIsPrintedBeforeThatOfItsBase) {
    EXPECT_EQ(lastLines(), (Names{"Deallocing ZOR_GSMClassIndex", "Deallocing ClassIndex"}));
}

} // namespace
} // namespace pallax
