#include "live/LiveTimeline.h"

#include "LogGenerator/Technologies/Technologies.h"
#include "host/DirectoryResources.h"
#include "platform/RecordedTechnology.h"
#include "simulator/Simulation.h"
#include "tests/doubles/FakeBundle.h"
#include "tests/doubles/Files.h"
#include "tests/doubles/SteppedQueue.h"

#include <gtest/gtest.h>

#include <cstdlib>
#include <string>
#include <utility>
#include <vector>

namespace pallax {
namespace {

using namespace std::chrono_literals;

class LiveTimelineTest : public testing::Test {
protected:
    LiveTimelineTest() { (void)::setenv("XDG_STATE_HOME", _state.path().c_str(), 1); }
    ~LiveTimelineTest() override { (void)::unsetenv("XDG_STATE_HOME"); }

    using Packets = std::vector<std::pair<Time, ByteBuffer>>;
    static Packets drive(const char* technology, std::chrono::seconds duration) {
        Packets packets;
        Simulation simulation({technologyOfCommandName(technology), 7, 40, duration});
        while (const auto packet = simulation.next()) {
            packets.emplace_back(packet->time,
                                 ByteBuffer(packet->data.begin(), packet->data.end()));
        }
        return packets;
    }
    static void add(LiveTimeline& live, const char* technology, const Packets& packets) {
        for (const auto& [time, data] : packets) {
            live.add(*technologyOfCommandName(technology), time, data);
        }
    }
    /// Each look at the clock takes a millisecond.
    LiveTimeline::Setup setup(const BoundedJournal::Limits& limits = {}) {
        return {queue,
                resources,
                bundle,
                technologies(),
                limits,
                [this](const std::string& sentence) { reports.push_back(sentence); },
                [this](Timeline& timeline) { slices.push_back(timeline.packets()); },
                [this] { return std::chrono::steady_clock::time_point(1ms * ++looks); }};
    }
    static std::string eventsOf(const Timeline& timeline) {
        std::string text;
        for (const Event& event : timeline.events()) {
            text += std::to_string(event.packet) + " " + event.words + "\n";
        }
        return text;
    }

    doubles::SteppedQueue queue;
    DirectoryResources resources{PALLAX_SOURCE_DIR "/resources"};
    doubles::FakeBundle bundle;
    std::vector<std::string> reports;
    std::vector<std::uint64_t> slices;
    int looks = 0;

private:
    doubles::TemporaryFolder _state;
};

TEST_F(LiveTimelineTest, WithoutAPacketThereIsNone) {
    LiveTimeline live(setup());
    live.finish();
    EXPECT_EQ(live.timeline(), nullptr);
    EXPECT_EQ(live.notes(), std::vector<std::string>());
}

TEST_F(LiveTimelineTest, IndexesPacketsInSlicesBetweenOtherBlocks) {
    LiveTimeline live(setup());
    const Packets packets = drive("lte", 10s);
    add(live, "lte", packets);
    ASSERT_EQ(packets.size(), 400U);
    EXPECT_EQ(live.timeline()->packets(), 0U) << "the queue has not run";
    int others = 0;
    queue.async([&] { ++others; });
    EXPECT_TRUE(queue.step());
    EXPECT_EQ(slices, std::vector<std::uint64_t>{live.timeline()->packets()});
    EXPECT_GT(slices.front(), 0U);
    EXPECT_LE(slices.front(), 5 * 16U) << "asked every 16 packets, until 5 ms have passed";
    EXPECT_EQ(others, 0);
    EXPECT_TRUE(queue.step());
    EXPECT_EQ(others, 1) << "between slices";
    queue.runReady();
    EXPECT_GT(slices.size(), 4U);
    EXPECT_EQ(live.timeline()->packets(), packets.size());
    EXPECT_FALSE(queue.step()) << "nothing is left to do";
    add(live, "lte", {packets.back()});
    queue.runReady();
    EXPECT_EQ(live.timeline()->packets(), packets.size() + 1);
}

TEST_F(LiveTimelineTest, FindsTheEventsOfARecording) {
    LiveTimeline live(setup());
    const Packets packets = drive("gsm", 120s);
    for (const auto& each : packets) {
        add(live, "gsm", {each});
        queue.runReady();
    }
    BoundedJournal journal("");
    for (const auto& [time, data] : packets) {
        journal.add(time, data);
    }
    Timeline whole(journal, {*technologyOfCommandName("gsm"), resources, bundle, technologies()});
    (void)whole.index();
    EXPECT_GT(whole.events().size(), 3U);
    EXPECT_EQ(eventsOf(*live.timeline()), eventsOf(whole));
    EXPECT_EQ(live.notes(), std::vector<std::string>());
}

TEST_F(LiveTimelineTest, FinishIndexesWhatIsLeftAndNoSliceFollows) {
    LiveTimeline live(setup());
    add(live, "lte", drive("lte", 10s));
    live.finish();
    EXPECT_EQ(slices, std::vector<std::uint64_t>{400});
    queue.runReady();
    EXPECT_EQ(slices.size(), 1U);
}

TEST_F(LiveTimelineTest, ASliceOfOneThatIsGoneDoesNothing) {
    {
        LiveTimeline live(setup());
        add(live, "lte", drive("lte", 10s));
    }
    queue.runReady();
    EXPECT_EQ(slices, std::vector<std::uint64_t>());
}

TEST_F(LiveTimelineTest, AnotherTechnologyBeginsAnew) {
    LiveTimeline live(setup());
    add(live, "lte", drive("lte", 10s));
    queue.runReady();
    add(live, "gsm", drive("gsm", 5s));
    queue.runReady();
    EXPECT_EQ(live.timeline()->packets(), 200U);
    EXPECT_EQ(reports, std::vector<std::string>{"The modem's technology is now Zorell_GSM (gsm); "
                                                "the packets before are dropped."});
}

TEST_F(LiveTimelineTest, OlderPacketsThanTheLimitsAllowAreDroppedAndThatIsTold) {
    LiveTimeline live(setup({2h, std::uint64_t{1} << 20U, std::uint64_t{1} << 19U}));
    const Packets packets = drive("lte", 1200s);
    add(live, "lte", packets);
    queue.runReady();
    EXPECT_EQ(live.timeline()->packets(), packets.size());
    const std::uint64_t first = live.timeline()->firstInstant() + 1;
    EXPECT_GT(first, 1000U);
    ASSERT_EQ(live.notes().size(), 1U);
    EXPECT_EQ(live.notes().front(),
              "The packets before packet " + std::to_string(first) +
                  " were dropped to keep those of 2 hours in at most 1 MiB (journal-hours, "
                  "journal-mebibytes).");
    (void)live.timeline()->valuesAt(packets.size());
}

} // namespace
} // namespace pallax
