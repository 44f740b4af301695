#include "overview/StatusWatch.h"

#include "LogGenerator/Technologies/Technologies.h"
#include "decoding/DroppedNotices.h"
#include "monitor/DisplayDriver.h"
#include "overview/StatusWords.h"
#include "tests/doubles/FakeBundle.h"
#include "tests/doubles/ManualClock.h"
#include "tests/timeline/TimelineFixture.h"

#include <string>

namespace pallax {
namespace {

using namespace std::chrono_literals;

/// A driver that a watch follows, and a timeline of the same packets.
class Watched {
public:
    explicit Watched(const char* technology) : recorded(technology) {
        driver.setGenerator(LogGenerator::generatorFromTechnology(
            Text(recorded.technology.identifier), technologies(),
            {clock, resources, bundle, drop}));
        driver.addSampleSink(watch);
        watch.begin(recorded.technology.identifier);
    }

    /// Gives the packets of the journal from `first` on, later by so much.
    void play(std::uint64_t first = 1, std::chrono::nanoseconds later = 0ns) {
        for (std::uint64_t number = first; number <= recorded.journal.size(); ++number) {
            const JournalPacket packet = recorded.journal.packet(number);
            driver.update(packet.data, {number, packet.time + later});
            end = packet.time + later;
        }
    }
    Overview overview() const {
        return watch.overview(end, NetworkNames(), *builtInProfile(kDefaultProfile));
    }

