#include "LogGenerator/Technologies/Technologies.h"
#include "LogGenerator/UTRAN/UTRANLogGenerator.h"
#include "tests/doubles/GeneratorFixture.h"
#include "tests/doubles/InOrder.h"
#include "tests/doubles/ModelFixture.h"
#include "tests/doubles/RecordFixture.h"

#include <gtest/gtest.h>

namespace pallax {
namespace {

using doubles::GeneratorFixture;
using doubles::ModelFixture;
using doubles::Record;
using doubles::RecordingLog;
using doubles::sameInOrder;
using Lines = std::vector<RecordingLog::Line>;

/// A generator without a template; the log begins after its creation.
class UTRANWithoutTemplate : public testing::Test {
protected:
    UTRANLogGenerator& generator() { return dynamic_cast<UTRANLogGenerator&>(*_generator); }

    GeneratorFixture _fixture;
    RecordingLog _log;
    std::unique_ptr<LogGenerator> _generator = UTRANLogGenerator::generator(_fixture.environment());
    Dictionary _state;
};

TEST_F(UTRANWithoutTemplate, ItsMakingLogsNothingAndItIsAUTRANLogGenerator) {
    EXPECT_NE(dynamic_cast<UTRANLogGenerator*>(_generator.get()), nullptr);
    EXPECT_EQ(_log.lines(), Lines());
}

TEST_F(UTRANWithoutTemplate, AResourceFolderWithOtherTemplatesIsNoDifference) {
    _fixture.resources.add("ZOR_GSM", Dictionary{{"RRC Info", Dictionary()}});
    (void)_log.take();
    const auto generator = UTRANLogGenerator::generator(_fixture.environment());
    generator->updateState(_state, Record(0xD0E0).u8(1).u8(3).bytes());
    EXPECT_TRUE(_state.empty());
    EXPECT_EQ(_log.lines(), Lines());
}

TEST_F(UTRANWithoutTemplate, AWholeReplayDoesNothingAndReturnsNothing) {
    EXPECT_TRUE(generator().getStartCommand().isNull());
    for (const ByteBuffer& packet :
         {ByteBuffer(), ByteBuffer{0x81}, ByteBuffer{0x02}, Record(0xD0E0).u8(1).u8(3).prefixed(),
          Record(0xD00C).padTo(17).bytes(), Record(0xFF0000).prefixed()}) {
        generator().updateState(_state, packet);
        generator().updateWithData(packet);
        EXPECT_TRUE(generator().generateLogUsingState(_state).isNull());
    }
    EXPECT_TRUE(generator().getSaveContentsFromState(_state).isNull());
    EXPECT_TRUE(generator().processTemplate(Dictionary{{"RRC Info", Dictionary()}}).isNull());
    EXPECT_TRUE(_state.empty()) << "no template, no display, no history, no capture";
    EXPECT_EQ(_log.lines(), Lines());
    EXPECT_TRUE(_fixture.standardOutput.lines.empty());
}

TEST_F(UTRANWithoutTemplate, WhatAnotherGeneratorLeftInTheStateIsNeitherShownNorSaved) {
    _state.set("Display", Dictionary{{"RRC Info", Dictionary()}});
    _state.set("History", Array{Dictionary{{"Description", "Snapshot"}}});
    const Dictionary before = _state;
    generator().updateState(_state, Record(0xD0E0).u8(1).u8(3).bytes());
    EXPECT_TRUE(generator().getDisplayFromState(_state).isNull());
    EXPECT_TRUE(generator().generateLogUsingState(_state).isNull());
    EXPECT_TRUE(generator().getSaveContentsFromState(_state).isNull());
    EXPECT_TRUE(sameInOrder(_state, before));
}

TEST_F(UTRANWithoutTemplate, ItsEndIsThatOfItsBase) {
    const auto* self = static_cast<const void*>(_generator.get());
    _generator.reset();
    EXPECT_EQ(_log.lines(),
              (Lines{{4, formatText("ZOR_GSMLogGenerator is destructed %p", {self})}}));
    EXPECT_TRUE(_fixture.standardOutput.lines.empty()) << "there was no index";
}

/// The model with fakes, the real technologies and no resources.
class UTRANModelWithoutTemplate : public ModelFixture {
protected:
    void SetUp() override {
        ModelFixture::SetUp();
        reply = technology("Zorell_UTRAN2");
        model = std::make_unique<PallaxModel>(
            PallaxModel::Platform{.ports = ports,
                                  .telephony = telephony,
                                  .queue = queue,
                                  .timers = queue,
                                  .generators = {clock, resources, bundle, standardOutput},
                                  .technologies = technologies()},
            observer);
    }
};

TEST_F(UTRANModelWithoutTemplate, ItsStartCommandIsNoPropertyListSoTheStartFailsAndIsRetried) {
    start();
    EXPECT_EQ(errors().back(), " Could not generate PLIST");
    ASSERT_EQ(ports.requests.size(), 1U) << "the query, and no start command";
    EXPECT_TRUE(retriesAfter5Seconds());
    EXPECT_EQ(errors().back(), " Could not generate PLIST");
    EXPECT_EQ(ports.requests.size(), 2U);
}

TEST_F(UTRANModelWithoutTemplate, TheModelHasNothingToShowAndNothingToSave) {
    start();
    EXPECT_TRUE(model->getSaveContents().isNull());
    (void)model->topLevelNodes(); // null without a display
    EXPECT_EQ(model->nodeAtPath("RRC Info"), nullptr);
}

TEST_F(UTRANModelWithoutTemplate, ATemplateThatAppearsLaterServesTheNextRetry) {
    start();
    resources.add("UTRAN", Dictionary{{"RRC Info", Dictionary()}});
    EXPECT_TRUE(retriesAfter5Seconds());
    EXPECT_EQ(errors().back(), "Starting the display update timer");
    EXPECT_EQ(ports.requests.size(), 3U);
}

TEST(StartCommand, NothingIsNoPropertyList) {
    EXPECT_FALSE(serializeXml(PropertyList()));
}

} // namespace
} // namespace pallax
