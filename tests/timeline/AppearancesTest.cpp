#include "timeline/Appearances.h"

#include "tests/timeline/TimelineFixture.h"
#include "timeline/Series.h"

#include <gtest/gtest.h>

#include <map>
#include <string>
#include <vector>

namespace pallax {
namespace {

class AppearancesTest : public testing::Test {
protected:
    AppearancesTest() {
        fixture.drive(7, std::chrono::seconds(60));
        timeline = fixture.indexed();
    }
    std::vector<Appearances::Hit> found(const std::string& text) {
        EXPECT_TRUE(appearances.read(*timeline, {}));
        return appearances.find(*timeline, [&text](std::string_view each) {
            return each.find(text) != std::string_view::npos;
        });
    }

    TimelineFixture fixture{"utran"};
    std::unique_ptr<Timeline> timeline;
    Appearances appearances;
};

TEST_F(AppearancesTest, ATextAppearsWhereItIsReadFirst) {
    const auto field = timeline->fields().named("utran.rrc_info.state");
    ASSERT_TRUE(field);
    const auto series = readSeries(*timeline, *field, kNoEntry, 1, timeline->packets());
    std::uint64_t expected = 0;
    for (const SeriesPoint& point : series) {
        if (expected == 0 && point.value.text() == "Cell DCH") {
            expected = point.packet;
        }
    }
    ASSERT_NE(expected, 0U);
    bool isFound = false;
    for (const Appearances::Hit& hit : found("Cell DCH")) {
        if (hit.name == "State") {
            EXPECT_EQ(hit.packet, expected);
            EXPECT_EQ(hit.value, "Cell DCH");
            EXPECT_EQ(hit.where, "RRC Info");
            isFound = true;
        }
    }
    EXPECT_TRUE(isFound);
}

TEST_F(AppearancesTest, ANumberAppearsWhereItIsReadFirst) {
    const auto field = timeline->fields().named("utran.serving_cell_info.cell_scrambling_code");
    ASSERT_TRUE(field);
    const auto series = readSeries(*timeline, *field, kNoEntry, 1, timeline->packets());
    std::map<std::string, std::uint64_t> expected;
    for (const SeriesPoint& point : series) {
        expected.emplace(point.value.text(), point.packet);
    }
    ASSERT_GT(expected.size(), 1U);
    std::map<std::string, std::uint64_t> seen;
    for (const Appearances::Hit& hit : found("")) {
        if (hit.name == "Cell Scrambling Code" && hit.where == "Serving Cell Info") {
            EXPECT_TRUE(seen.emplace(hit.value, hit.packet).second) << hit.value;
        }
    }
    EXPECT_EQ(seen, expected);
}

TEST_F(AppearancesTest, AFieldAppearsOnceForEachEntry) {
    const auto byKey = found("Downlink UARFCN");
    ASSERT_EQ(byKey.size(), 1U);
    EXPECT_EQ(found("downlink_uarfcn").size(), 1U) << "as queries name it";
    EXPECT_EQ(found("utran.").size(), 0U) << "but not the name of the technology";
    std::string entry;
    for (EntryId id = 2; id < timeline->entries().entries() && entry.empty(); ++id) {
        entry = timeline->entries().words(id);
    }
    ASSERT_NE(entry, "");
    int entries = 0;
    for (const Appearances::Hit& hit : found(entry)) {
        entries += hit.name == entry ? 1 : 0;
        EXPECT_GE(hit.packet, 1U);
    }
    EXPECT_EQ(entries, 1);
}

TEST_F(AppearancesTest, EventsAreFoundInTheOrderOfThePackets) {
    ASSERT_FALSE(timeline->events().empty());
    const Event& event = timeline->events().front();
    const auto hits = found(event.words);
    ASSERT_FALSE(hits.empty());
    EXPECT_EQ(hits.front().packet, event.packet);
    EXPECT_EQ(hits.front().value, event.words);
    const auto all = found("");
    for (std::size_t index = 1; index < all.size(); ++index) {
        EXPECT_LE(all[index - 1].packet, all[index].packet);
    }
}

TEST_F(AppearancesTest, ItGoesOnWhereItWasStoppedAndReadsNoPacketTwice) {
    Appearances stopped;
    int asked = 0;
    EXPECT_FALSE(stopped.read(*timeline, [&asked] { return ++asked <= 100; }));
    const auto everything = [](std::string_view) { return true; };
    const std::size_t early = stopped.find(*timeline, everything).size();
    EXPECT_TRUE(stopped.read(*timeline, [&asked] {
        ++asked;
        return true;
    }));
    EXPECT_EQ(static_cast<std::uint64_t>(asked), timeline->packets() + 1);
    EXPECT_TRUE(stopped.read(*timeline, [] { return false; })) << "there is nothing to read";
    const auto whole = stopped.find(*timeline, everything);
    EXPECT_GT(whole.size(), early);
    EXPECT_TRUE(appearances.read(*timeline, {}));
    EXPECT_EQ(whole.size(), appearances.find(*timeline, everything).size());
    EXPECT_FALSE(appearances.isFull());
}

TEST_F(AppearancesTest, AnotherTimelineIsReadFromItsStart) {
    const std::size_t first = found("Downlink UARFCN").size();
    TimelineFixture other{"lte"};
    other.drive(7, std::chrono::seconds(5));
    timeline = other.indexed();
    EXPECT_EQ(found("Downlink UARFCN").size(), 0U);
    EXPECT_GT(found("Measured RSRP").size(), 0U);
    EXPECT_EQ(first, 1U);
    EXPECT_TRUE(Appearances().find(*timeline, [](std::string_view) { return true; }).empty());
    timeline.reset();
}

} // namespace
} // namespace pallax
