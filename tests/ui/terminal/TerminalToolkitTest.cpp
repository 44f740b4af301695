#include "ui/terminal/TerminalToolkit.h"

#include "platform/ui/Window.h"
#include "tests/ui/terminal/TextRows.h"

#include <gtest/gtest.h>

#include <memory>

namespace pallax::terminal {
namespace {

/// A pane without rows.
class EmptyPane final : public ui::TableScreen {
public:
    using TableScreen::TableScreen;
    std::size_t numberOfRows() const override { return 0; }
    std::shared_ptr<ui::TableCell> cellForRow(std::size_t /*row*/) override { return nullptr; }
    void didSelectRow(std::optional<std::size_t> /*row*/) override {}
};

class TerminalToolkitTest : public testing::Test {
protected:
    std::unique_ptr<ui::NavigationStack> stack() {
        return toolkit.makeNavigationStack(std::make_shared<EmptyPane>(toolkit));
    }

    int displays = 0;
    TerminalToolkit toolkit{[this] { ++displays; }};
};

TEST_F(TerminalToolkitTest, TheScreenIsThatOfATerminalOf80ColumnsUntilItIsKnown) {
    EXPECT_EQ(toolkit.columns(), 80);
    EXPECT_EQ(toolkit.rows(), 24);
    EXPECT_EQ(toolkit.screenBounds(), (ui::Rect{{0, 0}, {800, 1200}}));
}

TEST_F(TerminalToolkitTest, TheScreenFollowsTheTerminalAndIsAllTheApplications) {
    toolkit.setSize(40, 12);
    EXPECT_EQ(toolkit.screenBounds(), (ui::Rect{{0, 0}, {400, 600}}));
    EXPECT_EQ(toolkit.applicationFrame(), toolkit.screenBounds());
    EXPECT_EQ(displays, 1);
    toolkit.setSize(-3, -1);
    EXPECT_EQ(toolkit.columns(), 0);
    EXPECT_EQ(toolkit.rows(), 0);
}

TEST_F(TerminalToolkitTest, ATextIsAsWideAsItsColumnsInAnyFont) {
    const ui::TextMetrics& metrics = toolkit.textMetrics();
    EXPECT_EQ(metrics.measure("", {}), (ui::Size{0, 50}));
    EXPECT_EQ(metrics.measure("abc", {ui::FontFace::System, 15}), (ui::Size{30, 50}));
    EXPECT_EQ(metrics.measure("abc", {ui::FontFace::BoldSystem, 40}), (ui::Size{30, 50}));
    EXPECT_EQ(metrics.measure("漢e\u0301", {}), (ui::Size{30, 50}));
    EXPECT_EQ(columnOf(49), 4);
    EXPECT_EQ(columnOf(50), 5);
}

TEST_F(TerminalToolkitTest, RowsLeaveTwoColumnsForTheMark) {
    EXPECT_EQ(rowContentBounds(80), (ui::Rect{{0, 0}, {780, 50}}));
    EXPECT_EQ(rowContentBounds(2), (ui::Rect{{0, 0}, {0, 50}}));
    EXPECT_EQ(rowContentBounds(0), (ui::Rect{{0, 0}, {0, 50}}));
}

TEST_F(TerminalToolkitTest, ATableHasTheScreensWidth) {
    TextRows rows{"A"};
    toolkit.setSize(40, 12);
    const auto table = toolkit.makeTableView(rows);
    EXPECT_EQ(table->contentBounds(), rowContentBounds(40));
    EXPECT_EQ(&terminalTable(*table).source(), &rows);
}

TEST_F(TerminalToolkitTest, LayoutsOfAnyNameGiveAListAndAField) {
    TextRows rows{"A"};
    const ui::ModalOutlets outlets = toolkit.loadLayout("Any name", rows);
    EXPECT_EQ(&terminalTable(*outlets.list).source(), &rows);
    EXPECT_EQ(outlets.field->text(), "");
    EXPECT_FALSE(terminalTextField(*outlets.field).isEditing());
}

TEST_F(TerminalToolkitTest, OnlyTheStackOfAVisibleWindowIsShown) {
    const auto shown = stack();
    const auto window = toolkit.makeWindow(toolkit.screenBounds());
    EXPECT_EQ(toolkit.navigation(), nullptr);
    window->setRoot(*shown);
    window->addView(*shown);
    EXPECT_EQ(toolkit.navigation(), nullptr);
    window->makeKeyAndVisible();
    EXPECT_EQ(toolkit.navigation(), shown.get());
    window->takeOffScreen();
    EXPECT_EQ(toolkit.navigation(), nullptr);
}

TEST_F(TerminalToolkitTest, AWindowThatEndsIsNotShownAnyMore) {
    const auto shown = stack();
    auto window = toolkit.makeWindow({});
    window->setRoot(*shown);
    window->makeKeyAndVisible();
    window.reset();
    EXPECT_EQ(toolkit.navigation(), nullptr);
}

TEST_F(TerminalToolkitTest, AWindowThatIsHiddenTakesNoOthersStackOffTheScreen) {
    const auto first = stack();
    const auto second = stack();
    auto hidden = toolkit.makeWindow({});
    hidden->setRoot(*first);
    hidden->makeKeyAndVisible();
    const auto visible = toolkit.makeWindow({});
    visible->setRoot(*second);
    visible->makeKeyAndVisible();
    hidden.reset();
    EXPECT_EQ(toolkit.navigation(), second.get());
}

TEST_F(TerminalToolkitTest, AWindowWithoutAStackShowsNothing) {
    const auto window = toolkit.makeWindow({});
    window->makeKeyAndVisible();
    EXPECT_EQ(toolkit.navigation(), nullptr);
}

TEST_F(TerminalToolkitTest, AlertsAreShownOneAfterTheOther) {
    EXPECT_EQ(toolkit.alert(), nullptr);
    toolkit.closeAlert();
    EXPECT_EQ(displays, 0);
    toolkit.showAlert({"First", "message", "Close"});
    toolkit.showAlert({"Second", "message", "Close"});
    ASSERT_NE(toolkit.alert(), nullptr);
    EXPECT_EQ(toolkit.alert()->title, "First");
    toolkit.closeAlert();
    ASSERT_NE(toolkit.alert(), nullptr);
    EXPECT_EQ(toolkit.alert()->title, "Second");
    toolkit.closeAlert();
    EXPECT_EQ(toolkit.alert(), nullptr);
    EXPECT_EQ(displays, 4);
}

TEST_F(TerminalToolkitTest, WhateverHappensToAScreenIsDrawn) {
    EmptyPane pane(toolkit);
    pane.viewDidLoad();
    pane.viewWillAppear(false);
    pane.viewWillDisappear(false);
    pane.setTitle("Title");
    pane.setToolbarItems({}, false);
    pane.view().setFrame({});
    pane.view().resignFirstResponder();
    EXPECT_EQ(displays, 7);
    pane.didReceiveMemoryWarning(); // neither call has a visible effect
    pane.viewDidUnload();
    EXPECT_EQ(displays, 7);
}

} // namespace
} // namespace pallax::terminal
