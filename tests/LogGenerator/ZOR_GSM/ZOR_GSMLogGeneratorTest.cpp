#include "LogGenerator/ZOR_GSM/ZOR_GSMLogGenerator.h"

#include "LogGenerator/Technologies/Technologies.h"
#include "platform/TelephonyConstants.h"
#include "tests/doubles/GeneratorFixture.h"
#include "tests/doubles/RecordBuilder.h"
#include "tests/doubles/RecordingLog.h"

#include <gtest/gtest.h>

namespace pallax {
namespace {

using doubles::GeneratorFixture;
using doubles::Record;
using doubles::RecordingLog;
using Lines = std::vector<RecordingLog::Line>;

TEST(ZOR_GSMLogGenerator, ItsLifeIsLoggedWithTheDestructionTwice) {
    GeneratorFixture fixture;
    RecordingLog log;
    auto generator = ZOR_GSMLogGenerator::generator(fixture.environment());
    const auto* self = static_cast<const void*>(generator.get());
    const Lines created = log.take();
    ASSERT_GE(created.size(), 4U);
    EXPECT_EQ(created.front(), (RecordingLog::Line{3, "Creating ZOR_GSMLogGenerator object"}));
    EXPECT_EQ(created[1].text.substr(0, 13), "Array Count: ") << "then the records register";
    EXPECT_EQ(created[created.size() - 3].text.substr(0, 38),
              "Creating ZORLogGenerator2 object with ");
    EXPECT_EQ(created[created.size() - 3].priority, 3);
    EXPECT_EQ(created[created.size() - 2],
              (RecordingLog::Line{4, formatText("Creating Log object: %p", {self})}));
    EXPECT_EQ(created.back(), (RecordingLog::Line{3, "Class Index: 1"}));
    generator.reset();
    const RecordingLog::Line destructed{4,
                                        formatText("ZOR_GSMLogGenerator is destructed %p", {self})};
    EXPECT_EQ(log.lines(), (Lines{destructed, destructed}));
    EXPECT_EQ(fixture.standardOutput.lines,
              (std::vector<std::string>{"Deallocing ZOR_GSMClassIndex", "Deallocing ClassIndex"}));
}

TEST(ZOR_GSMLogGenerator, UsesTheTemplateZOR_GSM) {
    GeneratorFixture fixture;
    fixture.resources.add("ZOR_GSM", Dictionary{{"Process PS", Dictionary()}});
    const auto generator = ZOR_GSMLogGenerator::generator(fixture.environment());
    Dictionary state;
    generator->updateState(state, Record(0x7130).u8(3).u8(0).u8(0).bytes());
    EXPECT_EQ(*state.find("Display"),
              PropertyList(Dictionary{
                  {"Process PS", Dictionary{{"MM State", "GMM_REGISTERED"},
                                            {"MM Sub State", "GMM_NORMAL_SERVICE"},
                                            {"Attach Reject Cause", "GMM_GU1_UPDATED"}}}}));
}

TEST(Technologies, TheGSMIdentifierGivesTheGSMGenerator) {
    GeneratorFixture fixture;
    const auto generator =
        LogGenerator::generatorFromTechnology("Zorell_GSM", technologies(), fixture.environment());
    EXPECT_NE(dynamic_cast<ZOR_GSMLogGenerator*>(generator.get()), nullptr);
    EXPECT_EQ(
        LogGenerator::generatorFromTechnology("Zorell_gsm", technologies(), fixture.environment()),
        nullptr);
}

} // namespace
} // namespace pallax
