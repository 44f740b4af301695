#include "LogGenerator/LTE/LTEClassIndex.h"

#include "tests/doubles/ClassIndexFixture.h"

#include <gtest/gtest.h>

namespace pallax {
namespace {

using Names = std::vector<std::string>;

/// Who gets the packets of a log code, in call order.
const std::map<LogCode, Names> kSubscribers = {
    {0xB0C1, {"Serving Cell Info"}},
    {0xB0C2, {"Serving Cell Info"}},
    {0xB179,
     {"Connected mode LTE Intra-frequency Measurement", "Measured Neighbor Cells",
      "Detected Cells"}},
    {0xB17F, {"Serving Cell Measurements"}},
    {0xB180, {"Neighbor Measurements", "Neighbor Cells List"}},
    {0xB186, {"Reselection Candidates", "Reselection Candidates List"}},
    {0xFF0000, {"SIM Info"}},
    {0xFF0001, {"Serving Cell Info"}},
    {0xFF0002, {"PDP Context Info"}},
};

class LTEClassIndexTest : public doubles::ClassIndexFixture<LTEClassIndex> {};

TEST_F(LTEClassIndexTest, SubscribersInCallOrderAndExactlyTheCodesOfItsRecords) {
    expectSubscribers(kSubscribers, 0xB0C3);
}

TEST_F(LTEClassIndexTest, ItHoldsElevenSections) {
    EXPECT_EQ(sections(),
              (Names{"Connected mode LTE Intra-frequency Measurement", "Detected Cells",
                     "Measured Neighbor Cells", "Neighbor Cells List", "Neighbor Measurements",
                     "PDP Context Info", "Reselection Candidates", "Reselection Candidates List",
                     "SIM Info", "Serving Cell Info", "Serving Cell Measurements"}));
}

TEST_F(LTEClassIndexTest, TemplateAndRecordsMatchBothWays) {
    expectTemplateMatches("LTE.plist");
}

TEST_F(LTEClassIndexTest, ItsRecordsRegisterInTheirOrder) {
    expectRegistration({3, 1, 1, 1, 1, 1, 1, 1, 1, 1, 1});
}

TEST_F(LTEClassIndexTest, ItsEndIsPrintedBeforeThatOfItsBase) {
    EXPECT_EQ(lastLines(), (Names{"Deallocing LTEClassIndex", "Deallocing ClassIndex"}));
}

} // namespace
} // namespace pallax
