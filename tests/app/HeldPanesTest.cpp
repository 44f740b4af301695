#include "app/HeldPanes.h"

#include "tests/app/PaneFixture.h"

#include <gtest/gtest.h>

#include <memory>
#include <string>

namespace pallax {
namespace {

using doubles::PaneFixture;

FrameRef frameOf(const PropertyList& display, const Frame* before = nullptr) {
    const auto paths = std::make_shared<PathDictionary>();
    NodeRef root = PallaxModelNode::makeTreeFromObject(display, *paths);
    return std::make_shared<Frame>(Frame::Picture{std::move(root), paths, Time()}, before, nullptr);
}

PropertyList displayOf(const char* level) {
    return Dictionary{{"Cell", Dictionary{{"Level", level}, {"Name", "A"}}}, {"Other", "1"}};
}

class HeldPanesTest : public PaneFixture {
protected:
    /// The live panes: the root and a section.
    HeldPanesTest() {
        const FrameRef live = frameOf(displayOf("-80"));
        putOnStack(makePane(live->root()));
        application.stack->push(makePane(live->nodeAtPath("/Cell"), "/Cell"), false);
    }
    static PaneModel& pane(ui::NavigationStack& stack, std::size_t index) {
        return dynamic_cast<PallaxPaneController&>(*stack.screens().at(index)).pane();
    }
};

TEST_F(HeldPanesTest, BeginWithTheLivePanesAndLeaveThemAlone) {
    pane(*application.stack, 1).setFilter("level");
    HeldPanes held(toolkit, *application.stack);
    held.show(frameOf(displayOf("-90")), nullptr);
    ASSERT_EQ(held.stack().screens().size(), 2U);
    EXPECT_EQ(held.stack().screens()[1]->title(), "Cell");
    EXPECT_EQ(pane(held.stack(), 1).filter(), "level");
    EXPECT_EQ(pane(held.stack(), 1).row(0).text, "-90");
    EXPECT_EQ(pane(*application.stack, 1).row(0).text, "-80");
    held.stack().popTo(0, false);
    EXPECT_EQ(application.stack->screens().size(), 2U);
}

TEST_F(HeldPanesTest, WhatDiffersFromTheFrameBeforeHasChanged) {
    HeldPanes held(toolkit, *application.stack);
    const FrameRef before = frameOf(displayOf("-80"));
    held.show(frameOf(displayOf("-90"), before.get()), before);
    EXPECT_TRUE(pane(held.stack(), 1).row(0).hasChanged);
    EXPECT_FALSE(pane(held.stack(), 1).row(1).hasChanged);
}

TEST_F(HeldPanesTest, APaneThatTheFrameDoesNotHaveIsEmptyAndStays) {
    HeldPanes held(toolkit, *application.stack);
    held.show(frameOf(Dictionary{{"Other", "1"}}), nullptr);
    ASSERT_EQ(held.stack().screens().size(), 2U);
    EXPECT_EQ(held.stack().screens()[1]->title(), "Cell");
    EXPECT_EQ(pane(held.stack(), 1).totalRows(), 0U);
    held.show(nullptr, nullptr);
    EXPECT_EQ(pane(held.stack(), 0).totalRows(), 0U);
}

TEST_F(HeldPanesTest, OpeningARowAddsAPaneOfTheFrame) {
    HeldPanes held(toolkit, *application.stack);
    held.show(frameOf(displayOf("-90")), nullptr);
    held.stack().popTo(0, false);
    auto& root = dynamic_cast<PallaxPaneController&>(*held.stack().screens()[0]);
    root.didSelectRow(0);
    ASSERT_EQ(held.stack().screens().size(), 2U);
    EXPECT_EQ(pane(held.stack(), 1).row(0).text, "-90");
    EXPECT_TRUE(application.stack->screens().size() == 2U);
}

} // namespace
} // namespace pallax
