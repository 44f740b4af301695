#include "tests/app/PaneFixture.h"

#include <algorithm>

namespace pallax {
namespace {

using namespace doubles; // NOLINT: the vocabulary of these tests
using ui::CellAccessory;
using ui::Rect;

class PallaxPaneControllerTest : public PaneFixture {
protected:
    static NodeRef section(std::string name) {
        return treeNode(std::move(name),
                        {leafNode("ARFCN", "17"), treeNode("Neighbours", {leafNode("0", "21")})});
    }
    /// A pane of `section` on a stack; row 0 is a leaf, row 1 a branch.
    PaneRef shownPane() {
        PaneRef pane = makePane(section("Serving Cell"), "/Serving Cell");
        putOnStack(pane);
        toolkit.take();
        return pane;
    }
    /// The screen on top of the stack.
    const PallaxPaneController& top() const {
        return dynamic_cast<const PallaxPaneController&>(application.stack->top());
    }
};

TEST_F(PallaxPaneControllerTest, ItStartsLoadingWithAnEmptyStatus) {
    const PaneRef pane = makePane(nullptr);
    pane->createToolbarItems();
    EXPECT_TRUE(spinnerOf(*pane).isSpinning);
    EXPECT_EQ(statusOf(*pane).text, "");
}

TEST_F(PallaxPaneControllerTest, TheToolbarIsSpinnerStatusLabelSpaceAndSaveButton) {
    application.saveAllowed = true;
    const PaneRef pane = makePane(nullptr);
    toolkit.take();
    pane->setStatus("Updated", false);
    EXPECT_EQ(toolkit.take(), ScreenDiary{"screen 1 toolbarItemsChanged animated=true"});

    const ui::BarItems& items = pane->toolbarItems();
    ASSERT_EQ(items.size(), 4U);
    const auto& spinner = std::get<ui::ActivityIndicator>(items[0]);
    EXPECT_EQ(spinner.style, ui::IndicatorStyle::Gray);
    EXPECT_TRUE(spinner.hidesWhenStopped);
    EXPECT_FALSE(spinner.isSpinning);
    const auto& label = std::get<ui::Label>(items[1]);
    EXPECT_EQ(label.text, "Updated");
    EXPECT_EQ(label.font, (ui::Font{ui::FontFace::System, 14}));
    EXPECT_TRUE(label.clearBackground);
    EXPECT_EQ(label.color, ui::TextColor::Dark);
    EXPECT_TRUE(std::holds_alternative<ui::FlexibleSpace>(items[2]));
    EXPECT_TRUE(std::holds_alternative<ui::SaveButton>(items[3]));
}

TEST_F(PallaxPaneControllerTest, TheStatusLabelIsSizedToFitItsText) {
    toolkit.metrics.extents["Connecting"] = {71, 17};
    const PaneRef pane = makePane(nullptr);
    pane->setStatus("Connecting", true);
    EXPECT_EQ(statusOf(*pane).frame.size, (ui::Size{71, 17}));
    EXPECT_EQ(toolkit.metrics.measured.back().second, (ui::Font{ui::FontFace::System, 14}));
}

TEST_F(PallaxPaneControllerTest, WithoutTheSavePermissionTheToolbarEndsWithTheSpace) {
    const PaneRef pane = makePane(nullptr);
    pane->createToolbarItems();
    ASSERT_EQ(pane->toolbarItems().size(), 3U);
    EXPECT_TRUE(std::holds_alternative<ui::FlexibleSpace>(pane->toolbarItems()[2]));
}

TEST_F(PallaxPaneControllerTest, TheSavePermissionIsCheckedEachTimeTheToolbarIsBuilt) {
    const PaneRef pane = makePane(nullptr);
    pane->createToolbarItems();
    application.saveAllowed = true;
    pane->createToolbarItems();
    EXPECT_EQ(pane->toolbarItems().size(), 4U);
}

TEST_F(PallaxPaneControllerTest, TheSaveButtonsActionIsTheApplicationsShowSaveView) {
    application.saveAllowed = true;
    const PaneRef pane = makePane(nullptr);
    pane->createToolbarItems();
    EXPECT_EQ(application.saveViewsAsked, 0);
    std::get<ui::SaveButton>(pane->toolbarItems().at(3)).action();
    EXPECT_EQ(application.saveViewsAsked, 1);
}

TEST_F(PallaxPaneControllerTest, SetStatusStoresStatusAndFlagAndRebuildsTheToolbar) {
    const PaneRef pane = makePane(nullptr);
    pane->setStatus("Connecting...", true);
    EXPECT_EQ(statusOf(*pane).text, "Connecting...");
    EXPECT_TRUE(spinnerOf(*pane).isSpinning);
    pane->setStatus("Updated", false);
    EXPECT_EQ(statusOf(*pane).text, "Updated");
    EXPECT_FALSE(spinnerOf(*pane).isSpinning);
}

TEST_F(PallaxPaneControllerTest, ANullStatusIsStoredAsAnEmptyOne) {
    const PaneRef pane = makePane(nullptr);
    pane->setStatus("Updated", false);
    pane->setStatus(std::nullopt, true);
    EXPECT_EQ(statusOf(*pane).text, "");
    EXPECT_TRUE(spinnerOf(*pane).isSpinning);
}

TEST_F(PallaxPaneControllerTest, ViewWillAppearCallsOnThenShowsTitleAndToolbar) {
    const PaneRef pane = shownPane();
    pane->viewWillAppear(true);
    EXPECT_EQ(toolkit.take(),
              (ScreenDiary{"screen 1 willAppear animated=true", "screen 1 titleChanged",
                           "stack showToolbar", "screen 1 toolbarItemsChanged animated=true"}));
    EXPECT_EQ(pane->title(), "Serving Cell");
    EXPECT_EQ(pane->toolbarItems().size(), 3U);
}

TEST_F(PallaxPaneControllerTest, ViewWillDisappearGivesUpFirstResponderAndDoesNotCallOn) {
    const PaneRef pane = shownPane();
    pane->viewWillDisappear(true);
    EXPECT_EQ(toolkit.take(), ScreenDiary{"screen 1 resignFirstResponder"});
}

TEST_F(PallaxPaneControllerTest, APaneWithoutANodeHasNoRowsAndTheTitlePallax) {
    const PaneRef pane = makePane(nullptr);
    putOnStack(pane);
    pane->viewWillAppear(false);
    EXPECT_EQ(pane->title(), "Pallax");
    EXPECT_EQ(pane->numberOfRows(), 0U);
    EXPECT_EQ(pane->cellForRow(0), nullptr);
    EXPECT_EQ(pane->pane().row(0).name, "");
}

TEST_F(PallaxPaneControllerTest, ANodeWithoutChildrenGivesNoRows) {
    EXPECT_EQ(makePane(leafNode("ARFCN", "17"))->numberOfRows(), 0U);
    EXPECT_EQ(makePane(treeNode("Empty", {}))->numberOfRows(), 0U);
}

TEST_F(PallaxPaneControllerTest, ThereIsARowForEachChild) {
    EXPECT_EQ(makePane(section("Serving Cell"))->numberOfRows(), 2U);
}

TEST_F(PallaxPaneControllerTest, ReloadReplacesTheNodeSetsTheTitleReloadsTheTableAndTheToolbar) {
    const PaneRef pane = shownPane();
    pane->reloadWithNode(treeNode("Other", {leafNode("A", "1")}));
    EXPECT_EQ(toolkit.take(), (ScreenDiary{"screen 1 titleChanged", "table 1 reloadData",
                                           "screen 1 toolbarItemsChanged animated=true"}));
    EXPECT_EQ(pane->title(), "Other");
    EXPECT_EQ(pane->numberOfRows(), 1U);
    pane->reloadWithNode(nullptr);
    EXPECT_EQ(pane->title(), "Pallax");
    EXPECT_EQ(pane->numberOfRows(), 0U);
}

TEST_F(PallaxPaneControllerTest, ReloadDoesNotChangeThePath) {
    const PaneRef pane = shownPane();
    pane->reloadWithNode(treeNode("Other", {}));
    EXPECT_EQ(pane->path(), "/Serving Cell");
}

TEST_F(PallaxPaneControllerTest, ThePaneIsTheSourceOfItsTable) {
    const PaneRef pane = makePane(section("Serving Cell"));
    EXPECT_EQ(tableOf(*pane).source.numberOfRows(), 2U);
}

TEST_F(PallaxPaneControllerTest, ALeafRowShowsNameAndValue) {
    const PaneRef pane = shownPane();
    toolkit.metrics.extents = {{"ARFCN", {60, 18}}, {"17", {20, 18}}};
    tableOf(*pane).bounds = {{2, 3}, {300, 44}};
    const auto cell = cellOf(*pane, 0);
    ASSERT_NE(cell, nullptr);
    EXPECT_EQ(cell->reuseIdentifier(), "PallaxPaneControllerCell");
    EXPECT_EQ(tableOf(*pane).dequeued, std::vector<std::string>{"PallaxPaneControllerCell"});
    EXPECT_EQ(cell->accessory(), CellAccessory::None);
    EXPECT_EQ(cell->key()->text, "ARFCN");
    EXPECT_EQ(cell->key()->frame, (Rect{{12, 13}, {60, 18}}));
    ASSERT_NE(cell->value(), nullptr);
    EXPECT_EQ(cell->value()->text, "17");
    EXPECT_EQ(cell->value()->frame, (Rect{{280, 13}, {20, 18}}));
    EXPECT_EQ(cell->view()->frame, (Rect{{2, 3}, {300, 50}}));
}

TEST_F(PallaxPaneControllerTest, ABranchRowShowsItsNameAndADisclosureIndicator) {
    const PaneRef pane = shownPane();
    toolkit.metrics.extents = {{"Neighbours", {90, 18}}};
    const auto cell = cellOf(*pane, 1);
    ASSERT_NE(cell, nullptr);
    EXPECT_EQ(cell->reuseIdentifier(), "PallaxPaneControllerCell");
    EXPECT_EQ(cell->accessory(), CellAccessory::DisclosureIndicator);
    EXPECT_EQ(cell->key()->text, "Neighbours");
    EXPECT_EQ(cell->key()->frame, (Rect{{10, 13}, {90, 18}}));
    EXPECT_EQ(cell->value(), nullptr);
    EXPECT_EQ(cell->view(), nullptr);
}

TEST_F(PallaxPaneControllerTest, AnEmptyBranchIsABranchRow) {
    const PaneRef pane = makePane(treeNode("Pallax", {treeNode("Empty", {})}));
    EXPECT_EQ(cellOf(*pane, 0)->accessory(), CellAccessory::DisclosureIndicator);
}

TEST_F(PallaxPaneControllerTest, AReusedBranchCellMayShowALeafWithoutItsValue) {
    const PaneRef pane = shownPane();
    const auto branch = cellOf(*pane, 1);
    tableOf(*pane).spare = {branch};
    const auto cell = cellOf(*pane, 0);
    EXPECT_EQ(cell, branch);
    EXPECT_EQ(cell->accessory(), CellAccessory::None);
    EXPECT_EQ(cell->key()->text, "ARFCN");
    EXPECT_EQ(cell->key()->frame, (Rect{{10, 13}, {45, 18}}));
    EXPECT_EQ(cell->value(), nullptr);
    EXPECT_EQ(cell->view(), nullptr);
}

TEST_F(PallaxPaneControllerTest, AReusedLeafCellMayShowABranchAndKeepsItsScrollContainer) {
    const PaneRef pane = shownPane();
    toolkit.metrics.extents = {{"ARFCN", {200, 18}}, {"17", {100, 18}}};
    const auto leaf = cellOf(*pane, 0);
    const Rect valueFrame = leaf->value()->frame;
    tableOf(*pane).spare = {leaf};
    const auto cell = cellOf(*pane, 1);
    EXPECT_EQ(cell, leaf);
    EXPECT_EQ(cell->accessory(), CellAccessory::DisclosureIndicator);
    EXPECT_EQ(cell->key()->text, "Neighbours");
    EXPECT_EQ(cell->key()->frame, (Rect{{10, 13}, {90, 18}}));
    ASSERT_NE(cell->value(), nullptr);
    EXPECT_EQ(cell->value()->text, "");
    EXPECT_EQ(cell->value()->frame, valueFrame);
    ASSERT_NE(cell->view(), nullptr);
    EXPECT_EQ(cell->view()->contentSize, (ui::Size{620, 50})) << "320 + 200 + 100, as before";
}

TEST_F(PallaxPaneControllerTest, AReusedCellOfTheSameKindShowsTheOtherNode) {
    const PaneRef pane = makePane(treeNode("Pallax", {leafNode("A", "1"), leafNode("B", "2")}));
    const auto first = cellOf(*pane, 0);
    tableOf(*pane).spare = {first};
    const auto second = cellOf(*pane, 1);
    EXPECT_EQ(second, first);
    EXPECT_EQ(second->key()->text, "B");
    EXPECT_EQ(second->value()->text, "2");
}

TEST_F(PallaxPaneControllerTest, ANewCellGetsTheTablesContentAreaWithAnyAccessory) {
    const PaneRef pane = shownPane();
    tableOf(*pane).bounds = {{0, 0}, {500, 44}};
    for (const std::size_t row : {0U, 1U}) {
        EXPECT_EQ(cellOf(*pane, row)->contentBounds(), (Rect{{0, 0}, {500, 44}}));
    }
}

TEST_F(PallaxPaneControllerTest, ACellAskedForAgainIsLaidOutForTheWidthThatThereIsNow) {
    const PaneRef pane = shownPane();
    const auto cell = cellOf(*pane, 0);
    tableOf(*pane).bounds = {{0, 0}, {500, 44}};
    EXPECT_EQ(cell->view()->frame, (Rect{{0, 0}, {320, 50}}));
    EXPECT_EQ(cellOf(*pane, 0)->view()->frame, (Rect{{0, 0}, {500, 50}}));
}

TEST_F(PallaxPaneControllerTest, AReusedCellKeepsTheContentAreaThatTheTableGaveIt) {
    const PaneRef pane = shownPane();
    const auto cell = cellOf(*pane, 0);
    cell->setContentBounds({{0, 0}, {600, 60}});
    tableOf(*pane).spare = {cell};
    EXPECT_EQ(cellOf(*pane, 0)->contentBounds(), (Rect{{0, 0}, {600, 60}}));
    EXPECT_EQ(cell->view()->frame, (Rect{{0, 0}, {600, 50}}));
}

TEST_F(PallaxPaneControllerTest, SelectingANullIndexPathIsIgnored) {
    const PaneRef pane = shownPane();
    pane->didSelectRow(std::nullopt);
    EXPECT_EQ(toolkit.take(), ScreenDiary{});
}

TEST_F(PallaxPaneControllerTest, SelectingARowThatIsGoneIsIgnored) {
    const PaneRef pane = shownPane();
    pane->didSelectRow(2);
    EXPECT_EQ(toolkit.take(), ScreenDiary{});
}

TEST_F(PallaxPaneControllerTest, SelectingALeafOnlyDeselectsItWithoutAnimation) {
    const PaneRef pane = shownPane();
    pane->didSelectRow(0);
    EXPECT_EQ(toolkit.take(), ScreenDiary{"table 1 deselectRow 0 animated=false"});
    EXPECT_EQ(application.stack->screens().size(), 1U);
}

TEST_F(PallaxPaneControllerTest, SelectingABranchPushesAPaneWithTheBranchsNameAndTheSameStatus) {
    for (const bool loading : {true, false}) {
        const PaneRef pane = shownPane();
        pane->setStatus("status here", loading);
        toolkit.take();
        pane->didSelectRow(1);
        const ScreenDiary diary = toolkit.take();
        EXPECT_EQ(std::count(diary.begin(), diary.end(), "stack push animated=true"), 1);
        ASSERT_EQ(application.stack->screens().size(), 2U);
        EXPECT_EQ(top().title(), "Neighbours");
        EXPECT_EQ(top().path(), "/Serving Cell/Neighbours");
        EXPECT_EQ(top().numberOfRows(), 1U);
        EXPECT_EQ(statusOf(top()).text, "status here");
        EXPECT_EQ(spinnerOf(top()).isSpinning, loading);
    }
}

TEST_F(PallaxPaneControllerTest, APushedPanesPathIsTheChildsKeyInThePathDictionary) {
    PathDictionary paths;
    const NodeRef root = PallaxModelNode::makeTreeFromObject(
        Dictionary{
            {"a/b", Dictionary{{"_sorted", "1"}, {"1;x", Array{PropertyList(Array{"leaf"})}}}}},
        paths);
    putOnStack(makePane(root, "/"));
    for (const char* path : {"/a/b", "/a/b/x", "/a/b/x/0"}) {
        auto& pane = dynamic_cast<PallaxPaneController&>(application.stack->top());
        pane.didSelectRow(0);
        EXPECT_EQ(top().path(), path);
        ASSERT_TRUE(paths.contains(path));
        EXPECT_EQ(top().title(), paths.at(path)->displayName());
    }
}

} // namespace
} // namespace pallax
