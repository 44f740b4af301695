#include "ui/contents/EventsContent.h"

#include "tests/ui/pages/SampleTimeline.h"

#include <gtest/gtest.h>

namespace pallax {
namespace {

class EventsContentTest : public testing::Test {
protected:
    EventsContent content{{.moment = [this] { return moment; },
                           .ahead = [this] { return ahead; },
                           .wording = [](std::string words) { return "(" + words + ")"; }}};
    void recordDrive() {
        drive.emplace();
        moment = {drive->timeline.get(), drive->timeline->packets()};
    }
    const std::vector<TableRow>& rows() const { return table.content().rows; }

    std::optional<terminal::SampleTimeline> drive;
    Moment moment;
    std::chrono::seconds ahead{0};
    TableModel table;
};

TEST_F(EventsContentTest, WithoutATimelineTheTableIsEmpty) {
    content.fill(table);
    EXPECT_TRUE(rows().empty());
    EXPECT_EQ(content.selected(table), std::nullopt);
    recordDrive();
    content.fill(table);
    EXPECT_EQ(rows().size(), 4U);
    moment = {};
    EXPECT_EQ(content.selected(table), std::nullopt) << "the timeline is gone";
    content.fill(table);
    EXPECT_TRUE(rows().empty());
}

TEST_F(EventsContentTest, TheLatestComesFirstInTheWordsOfTheFrontEnd) {
    recordDrive();
    content.fill(table);
    ASSERT_EQ(rows().size(), 4U);
    EXPECT_EQ(rows().front().cells[0].text, "22:14:11");
    EXPECT_EQ(rows().front().cells[1].text, "context-up");
    EXPECT_EQ(rows().front().cells[2].text, "(context up: internet)");
    EXPECT_EQ(rows().back().cells[0].text, "22:13:27");
}

TEST_F(EventsContentTest, IsFilledAgainOnlyWhenSomethingIsAnother) {
    recordDrive();
    content.fill(table);
    const auto version = table.version();
    content.fill(table);
    EXPECT_EQ(table.version(), version);
    ahead = std::chrono::hours(1);
    content.fill(table);
    EXPECT_NE(table.version(), version);
    EXPECT_EQ(rows().front().cells[0].text, "23:14:11");
}

TEST_F(EventsContentTest, TheCursorBeginsAtTheShownInstantAndEventsAfterItAreSecondary) {
    recordDrive();
    moment.instant = drive->timeline->events()[1].packet;
    content.fill(table);
    EXPECT_TRUE(rows()[1].isSecondary);
    EXPECT_FALSE(rows()[2].isSecondary);
    EXPECT_EQ(table.cursor(), 2U);
    EXPECT_EQ(content.selected(table), moment.instant);
    moment.instant = drive->timeline->packets();
    content.fill(table);
    EXPECT_EQ(table.cursor(), 2U) << "it stays on its event";
}

} // namespace
} // namespace pallax
