#include "store/RecordingMeasurements.h"

#include "tests/query/QueryFixture.h"

#include <gtest/gtest.h>

#include <algorithm>

namespace pallax {
namespace {

using std::chrono::milliseconds;

std::vector<Interval> intervalsOf(TimelineFixture& fixture, Resolution resolution) {
    std::vector<Interval> intervals;
    RecordingMeasurements measurements(
        fixture.source(), resolution,
        [&intervals](const Interval& interval) { intervals.push_back(interval); });
    for (std::uint64_t number = 1; number <= fixture.journal.size(); ++number) {
        EXPECT_TRUE(measurements.add(fixture.journal.packet(number)));
    }
    measurements.finish();
    return intervals;
}

TEST(RecordingMeasurements, CellsDivideTheTimeOfAValue) {
    TimelineFixture fixture("lte");
    fixture.drive(1, std::chrono::seconds(200));
    const auto intervals = intervalsOf(fixture, Resolution::Packet);
    std::size_t divided = 0;
    for (std::size_t index = 0; index < intervals.size(); ++index) {
        const Interval& first = intervals[index];
        if (first.part != Interval::Part::First) {
            continue;
        }
        ++divided;
        milliseconds sum = first.hold;
        Time end = first.start + first.hold;
        for (std::size_t next = index + 1;
             next < intervals.size() && intervals[next].part == Interval::Part::Continued; ++next) {
            const Interval& part = intervals[next];
            EXPECT_EQ(part.field, first.field);
            EXPECT_EQ(part.entry, first.entry);
            EXPECT_TRUE(part.value == first.value);
            EXPECT_NE(part.cell, intervals[next - 1].cell);
            EXPECT_LE(part.start - end, milliseconds(1)) << "without a gap";
            sum += part.hold;
            end = part.start + part.hold;
        }
        EXPECT_EQ(sum, first.whole);
    }
    EXPECT_GT(divided, 10U);
}

TEST(RecordingMeasurements, AtTicksTheValuesAreThoseOfTheDisplay) {
    QueryFixture fixture("lte", 1, std::chrono::seconds(60));
    const auto intervals = intervalsOf(fixture, Resolution::Tick);
    const auto field = *fixture.timeline->fields().named("lte.serving_cell_info.physical_cell_id");
    std::vector<std::string> spans;
    for (const Interval& interval : intervals) {
        if (interval.field == field && interval.part != Interval::Part::Continued) {
            spans.push_back(std::to_string(microseconds(interval.start)) + "|" +
                            std::to_string(interval.packet) + "|" + interval.value.text());
        }
    }
    EXPECT_EQ(spans, fixture.ask("SELECT time, packet, pci FROM (SELECT time, packet, "
                                 "serving_cell_info_physical_cell_id AS pci, "
                                 "lag(serving_cell_info_physical_cell_id) OVER (ORDER BY tick) AS "
                                 "before FROM state) WHERE pci IS NOT before"));
    EXPECT_FALSE(spans.empty());
}

TEST(RecordingMeasurements, ALevelThatIsOldIsNotKnown) {
    TimelineFixture fixture("lte");
    fixture.drive(1, std::chrono::seconds(30));
    const JournalPacket last = fixture.journal.packet(fixture.journal.size());
    // Afterwards, only another record comes.
    const ByteBuffer other = doubles::Record(0xFF0002).padTo(64).prefixed();
    for (int second = 1; second <= 40; ++second) {
        fixture.journal.add(last.time + std::chrono::seconds(second), other);
    }
    Time latest{};
    const FieldTable fields(fixture.technology, fixture.resources);
    for (const Interval& interval : intervalsOf(fixture, Resolution::Tick)) {
        if (fields[interval.field].name.ends_with("_rsrp")) {
            latest = std::max(latest, interval.start + interval.hold);
        }
    }
    EXPECT_GT(latest, Simulation::kStart);
    EXPECT_LE(latest, last.time + RecordingMeasurements::kLevelHolds + std::chrono::seconds(2));
}

TEST(RecordingMeasurements, OfLevelsThatTellTheSameTheLatestIsKnown) {
    TimelineFixture fixture("lte");
    fixture.drive(1, std::chrono::seconds(200));
    const FieldTable fields(fixture.technology, fixture.resources);
    const auto idle = *fields.named("lte.serving_cell_measurements.measured_rsrp");
    const auto connected =
        *fields.named("lte.connected_mode_lte_intra_frequency_measurement.serving_filtered_rsrp");
    std::vector<Interval> levels = intervalsOf(fixture, Resolution::Tick);
    std::erase_if(levels, [&](const Interval& each) {
        return each.field != idle && each.field != connected;
    });
    std::sort(levels.begin(), levels.end(),
              [](const Interval& one, const Interval& other) { return one.start < other.start; });
    bool areBoth = false;
    for (std::size_t index = 1; index < levels.size(); ++index) {
        EXPECT_GE(levels[index].start, levels[index - 1].start + levels[index - 1].hold);
        areBoth = areBoth || levels[index].field != levels[index - 1].field;
    }
    EXPECT_TRUE(areBoth);
}

TEST(RecordingMeasurements, NothingHoldsAcrossAGap) {
    TimelineFixture fixture("lte");
    fixture.drive(1, std::chrono::seconds(10));
    const JournalPacket last = fixture.journal.packet(fixture.journal.size());
    const ByteBuffer again(last.data.begin(), last.data.end());
    fixture.journal.add(last.time + std::chrono::hours(1), again);
    for (const Resolution resolution : {Resolution::Tick, Resolution::Packet}) {
        for (const Interval& interval : intervalsOf(fixture, resolution)) {
            EXPECT_LE(interval.hold, std::chrono::seconds(12));
        }
    }
}

TEST(RecordingMeasurements, ARecordThatThrowsIsTheEnd) {
    TimelineFixture fixture("gsm");
    fixture.drive(1, std::chrono::seconds(5));
    RecordingMeasurements measurements(fixture.source(), Resolution::Tick,
                                       [](const Interval& /*interval*/) {});
    EXPECT_TRUE(measurements.add(fixture.journal.packet(1)));
    (void)measurements.takeEvents();
    const ByteBuffer thrown = doubles::Record(0xFF0000).append({'n', 'o', ' ', '{'}).prefixed();
    EXPECT_FALSE(measurements.add({2, fixture.journal.packet(2).time, thrown}));
    const auto events = measurements.takeEvents();
    ASSERT_EQ(events.size(), 1U);
    EXPECT_EQ(events.front().kind, EventKind::FatalRecord);
    EXPECT_EQ(events.front().packet, 2U);
}

} // namespace
} // namespace pallax
