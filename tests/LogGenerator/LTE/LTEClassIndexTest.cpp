#include "LogGenerator/LTE/LTEClassIndex.h"

#include "LogGenerator/LTE/LTELogGenerator.h"
#include "tests/doubles/ClassIndexFixture.h"
#include "tests/doubles/WholeLte.h"

#include <gtest/gtest.h>

namespace pallax {
namespace {

using doubles::kWholeLte;
using Names = std::vector<std::string>;

class LTEClassIndexTest : public doubles::ClassIndexFixture<LTEClassIndex> {};

TEST_F(LTEClassIndexTest, SubscribersInCallOrderAndExactlyTheCodesOfItsRecords) {
    expectSubscribers(kWholeLte.subscribers, 0xB0C3);
}

TEST_F(LTEClassIndexTest, TheStartCommandHoldsExactlyTheCodesOfItsRecords) {
    expectStartCommand(kWholeLte.subscribers, LTELogGenerator::generator, "LTE");
}

TEST_F(LTEClassIndexTest, TemplateAndRecordsMatchBothWays) {
    expectTemplateMatches("LTE.plist");
}

TEST_F(LTEClassIndexTest, TheDisplayHoldsExactlyTheSectionsInTheOrderOfTheTemplate) {
    doubles::GeneratorFixture fixture;
    fixture.resources.add("LTE",
                          doubles::propertyListFile(PALLAX_SOURCE_DIR "/resources/LTE.plist"));
    const auto generator = LTELogGenerator::generator(fixture.environment());
    Dictionary state;
    generator->updateState(state, doubles::Record(0x1234).padTo(200).bytes()); // no record reads it
    doubles::expectInOrder(
        *state.find("Display"),
        Dictionary{{"Serving Cell Info", Dictionary()},
                   {"Serving Cell Measurements", Dictionary()},
                   {"Connected mode LTE Intra-frequency Measurement", Dictionary()},
                   {"Measured Neighbor Cells", Array()},
                   {"Detected Cells", Array()},
                   {"Neighbor Measurements", Dictionary()},
                   {"Neighbor Cells List", Array()},
                   {"Reselection Candidates", Dictionary()},
                   {"Reselection Candidates List", Array()},
                   {"SIM Info", Dictionary()},
                   {"PDP Context Info", Array()}});
}

TEST_F(LTEClassIndexTest, ItsRecordsRegisterInTheirOrder) {
    expectRegistration(kWholeLte.registration);
}

TEST_F(LTEClassIndexTest, ItsEndIsPrintedBeforeThatOfItsBase) {
    EXPECT_EQ(lastLines(), (Names{"Deallocing LTEClassIndex", "Deallocing ClassIndex"}));
}

} // namespace
} // namespace pallax
