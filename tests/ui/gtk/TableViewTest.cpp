#include "ui/gtk/TableView.h"

#include "tests/ui/gtk/WindowStage.h"
#include "tests/ui/gtk/XDisplay.h"

#include <string>
#include <vector>

namespace pallax::gtk {
namespace {

class TableViewTest : public DisplayTest {
protected:
    /// A page with the table, of this width.
    void open(int width, int height) {
        stage = std::make_unique<WindowStage>(width, height);
        stage->tick(Dictionary{{"RSRP", "-92.25 dBm"}});
        view = std::make_unique<TableView>(stage->frame.metrics(), stage->guard, [this] {
            opened.push_back(view->model().content().rows[*view->model().cursorRow()].key);
        });
        view->model().show(cells());
        view->refresh();
        stage->frame.pages().open(view->widget(), "Cells");
        stage->settle();
        stage->settle();
    }
    void TearDown() override {
        if (stage != nullptr) {
            stage->frame.pages().close();
            stage->settle();
        }
        view = nullptr;
    }

    static TableRow cell(const char* pci, double rsrp, const char* text, const char* state) {
        return {pci, {{pci, std::stod(pci)}, {text, rsrp}, {state}, {"2", std::nullopt, true}}};
    }
    static TableContent cells(const char* rsrp = "-94.00") {
        return {{{"Physical Cell ID", {}, true},
                 {"Measured RSRP", "dBm"},
                 {"State, in the words of the record"},
                 {"Antennas"}},
                {cell("184", std::stod(rsrp), rsrp, "candidate for a reselection"),
                 cell("285", -97, "-97.00", "measured"), cell("252", -91.5, "-91.50", "")},
                "cell",
                "cells"};
    }
    void update(TableContent content, TableModel::Changes changes = TableModel::Changes::Mark) {
        view->model().update(std::move(content), changes);
        view->refresh();
        stage->settle();
    }
    /// The part of the dump that the table is.
    std::string dump() {
        const std::string all = stage->dump();
        return "\n" + all.substr(std::min(all.find("columns: "), all.size()));
    }
    void press(guint key, GdkModifierType state = {}) {
        const Ref<GListModel> controllers(gtk_widget_observe_controllers(view->widget()));
        const Ref<GObject> keys(G_OBJECT(g_list_model_get_item(controllers.get(), 0)));
        gboolean isTaken = FALSE;
        g_signal_emit_by_name(keys.get(), "key-pressed", key, 0U, state, &isTaken);
        taken = isTaken != FALSE;
        stage->settle();
    }
    /// Recognizes a gesture on a heading.
    void gesture(const char* heading, GType type, const std::function<void(GObject*)>& recognize) {
        GtkWidget* button = WindowStage::found(stage->window(), [&](GtkWidget* each) {
            const char* name = gtk_widget_get_tooltip_text(each);
            return name != nullptr && std::string(name) == heading;
        });
        ASSERT_NE(button, nullptr) << heading;
        const Ref<GListModel> controllers(gtk_widget_observe_controllers(button));
        for (guint index = 0; index < g_list_model_get_n_items(controllers.get()); ++index) {
            const Ref<GObject> each(G_OBJECT(g_list_model_get_item(controllers.get(), index)));
            const bool isPrimary =
                GTK_IS_GESTURE_CLICK(each.get()) != FALSE &&
                gtk_gesture_single_get_button(GTK_GESTURE_SINGLE(each.get())) == GDK_BUTTON_PRIMARY;
            if (G_OBJECT_TYPE(each.get()) == type && !isPrimary) {
                recognize(each.get());
            }
        }
        stage->settle();
    }
    void pressLong(const char* heading) {
        gesture(heading, GTK_TYPE_GESTURE_LONG_PRESS,
                [](GObject* each) { g_signal_emit_by_name(each, "pressed", 1.0, 1.0); });
    }
    void pressOther(const char* heading) {
        gesture(heading, GTK_TYPE_GESTURE_CLICK,
                [](GObject* each) { g_signal_emit_by_name(each, "pressed", 1, 1.0, 1.0); });
    }
    void activate(guint row) {
        g_signal_emit_by_name(WindowStage::below(view->widget(), GTK_TYPE_LIST_VIEW), "activate",
                              row);
        stage->settle();
    }

