#include "LogGenerator/UTRAN/UTRANLogGenerator.h"

#include "LogGenerator/Technologies/Technologies.h"
#include "platform/TelephonyConstants.h"
#include "tests/doubles/GeneratorFixture.h"
#include "tests/doubles/RecordFixture.h"
#include "tests/doubles/TemplateCheck.h"

#include <gtest/gtest.h>

namespace pallax {
namespace {

using doubles::GeneratorFixture;
using doubles::Record;
using doubles::RecordingLog;
using Lines = std::vector<RecordingLog::Line>;

/// The path of every resource is what the test says.
class ResourcesAt final : public Resources {
public:
    explicit ResourcesAt(std::vector<std::string> paths) : _paths(std::move(paths)) {}
    std::optional<PropertyList> propertyList(std::string_view name) const override {
        asked.emplace_back(name);
        return std::nullopt;
    }
    std::vector<std::string> propertyListPaths() const override { return _paths; }

    mutable std::vector<std::string> asked;

private:
    std::vector<std::string> _paths;
};

/// The names under which a generator asks for its template.
std::vector<std::string> askedFor(std::vector<std::string> paths) {
    GeneratorFixture fixture;
    const ResourcesAt resources(std::move(paths));
    const auto generator = UTRANLogGenerator::generator(
        {fixture.clock, resources, fixture.bundle, fixture.standardOutput});
    Dictionary state;
    (void)generator->generateLogUsingState(state);
    return resources.asked;
}

TEST(UTRANLogGenerator, TheNameIsThatOfTheFirstPathThatContainsUTRANInAnyCase) {
    using TemplateNames = std::vector<std::string>;
    EXPECT_EQ(askedFor({"a/UTRAN.plist"}), TemplateNames{"UTRAN"});
    EXPECT_EQ(askedFor({"a/utran_v2.plist"}), TemplateNames{"utran_v2"});
    EXPECT_EQ(askedFor({"a/LTE.plist", "a/My.uTrAn.v3.plist", "a/UTRAN.plist"}),
              TemplateNames{"My.uTrAn.v3"});
    EXPECT_EQ(askedFor({"a/EUTRANCELL.plist"}), TemplateNames{"EUTRANCELL"})
        << "anywhere in the name";
    EXPECT_EQ(askedFor({"a/utran/Other.plist", "b/UTRAN.plist"}), TemplateNames{"Other"})
        << "anywhere in the path";
    EXPECT_EQ(askedFor({"UTRAN"}), TemplateNames{"UTRAN"}) << "without a folder and an extension";
}

TEST(UTRANLogGenerator, NoPathOrNoneThatContainsUTRANAsksForNothing) {
    EXPECT_TRUE(askedFor({}).empty());
    EXPECT_TRUE(askedFor({"a/LTE.plist", "a/UTRA.plist", "a/U-TRAN.plist"}).empty());
}

TEST(UTRANLogGenerator, ItsCreationIsLoggedBehindTheBase) {
    GeneratorFixture fixture;
    fixture.resources.add("UTRAN", Dictionary());
    RecordingLog log;
    auto generator = UTRANLogGenerator::generator(fixture.environment());
    const auto* self = static_cast<const void*>(generator.get());
    const Lines created = log.take();
    constexpr std::size_t kRecords = 8;
    ASSERT_EQ(created.size(), kRecords + 4);
    EXPECT_EQ(created[kRecords].text.substr(0, 38), "Creating ZORLogGenerator2 object with ");
    EXPECT_EQ(created[kRecords].priority, 3);
    EXPECT_EQ(created[kRecords + 1],
              (RecordingLog::Line{4, formatText("Creating Log object: %p", {self})}));
    EXPECT_EQ(created[kRecords + 2], (RecordingLog::Line{3, "Class Index: 1"}));
    EXPECT_EQ(created.back(), (RecordingLog::Line{3, "Created UTRANLogGenerator object"}));
}

TEST(UTRANLogGenerator, ItsEndLogsOnlyTheLineOfTheBase) {
    GeneratorFixture fixture;
    fixture.resources.add("UTRAN", Dictionary());
    auto generator = UTRANLogGenerator::generator(fixture.environment());
    const auto* self = static_cast<const void*>(generator.get());
    RecordingLog log;
    generator.reset();
    EXPECT_EQ(log.lines(),
              (Lines{{4, formatText("ZOR_GSMLogGenerator is destructed %p", {self})}}));
    EXPECT_EQ(fixture.standardOutput.lines, (std::vector<std::string>{"Deallocing ClassIndex"}));
}

TEST(UTRANLogGenerator, ATemplateNamedUtran_v2AloneIsUsed) {
    GeneratorFixture fixture;
    fixture.resources.add("utran_v2", Dictionary{{"RRC Info", Dictionary()}});
    const auto generator = UTRANLogGenerator::generator(fixture.environment());
    Dictionary state;
    generator->updateState(state, Record(0xD0E0).u8(1).u8(3).bytes());
    EXPECT_EQ(generator->display(state),
              PropertyList(Dictionary{{"RRC Info", Dictionary{{"State", "Cell DCH"}}}}));
}

TEST(UTRANLogGenerator, TheStartCommandHoldsExactlyTheCodesOfItsRecords) {
    GeneratorFixture fixture;
    fixture.resources.add("UTRAN", Dictionary());
    const auto generator = UTRANLogGenerator::generator(fixture.environment());
    Array codes;
    for (const LogCode logCode : std::vector<LogCode>{0xD00A, 0xD00C, 0xD00E, 0xD0E0, 0xD0E2}) {
        codes.push_back(PropertyList::integer(logCode));
    }
    const Array extraCodes = {PropertyList::integer(0), PropertyList::integer(1),
                              PropertyList::integer(2)};
    doubles::expectInOrder(generator->getStartCommand(),
                           Dictionary{{"SetState", "Streaming"},
                                      {"SetZorellLogCodes", codes},
                                      {"SetHxExtraCodes", extraCodes}});
}

TEST(UTRANLogGenerator, ALinkQualityPacketIsOfferedToTheBlockErrorsFirst) {
    GeneratorFixture fixture;
    fixture.resources.add("UTRAN", Dictionary());
    const auto generator = UTRANLogGenerator::generator(fixture.environment());
    Dictionary state;
    (void)generator->generateLogUsingState(state);
    RecordingLog log;
    generator->updateState(state, Record(0xD00C).padTo(17).prefixed());
    EXPECT_EQ(log.lines(), (Lines{{6, "Log Header 0x81"},
                                  {5, "TRCH BLER Measurement"},
                                  {4, "CCTRCH SIR Measurement"}}));
}

TEST(UTRANLogGenerator, TheShippedTemplateShowsEveryRecord) {
    GeneratorFixture fixture;
    fixture.resources.add("UTRAN",
                          doubles::propertyListFile(PALLAX_SOURCE_DIR "/resources/UTRAN.plist"));
    const auto generator = UTRANLogGenerator::generator(fixture.environment());
    Dictionary state;
    generator->updateState(state, Record(0xD0E0).u8(1).u8(4).prefixed());
    generator->updateState(state, Record(0xD0E2).padTo(26).prefixed());
    generator->updateState(state, Record(0xD00A).padTo(172).at(16, 2).prefixed());
    generator->updateState(state, Record(0xD00E).padTo(25).at(16, 1).prefixed());
    generator->updateState(state, Record(0xD00C).padTo(331).at(14, 0x40).at(15, 0x10).prefixed());
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

TEST(Technologies, TheUTRANIdentifierGivesTheUTRANGeneratorAndIsComparedLast) {
    GeneratorFixture fixture;
    const auto generator = LogGenerator::generatorFromTechnology("Zorell_UTRAN2", technologies(),
                                                                 fixture.environment());
    EXPECT_NE(dynamic_cast<UTRANLogGenerator*>(generator.get()), nullptr);
    EXPECT_EQ(technologies().back().identifier, kHXLogChannelTechnology_Zorell_UTRAN2);
}

} // namespace
} // namespace pallax
