#include "LogGenerator/UTRAN/UTRANClassIndex.h"

#include "LogGenerator/UTRAN/UTRANLogGenerator.h"
#include "tests/doubles/ClassIndexFixture.h"
#include "tests/doubles/WholeUtran.h"

#include <gtest/gtest.h>

namespace pallax {
namespace {

using doubles::kWholeUtran;
using Names = std::vector<std::string>;

class UTRANClassIndexTest : public doubles::ClassIndexFixture<UTRANClassIndex> {};

TEST_F(UTRANClassIndexTest, SubscribersInCallOrderAndExactlyTheCodesOfItsRecords) {
    expectSubscribers(kWholeUtran.subscribers, 0xD00B);
}

TEST_F(UTRANClassIndexTest, TheStartCommandHoldsExactlyTheCodesOfItsRecords) {
    expectStartCommand(kWholeUtran.subscribers, UTRANLogGenerator::generator, "UTRAN");
}

TEST_F(UTRANClassIndexTest, TemplateAndRecordsMatchBothWays) {
    expectTemplateMatches("UTRAN.plist");
}

TEST_F(UTRANClassIndexTest, ItsRecordsRegisterInTheirOrder) {
    expectRegistration(kWholeUtran.registration);
}

TEST_F(UTRANClassIndexTest, TheShippedTemplateShowsEveryRecord) {
    doubles::GeneratorFixture fixture;
    fixture.resources.add("UTRAN",
                          doubles::propertyListFile(PALLAX_SOURCE_DIR "/resources/UTRAN.plist"));
    const auto generator = UTRANLogGenerator::generator(fixture.environment());
    Dictionary state;
    generator->updateState(state, doubles::Record(0xD0E0).u8(1).u8(4).prefixed());
    generator->updateState(state, doubles::Record(0xD0E2).padTo(26).prefixed());
    generator->updateState(state, doubles::Record(0xD00A).padTo(172).at(16, 2).prefixed());
    generator->updateState(state, doubles::Record(0xD00E).padTo(25).at(16, 1).prefixed());
    generator->updateState(state,
                           doubles::Record(0xD00C).padTo(331).at(14, 0x40).at(15, 0x10).prefixed());
    const PropertyList display = generator->generateLogUsingState(state);
    doubles::expectInOrder(
        display, Dictionary{{"RRC Info", Dictionary{{"State", "Cell PCH"}}},
                            {"Serving Cell Info", Dictionary{{"Cell Access Restrictions", "0"},
                                                             {"Cell ID", "0"},
                                                             {"Downlink UARFCN", "0"},
                                                             {"Uplink UARFCN", "0"},
                                                             {"URA ID", "0"},
                                                             {"Allowed Access", "All Calls"}}},
                            {"Neighbor Cell List", Array{Dictionary{{"UARFCN", "0"},
                                                                    {"Cell ID", "0"},
                                                                    {"Filter RSCP", "0.000000"},
                                                                    {"Status", "ASET"},
                                                                    {"inJDCS", "FALSE"}}}},
                            {"GSM Neighbor Cell List", Array()},
                            {"TRCH BLER",
                             Array{Dictionary{{"TRCH ID", "0"}, {"TRCH BLER Measurement", "0"}}}},
                            {"CCTRCH SIR", Array{Dictionary{{"CCTRCH ID", "0"},
                                                            {"TSNUM", "0"},
                                                            {"SIR", Array(6, PropertyList("0"))}}}},
                            {"PDP Context Info", Array()},
                            {"SIM Info", Dictionary()}});
}

TEST_F(UTRANClassIndexTest, ItsEndPrintsNoLineOfItsOwn) {
    EXPECT_EQ(lastLines(), (Names{"Deallocing ClassIndex"}));
}

} // namespace
} // namespace pallax
