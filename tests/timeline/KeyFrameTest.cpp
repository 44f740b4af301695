#include "LogGenerator/KeyFrame.h"

#include "monitor/Frame.h"
#include "tests/doubles/RecordingLog.h"
#include "tests/doubles/SampleRecorder.h"
#include "tests/timeline/TimelineFixture.h"
#include "timeline/Replay.h"

#include <exception>
#include <string>

namespace pallax {
namespace {

using namespace std::chrono_literals;
namespace any = doubles::any;

/// A display with the time at which each of its nodes was read.
std::string pictureOf(Replay& replay) {
    const PropertyList display = replay.displayAt({});
    PathDictionary paths;
    (void)PallaxModelNode::makeTreeFromObject(display, paths);
    const SectionAges ages = replay.ages();
    std::string picture = display.description();
    for (const auto& [path, node] : std::map(paths.begin(), paths.end())) {
        const auto read = ages.lastRead(path);
        picture += "\n" + path + " " + (read ? isoTimeText(*read) : "never");
    }
    return picture;
}

/// A record may throw; then it has no effect that either of two decoders would not have.
void update(Replay& replay, const JournalPacket& packet, SampleSink& sink) {
    try {
        replay.update(packet, &sink);
    } catch (const std::exception&) {
        return;
    }
}

/// Whether a decoder that goes on from a key frame is like the one that gave it.
void compareFromKeyFrame(const TimelineFixture& fixture, std::uint64_t instant) {
    const MemoryJournal& journal = fixture.journal;
    const DecodingSource source = fixture.source();
    doubles::SampleRecorder expected;
    doubles::SampleRecorder actual;
    Replay whole(source);
    for (std::uint64_t number = 1; number <= instant; ++number) {
        update(whole, journal.packet(number), expected);
    }
    Replay resumed(source);
    resumed.resume(whole.keyFrame(), instant);
    (void)expected.takeLines();
    RC_ASSERT(pictureOf(resumed) == pictureOf(whole));
    for (std::uint64_t number = instant + 1; number <= journal.size(); ++number) {
        update(whole, journal.packet(number), expected);
        update(resumed, journal.packet(number), actual);
        RC_ASSERT(actual.takeLines() == expected.takeLines());
        if (number % 37 == 0) { // not always: between, records are kept and not read
            RC_ASSERT(pictureOf(resumed) == pictureOf(whole));
        }
    }
    RC_ASSERT(pictureOf(resumed) == pictureOf(whole));
}

class KeyFrameTest : public testing::TestWithParam<const char*> {};

TEST_P(KeyFrameTest, ADecoderGoesOnFromItInDrivesAsIfItHadReadThePacketsBefore) {
    EXPECT_TRUE(doubles::holds([] {
        TimelineFixture fixture(GetParam());
        fixture.drive(any::bits(), std::chrono::seconds(any::between(1, 40)), 5);
        compareFromKeyFrame(fixture, any::index(fixture.journal.size() + 1));
    }));
}

TEST_P(KeyFrameTest, ADecoderGoesOnFromItInAnyBytes) {
    EXPECT_TRUE(doubles::holds([] {
        TimelineFixture fixture(GetParam());
        fixture.anyPackets(60);
        compareFromKeyFrame(fixture, any::index(fixture.journal.size() + 1));
    }));
}

TEST_P(KeyFrameTest, ItSharesNothingWithTheDecoderThatGaveIt) {
    TimelineFixture fixture(GetParam());
    fixture.drive(3, 20s);
    doubles::SampleRecorder samples;
    Replay replay(fixture.source());
    for (std::uint64_t number = 1; number <= 100; ++number) {
        update(replay, fixture.journal.packet(number), samples);
    }
    const KeyFrame keyFrame = replay.keyFrame();
    const std::string then = keyFrame.display.description();
    const std::string picture = pictureOf(replay);
    for (std::uint64_t number = 101; number <= fixture.journal.size(); ++number) {
        update(replay, fixture.journal.packet(number), samples);
    }
    EXPECT_NE(pictureOf(replay), picture) << "the packets change the display";
    EXPECT_EQ(keyFrame.display.description(), then);
    Replay resumed(fixture.source());
    resumed.resume(keyFrame, 100);
    EXPECT_EQ(pictureOf(resumed), picture);
}

TEST_P(KeyFrameTest, DecodingAgainIsQuiet) {
    TimelineFixture fixture(GetParam());
    fixture.drive(3, 5s);
    const doubles::RecordingLog log;
    {
        doubles::SampleRecorder samples;
        Replay replay(fixture.source());
        update(replay, fixture.journal.packet(1), samples);
        Replay resumed(fixture.source());
        resumed.resume(replay.keyFrame(), 1);
        update(resumed, fixture.journal.packet(2), samples);
        (void)pictureOf(resumed);
    }
    EXPECT_TRUE(log.lines().empty()) << log.lines().front().text;
    systemLog(LogPriority::Error, "afterwards the log works");
    EXPECT_EQ(log.lines().size(), 1U);
}

INSTANTIATE_TEST_SUITE_P(Technologies, KeyFrameTest, testing::ValuesIn(technologyNames()),
                         [](const auto& each) { return std::string(each.param); });

TEST(KeyFrame, HasTheBsicsThatOtherRecordsLookUp) {
    TimelineFixture fixture("gsm");
    const auto add = [&fixture](doubles::Record record) {
        fixture.journal.add(Simulation::kStart, record.bytes());
    };
    add(doubles::Record(0x51FF).padTo(14).u8(1).u16(62).u8(18).padTo(19));
    add(doubles::Record(0x5137).padTo(28).u8(1).u16(62).padTo(43));
    doubles::SampleRecorder samples;
    Replay whole(fixture.source());
    update(whole, fixture.journal.packet(1), samples);
    Replay resumed(fixture.source());
    resumed.resume(whole.keyFrame(), 1);
    update(resumed, fixture.journal.packet(2), samples);
    EXPECT_NE(pictureOf(resumed).find("BSIC = 18;"), std::string::npos) << pictureOf(resumed);
}

TEST(KeyFrames, AreAtTwiceTheDistanceWhenThereAreTooMany) {
    TimelineFixture fixture("lte");
    const auto timeline = fixture.indexed();
    KeyFrames::Limits limits;
    limits.distance = 10;
    limits.count = 4;
    KeyFrames keyFrames(limits);
    const auto packets = [&] {
        std::vector<std::uint64_t> numbers;
        for (const TimelineKeyFrame& each : keyFrames.all()) {
            numbers.push_back(each.packet);
        }
        return numbers;
    };
    using Numbers = std::vector<std::uint64_t>;
    for (std::uint64_t packet = 0; packet <= 40; packet += 10) {
        keyFrames.add({packet, {}, timeline->valuesAt(0), {}, {}});
    }
    EXPECT_EQ(packets(), (Numbers{0, 20, 40}));
    EXPECT_FALSE(keyFrames.isDue(19, 0));
    EXPECT_TRUE(keyFrames.isDue(20, 0));
    EXPECT_EQ(keyFrames.atOrBefore(39)->packet, 20U);
    EXPECT_EQ(keyFrames.atOrBefore(40)->packet, 40U);
    keyFrames.dropBefore(21);
    EXPECT_EQ(packets(), (Numbers{20, 40})) << "decoding goes on from 20 with packet 21";
    keyFrames.dropBefore(22);
    EXPECT_EQ(packets(), Numbers{40});
    EXPECT_EQ(keyFrames.atOrBefore(39), nullptr);
}

} // namespace
} // namespace pallax
