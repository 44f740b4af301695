#include "monitor/DisplayDriver.h"

#include "tests/doubles/FakeBundle.h"
#include "tests/doubles/FakeGenerator.h"
#include "tests/doubles/FakeResources.h"
#include "tests/doubles/FakeStandardOutput.h"
#include "tests/doubles/ManualClock.h"
#include "tests/doubles/SampleRecorder.h"

#include <gtest/gtest.h>

namespace pallax {
namespace {

using doubles::FakeGenerator;

class DisplayDriverTest : public testing::Test {
protected:
    FakeGenerator& setGenerator() {
        driver.setGenerator(std::make_unique<FakeGenerator>(
            GeneratorEnvironment{clock, resources, bundle, output}));
        return *FakeGenerator::living.back();
    }

    doubles::ManualClock clock;
    doubles::FakeResources resources;
    doubles::FakeBundle bundle;
    doubles::FakeStandardOutput output;
    DisplayDriver driver;
};

TEST_F(DisplayDriverTest, WithoutAGeneratorPacketsAreLostAndNothingIsShown) {
    EXPECT_EQ(driver.generator(), nullptr);
    EXPECT_FALSE(driver.keepsDisplay());
    EXPECT_FALSE(driver.takeUpdated());
    driver.update({});
    EXPECT_TRUE(driver.takeUpdated()) << "it still counts as new data";
    EXPECT_TRUE(driver.generate().isNull());
    EXPECT_TRUE(driver.display().isNull());
    EXPECT_TRUE(driver.saveContents().isNull());
}

TEST_F(DisplayDriverTest, PacketsAreNewDataUntilTheNextTick) {
    const FakeGenerator& generator = setGenerator();
    driver.update({});
    driver.update({});
    EXPECT_EQ(generator.packets.size(), 2U);
    EXPECT_TRUE(driver.takeUpdated());
    EXPECT_FALSE(driver.takeUpdated());
}

TEST_F(DisplayDriverTest, APacketWhoseRecordThrowsIsNoNewData) {
    setGenerator().refusePackets = true;
    EXPECT_THROW(driver.update({}), std::runtime_error);
    EXPECT_FALSE(driver.takeUpdated());
}

TEST_F(DisplayDriverTest, TheLiveDisplayIsCaughtUpAndNotGenerated) {
    FakeGenerator& generator = setGenerator();
    generator.display = "shown";
    EXPECT_TRUE(driver.display().isNull()) << "no tick has made a display";
    EXPECT_EQ(driver.generate(), PropertyList("shown"));
    EXPECT_EQ(driver.display(), PropertyList("shown"));
    EXPECT_EQ(generator.caughtUp, 2);
    EXPECT_EQ(generator.displaysMade, 1);
}

/// On destruction, stores how often it was brought up to date.
class CountedGenerator final : public FakeGenerator {
public:
    CountedGenerator(const GeneratorEnvironment& environment, int& asked)
        : FakeGenerator(environment), _asked(asked) {}
    ~CountedGenerator() override { _asked = caughtUp; }

private:
    int& _asked;
};

TEST_F(DisplayDriverTest, WhatAGeneratorHasReceivedIsShownBeforeAnotherTakesItsPlace) {
    int asked = 0;
    driver.setGenerator(std::make_unique<CountedGenerator>(
        GeneratorEnvironment{clock, resources, bundle, output}, asked));
    driver.update({});
    setGenerator();
    EXPECT_EQ(asked, 1);
}

TEST_F(DisplayDriverTest, TheStateOutlivesTheGenerator) {
    setGenerator().display = "shown";
    EXPECT_FALSE(driver.keepsDisplay());
    (void)driver.generate();
    setGenerator();
    EXPECT_EQ(FakeGenerator::living.size(), 1U);
    EXPECT_TRUE(driver.keepsDisplay());
    EXPECT_EQ(driver.display(), PropertyList("shown"));
    EXPECT_EQ(driver.saveContents(), PropertyList(Array{Dictionary{{"Display", "shown"}}}));
}

/// Knows its sink.
class SampledGenerator final : public FakeGenerator {
public:
    using FakeGenerator::FakeGenerator;
    void setSampleSink(SampleSink* sink) override { samples = sink; }
    void updateState(Dictionary& state, Bytes data) override {
        if (samples != nullptr) {
            samples->keyRemoved("in the packet");
        }
        FakeGenerator::updateState(state, data);
    }

    SampleSink* samples = nullptr;
};

class SampledDriverTest : public DisplayDriverTest {
protected:
    SampledGenerator& setSampledGenerator() {
        driver.setGenerator(std::make_unique<SampledGenerator>(
            GeneratorEnvironment{clock, resources, bundle, output}));
        return dynamic_cast<SampledGenerator&>(*FakeGenerator::living.back());
    }
    std::vector<std::string> samplesOf(std::uint64_t packet) {
        driver.update({}, {packet, clock.now()});
        return recorder.takeLines();
    }

    using Lines = std::vector<std::string>;
    doubles::SampleRecorder recorder;
};

TEST_F(SampledDriverTest, EachPacketOfTheSinkBeginsAndEnds) {
    setSampledGenerator();
    driver.addSampleSink(recorder);
    EXPECT_EQ(samplesOf(7), (Lines{"packet 7", "removed in the packet", "end of packet"}));
    EXPECT_EQ(samplesOf(8), (Lines{"packet 8", "removed in the packet", "end of packet"}));
    driver.removeSampleSink(recorder);
    EXPECT_EQ(samplesOf(9), Lines{});
}

TEST_F(SampledDriverTest, EverySinkGetsAllUntilItIsRemoved) {
    setSampledGenerator();
    doubles::SampleRecorder second;
    driver.addSampleSink(recorder);
    driver.addSampleSink(second);
    const Lines packet = {"packet 7", "removed in the packet", "end of packet"};
    EXPECT_EQ(samplesOf(7), packet);
    EXPECT_EQ(second.takeLines(), packet);
    driver.removeSampleSink(recorder);
    EXPECT_EQ(samplesOf(8), Lines{});
    EXPECT_EQ(second.takeLines(), (Lines{"packet 8", "removed in the packet", "end of packet"}));
}

TEST_F(SampledDriverTest, APacketWhoseRecordThrowsEndsToo) {
    setSampledGenerator().refusePackets = true;
    driver.addSampleSink(recorder);
    EXPECT_THROW(driver.update({}), std::runtime_error);
    EXPECT_EQ(recorder.takeLines(), (Lines{"packet 0", "removed in the packet", "end of packet"}));
    EXPECT_FALSE(driver.takeUpdated());
}

TEST_F(SampledDriverTest, WithoutAGeneratorPacketsAreEmpty) {
    driver.addSampleSink(recorder);
    EXPECT_EQ(samplesOf(1), (Lines{"packet 1", "end of packet"}));
}

TEST_F(SampledDriverTest, AGeneratorThatIsSetLaterGetsTheSink) {
    driver.addSampleSink(recorder);
    EXPECT_EQ(setSampledGenerator().samples, &recorder);
    driver.removeSampleSink(recorder);
    EXPECT_EQ(setSampledGenerator().samples, nullptr);
}

} // namespace
} // namespace pallax