    std::unique_ptr<WindowStage> stage;
    std::unique_ptr<TableView> view;
    std::vector<std::string> opened;
    bool taken = false;
};

constexpr const char* kWide = R"(
columns: Physical Cell ID (right) | Measured RSRP dBm (right) | State, in the words of the record | Antennas (right)
cells (cursor): 184 | -94.00 | candidate for a reselection | 2 ›
cells: 285 | -97.00 | measured | 2 ›
cells: 252 | -91.50 |  | 2 ›
)";

TEST_F(TableViewTest, ShowsAllColumnsWhereThereIsRoom) {
    open(1024, 768);
    EXPECT_EQ(dump(), kWide);
}

TEST_F(TableViewTest, WhatDoesNotFitIsPushedSidewaysBelowTheColumnThatTellsTheRowsApart) {
    open(360, 720);
    const char* const kBegin = R"(
columns: Physical Cell ID (right) | Measured RSRP dBm (right) | State, in the words of the record
cells (cursor): 184 | -94.00 | candidate for a reselection
cells: 285 | -97.00 | measured
cells: 252 | -91.50 | 
)";
    EXPECT_EQ(dump(), kBegin);
    press(GDK_KEY_Left);
    EXPECT_FALSE(taken) << "it is at the left end";
    for (int time = 0; time < 3; ++time) {
        press(GDK_KEY_Right);
        EXPECT_TRUE(taken);
    }
    EXPECT_EQ(dump(), R"(
columns: Physical Cell ID (right) | State, in the words of the record | Antennas (right)
cells (cursor): 184 | candidate for a reselection | 2 ›
cells: 285 | measured | 2 ›
cells: 252 |  | 2 ›
)");
    for (int time = 0; time < 10; ++time) {
        press(GDK_KEY_Right);
    }
    EXPECT_FALSE(taken);
    for (int time = 0; time < 10; ++time) {
        press(GDK_KEY_Left);
    }
    EXPECT_EQ(dump(), kBegin);
}

TEST_F(TableViewTest, AHeadingSortsAndReverses) {
    open(1024, 768);
    stage->press("Measured RSRP dBm");
    EXPECT_EQ(dump(), R"(
columns: Physical Cell ID (right) | Measured RSRP dBm, sorted, least first (right) | State, in the words of the record | Antennas (right)
cells: 285 | -97.00 | measured | 2 ›
cells (cursor): 184 | -94.00 | candidate for a reselection | 2 ›
cells: 252 | -91.50 |  | 2 ›
)");
    stage->press("Measured RSRP dBm, sorted, least first");
    EXPECT_EQ(dump(), R"(
columns: Physical Cell ID (right) | Measured RSRP dBm, sorted, greatest first (right) | State, in the words of the record | Antennas (right)
cells: 252 | -91.50 |  | 2 ›
cells (cursor): 184 | -94.00 | candidate for a reselection | 2 ›
cells: 285 | -97.00 | measured | 2 ›
)");
}

TEST_F(TableViewTest, TheKeysOfTablesOnATerminalWork) {
    open(360, 720);
    press(GDK_KEY_greater);
    press(GDK_KEY_greater);
    press(GDK_KEY_greater);
    EXPECT_NE(dump().find("State, in the words of the record, sorted, least first"),
              std::string::npos);
    press(GDK_KEY_greater);
    EXPECT_NE(dump().find("Antennas, sorted, least first"), std::string::npos)
        << "it is pushed into view";
    press(GDK_KEY_r);
    EXPECT_NE(dump().find("Antennas, sorted, greatest first"), std::string::npos);
    press(GDK_KEY_x);
    EXPECT_EQ(dump().find("Antennas"), std::string::npos);
    press(GDK_KEY_X);
    press(GDK_KEY_greater);
    EXPECT_NE(dump().find("Antennas, sorted"), std::string::npos);
    press(GDK_KEY_q);
    EXPECT_FALSE(taken);
    for (int time = 0; time < 4; ++time) {
        press(GDK_KEY_less);
    }
    EXPECT_EQ(dump().find("sorted"), std::string::npos);
}

TEST_F(TableViewTest, AHeadingHasAMenuThatHidesItsColumnAndShowsAll) {
    open(1024, 768);
    TableContent aged = cells();
    aged.columns.push_back({"age", {}, false, true});
    for (TableRow& row : aged.rows) {
        row.cells.push_back({"2 s"});
    }
    update(aged, TableModel::Changes::Ignore);
    EXPECT_EQ(dump(), kWide);
    pressLong("State, in the words of the record");
    stage->press("Hide Column");
    EXPECT_EQ(
        dump().substr(0, dump().find("cells")),
        "\ncolumns: Physical Cell ID (right) | Measured RSRP dBm (right) | Antennas (right)\n");
    pressOther("Antennas");
    stage->press("Show All Columns");
    EXPECT_EQ(
        dump().substr(0, dump().find("cells")),
        "\ncolumns: Physical Cell ID (right) | Measured RSRP dBm (right) | State, in the words "
        "of the record | Antennas (right) | age\n");
}

TEST_F(TableViewTest, AMenuThatIsOpenGoesWithItsHeading) {
    open(1024, 768);
    pressLong("Antennas");
    GtkWidget* const found = WindowStage::below(stage->window(), GTK_TYPE_POPOVER);
    ASSERT_NE(found, nullptr);
    const Ref<GtkWidget> menu = shared(found);
    TableContent fewer = cells();
    fewer.columns.pop_back();
    for (TableRow& row : fewer.rows) {
        row.cells.pop_back();
    }
    update(fewer);
    EXPECT_EQ(gtk_widget_get_parent(menu.get()), nullptr);
    pressLong("Measured RSRP dBm");
    EXPECT_NE(WindowStage::below(stage->window(), GTK_TYPE_POPOVER), nullptr);
}

