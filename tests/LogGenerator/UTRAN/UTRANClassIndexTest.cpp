#include "LogGenerator/UTRAN/UTRANClassIndex.h"

#include "tests/doubles/ClassIndexFixture.h"

#include <gtest/gtest.h>

namespace pallax {
namespace {

using Names = std::vector<std::string>;

/// Who gets the packets of a log code, in call order.
const std::map<LogCode, Names> kSubscribers = {
    {0xD00A, {"Neighbor Cell List"}},     {0xD00C, {"TRCH BLER", "CCTRCH SIR"}},
    {0xD00E, {"GSM Neighbor Cell List"}}, {0xD0E0, {"RRC Info"}},
    {0xD0E2, {"Serving Cell Info"}},      {0xFF0000, {"SIM Info"}},
    {0xFF0001, {"Serving Cell Info"}},    {0xFF0002, {"PDP Context Info"}},
};

class UTRANClassIndexTest : public doubles::ClassIndexFixture<UTRANClassIndex> {};

TEST_F(UTRANClassIndexTest, SubscribersInCallOrderAndExactlyTheCodesOfItsRecords) {
    expectSubscribers(kSubscribers, 0xD00B);
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
    expectTemplateMatches("UTRAN.plist");
}

// The counts of the codes tell the records apart: only the serving cell has two.
TEST_F(UTRANClassIndexTest, TheRecordsRegisterInTheOrderOfItsFields) {
    expectRegistration({1, 2, 1, 1, 1, 1, 1, 1});
}

TEST_F(UTRANClassIndexTest, ItsEndPrintsNoLineOfItsOwn) {
    EXPECT_EQ(lastLines(), (Names{"Deallocing ClassIndex"}));
}

} // namespace
} // namespace pallax
