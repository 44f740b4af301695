#include "ui/gtk/SearchView.h"

#include "tests/ui/gtk/PageStage.h"

namespace pallax::gtk {
namespace {

class SearchViewTest : public PageTest {
protected:
    void openSearch(int width) {
        open(width);
        finder.emplace(
            TextFinder::Surroundings{.root = [this] { return stage->table(0).pane().node(); },
                                     .partAt = partAt,
                                     .moment = [this] { return moment; },
                                     .mayGoOn = [this] { return mayGoOn; }});
        view.emplace(
            stage->frame.metrics(), stage->guard,
            SearchView::Surroundings{
                .search = {.finder = *finder,
                           .goToRow = [this](const std::string& /*text*/,
                                             const FoundRow& row) { rows.push_back(row.name); },
                           .goToPacket = [this](const std::string& /*text*/,
                                                std::uint64_t packet) { went.push_back(packet); },
                           .ahead = [] { return std::chrono::seconds(0); }},
                .work = [](const auto& search) { search(); },
                .close =
                    [this] {
                        ++closings;
                        stage->frame.pages().close();
                    }});
        show(view->widget(), "Find a Text");
        view->focus();
        settle();
    }
    void find(const std::string& text) {
        gtk_search_entry_set_search_delay(GTK_SEARCH_ENTRY(field(view->widget())), 0);
        gtk_editable_set_text(field(view->widget()), text.c_str());
        settle();
    }

    const EntryPartAt partAt = [](const std::string& path) {
        return path.ends_with("/PCI") ? EntryPart::Cell : EntryPart::None;
    };
    std::optional<TextFinder> finder;
    std::optional<SearchView> view;
    std::vector<std::string> rows;
    int closings = 0;
    bool mayGoOn = true;
};

TEST_F(SearchViewTest, BeginsWithAnEmptyField) {
    openSearch(kPhone);
    EXPECT_EQ(dump(), R"(
button: Back
title: Find a Text / 
field: ""
button: This Instant (on)
button: Whole Recording
text: Type a part of a name or a value.
)");
}

TEST_F(SearchViewTest, RowsOfTheInstantThatContainTheTextAreListed) {
    openSearch(1024);
    find("7");
    EXPECT_EQ(dump(), R"(
button: Back
title: Find a Text / 
field: "7"
button: This Instant (on)
button: Whole Recording
columns: Name | Value | Where
cells (cursor): PCI | 7 | Cells, PCI 7
)");
    find("nothing");
    EXPECT_TRUE(shows("text: Nothing in this instant contains this text."));
    find("7");
    stage->tick(Dictionary{{"RSRP", "-97.00 dBm"}});
    view->refresh();
    settle();
    EXPECT_TRUE(shows(": RSRP | -97.00 dBm")) << "the frame of the next tick";
}

TEST_F(SearchViewTest, ChoosingAHitGoesToItsRow) {
    openSearch(kPhone);
    find("rsrp");
    g_signal_emit_by_name(field(view->widget()), "activate");
    settle();
    EXPECT_EQ(rows, (std::vector<std::string>{"RSRP"}));
    EXPECT_EQ(closings, 1);
}

TEST_F(SearchViewTest, TheWholeRecordingIsSearchedWhenItIsChosen) {
    recordDrive();
    openSearch(1024);
    find("context down");
    EXPECT_TRUE(shows("Nothing in this instant contains this text."));
    gtk_toggle_button_set_active(
        GTK_TOGGLE_BUTTON(WindowStage::found(view->widget(),
                                             [](GtkWidget* widget) {
                                                 return GTK_IS_TOGGLE_BUTTON(widget) != FALSE &&
                                                        std::string(gtk_button_get_label(GTK_BUTTON(
                                                            widget))) == "Whole Recording";
                                             })),
        TRUE);
    settle();
    EXPECT_TRUE(shows("columns: Time | Name | Value | Where\n"
                      "cells (cursor): 22:13:59 | context-down | context down: internet | "))
        << dump();
    activate(view->widget(), 0);
    EXPECT_EQ(went, (std::vector<std::uint64_t>{drive->timeline->events()[1 + 1].packet}));
    EXPECT_EQ(closings, 1);
}

TEST_F(SearchViewTest, ASearchThatIsStoppedSaysSo) {
    recordDrive();
    openSearch(kPhone);
    mayGoOn = false;
    stage->press("Whole Recording");
    find("nothing");
    EXPECT_TRUE(shows("text: The search was stopped.")) << dump();
    mayGoOn = true;
    find("nothing of it");
    EXPECT_TRUE(shows("text: No event, name or value of the recording contains it.")) << dump();
}

TEST_F(SearchViewTest, WithoutATimelineThereIsNothingToSearch) {
    openSearch(kPhone);
    stage->press("Whole Recording");
    find("nothing");
    EXPECT_TRUE(shows("text: There is nothing to search yet: no packet has come."));
}

TEST_F(SearchViewTest, WhatIsTypedReplacesTheTextBefore) {
    openSearch(kPhone);
    find("rsrp");
    view->focus();
    int from = 0;
    int to = 0;
    EXPECT_TRUE(gtk_editable_get_selection_bounds(field(view->widget()), &from, &to));
    EXPECT_EQ(to - from, 4) << "all of it is selected";
}

TEST_F(SearchViewTest, DownGoesToTheHitsAndEscapeGoesBack) {
    openSearch(kPhone);
    find("rsrp");
    pressInField(view->widget(), GDK_KEY_Down);
    EXPECT_TRUE(shows("cells (cursor) (focus): RSRP")) << dump();
    g_signal_emit_by_name(field(view->widget()), "stop-search");
    settle();
    EXPECT_EQ(closings, 1);
}

} // namespace
} // namespace pallax::gtk
