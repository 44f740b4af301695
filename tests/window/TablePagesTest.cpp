#include "window/TablePages.h"

#include "tests/window/SessionStage.h"

namespace pallax {
namespace {

/// The table pages of a sample drive.
class TablePagesTest : public gtk::DisplayTest {
protected:
    void SetUp() override {
        gtk::DisplayTest::SetUp();
        if (!IsSkipped()) {
            stage = std::make_unique<SessionStage>(PALLAX_SOURCE_DIR "/samples/lte-drive.pcap");
            stage->awaitShown("text: Updated 2023-11-14 at 22:15:20");
        }
    }
    /// Chooses a row of the table on the page on top.
    void choose(guint row) {
        g_signal_emit_by_name(
            SessionStage::below(GTK_WIDGET(stage->frame.window()), GTK_TYPE_LIST_VIEW), "activate",
            row);
    }
    void find(const std::string& text, const std::string& hit) {
        stage->press(GDK_KEY_f);
        stage->type(text);
        stage->awaitShown(hit);
        g_signal_emit_by_name(gtk_widget_get_ancestor(gtk_window_get_focus(stage->frame.window()),
                                                      GTK_TYPE_SEARCH_ENTRY),
                              "activate");
    }
    /// Makes the window as narrow as a phone.
    void narrow() {
        constexpr int kWidth = 360;
        constexpr int kHeight = 720;
        EXPECT_TRUE(stage->await([&] {
            // Again, because a size that the server still had to tell of replaces a wish.
            gtk_window_set_default_size(stage->frame.window(), kWidth, kHeight);
            return !stage->frame.shownStack()->isSideBySide();
        }));
    }
    /// The name of the row with the cursor in the topmost pane.
    std::string cursor() const {
        const gtk::WidgetTable& table = stage->table();
        return table.pane().nodeAt(table.cursorRow().value())->displayName();
    }

