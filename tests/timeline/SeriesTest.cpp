#include "timeline/Series.h"

#include "tests/timeline/PlainReadings.h"
#include "tests/timeline/TimelineFixture.h"

#include <limits>
#include <string>

namespace pallax {
namespace {

using namespace std::chrono_literals;
namespace any = doubles::any;
using Reading = PlainReadings::Reading;

/// What a bucket must be.
std::string expectedBucket(const std::vector<Reading>& readings, std::uint64_t from,
                           std::uint64_t to) {
    std::optional<std::string> first;
    std::string last;
    double least = NAN;
    double most = NAN;
    for (const Reading& reading : readings) {
        if (reading.packet < from || reading.packet >= to) {
            continue;
        }
        last = std::isnan(reading.number) ? reading.text : std::to_string(reading.number);
        first = first.value_or(last);
        least = std::fmin(least, reading.number);
        most = std::fmax(most, reading.number);
    }
    return first.value_or("") + " " + std::to_string(least) + " " + std::to_string(most) + " " +
           last;
}

std::string textOf(const SeriesValue& value, const SeriesStore& store) {
    return value.isNumber() ? std::to_string(value.number()) : store.texts().text(value.text());
}

std::string textOf(const Bucket& bucket, const SeriesStore& store) {
    return textOf(bucket.first, store) + " " + std::to_string(bucket.least.number()) + " " +
           std::to_string(bucket.most.number()) + " " + textOf(bucket.last, store);
}

struct Series {
    FieldIndex field;
    EntryId entry;
};

/// The series of that name in PlainReadings.
Series seriesNamed(const Timeline& timeline, const std::string& name) {
    const std::size_t blank = std::min(name.find(' '), name.size());
    const FieldIndex field = timeline.fields().named(name.substr(0, blank)).value();
    if (blank == name.size()) {
        return {field, kNoEntry};
    }
    for (const EntryId entry : timeline.series().entriesOf(field)) {
        if (timeline.entries().words(entry) == name.substr(blank + 1)) {
            return {field, entry};
        }
    }
    ADD_FAILURE() << "no series " << name;
    return {field, kNoEntry};
}

PlainReadings readingsOf(const TimelineFixture& fixture, const FieldRegistry& registry) {
    PlainReadings readings(registry);
    Replay replay(fixture.source());
    for (std::uint64_t number = 1; number <= fixture.journal.size(); ++number) {
        replay.update(fixture.journal.packet(number), &readings);
    }
    return readings;
}

class SeriesTest : public testing::TestWithParam<const char*> {
protected:
    SeriesTest() { fixture.drive(11, 90s); }

