#include "LogGenerator/UTRAN/UTRANLogGenerator.h"

#include "LogGenerator/Technologies/Technologies.h"
#include "platform/TelephonyConstants.h"
#include "tests/doubles/GeneratorFixture.h"
#include "tests/doubles/RecordFixture.h"

#include <gtest/gtest.h>

namespace pallax {
namespace {

using doubles::GeneratorFixture;
using doubles::Record;
using doubles::RecordingLog;
using Lines = std::vector<RecordingLog::Line>;

/// Resources with these paths.
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

/// The template names that a generator requests.
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
    ASSERT_GE(created.size(), 4U);
    EXPECT_EQ(created.rbegin()[3].text.substr(0, 38), "Creating ZORLogGenerator2 object with ");
    EXPECT_EQ(created.rbegin()[3].priority, 3);
    EXPECT_EQ(created.rbegin()[2],
              (RecordingLog::Line{4, formatText("Creating Log object: %p", {self})}));
    EXPECT_EQ(created.rbegin()[1], (RecordingLog::Line{3, "Class Index: 1"}));
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

TEST(Technologies, TheUTRANIdentifierGivesTheUTRANGeneratorAndIsComparedLast) {
    GeneratorFixture fixture;
    const auto generator = LogGenerator::generatorFromTechnology("Zorell_UTRAN2", technologies(),
                                                                 fixture.environment());
    EXPECT_NE(dynamic_cast<UTRANLogGenerator*>(generator.get()), nullptr);
    EXPECT_EQ(technologies().back().identifier, kHXLogChannelTechnology_Zorell_UTRAN2);
}

} // namespace
} // namespace pallax
