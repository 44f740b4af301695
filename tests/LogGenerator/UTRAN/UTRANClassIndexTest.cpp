#include "LogGenerator/UTRAN/UTRANClassIndex.h"

#include "LogGenerator/UTRAN/UTRANLogGenerator.h"
#include "tests/doubles/ClassIndexFixture.h"

#include <gtest/gtest.h>

/// The whole technology: who reads which log code, and the order of the records.
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

TEST_F(UTRANClassIndexTest, TheStartCommandHoldsExactlyTheCodesOfItsRecords) {
    expectStartCommand(kSubscribers, UTRANLogGenerator::generator, "UTRAN");
}

TEST_F(UTRANClassIndexTest, TemplateAndRecordsMatchBothWays) {
    expectTemplateMatches("UTRAN.plist");
}

TEST_F(UTRANClassIndexTest, ItsRecordsRegisterInTheirOrder) {
    expectRegistration({
        {"RRC Info", 1},
        {"Serving Cell Info", 2},
        {"Neighbor Cell List", 1},
        {"GSM Neighbor Cell List", 1},
        {"TRCH BLER", 1},
        {"CCTRCH SIR", 1},
        {"PDP Context Info", 1},
        {"SIM Info", 1},
    });
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