    TimelineFixture fixture{GetParam()};
    FieldRegistry registry{gatherReference(fixture.technology, fixture.resources)};
};

TEST_P(SeriesTest, AreAllReadingsOfAFieldAndEntryWhereverItStands) {
    const PlainReadings plain = readingsOf(fixture, registry);
    ASSERT_GT(plain.series.size(), 10U);
    const auto timeline = fixture.indexed();
    for (std::size_t each = 0; each < plain.series.size(); each += 1 + plain.series.size() / 40) {
        const auto& [name, readings] =
            *std::next(plain.series.begin(), static_cast<std::ptrdiff_t>(each));
        const auto [field, entry] = seriesNamed(*timeline, name);
        const auto points = readSeries(*timeline, field, entry, 1, timeline->packets());
        ASSERT_EQ(points.size(), readings.size()) << name;
        for (std::size_t index = 0; index < points.size(); ++index) {
            ASSERT_EQ(points[index].packet, readings[index].packet) << name;
            ASSERT_EQ(points[index].time, readings[index].time) << name;
            ASSERT_EQ(points[index].value.text(), readings[index].text) << name;
        }
    }
}

TEST_P(SeriesTest, BucketsAreExactForThePacketsThatTheyName) {
    const PlainReadings plain = readingsOf(fixture, registry);
    Timeline::Limits limits = TimelineFixture::closeKeyFrames(500);
    limits.series.cells = 64; // so that they are halved often
    const auto timeline = fixture.indexed(limits);
    const SeriesStore& store = timeline->series();
    ASSERT_GT(store.cellSize(), 16U);
    std::vector<std::uint64_t> borders;
    for (std::uint64_t border = 1; border <= timeline->packets(); border += store.cellSize()) {
        borders.push_back(border);
    }
    borders.push_back(borders.back() + store.cellSize());
    for (const auto& [name, readings] : plain.series) {
        const auto [field, entry] = seriesNamed(*timeline, name);
        for (const Bucket& bucket : store.buckets(field, entry, borders)) {
            ASSERT_EQ(textOf(bucket, store), expectedBucket(readings, bucket.from, bucket.to))
                << name << " from " << bucket.from << " to " << bucket.to;
            ASSERT_EQ(bucket.time, fixture.journal.packet(bucket.from).time);
        }
    }
}

TEST_P(SeriesTest, FewPacketsAreReducedToBucketsThatDivideTheTimeEvenly) {
    const PlainReadings plain = readingsOf(fixture, registry);
    const auto timeline = fixture.indexed();
    EXPECT_TRUE(doubles::holds([&] {
        const auto& [name, readings] = *std::next(
            plain.series.begin(), static_cast<std::ptrdiff_t>(any::index(plain.series.size())));
        const auto [field, entry] = seriesNamed(*timeline, name);
        const std::uint64_t from = 1 + any::index(timeline->packets());
        const std::uint64_t to = from + any::index(timeline->packets() - from + 1);
        const auto count = static_cast<std::size_t>(any::between(1, 50));
        const auto buckets = readBuckets(*timeline, field, entry, from, to, count);
        RC_ASSERT(!buckets.empty());
        RC_ASSERT(buckets.size() <= count);
        RC_ASSERT(buckets.front().from == from);
        RC_ASSERT(buckets.back().to == to + 1);
        const Time first = fixture.journal.packet(from).time;
        const Time last = fixture.journal.packet(to).time;
        for (std::size_t index = 0; index < buckets.size(); ++index) {
            const Bucket& bucket = buckets[index];
            if (index > 0) {
                RC_ASSERT(bucket.from == buckets[index - 1].to);
            }
            RC_ASSERT(textOf(bucket, timeline->series()) ==
                      expectedBucket(readings, bucket.from, bucket.to));
            const Time end = fixture.journal.packet(bucket.to - 1).time;
            RC_ASSERT((end - bucket.time) * static_cast<long>(count) <=
                      (last - first) * 11 / 10 + 1s);
        }
    }));
}

INSTANTIATE_TEST_SUITE_P(Technologies, SeriesTest, testing::Values("gsm", "cdma", "lte", "utran"),
                         [](const auto& each) { return std::string(each.param); });

class SeriesStoreTest : public testing::Test {
protected:
    static FieldValue number(double value) { return {PropertyList(std::to_string(value)), value}; }
};

TEST_F(SeriesStoreTest, AConstantIsOneRunHoweverLong) {
    SeriesStore store(SeriesStore::Limits{64, 1000, 10});
    for (std::uint64_t packet = 1; packet <= 5000; ++packet) {
        store.beginPacket(packet, Time(std::chrono::seconds(packet)));
        store.add(0, kNoEntry, number(7));
    }
    EXPECT_EQ(store.runCount(), 1U);
    EXPECT_EQ(store.cellSize(), 128U);
    const auto buckets = store.buckets(0, kNoEntry, {1, 129, 4993, 5121});
    ASSERT_EQ(buckets.size(), 3U);
    EXPECT_EQ(buckets[2].last.number(), 7);
    EXPECT_EQ(buckets[1].time, Time(std::chrono::seconds(129)));
}

TEST_F(SeriesStoreTest, BucketsAreExactForAnyValues) {
    EXPECT_TRUE(doubles::holds([] {
        SeriesStore store(SeriesStore::Limits{16, 1000, 10});
        std::vector<Reading> readings;
        std::uint64_t packet = 0;
        for (const int value : any::integers(-3, 4)) {
            packet += static_cast<std::uint64_t>(any::between(1, 9));
            store.beginPacket(packet, Time());
            for (int times = any::between(0, 3); times > 0; --times) {
                const std::string text = value == 3 ? "none" : "";
                const double shown = value == 3 ? std::numeric_limits<double>::quiet_NaN()
                                                : static_cast<double>(value);
                store.add(0, kNoEntry, {PropertyList(text), shown});
                readings.push_back({packet, {}, text, shown});
            }
        }
        if (packet == 0) {
            return;
        }
        std::vector<std::uint64_t> borders{1};
        while (borders.back() <= packet) {
            borders.push_back(borders.back() +
                              store.cellSize() * static_cast<unsigned>(any::between(1, 4)));
        }
        for (const Bucket& bucket : store.buckets(0, kNoEntry, borders)) {
            RC_ASSERT(textOf(bucket, store) == expectedBucket(readings, bucket.from, bucket.to));
        }
    }));
}

TEST_F(SeriesStoreTest, TooManySeriesAreLeftOutAndItIsTold) {
    SeriesStore store(SeriesStore::Limits{64, 1000, 2});
    store.beginPacket(1, {});
    store.add(0, 5, number(1));
    store.add(0, 6, number(1));
    EXPECT_FALSE(store.isFull());
    store.add(0, 7, number(1));
    EXPECT_TRUE(store.isFull());
    EXPECT_EQ(store.entriesOf(0), (std::vector<EntryId>{5, 6}));
    EXPECT_TRUE(store.buckets(0, 7, {1, 65}).front().isEmpty());
}

TEST_F(SeriesStoreTest, ManyRunsMakeLargerCells) {
    SeriesStore store(SeriesStore::Limits{4096, 100, 10});
    for (std::uint64_t packet = 1; packet <= 2000; ++packet) {
        store.beginPacket(packet, {});
        store.add(0, kNoEntry, number(static_cast<double>(packet)));
    }
    EXPECT_LE(store.runCount(), 101U);
    const auto all = store.buckets(0, kNoEntry, {1, 4097}).front();
    EXPECT_EQ(all.first.number(), 1);
    EXPECT_EQ(all.least.number(), 1);
    EXPECT_EQ(all.most.number(), 2000);
    EXPECT_EQ(all.last.number(), 2000);
}

} // namespace
} // namespace pallax
