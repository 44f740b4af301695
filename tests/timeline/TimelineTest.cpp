#include "timeline/Timeline.h"

#include "tests/doubles/RecordingLog.h"
#include "tests/doubles/SampleRecorder.h"
#include "tests/timeline/TimelineFixture.h"
#include "timeline/Changes.h"

#include <string>

namespace pallax {
namespace {

using namespace std::chrono_literals;
namespace any = doubles::any;

std::string textOf(const CurrentValues& values, const Timeline& timeline) {
    std::string text;
    for (FieldIndex field = 0; field < timeline.fields().size(); ++field) {
        if (const FieldValue* value = values.value(field)) {
            text += timeline.fields()[field].name + ": " + value->text() + "\n";
        }
    }
    values.forEachEntry([&](const EntryValues& entry) {
        text += timeline.entries().words(entry.entry) + "\n";
        for (const auto& [field, value] : entry.values) {
            text += "  " + timeline.fields()[field].name + ": " + value.text() + "\n";
        }
    });
    return text;
}

/// The text at a path of dictionaries, or null.
const PropertyList* atPath(const PropertyList& display, std::string_view path) {
    const PropertyList* at = &display;
    while (at != nullptr && !path.empty()) {
        const std::size_t end = std::min(path.find('/', 1), path.size());
        const DictionaryRef keys = at->dictionary();
        at = keys != nullptr ? keys->find(path.substr(1, end - 1)) : nullptr;
        path.remove_prefix(end);
    }
    return at;
}

class TimelineTest : public testing::TestWithParam<const char*> {
protected:
    TimelineFixture fixture{GetParam()};
};

TEST_P(TimelineTest, EveryInstantIsAsDecodingFromTheStartShowsIt) {
    EXPECT_TRUE(doubles::holds([] {
        TimelineFixture drive(GetParam());
        drive.drive(any::bits(), std::chrono::seconds(any::between(1, 15)), 20);
        const auto timeline = drive.indexed(
            TimelineFixture::closeKeyFrames(static_cast<std::uint64_t>(any::between(1, 40))));
        RC_ASSERT(timeline->packets() == drive.journal.size());
        const std::uint64_t instant = any::index(timeline->packets() + 1);
        Replay whole(drive.source());
        CurrentValues values(timeline->fieldTable(), timeline->entryTable());
        for (std::uint64_t number = 1; number <= instant; ++number) {
            whole.update(drive.journal.packet(number), &values);
        }
        RC_ASSERT(timeline->displayAt(instant) == whole.displayAt({}));
        RC_ASSERT(textOf(timeline->valuesAt(instant), *timeline) == textOf(values, *timeline));
        RC_ASSERT(changesBetween(values, timeline->valuesAt(instant)).empty());
    }));
}

TEST_P(TimelineTest, TheValuesAreThoseOfTheDisplay) {
    fixture.drive(5, 60s);
    const auto timeline = fixture.indexed();
    std::size_t compared = 0;
    for (std::uint64_t instant = 1; instant <= timeline->packets(); instant += 71) {
        const CurrentValues values = timeline->valuesAt(instant);
        const PropertyList display = timeline->displayAt(instant);
        for (FieldIndex field = 0; field < values.fieldCount(); ++field) {
            const FieldInfo& info = timeline->fields()[field];
            const FieldValue* value = values.value(field);
            const bool isPath = info.key.find('/') == std::string::npos;
            if (value != nullptr && info.isShown && !info.isInList && isPath) {
                const PropertyList* shown = atPath(display, info.path);
                ASSERT_NE(shown, nullptr) << info.path;
                EXPECT_EQ(*shown, value->shown) << info.path;
                ++compared;
            }
        }
    }
    EXPECT_GT(compared, 100U);
}

TEST_P(TimelineTest, ReadingSamplesAgainGivesThoseOfTheRangeAndNoOthers) {
    EXPECT_TRUE(doubles::holds([] {
        TimelineFixture drive(GetParam());
        drive.drive(any::bits(), 2s);
        const auto timeline = drive.indexed(TimelineFixture::closeKeyFrames(20));
        const std::uint64_t from = 1 + any::index(timeline->packets());
        const std::uint64_t to = from + any::index(50);
        doubles::SampleRecorder before;
        doubles::SampleRecorder expected;
        Replay whole(drive.source());
        for (std::uint64_t number = 1; number <= std::min(to, timeline->packets()); ++number) {
            whole.update(drive.journal.packet(number), number < from ? &before : &expected);
        }
        doubles::SampleRecorder actual;
        RC_ASSERT(timeline->read(from, to, actual));
        RC_ASSERT(actual.takeLines() == expected.takeLines());
    }));
}

TEST_P(TimelineTest, ReadingStopsWhenItIsTold) {
    fixture.drive(5, 5s);
    const auto timeline = fixture.indexed();
    doubles::SampleRecorder samples;
    int asked = 0;
    EXPECT_FALSE(timeline->read(11, 100, samples, [&asked] { return ++asked <= 3; }));
    const auto lines = samples.takeLines();
    EXPECT_EQ(std::count(lines.begin(), lines.end(), "end of packet"), 3);
    EXPECT_EQ(lines.front(), "packet 11");
}

TEST_P(TimelineTest, TheIndexIsTheSameInSlicesAndWhileTheJournalGrows) {
    TimelineFixture drive(GetParam());
    drive.drive(9, 20s);
    const auto whole = drive.indexed();
    Timeline sliced(fixture.journal, fixture.source(), TimelineFixture::closeKeyFrames());
    for (std::uint64_t number = 1; number <= drive.journal.size(); ++number) {
        const JournalPacket packet = drive.journal.packet(number);
        fixture.journal.add(packet.time, ByteBuffer(packet.data.begin(), packet.data.end()));
        if (number % 97 == 0) {
            int left = 2;
            while (!sliced.index([&left] { return --left > 0; })) {
                left = 2;
            }
            EXPECT_EQ(sliced.packets(), number);
        }
    }
    EXPECT_TRUE(sliced.index());
    EXPECT_EQ(sliced.packets(), whole->packets());
    EXPECT_EQ(sliced.events().size(), whole->events().size());
    EXPECT_EQ(sliced.keyFrames().all().size(), whole->keyFrames().all().size());
    EXPECT_EQ(textOf(sliced.valuesAt(300), sliced), textOf(whole->valuesAt(300), *whole));
}

TEST_P(TimelineTest, OfAJournalThatHasDroppedPacketsTheOthersCanBeSeen) {
    fixture.drive(9, 20s);
    const auto timeline = fixture.indexed();
    const PropertyList display = timeline->displayAt(500);
    EXPECT_EQ(timeline->firstInstant(), 0U);
    fixture.journal.dropBefore(401);
    EXPECT_TRUE(timeline->index());
    EXPECT_EQ(timeline->firstInstant(), 400U);
    EXPECT_EQ(timeline->displayAt(500), display);
    EXPECT_THROW((void)timeline->displayAt(399), std::out_of_range);
    doubles::SampleRecorder samples;
    EXPECT_TRUE(timeline->read(1, 401, samples));
    EXPECT_EQ(samples.takeLines().front(), "packet 401");
}

TEST_P(TimelineTest, IndexingAndSeekingAreQuiet) {
    fixture.drive(3, 10s);
    const doubles::RecordingLog log;
    {
        const auto timeline = fixture.indexed();
        (void)timeline->displayAt(100);
        (void)timeline->valuesAt(77);
    }
    EXPECT_TRUE(log.lines().empty()) << log.lines().front().text;
}

INSTANTIATE_TEST_SUITE_P(Technologies, TimelineTest, testing::ValuesIn(technologyNames()),
                         [](const auto& each) { return std::string(each.param); });

TEST(Timeline, AnInstantIsTheLastPacketAtATimeInTheFirstStretchThatHasIt) {
    TimelineFixture fixture("lte");
    const ByteBuffer packet = doubles::Record(0xB0C2).padTo(38).bytes();
    const Time start = Simulation::kStart;
    for (const int second : {10, 11, 13, 13, 12, 14, 5, 6, 12, 30}) { // back twice, once a little
        fixture.journal.add(start + std::chrono::seconds(second), packet);
    }
    const auto timeline = fixture.indexed(TimelineFixture::closeKeyFrames(3));
    EXPECT_EQ(timeline->stretches().size(), 2U);
    const auto at = [&](double second) {
        const auto instant =
            timeline->instantAt(start + std::chrono::duration_cast<std::chrono::nanoseconds>(
                                            std::chrono::duration<double>(second)));
        return instant ? static_cast<int>(*instant) : -1;
    };
    EXPECT_EQ(at(4), -1);
    EXPECT_EQ(at(5), 7) << "only the second stretch has it";
    EXPECT_EQ(at(6.5), 8);
    EXPECT_EQ(at(10), 1) << "both stretches have it";
    EXPECT_EQ(at(12.5), 2);
    EXPECT_EQ(at(13), 5);
    EXPECT_EQ(at(14), 6);
    EXPECT_EQ(at(20), 9);
    EXPECT_EQ(at(99), 10);
}

TEST(Timeline, ARecordThatThrowsEndsItBeforeItsPacketWithAnEvent) {
    TimelineFixture fixture("gsm");
    fixture.drive(1, 5s);
    const Time time = fixture.journal.packet(fixture.journal.size()).time;
    const std::uint64_t good = fixture.journal.size();
    fixture.journal.add(time, doubles::Record(0xFF0000).u8(1).bytes()); // no property list
    fixture.drive(1, 5s);
    const auto timeline = fixture.indexed();
    EXPECT_TRUE(timeline->hasEnded());
    EXPECT_EQ(timeline->packets(), good);
    ASSERT_FALSE(timeline->events().empty());
    const Event& event = timeline->events().back();
    EXPECT_EQ(event.kind, EventKind::FatalRecord);
    EXPECT_EQ(event.packet, good + 1);
    EXPECT_EQ(event.time, time);
    EXPECT_NE(event.words.find("property list"), std::string::npos) << event.words;
    EXPECT_FALSE(timeline->displayAt(good).isNull());
    EXPECT_TRUE(timeline->index()) << "nothing more is read";
    EXPECT_EQ(timeline->packets(), good);
}

TEST(Timeline, TooManyPathsAreTold) {
    TimelineFixture fixture("ifx");
    Dictionary many;
    for (int number = 0; number < 5000; ++number) {
        many.set("P" + std::to_string(number), "1");
    }
    fixture.journal.add(Simulation::kStart, *serializeBinary(Dictionary{{"A", "1"}}));
    const auto few = fixture.indexed();
    EXPECT_TRUE(few->notes().empty());
    EXPECT_TRUE(few->fields().named("ifx.a"));
    fixture.journal.add(Simulation::kStart, *serializeBinary(many));
    const auto timeline = fixture.indexed();
    EXPECT_EQ(timeline->notes(),
              std::vector<std::string>{"Only the first 4,096 paths of the messages are fields."});
    EXPECT_TRUE(timeline->fields().named("ifx.p4094"));
    EXPECT_FALSE(timeline->fields().named("ifx.p4095"));
}

TEST(Timeline, AnAddedEventStandsAfterThoseOfItsPacketOnce) {
    TimelineFixture fixture{"lte"};
    fixture.drive(5, std::chrono::seconds(120));
    const auto timeline = fixture.indexed();
    const std::size_t before = timeline->events().size();
    ASSERT_GT(before, 2U);
    const Event& second = timeline->events()[1];
    const Event alarm{EventKind::Alarm, second.time, second.packet, "alarm: weak", {}};
    timeline->add(alarm);
    timeline->add(alarm);
    ASSERT_EQ(timeline->events().size(), before + 1);
    std::size_t at = 0;
    while (timeline->events()[at].kind != EventKind::Alarm) {
        ++at;
    }
    EXPECT_EQ(timeline->events()[at - 1].packet, alarm.packet);
    for (std::size_t index = 1; index < timeline->events().size(); ++index) {
        EXPECT_LE(timeline->events()[index - 1].packet, timeline->events()[index].packet);
    }
}

} // namespace
} // namespace pallax
