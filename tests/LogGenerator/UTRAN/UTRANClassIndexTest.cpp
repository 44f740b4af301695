#include "LogGenerator/UTRAN/UTRANClassIndex.h"

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
    {0xD00A, {"Neighbor Cell List"}},     {0xD00C, {"TRCH BLER", "CCTRCH SIR"}},
    {0xD00E, {"GSM Neighbor Cell List"}}, {0xD0E0, {"RRC Info"}},
    {0xD0E2, {"Serving Cell Info"}},      {0xFF0000, {"SIM Info"}},
    {0xFF0001, {"Serving Cell Info"}},    {0xFF0002, {"PDP Context Info"}},
};

class UTRANClassIndexTest : public testing::Test {
protected:
    Names subscribersOf(LogCode logCode) const {
        Names names;
        for (const Base* record : *_index.getSubscribers(logCode)) {
            names.emplace_back(record->getSectionName());
        }
        return names;
    }

    FakeStandardOutput _output;
    UTRANClassIndex _index{_output};
};

TEST_F(UTRANClassIndexTest, SubscribersInCallOrder) {
    for (const auto& [logCode, names] : kSubscribers) {
        ASSERT_NE(_index.getSubscribers(logCode), nullptr) << std::hex << logCode;
        EXPECT_EQ(subscribersOf(logCode), names) << std::hex << logCode;
    }
}

TEST_F(UTRANClassIndexTest, ItWantsExactlyTheCodesOfItsRecords) {
    std::vector<std::string> codes;
    for (const auto& [logCode, names] : kSubscribers) {
        codes.push_back(std::to_string(logCode));
    }
    EXPECT_EQ(_index.getAllLogCodes(), codes);
    EXPECT_EQ(_index.getSubscribers(0xD00B), nullptr);
}

TEST_F(UTRANClassIndexTest, ItHoldsEightSectionsEachOfItsClass) {
    EXPECT_EQ(_index.classes().size(), 8U);
    EXPECT_NE(dynamic_cast<RRC_State*>(_index.getClass("RRC Info")), nullptr);
    EXPECT_NE(dynamic_cast<UTRANServingCellInfo*>(_index.getClass("Serving Cell Info")), nullptr);
    EXPECT_NE(dynamic_cast<UTRANNeighbhorMeasurements*>(_index.getClass("Neighbor Cell List")),
              nullptr);
    EXPECT_NE(dynamic_cast<GSMNeighbhorMeasurements*>(_index.getClass("GSM Neighbor Cell List")),
              nullptr);
    EXPECT_NE(dynamic_cast<TRCHBLERMeasurement*>(_index.getClass("TRCH BLER")), nullptr);
    EXPECT_NE(dynamic_cast<CCTRCHSIRMeasurement*>(_index.getClass("CCTRCH SIR")), nullptr);
    EXPECT_NE(dynamic_cast<PDPContextList*>(_index.getClass("PDP Context Info")), nullptr);
    EXPECT_NE(dynamic_cast<SimInfo*>(_index.getClass("SIM Info")), nullptr);
}

TEST_F(UTRANClassIndexTest, TemplateAndRecordsMatchBothWays) {
    doubles::expectTemplateMatches(
        doubles::propertyListFile(PALLAX_SOURCE_DIR "/resources/UTRAN.plist"), _index);
}

// The counts of the codes tell the records apart: only the serving cell has two.
TEST(UTRANClassIndex, TheRecordsRegisterInTheOrderOfItsFields) {
    FakeStandardOutput output;
    RecordingLog log;
    const UTRANClassIndex index(output);
    std::vector<RecordingLog::Line> lines(8, {4, "Array Count: 1"});
    lines[1].text = "Array Count: 2";
    EXPECT_EQ(log.lines(), lines);
}

TEST(UTRANClassIndex, ItsEndPrintsNoLineOfItsOwn) {
    FakeStandardOutput output;
    { const UTRANClassIndex index(output); }
    EXPECT_EQ(output.lines, (Names{"Deallocing ClassIndex"}));
}

} // namespace
} // namespace pallax
