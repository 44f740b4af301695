#include "monitor/DisplayDriver.h"

#include "tests/doubles/FakeBundle.h"
#include "tests/doubles/FakeGenerator.h"
#include "tests/doubles/FakeResources.h"
#include "tests/doubles/FakeStandardOutput.h"
#include "tests/doubles/ManualClock.h"

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
    EXPECT_TRUE(driver.takeUpdated()) << "it counts as new data all the same";
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
    EXPECT_TRUE(driver.display().isNull()) << "no tick has made it";
    EXPECT_EQ(driver.generate(), PropertyList("shown"));
    EXPECT_EQ(driver.display(), PropertyList("shown"));
    EXPECT_EQ(generator.caughtUp, 2);
    EXPECT_EQ(generator.displaysMade, 1);
}

/// Counts on its way out what it was asked until then.
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

} // namespace
} // namespace pallax