    std::unique_ptr<SessionStage> stage;
};

TEST_F(TablePagesTest, KeysOpenAndCloseThem) {
    stage->press(GDK_KEY_e);
    stage->awaitShown("title: Events");
    stage->press(GDK_KEY_f);
    stage->awaitShown("title: Find a Text");
    stage->press(GDK_KEY_f);
    stage->awaitShown("title: Events");
    stage->press(GDK_KEY_semicolon);
    stage->awaitShown("title: Ask in SQL");
    stage->press(GDK_KEY_semicolon);
    stage->awaitShown("title: Ask in SQL");
    stage->press(GDK_KEY_e);
    stage->awaitShown("title: Events");
    stage->press(GDK_KEY_e);
    stage->awaitShown("title: Ask in SQL");
    stage->frame.pages().close();
    stage->awaitShown("row: SIM Info");
    EXPECT_FALSE(stage->session->tablePages().handleKey(GDK_KEY_z));
}

TEST_F(TablePagesTest, AnEventIsGoneToAndThePageBelowShowsIt) {
    stage->open("Serving Cell Measurements");
    stage->awaitShown("row: Measured RSRP");
    stage->open("Measured RSRP");
    stage->awaitShown("text: -94.50 dBm");
    stage->press(GDK_KEY_e);
    stage->awaitShown("22:15:14 | cell-change");
    choose(10); // the latest first
    stage->awaitShown("title: Measured RSRP");
    EXPECT_FALSE(stage->shows("text: -94.50 dBm")) << stage->dump();
}

TEST_F(TablePagesTest, ThePageBelowIsOfTheShownInstantWhenItIsSeenAgain) {
    stage->open("Serving Cell Measurements");
    stage->awaitShown("row: Measured RSRP");
    stage->open("Measured RSRP");
    stage->awaitShown("text: -94.50 dBm");
    stage->press(GDK_KEY_e);
    stage->press(GDK_KEY_asciicircum);
    stage->press(GDK_KEY_e);
    stage->awaitShown("title: Measured RSRP");
    EXPECT_TRUE(stage->shows("text: no value now")) << stage->dump();
}

TEST_F(TablePagesTest, AHitOfAnInstantIsARowOfAPane) {
    find("average rsrp", "Average RSRP | -94.75 dBm | Serving Cell Measurements");
    EXPECT_TRUE(stage->await([&] { return cursor() == "Average RSRP"; }));
    EXPECT_FALSE(stage->frame.pages().isOpen());
    stage->press(GDK_KEY_e);
    stage->press(GDK_KEY_n);
    stage->awaitShown("text: The hits are rows of panes: close the page first.");
    stage->press(GDK_KEY_e);
    stage->press(GDK_KEY_n);
    stage->awaitShown("text: average rsrp: 2 of ");
    stage->press(GDK_KEY_N);
    stage->awaitShown("text: average rsrp: 1 of ");
    EXPECT_EQ(cursor(), "Average RSRP");
}

TEST_F(TablePagesTest, TheRowOfAHitGetsTheKeyboard) {
    const auto hasKeyboard = [this](const std::string& path) {
        return stage->await([&] { return stage->frame.shownStack()->focusedValue() == path; });
    };
    find("measured rsrp", "Measured RSRP | -94.50 dBm");
    EXPECT_TRUE(hasKeyboard("/Serving Cell Measurements/Measured RSRP"));
    gtk_window_set_focus_visible(stage->frame.window(), FALSE);
    stage->press(GDK_KEY_n);
    EXPECT_TRUE(hasKeyboard("/Neighbor Cells List/0/Measured RSRP"));
    EXPECT_TRUE(gtk_window_get_focus_visible(stage->frame.window()));
    narrow();
    stage->press(GDK_KEY_n);
    EXPECT_TRUE(hasKeyboard("/Neighbor Cells List/1/Measured RSRP"));
    stage->press(GDK_KEY_n);
    EXPECT_TRUE(hasKeyboard("/Serving Cell Measurements/Measured RSRP"));
    stage->press(GDK_KEY_n);
    EXPECT_TRUE(hasKeyboard("/Neighbor Cells List/0/Measured RSRP"));
}

TEST_F(TablePagesTest, AHitOfTheRootPaneIsNotCoveredByTheOverview) {
    narrow();
    stage->frame.toggleDetail();
    stage->awaitShown("title: Overview");
    find("sim info", "cells (cursor): SIM Info");
    stage->awaitShown("title: Pallax");
    EXPECT_TRUE(stage->await([&] { return cursor() == "SIM Info"; }));
}

TEST_F(TablePagesTest, AConditionThatCameLaterIsFoundAgainInstead) {
    find("average rsrp", "Average RSRP | -94.75 dBm | Serving Cell Measurements");
    EXPECT_TRUE(stage->await([&] { return cursor() == "Average RSRP"; }));
    stage->press(GDK_KEY_asciicircum);
    stage->press(GDK_KEY_colon);
    stage->type("measured_rsrp < -100");
    g_signal_emit_by_name(
        gtk_widget_get_ancestor(gtk_window_get_focus(stage->frame.window()), GTK_TYPE_ENTRY),
        "activate");
    stage->awaitShown(", held");
    for (int times = 0; times < 20; ++times) {
        stage->press(GDK_KEY_n);
    }
    stage->awaitShown("text: measured_rsrp < -100 does not become true after this.");
}

TEST_F(TablePagesTest, NothingOfThemIsLeftWhenTheyAreForgotten) {
    find("average rsrp", "Average RSRP | -94.75 dBm | Serving Cell Measurements");
    EXPECT_TRUE(stage->await([&] { return cursor() == "Average RSRP"; }));
    stage->press(GDK_KEY_f);
    stage->awaitShown("field: \"average rsrp\"");
    stage->session->tablePages().forget();
    EXPECT_FALSE(stage->frame.pages().isOpen());
    EXPECT_FALSE(stage->session->tablePages().findAgain(Travel::Direction::Forward));
    stage->press(GDK_KEY_f);
    stage->awaitShown("field: \"\"");
}

} // namespace
} // namespace pallax