TEST_F(TableViewTest, ChangedCellsAreMarkedUntilTheNextRefresh) {
    open(1024, 768);
    update(cells("-93.25"));
    EXPECT_NE(dump().find("cells (cursor): 184 | -93.25 (changed) | candidate"), std::string::npos)
        << dump();
    update(cells("-93.25"));
    EXPECT_EQ(dump().find("(changed)"), std::string::npos);
}

TEST_F(TableViewTest, TheCursorAndTheKeyboardStayOnTheirRow) {
    open(1024, 768);
    view->model().moveCursorTo(1);
    view->focusCursor();
    stage->settle();
    EXPECT_NE(dump().find("cells (cursor) (focus): 285"), std::string::npos) << dump();
    TableContent more = cells();
    more.rows.insert(more.rows.begin(), cell("7", -80, "-80.00", "new"));
    update(more);
    EXPECT_NE(dump().find("cells (cursor) (focus): 285"), std::string::npos) << dump();
    press(GDK_KEY_greater);
    EXPECT_EQ(dump(), R"(
columns: Physical Cell ID, sorted, least first (right) | Measured RSRP dBm (right) | State, in the words of the record | Antennas (right)
cells: 7 (changed) | -80.00 (changed) | new (changed) | 2 › (changed)
cells: 184 | -94.00 | candidate for a reselection | 2 ›
cells: 252 | -91.50 |  | 2 ›
cells (cursor) (focus): 285 | -97.00 | measured | 2 ›
)");
    more.rows.erase(more.rows.begin() + 2); // its row
    update(more);
    EXPECT_NE(dump().find("cells (cursor) (focus): 252"), std::string::npos) << dump();
}

TEST_F(TableViewTest, ARowThatMovesKeepsItsWidgetAndTheKeyboard) {
    open(1024, 768);
    view->focusCursor();
    stage->settle();
    GtkWidget* const focused = gtk_window_get_focus(stage->frame.window());
    TableContent reversed = cells();
    std::swap(reversed.rows.front(), reversed.rows.back());
    view->model().update(reversed, TableModel::Changes::Ignore);
    view->refresh();
    EXPECT_EQ(gtk_window_get_focus(stage->frame.window()), focused) << "at once";
    stage->settle();
    EXPECT_EQ(gtk_window_get_focus(stage->frame.window()), focused);
    EXPECT_NE(dump().find("cells (cursor) (focus): 184"), std::string::npos) << dump();
}

TEST_F(TableViewTest, AChosenRowIsOpened) {
    open(360, 720);
    activate(2);
    EXPECT_EQ(opened, (std::vector<std::string>{"252"}));
    EXPECT_NE(dump().find("cells (cursor): 252"), std::string::npos);
    activate(7);
    EXPECT_EQ(opened.size(), 1U) << "there is no such row";
}

TEST_F(TableViewTest, AFilterShowsTheRowsThatContainIt) {
    open(1024, 768);
    view->setFilter("MEAS");
    stage->settle();
    EXPECT_EQ(dump().substr(dump().find("cells")),
              "cells (cursor): 285 | -97.00 | measured | 2 ›\n");
    view->setFilter("");
    stage->settle();
    EXPECT_NE(dump().find("cells (cursor): 285"), std::string::npos);
}

TEST_F(TableViewTest, RowsThatAreLessImportantAreDim) {
    open(360, 720);
    TableContent content = cells();
    content.rows[1].isSecondary = true;
    update(content);
    EXPECT_NE(dump().find("cells (dim): 285"), std::string::npos);
}

TEST_F(TableViewTest, ThousandsOfRowsScrollToTheCursor) {
    open(360, 720);
    TableContent many = cells();
    many.rows.clear();
    constexpr int kMany = 10000;
    for (int row = 0; row < kMany; ++row) {
        many.rows.push_back(cell(std::to_string(row).c_str(), -row, "-1", "s"));
    }
    update(many, TableModel::Changes::Ignore);
    view->model().moveCursorTo(kMany - 1);
    view->focusCursor();
    stage->settle();
    stage->settle();
    EXPECT_NE(dump().find("cells (cursor) (focus): 9999 |"), std::string::npos) << dump();
    EXPECT_NE(dump().find("cells: 9990 |"), std::string::npos);
    EXPECT_EQ(dump().find("cells: 100 |"), std::string::npos);
}

TEST_F(TableViewTest, CopiesTheCursorsValue) {
    open(360, 720);
    press(GDK_KEY_greater);
    press(GDK_KEY_greater);
    press(GDK_KEY_y);
    GdkClipboard* clipboard = gtk_widget_get_clipboard(view->widget());
    const auto text = [clipboard] {
        GValue value = G_VALUE_INIT;
        g_value_init(&value, G_TYPE_STRING);
        std::string copied;
        if (gdk_content_provider_get_value(gdk_clipboard_get_content(clipboard), &value, nullptr) !=
            FALSE) {
            copied = g_value_get_string(&value);
        }
        g_value_unset(&value);
        return copied;
    };
    EXPECT_EQ(text(), "-94.00 dBm");
    press(GDK_KEY_less);
    press(GDK_KEY_c, GDK_CONTROL_MASK);
    EXPECT_EQ(text(), "184");
}

} // namespace
} // namespace pallax::gtk
