#include "LogGenerator/LTE/LTELogGenerator.h"

#include "LogGenerator/Technologies/Technologies.h"
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

/// With the application's template.
struct LTEFixture : GeneratorFixture {
    LTEFixture() {
        resources.add("LTE", doubles::propertyListFile(PALLAX_SOURCE_DIR "/resources/LTE.plist"));
    }
};

TEST(LTELogGenerator, ItsLifeIsLoggedWithTheBasesDestructionLineUnderTheGSMName) {
    GeneratorFixture fixture;
    RecordingLog log;
    auto generator = LTELogGenerator::generator(fixture.environment());
    const auto* self = static_cast<const void*>(generator.get());
    const Lines created = log.take();
    ASSERT_GE(created.size(), 4U);
    EXPECT_EQ(created.front(), (RecordingLog::Line{3, "Creating LTELogGenerator object"}));
    EXPECT_EQ(created[1], (RecordingLog::Line{4, "Array Count: 3"})) << "the records register";
    EXPECT_EQ(created[created.size() - 3].text.substr(0, 38),
              "Creating ZORLogGenerator2 object with ");
    EXPECT_EQ(created.back(), (RecordingLog::Line{3, "Class Index: 1"}));
    generator.reset();
    EXPECT_EQ(log.lines(),
              (Lines{{4, formatText("LTELogGenerator is destructed %p", {self})},
                     {4, formatText("ZOR_GSMLogGenerator is destructed %p", {self})}}));
    EXPECT_EQ(fixture.standardOutput.lines,
              (std::vector<std::string>{"Deallocing LTEClassIndex", "Deallocing ClassIndex"}));
}

TEST(LTELogGenerator, A0xB179IsOfferedToItsThreeRecordsInOrder) {
    LTEFixture fixture;
    const auto generator = LTELogGenerator::generator(fixture.environment());
    Dictionary state;
    generator->updateState(state, Record(0x1234).padTo(13).bytes());
    const RecordingLog log;
    generator->updateState(state, Record(0xB179).padTo(20).prefixed());
    const Lines& lines = log.lines();
    ASSERT_GE(lines.size(), 3U);
    EXPECT_EQ((Lines{lines.end() - 3, lines.end()}),
              (Lines{{4, "Connected mode LTE Intra-frequency Measurement"},
                     {4, "Measured Neighbor Cells"},
                     {4, "Detected Cells"}}));
}

TEST(Technologies, TheLTEIdentifierGivesTheLTEGenerator) {
    GeneratorFixture fixture;
    const auto generator =
        LogGenerator::generatorFromTechnology("Zorell_LTE", technologies(), fixture.environment());
    EXPECT_NE(dynamic_cast<LTELogGenerator*>(generator.get()), nullptr);
}

} // namespace
} // namespace pallax