    TimelineFixture recorded;
    DirectoryResources resources{PALLAX_SOURCE_DIR "/resources"};
    doubles::FakeBundle bundle;
    doubles::ManualClock clock;
    DroppedNotices drop;
    StatusWatch watch{resources};
    DisplayDriver driver;
    Time end;
};

std::string wordsOf(const Status& status) {
    std::string words;
    for (const StatusCell& cell : status.cells) {
        words += cell.system + " " + cell.site + "\n";
        for (const StatusValue& level : cell.levels) {
            words += level.name + " " + level.text + "\n";
        }
    }
    for (const StatusNeighbour& neighbour : status.neighbours) {
        words += neighbour.cell + " " + neighbour.level.text + "\n";
    }
    for (const StatusValue& state : status.states) {
        words += state.name + " " + state.text + "\n";
    }
    return words + std::to_string(status.contexts.size());
}

TEST(StatusWatch, KnowsWhatATimelineOfTheSamePacketsKnows) {
    for (const RecordedTechnology& each : recordedTechnologies()) {
        Watched watched(each.commandName.data());
        watched.recorded.drive(3, 60s, 20);
        watched.play();
        const auto timeline = watched.recorded.indexed();
        const Status expected = statusOf(timeline->valuesAt(timeline->packets()), watched.end,
                                         NetworkNames(), *builtInProfile(kDefaultProfile));
        const Overview overview = watched.overview();
        EXPECT_EQ(wordsOf(overview.status), wordsOf(expected)) << each.commandName;
        EXPECT_FALSE(overview.status.isEmpty()) << each.commandName;

        const auto& events = timeline->events();
        ASSERT_FALSE(events.empty()) << each.commandName;
        EXPECT_EQ(overview.events.size(), std::min(events.size(), StatusWatch::kMostEvents));
        EXPECT_EQ(overview.events.back().words, events.back().words);
        EXPECT_EQ(overview.events.back().time, events.back().time);
        EXPECT_EQ(overview.events.back().packet, events.back().packet);
    }
}

TEST(StatusWatch, ForgetsEverythingWhenATechnologyBegins) {
    Watched watched("lte");
    watched.recorded.drive(3, 10s);
    watched.play();
    ASSERT_FALSE(watched.overview().status.isEmpty());
    watched.watch.begin(watched.recorded.technology.identifier);
    EXPECT_TRUE(watched.overview().status.isEmpty());
    EXPECT_TRUE(watched.overview().events.empty());
    watched.play();
    EXPECT_FALSE(watched.overview().status.isEmpty());
    watched.watch.begin("Another");
    watched.play();
    EXPECT_TRUE(watched.overview().status.isEmpty());
}

/// The value with this name among the levels and the identities of the cells.
const StatusValue* valueNamed(const Overview& overview, std::string_view name) {
    for (const StatusCell& cell : overview.status.cells) {
        for (const auto* values : {&cell.levels, &cell.identity}) {
            for (const StatusValue& value : *values) {
                if (value.name == name) {
                    return &value;
                }
            }
        }
    }
    return nullptr;
}

TEST(StatusWatch, KnowsHowOftenAValueUsuallyComes) {
    Watched watched("lte");
    watched.recorded.drive(3, 60s, 20);
    watched.play();
    const Overview now = watched.overview();
    const StatusValue* level = valueNamed(now, "RSRP");
    ASSERT_NE(level, nullptr);
    EXPECT_EQ(level->patience, Arrivals::kLeastPatience) << "it comes several times in a second";
    EXPECT_FALSE(isOverdue(now.status.time, *level));
    watched.end += 5s;
    const Overview later = watched.overview();
    EXPECT_TRUE(isOverdue(later.status.time, *valueNamed(later, "RSRP")));
    EXPECT_EQ(oldAgeWords(later.status.time, {valueNamed(later, "RSRP")}), "5 s ago");
}

TEST(StatusWatch, AValueThatCameOnceIsNeverOverdue) {
    Watched watched("lte");
    watched.recorded.drive(3, 1s, 20);
    watched.play();
    watched.end += 24h;
    const Overview later = watched.overview();
    const StatusValue* area = valueNamed(later, "TAC");
    ASSERT_NE(area, nullptr);
    EXPECT_FALSE(isOverdue(later.status.time, *area));
    EXPECT_TRUE(isOld(later.status.time, *area));
}

TEST(StatusWatch, AnEventCanBeAddedToItsOwn) {
    Watched watched("lte");
    watched.recorded.drive(3, 60s, 20);
    watched.play();
    for (std::size_t number = 0; number < StatusWatch::kMostEvents; ++number) {
        watched.watch.add({EventKind::Alarm, watched.end, 0, std::to_string(number), {}});
    }
    const auto events = watched.overview().events;
    ASSERT_EQ(events.size(), StatusWatch::kMostEvents);
    EXPECT_EQ(events.front().words, "0");
    EXPECT_EQ(events.back().words, "31");
    ASSERT_NE(watched.watch.values(), nullptr);
    watched.watch.begin("Another");
    watched.watch.add({EventKind::Alarm, watched.end, 0, "lost", {}});
    EXPECT_TRUE(watched.overview().events.empty());
    EXPECT_EQ(watched.watch.values(), nullptr);
}

TEST(StatusWatch, DoesNotTellATimeAcrossAGap) {
    Watched watched("lte");
    watched.recorded.drive(3, 60s);
    watched.play();
    watched.play(1, 10min); // the first packets show another cell than the last ones
    const std::vector<Event> events = watched.overview().events;
    const auto first = std::find_if(events.begin(), events.end(), [](const Event& event) {
        return event.kind == EventKind::CellChange && event.time > Simulation::kStart + 5min;
    });
    ASSERT_NE(first, events.end());
    EXPECT_EQ(first->words.find(" after "), std::string::npos) << first->words;
}

TEST(StatusWatchTest, FieldsTellWhichEntryOfAListIsWhich) {
    const Watched lte("lte");
    const std::string list = "/Neighbor Cells List/*/";
    EXPECT_TRUE(lte.watch.identifies(list + "Physical Cell ID"));
    EXPECT_TRUE(lte.watch.namesCell(list + "Physical Cell ID"));
    EXPECT_FALSE(lte.watch.identifies(list + "Measured RSRP"));
    EXPECT_FALSE(lte.watch.namesCell(list + "Measured RSRP"));
    EXPECT_FALSE(lte.watch.identifies(list + "No field"));
    const std::string candidates = "/Reselection Candidates List/*/";
    EXPECT_TRUE(lte.watch.identifies(candidates + "U ARFCN"));
    EXPECT_FALSE(lte.watch.namesCell(candidates + "U ARFCN")) << "a channel has many cells";
    StatusWatch none{lte.resources};
    EXPECT_FALSE(none.identifies(list + "Physical Cell ID"));
    EXPECT_FALSE(none.namesCell(list + "Physical Cell ID"));
}

} // namespace
} // namespace pallax
