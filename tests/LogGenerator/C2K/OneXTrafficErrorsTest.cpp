#include "LogGenerator/C2K/OneXTrafficErrors.h"

#include "LogGenerator/C2K/TrafficFER.h"
#include "tests/LogGenerator/C2K/C2KFixture.h"
#include "tests/LogGenerator/C2K/OneXRecords.h"
#include "tests/doubles/Property.h"

#include <gtest/gtest.h>

#include <cmath>

namespace pallax {
namespace {

using namespace doubles; // NOLINT: the vocabulary of these tests
using Lines = std::vector<RecordingLog::Line>;

TEST(OneXTrafficErrors, TheFirstFrameIsTheSampleAlone) {
    C2KFixture fixture;
    EXPECT_EQ(PropertyList(fixture.writtenBy(trafficFrame(1))),
              PropertyList(Dictionary{{"k1xTrafficFER", "1.56%"}}));
    EXPECT_EQ(fixture.state.find("TrafficFER")->real(), 0.015625);
    EXPECT_EQ(fixture.lines, Lines());
    C2KFixture good;
    good.feed(trafficFrame(0));
    EXPECT_EQ(good.text("k1xTrafficFER"), "0.00%");
    EXPECT_EQ(good.state.find("TrafficFER")->real(), 0.0);
}

TEST(OneXTrafficErrors, AnyByteButZeroIsAnError) {
    for (const unsigned inError : {1U, 2U, 0x80U, 0xFFU}) {
        C2KFixture fixture;
        fixture.feed(trafficFrame(inError));
        EXPECT_EQ(fixture.text("k1xTrafficFER"), "1.56%") << inError;
    }
}

TEST(OneXTrafficErrors, EachFurtherFrameWeighsA64thOfTheAverage) {
    C2KFixture fixture;
    fixture.feed(trafficFrame(1));
    fixture.feed(trafficFrame(0));
    EXPECT_EQ(fixture.state.find("TrafficFER")->real(), 0.015380859375);
    EXPECT_EQ(fixture.text("k1xTrafficFER"), "1.54%");
    fixture.feed(trafficFrame(1));
    EXPECT_EQ(fixture.state.find("TrafficFER")->real(), 0.030765533447265625);
    EXPECT_EQ(fixture.text("k1xTrafficFER"), "3.08%");
}

TEST(OneXTrafficErrors, SixtyFourErrorFramesFromNoStoredRateRead63Point50) {
    C2KFixture fixture;
    for (int frame = 0; frame < 64; ++frame) {
        fixture.feed(trafficFrame(1));
    }
    EXPECT_EQ(fixture.text("k1xTrafficFER"), "63.50%");
    EXPECT_NEAR(*fixture.state.find("TrafficFER")->real(), 1 - std::pow(0.984375, 64), 1e-6);
    EXPECT_EQ(fixture.value("k1xTrafficFER").displayNumber()->unit(), "%");
}

TEST(OneXTrafficErrors, TheAverageIsComputedInSinglePrecision) {
    Dictionary state;
    volatile float expected = 0.0F; // stored after every operation, so each is rounded on its own
    for (int frame = 0; frame < 1000; ++frame) {
        const bool inError = frame % 3 == 0;
        const volatile float decayed = 0.984375F * expected;
        expected = (inError ? 0.015625F : 0.0F) + decayed;
        ASSERT_EQ(addTrafficFrame(inError, state), expected) << "frame " << frame;
    }
    const double kept = *state.find("TrafficFER")->real();
    EXPECT_EQ(kept, static_cast<double>(expected));
    const auto percent = shownTrafficFER(static_cast<float>(kept));
    const volatile float single = expected * 100.0F;
    EXPECT_EQ(percent.displayNumber()->real(), static_cast<double>(single));
    EXPECT_NE(percent.displayNumber()->real(), kept * 100.0) << "not in double precision";
}

TEST(OneXTrafficErrors, TheRateKeepsBetween0And1) {
    EXPECT_TRUE(doubles::holds([] {
        Dictionary state;
        for (int count = doubles::any::between(0, 100); count > 0; --count) {
            const float rate = addTrafficFrame(doubles::any::boolean(), state);
            RC_ASSERT(rate >= 0.0F);
            RC_ASSERT(rate <= 1.0F);
        }
    }));
}

TEST(OneXTrafficErrors, AStoredRateThatIsNoNumberCountsAsNone) {
    C2KFixture fixture;
    fixture.state.set("TrafficFER", "0.5");
    fixture.feed(trafficFrame(1));
    EXPECT_EQ(fixture.text("k1xTrafficFER"), "1.56%");
    fixture.state.set("TrafficFER", PropertyList::integer(1));
    fixture.feed(trafficFrame(0));
    EXPECT_EQ(fixture.text("k1xTrafficFER"), "98.44%");
}

TEST(OneXTrafficErrors, AMissingSubpacketIsAWarningAndNothingIsSet) {
    C2KFixture fixture;
    EXPECT_TRUE(fixture.writtenBy(packetOf(0x119D, {Subpacket(5).padTo(30)})).empty());
    EXPECT_EQ(fixture.lines, (Lines{{4, "Log code 0x119d: missing traffic demod subpacket."}}));
    EXPECT_FALSE(fixture.state.contains("TrafficFER"));
}

TEST(OneXTrafficErrors, ABadSizeIsLoggedBeforeTheWarning) {
    C2KFixture fixture;
    fixture.feed(packetOf(0x119D, {Subpacket(11).padTo(25).claim(300)}));
    EXPECT_EQ(fixture.lines, (Lines{{3, "Log code error in subpkt#0: bad size (300)."},
                                    {4, "Log code 0x119d: missing traffic demod subpacket."}}));
}

TEST(OneXTrafficErrors, APacketBelow17BytesIsAnError) {
    C2KFixture fixture;
    EXPECT_TRUE(fixture.writtenBy(Record(0x119D).padTo(16)).empty());
    EXPECT_EQ(fixture.lines,
              (Lines{{3, "Log code 0x119d is 16 bytes long but must be at least 17 bytes."}}));
    fixture.feed(Record(0x119D).padTo(17));
    EXPECT_EQ(fixture.lines, (Lines{{4, "Log code 0x119d: missing traffic demod subpacket."}}));
}

TEST(OneXTrafficErrors, AFrameByteThatThePacketEndsBeforeIsNoError) {
    C2KFixture fixture;
    fixture.feed(packetOf(0x119D, {Subpacket(11).padTo(24).claim(25)}));
    EXPECT_EQ(fixture.text("k1xTrafficFER"), "0.00%");
    cutPacketAtEveryLength(trafficFrame(1), 22); // after the id
}

TEST(OneXTrafficErrors, InACutPacketTheFrameCountsWhereverTheWalkFindsIt) {
    const ByteBuffer whole = trafficFrame(1).bytes();
    const auto shown = [&whole](std::size_t length) {
        C2KFixture fixture;
        fixture.feed(
            ByteBuffer(whole.begin(), whole.begin() + static_cast<std::ptrdiff_t>(length)));
        return fixture.text("k1xTrafficFER");
    };
    EXPECT_EQ(shown(21), "") << "its id is cut off";
    EXPECT_EQ(shown(22), "0.00%");
    EXPECT_EQ(shown(23), "0.00%") << "its size reads 0";
    EXPECT_EQ(shown(24), "") << "its end at 46 is not below the bound";
    EXPECT_EQ(shown(29), "");
    EXPECT_EQ(shown(30), "0.00%");
    EXPECT_EQ(shown(45), "0.00%") << "the byte itself is cut off";
    EXPECT_EQ(shown(46), "1.56%");
}

TEST(OneXTrafficErrors, AnySubpacketsWriteOnlyItsRow) {
    EXPECT_TRUE(doubles::holds([] {
        C2KFixture fixture;
        const Dictionary rows =
            fixture.writtenBy(packetOf(0x119D, {anySubpacket(5), anySubpacket(11)}));
        RC_ASSERT(rows.size() == 1U);
        RC_ASSERT(rows.contains("k1xTrafficFER"));
    }));
}

} // namespace
} // namespace pallax
