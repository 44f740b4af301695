#include "ui/gtk/EventsView.h"

#include "tests/ui/gtk/PageStage.h"

namespace pallax::gtk {
namespace {

class EventsViewTest : public PageTest {
protected:
    void openEvents(int width) {
        open(width);
        view.emplace(stage->frame.metrics(), stage->guard,
                     EventsView::Surroundings{
                         .events = {.moment = [this] { return moment; },
                                    .ahead = [] { return std::chrono::seconds(0); }},
                         .goTo = [this](std::uint64_t packet) { went.push_back(packet); }});
        view->refresh();
        show(view->widget(), "Events");
        view->table().focusCursor();
        settle();
    }

    std::optional<EventsView> view;
};

TEST_F(EventsViewTest, WithoutATimelineThereAreNoEventsYet) {
    openEvents(kPhone);
    EXPECT_EQ(dump(), R"(
button: Back (focus)
title: Events / 
text: No events yet.
)");
    recordDrive();
    view->refresh();
    settle();
    EXPECT_TRUE(shows("cell-change"));
    EXPECT_FALSE(shows("No events yet."));
}

TEST_F(EventsViewTest, TheLatestComesFirst) {
    recordDrive();
    openEvents(1024);
    EXPECT_EQ(dump(), R"(
button: Back
title: Events / 
columns: Time | Kind | What
cells (cursor) (focus): 22:14:11 | context-up | context up: internet
cells: 22:13:59 | context-down | context down: internet
cells: 22:13:44 | context-up | context up: internet
cells: 22:13:27 | cell-change | serving cell 386 → 488 after 8 s
)");
}

TEST_F(EventsViewTest, OnAPhoneTheTimeStaysAtTheLeft) {
    recordDrive();
    openEvents(kPhone);
    EXPECT_TRUE(shows("cells (cursor) (focus): 22:14:11 | context-up | context up: internet"))
        << dump();
    EXPECT_LE(gtk_widget_get_width(stage->window()), kPhone) << "the table does not widen it";
}

TEST_F(EventsViewTest, EventsAfterTheShownInstantAreDimAndTheCursorIsAtIt) {
    recordDrive();
    moment.instant = drive->timeline->events()[1].packet;
    openEvents(1024);
    EXPECT_TRUE(shows("cells (dim): 22:14:11"));
    EXPECT_TRUE(shows("cells (dim): 22:13:59"));
    EXPECT_TRUE(shows("cells (cursor) (focus): 22:13:44"));
    EXPECT_TRUE(shows("cells: 22:13:27"));
}

TEST_F(EventsViewTest, ChoosingOneGoesToItsInstant) {
    recordDrive();
    openEvents(kPhone);
    activate(view->widget(), 1);
    EXPECT_EQ(went, (std::vector<std::uint64_t>{drive->timeline->events()[2].packet}));
}

} // namespace
} // namespace pallax::gtk
