#include "LogGenerator/LTE/LTEClassIndex.h"

#include "LogGenerator/LTE/LTELogGenerator.h"
#include "tests/doubles/ClassIndexFixture.h"

#include <gtest/gtest.h>

/// The whole technology: who reads which log code, and the order of the records.
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

TEST_F(LTEClassIndexTest, TheStartCommandHoldsExactlyTheCodesOfItsRecords) {
    expectStartCommand(kSubscribers, LTELogGenerator::generator, "LTE");
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
    generator->updateState(state, doubles::Record(0x1234).padTo(200).bytes()); // nobody's
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
    expectRegistration({
        {"Serving Cell Info", 3},
        {"Connected mode LTE Intra-frequency Measurement", 1},
        {"Measured Neighbor Cells", 1},
        {"Detected Cells", 1},
        {"Serving Cell Measurements", 1},
        {"Neighbor Measurements", 1},
        {"Neighbor Cells List", 1},
        {"Reselection Candidates", 1},
        {"Reselection Candidates List", 1},
        {"SIM Info", 1},
        {"PDP Context Info", 1},
    });
}

TEST_F(LTEClassIndexTest, ItsEndIsPrintedBeforeThatOfItsBase) {
    EXPECT_EQ(lastLines(), (Names{"Deallocing LTEClassIndex", "Deallocing ClassIndex"}));
}

} // namespace
} // namespace pallax
