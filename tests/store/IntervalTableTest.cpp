#include "store/IntervalTable.h"

#include "store/FileStore.h"
#include "tests/store/StoreFixture.h"

#include <gtest/gtest.h>

namespace pallax {
namespace {

using std::chrono::milliseconds;

/// Intervals with values that a drive has shown.
class IntervalTableTest : public StoreFixture {
protected:
    IntervalTableTest()
        : _measurements(source(), Resolution::Tick,
                        [this](const Interval& interval) { _shown.push_back(interval); }) {
        drive(1, std::chrono::seconds(60));
        for (std::uint64_t number = 1; number <= journal.size(); ++number) {
            (void)_measurements.add(journal.packet(number));
        }
        _measurements.finish();
    }

    /// The first value of the field, from that millisecond on, without a cell.
    Interval interval(std::string_view field, int start, int hold) {
        const FieldIndex index = *_measurements.fields().named(field);
        for (const Interval& shown : _shown) {
            if (shown.field == index) {
                Interval made = shown;
                made.start = kFirst + milliseconds(start);
                made.hold = milliseconds(hold);
                made.packet = 7;
                made.cell.reset();
                made.part = Interval::Part::Whole;
                return made;
            }
        }
        ADD_FAILURE() << field;
        return {};
    }
    void write() {
        FileStore store(file);
        StoreConnection::Transaction transaction(store.connection());
        NamedRows names(store.connection());
        writeIntervals(batch, store.connection(), 1, names);
        transaction.commit();
    }

    static constexpr Time kFirst = Simulation::kStart;
    static constexpr std::string_view kPci = "lte.serving_cell_info.physical_cell_id";
    static constexpr std::string_view kRsrp = "lte.serving_cell_measurements.measured_rsrp";
    static constexpr std::string_view kBandwidth = "lte.serving_cell_info.download_bandwidth";

private:
    std::vector<Interval> _shown;
    RecordingMeasurements _measurements;

protected:
    IntervalBatch batch{_measurements, kFirst};
};

TEST_F(IntervalTableTest, TheRowsOfASeriesAreTogetherInTheOrderOfTheirTimes) {
    batch.add(interval(kPci, 2000, 10));
    batch.add(interval(kRsrp, 1000, 20));
    batch.add(interval(kPci, 0, 30));
    write();
    EXPECT_EQ(ask("SELECT id, time, hold, packet FROM intervals"),
              (std::vector<std::string>{"1|0|30|7", "2|2000|10|7", "3|1000|20|7"}));
    EXPECT_EQ(ask("SELECT f.name, first_row, last_row, first, last, entry, site FROM series s JOIN "
                  "fields f ON f.id = s.field ORDER BY s.id"),
              (std::vector<std::string>{std::string(kPci) + "|1|2|0|2010|NULL|NULL",
                                        std::string(kRsrp) + "|3|3|1000|1020|NULL|NULL"}));
}

TEST_F(IntervalTableTest, ALevelIsAWholeNumberOfSixteenths) {
    const Interval level = interval(kRsrp, 0, 10);
    batch.add(level);
    write();
    EXPECT_EQ(
        ask("SELECT typeof(i.number), i.number * s.step, step, format, text FROM intervals i, "
            "series s"),
        std::vector<std::string>{"integer|" + textOf(QueryValue(level.value.number)) +
                                 "|0.062500|%4.2f dBm|NULL"});
}

TEST_F(IntervalTableTest, ALabelIsATextWithItsNumberInTheRecord) {
    batch.add(interval(kBandwidth, 0, 10));
    batch.add(interval(kBandwidth, 10, 10));
    write();
    EXPECT_EQ(ask("SELECT i.number, t.text, t.raw FROM intervals i JOIN texts t ON t.id = i.text"),
              (std::vector<std::string>{"NULL|20 MHz|100", "NULL|20 MHz|100"}));
    EXPECT_EQ(ask("SELECT count(*) FROM texts"), std::vector<std::string>{"1"});
}

TEST_F(IntervalTableTest, TheFirstPartOfADividedValueHasTheWholeTime) {
    Interval first = interval(kPci, 0, 10);
    first.part = Interval::Part::First;
    first.whole = milliseconds(25);
    Interval second = interval(kPci, 10, 15);
    second.part = Interval::Part::Continued;
    batch.add(first);
    batch.add(second);
    batch.add(interval(kPci, 25, 5));
    write();
    EXPECT_EQ(ask("SELECT hold, whole FROM intervals"),
              (std::vector<std::string>{"10|25", "15|-1", "5|NULL"}));
    EXPECT_EQ(ask("SELECT start % 1000000 / 1000, hold / 1000 FROM span, recordings"),
              std::vector<std::string>{})
        << "of a recording that is not there";
}

TEST_F(IntervalTableTest, CellsHaveSeriesOfTheirOwn) {
    Interval other = interval(kPci, 10, 10);
    other.cell = 0;
    batch.add(interval(kPci, 0, 10));
    batch.add(other);
    write();
    EXPECT_EQ(ask("SELECT site IS NULL, first_row FROM series ORDER BY id"),
              (std::vector<std::string>{"1|1", "0|2"}));
    EXPECT_EQ(ask("SELECT count(*) FROM sites"), std::vector<std::string>{"1"});
}

TEST_F(IntervalTableTest, WhatIsWrittenLaterComesAfterwards) {
    batch.add(interval(kPci, 0, 10));
    write();
    EXPECT_EQ(batch.count(), 1U);
    batch.add(interval(kPci, 10, 10));
    write();
    EXPECT_EQ(batch.count(), 2U);
    write(); // nothing
    EXPECT_EQ(ask("SELECT first_row, last_row FROM series"),
              (std::vector<std::string>{"1|1", "2|2"}));
}

TEST_F(IntervalTableTest, IsFullAtItsLimit) {
    const Interval one = interval(kPci, 0, 1);
    for (std::size_t count = 0; count < IntervalBatch::kMostKept; ++count) {
        ASSERT_FALSE(batch.isFull());
        batch.add(one);
    }
    EXPECT_TRUE(batch.isFull());
}

} // namespace
} // namespace pallax
