#include "timeline/Instants.h"

#include "decoding/RecordingDecoder.h"
#include "tests/doubles/FakeStandardOutput.h"
#include "tests/timeline/TimelineFixture.h"
#include "timeline/FrameWalk.h"

#include <string>

namespace pallax {
namespace {

using namespace std::chrono_literals;
namespace any = doubles::any;

/// What `decode --every tick` shows.
class ShownTicks final : public DisplayOutput {
public:
    struct Tick {
        std::uint64_t number;
        Time time;
        std::string display;
    };
    std::vector<Tick> all;

    void beginRecording() override {}
    void show(const DisplayMoment& moment, const PropertyList& display) override {
        all.push_back({moment.number, moment.time, treeText(display)});
    }
    static std::string treeText(const PropertyList& display) {
        PathDictionary paths;
        return treeText(PallaxModelNode::makeTreeFromObject(display, paths));
    }
    /// A line for each node, in display order.
    static std::string treeText(const NodeRef& node, const std::string& path = "/") {
        if (node == nullptr) {
            return {};
        }
        const PropertyList* value = node->value();
        std::string text =
            path + " " + (value != nullptr ? value->string().value_or(value->description()) : "") +
            "\n";
        if (node->childNodes() != nullptr) {
            for (const NodeRef& child : *node->childNodes()) {
                text += treeText(child, childPath(path, child->displayName()));
            }
        }
        return text;
    }
};

ShownTicks decoded(const TimelineFixture& fixture) {
    doubles::FakeStandardOutput output;
    ShownTicks ticks;
    RecordingDecoder decoder({fixture.resources, fixture.bundle, output, technologies()},
                             fixture.technology.identifier, Every::Tick, ticks);
    for (std::uint64_t number = 1; number <= fixture.journal.size(); ++number) {
        const JournalPacket packet = fixture.journal.packet(number);
        EXPECT_FALSE(decoder.add({packet.time, packet.data}));
    }
    decoder.finish();
    return ticks;
}

std::string treeText(const Frame& frame) {
    return ShownTicks::treeText(frame.root());
}

class InstantsTest : public testing::TestWithParam<const char*> {};

TEST_P(InstantsTest, AFrameIsThatOfTheLatestTickAtOrBeforeTheTime) {
    EXPECT_TRUE(doubles::holds([] {
        TimelineFixture fixture(GetParam());
        const auto seconds = any::between(1, 40);
        fixture.drive(any::bits(), std::chrono::seconds(seconds), 10);
        const ShownTicks shown = decoded(fixture);
        const auto timeline = fixture.indexed(
            TimelineFixture::closeKeyFrames(static_cast<std::uint64_t>(any::between(1, 60))));
        // Often the very time of a tick, to which it belongs.
        const Time random = Simulation::kStart + any::between(0, seconds * 1000 + 3000) * 1ms;
        const Time time = any::boolean() ? any::elementOf(shown.all).time : random;
        std::size_t expected = 0;
        while (expected < shown.all.size() && shown.all[expected].time <= time) {
            ++expected;
        }
        const auto frame = frameAt(*timeline, time);
        RC_ASSERT(frame.has_value() == (expected != 0));
        if (!frame) {
            return;
        }
        const ShownTicks::Tick& tick = shown.all[expected - 1];
        RC_ASSERT(frame->tick.number == tick.number);
        RC_ASSERT(frame->tick.time == tick.time);
        RC_ASSERT(frame->frame->time() == tick.time);
        RC_ASSERT(treeText(*frame->frame) == tick.display);
        RC_ASSERT((frame->before != nullptr) == (expected > 1));
        if (frame->before) {
            RC_ASSERT(frame->before->time() == shown.all[expected - 2].time);
            RC_ASSERT(treeText(*frame->before) == shown.all[expected - 2].display);
        }
    }));
}

TEST_P(InstantsTest, TicksAfterAClockThatStepsBackAreFound) {
    TimelineFixture fixture(GetParam());
    fixture.drive(2, 30s, 10);
    MemoryJournal again;
    const std::uint64_t first = fixture.journal.size();
    for (std::uint64_t number = 1; number <= first; number += 2) {
        const JournalPacket packet = fixture.journal.packet(number);
        // Begins 50 s earlier and ends between the first stretch's begin and end.
        again.add(packet.time - 50s + 25s * number / first,
                  ByteBuffer(packet.data.begin(), packet.data.end()));
    }
    for (std::uint64_t number = 1; number <= again.size(); ++number) {
        const JournalPacket packet = again.packet(number);
        fixture.journal.add(packet.time, ByteBuffer(packet.data.begin(), packet.data.end()));
    }
    const ShownTicks shown = decoded(fixture);
    const auto timeline = fixture.indexed(TimelineFixture::closeKeyFrames(30));
    ASSERT_EQ(timeline->stretches().size(), 2U);
    const Time start = timeline->stretches()[0].first;
    std::size_t inSecond = 0;
    for (std::size_t index = 0; index < shown.all.size(); ++index) {
        const ShownTicks::Tick& tick = shown.all[index];
        const bool isSecond = index > 0 && (inSecond > 0 || tick.time < shown.all[index - 1].time);
        inSecond += isSecond ? 1 : 0;
        if (isSecond && tick.time >= start) {
            continue; // the first stretch has that time, too
        }
        const auto frame = frameAt(*timeline, tick.time + 1ms);
        ASSERT_TRUE(frame);
        EXPECT_EQ(frame->tick.number, tick.number);
        EXPECT_EQ(frame->tick.time, tick.time);
        EXPECT_EQ(treeText(*frame->frame), tick.display);
    }
    EXPECT_GT(inSecond, 5U);
}

/// The ticks of all packets, and the last packet before each.
std::vector<ShownTick> plainTicks(const MemoryJournal& journal) {
    std::vector<ShownTick> ticks;
    TickGrid grid;
    for (std::uint64_t number = 1; number <= journal.size(); ++number) {
        if (const auto tick = grid.passedBefore(journal.packet(number).time)) {
            ticks.push_back({*tick, number - 1});
        }
    }
    ticks.push_back({grid.next(), journal.size()});
    return ticks;
}

TEST_P(InstantsTest, TheTicksBesideAnInstantAreFoundWithoutDecodingAll) {
    EXPECT_TRUE(doubles::holds([] {
        TimelineFixture fixture(GetParam());
        fixture.drive(any::bits(), std::chrono::seconds(any::between(1, 20)), 10);
        if (any::boolean()) { // the clock is set back
            fixture.drive(any::bits(), std::chrono::seconds(any::between(3, 20)), 10);
        }
        const std::vector<ShownTick> ticks = plainTicks(fixture.journal);
        const auto timeline = fixture.indexed(
            TimelineFixture::closeKeyFrames(static_cast<std::uint64_t>(any::between(1, 60))));
        const std::uint64_t instant = any::index(fixture.journal.size() + 1);
        std::optional<ShownTick> before;
        std::optional<ShownTick> after;
        for (const ShownTick& tick : ticks) {
            before = tick.packet < instant ? tick : before;
            after = tick.packet > instant && !after ? tick : after;
        }
        const auto same = [](const auto& found, const auto& expected) {
            return found.has_value() == expected.has_value() &&
                   (!found || (found->packet == expected->packet &&
                               found->tick.number == expected->tick.number &&
                               found->tick.time == expected->tick.time));
        };
        RC_ASSERT(same(tickBefore(*timeline, instant), before));
        RC_ASSERT(same(tickAfter(*timeline, instant), after));
        const auto frame = FrameWalk(*timeline).at(instant);
        RC_ASSERT(frame.has_value() == (instant != 0));
        if (frame) {
            RC_ASSERT(ShownTicks::treeText(timeline->displayAt(instant)) ==
                      treeText(*frame->frame));
            RC_ASSERT(frame->frame->time() == fixture.journal.packet(instant).time);
            RC_ASSERT((frame->before != nullptr) == before.has_value());
            if (before) {
                RC_ASSERT(ShownTicks::treeText(timeline->displayAt(before->packet)) ==
                          treeText(*frame->before));
            }
        }
    }));
}

TEST(Instants, ATimeBesideAnInstantStaysInItsStretchOrGoesToTheNextOne) {
    TimelineFixture fixture("lte");
    fixture.drive(2, 10s, 10);
    const std::uint64_t first = fixture.journal.size();
    fixture.drive(3, 10s, 10);
    const auto timeline = fixture.indexed();
    ASSERT_EQ(timeline->stretches().size(), 2U);
    const Time start = timeline->stretches()[1].first;
    const std::uint64_t inSecond = first + 40;
    const std::uint64_t beside = instantBeside(*timeline, inSecond, start + 2s);
    EXPECT_GT(beside, first);
    EXPECT_LE(*timeOf(*timeline, beside), start + 2s);
    EXPECT_GT(*timeOf(*timeline, beside + 1), start + 2s);
    EXPECT_EQ(instantBeside(*timeline, inSecond, start - 1min), first);
    EXPECT_EQ(instantBeside(*timeline, inSecond, start + 1min), fixture.journal.size());
    EXPECT_EQ(instantBeside(*timeline, 3, start + 1min), first + 1);
    EXPECT_EQ(instantBeside(*timeline, 3, start - 1min), 0U);
}

INSTANTIATE_TEST_SUITE_P(Technologies, InstantsTest, testing::ValuesIn(technologyNames()),
                         [](const auto& each) { return std::string(each.param); });

TEST(Instants, AFrameTellsWhatChangedSinceTheTickBefore) {
    TimelineFixture fixture("lte");
    const Time start = Simulation::kStart;
    const auto cell = [&](int second, std::uint16_t pci) {
        fixture.journal.add(start + std::chrono::seconds(second),
                            doubles::Record(0xB0C2).padTo(14).u16(pci).padTo(38).bytes());
    };
    cell(0, 150);
    cell(3, 182);
    cell(5, 182);
    const auto timeline = fixture.indexed(TimelineFixture::closeKeyFrames(1));
    const auto frame = frameAt(*timeline, start + 4s);
    ASSERT_TRUE(frame && frame->before);
    EXPECT_EQ(frame->frame->changed(),
              std::vector<std::string>{"/Serving Cell Info/Physical Cell ID"});
    EXPECT_EQ(frame->frame->age(*frame->frame->nodeAtPath("/Serving Cell Info/Cell Identity")), 1s);
    const auto last = frameAt(*timeline, start + 100s);
    ASSERT_TRUE(last);
    EXPECT_TRUE(last->frame->changed().empty());
    EXPECT_FALSE(frameAt(*timeline, start + 1s)) << "no tick has passed";
    EXPECT_FALSE(frameAt(*timeline, start - 1s));
}

} // namespace
} // namespace pallax
