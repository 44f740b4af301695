#include "app/PallaxCell.h"

#include "tests/doubles/FakeTextMetrics.h"

#include <gtest/gtest.h>

#include <memory>

namespace pallax {
namespace {

using doubles::FakeTextMetrics;
using ui::Rect;
using ui::Size;

constexpr ui::Font kBold15{ui::FontFace::BoldSystem, 15};
constexpr ui::Font kRegular15{ui::FontFace::System, 15};

class PallaxCellTest : public testing::Test {
protected:
    /// A leaf cell after layout, with "key" of 60 x 18 and "value" of 90 x 20 points.
    std::unique_ptr<PallaxCell> leaf(const Rect& bounds) {
        auto made = make(PallaxCell::Kind::Leaf, bounds);
        made->key()->text = "key";
        made->value()->text = "value";
        made->setLayout();
        return made;
    }
    std::unique_ptr<PallaxCell> branch(const Rect& bounds) {
        auto made = make(PallaxCell::Kind::Branch, bounds);
        made->key()->text = "key";
        return made;
    }
    std::unique_ptr<PallaxCell> make(PallaxCell::Kind kind, const Rect& bounds) {
        auto made = std::make_unique<PallaxCell>(kind, "PallaxPaneControllerCell", metrics);
        made->setContentBounds(bounds);
        return made;
    }

    /// The extents of "key" and "value"; the row needs 60 + 10 + 50 + 90 = 210 points.
    void SetUp() override { metrics.extents = {{"key", {60, 18}}, {"value", {90, 20}}}; }

    FakeTextMetrics metrics;
};

TEST_F(PallaxCellTest, ABranchCellHasItsKeyDirectlyAndNeitherValueNorView) {
    const auto cell = branch({{0, 0}, {320, 44}});
    ASSERT_NE(cell->key(), nullptr);
    EXPECT_EQ(cell->value(), nullptr);
    EXPECT_EQ(cell->view(), nullptr);
}

TEST_F(PallaxCellTest, ALeafCellHasAViewThatHoldsKeyAndValue) {
    const auto cell = leaf({{0, 0}, {320, 44}});
    EXPECT_NE(cell->key(), nullptr);
    EXPECT_NE(cell->value(), nullptr);
    EXPECT_NE(cell->view(), nullptr);
}

TEST_F(PallaxCellTest, TheKeyIsLeftAlignedInBoldSystem15) {
    for (const auto kind : {PallaxCell::Kind::Branch, PallaxCell::Kind::Leaf}) {
        const auto cell = make(kind, {});
        EXPECT_EQ(cell->key()->font, kBold15);
        EXPECT_EQ(cell->key()->alignment, ui::TextAlignment::Left);
    }
}

TEST_F(PallaxCellTest, TheValueIsLeftAlignedInRegularSystem15) {
    const auto cell = make(PallaxCell::Kind::Leaf, {});
    EXPECT_EQ(cell->value()->font, kRegular15);
    EXPECT_EQ(cell->value()->alignment, ui::TextAlignment::Left);
}

TEST_F(PallaxCellTest, BothKindsPassTheStyleWithTitleAndDetailOn) {
    for (const auto kind : {PallaxCell::Kind::Branch, PallaxCell::Kind::Leaf}) {
        const auto cell = make(kind, {});
        EXPECT_EQ(cell->style(), ui::CellStyle::TitleAndDetail);
        EXPECT_EQ(static_cast<int>(cell->style()), 1);
        EXPECT_EQ(cell->reuseIdentifier(), "PallaxPaneControllerCell");
        EXPECT_EQ(cell->accessory(), ui::CellAccessory::None);
    }
}

TEST_F(PallaxCellTest, KeyAndValueAreRetainedWhenSet) {
    const auto cell = make(PallaxCell::Kind::Branch, {});
    auto key = std::make_shared<ui::Label>();
    auto value = std::make_shared<ui::Label>();
    cell->setKey(key);
    cell->setValue(value);
    EXPECT_EQ(cell->key(), key);
    EXPECT_EQ(cell->value(), value);
    EXPECT_EQ(key.use_count(), 2);
}

TEST_F(PallaxCellTest, WhatIsDrawnAreItsLabelsInTheirContainer) {
    const auto leafCell = leaf({{0, 0}, {320, 44}});
    EXPECT_EQ(leafCell->contents().container, leafCell->view().get());
    EXPECT_EQ(leafCell->contents().labels,
              (std::vector<const ui::Label*>{leafCell->key().get(), leafCell->value().get()}));
    const auto branchCell = branch({{0, 0}, {320, 44}});
    EXPECT_EQ(branchCell->contents().container, nullptr);
    EXPECT_EQ(branchCell->contents().labels,
              (std::vector<const ui::Label*>{branchCell->key().get()}));
    branchCell->setKey(nullptr);
    EXPECT_TRUE(branchCell->contents().labels.empty());
}

TEST_F(PallaxCellTest, BothLayoutsFirstLetTheToolkitLayOutItsOwnLabel) {
    const Rect bounds{{3, 4}, {320, 44}};
    EXPECT_EQ(leaf(bounds)->textLabel().frame, bounds);
    const auto cell = branch(bounds);
    EXPECT_EQ(cell->textLabel().frame, Rect());
    cell->setLayoutKey();
    EXPECT_EQ(cell->textLabel().frame, bounds);
}

TEST_F(PallaxCellTest, TheKeyOfABranchLies10PointsFromTheLeftAndCentred) {
    const auto cell = branch({{0, 0}, {320, 44}});
    cell->setLayoutKey();
    EXPECT_EQ(cell->key()->frame, (Rect{{10, 13}, {60, 18}}));
    EXPECT_EQ(metrics.measured, (std::vector<std::pair<std::string, ui::Font>>{{"key", kBold15}}));
}

TEST_F(PallaxCellTest, TheKeyOfABranchAddsTheXOfTheBoundsButNotTheirY) {
    const auto cell = branch({{7, 5}, {320, 44}});
    cell->setLayoutKey();
    EXPECT_EQ(cell->key()->frame, (Rect{{17, 13}, {60, 18}}));
}

TEST_F(PallaxCellTest, ATextHigherThanTheRowBeginsAboveIt) {
    const auto cell = branch({{0, 0}, {320, 11}});
    cell->setLayoutKey();
    EXPECT_EQ(cell->key()->frame, (Rect{{10, -3.5}, {60, 18}}));
}

TEST_F(PallaxCellTest, AShortValueSitsFlushWithTheRightEdge) {
    const auto cell = leaf({{0, 0}, {320, 44}});
    EXPECT_EQ(cell->key()->frame, (Rect{{10, 13}, {60, 18}}));
    EXPECT_EQ(cell->value()->frame, (Rect{{230, 12}, {90, 20}}));
    EXPECT_EQ(cell->view()->contentSize, (Size{320, 50}));
    EXPECT_EQ(cell->view()->frame, (Rect{{0, 0}, {320, 50}}));
}

TEST_F(PallaxCellTest, AFlushValueDoesNotAddTheXOfTheBounds) {
    const auto cell = leaf({{7, 5}, {320, 44}});
    EXPECT_EQ(cell->key()->frame, (Rect{{17, 13}, {60, 18}}));
    EXPECT_EQ(cell->value()->frame, (Rect{{230, 12}, {90, 20}}));
    EXPECT_EQ(cell->view()->frame, (Rect{{7, 5}, {320, 50}}));
}

TEST_F(PallaxCellTest, ALongValueFollowsTheKeyByAGapOf50AndTheRowScrollsSideways) {
    const auto cell = leaf({{0, 0}, {200, 44}});
    EXPECT_EQ(cell->value()->frame, (Rect{{120, 12}, {90, 20}}));
    EXPECT_EQ(cell->view()->contentSize, (Size{350, 50})) << "200 + 60 + 90";
    EXPECT_EQ(cell->view()->frame, (Rect{{0, 0}, {200, 50}}));
}

TEST_F(PallaxCellTest, AFollowingValueAddsTheXOfTheBounds) {
    const auto cell = leaf({{7, 5}, {200, 44}});
    EXPECT_EQ(cell->value()->frame, (Rect{{127, 12}, {90, 20}}));
    EXPECT_EQ(cell->view()->contentSize, (Size{350, 50}));
    EXPECT_EQ(cell->view()->frame, (Rect{{7, 5}, {200, 50}}));
}

TEST_F(PallaxCellTest, WhenTheNeedEqualsTheWidthTheValueFollowsButNothingScrolls) {
    const auto exact = leaf({{7, 0}, {210, 44}});
    EXPECT_EQ(exact->value()->frame, (Rect{{127, 12}, {90, 20}})) << "not flush at 120";
    EXPECT_EQ(exact->view()->contentSize, (Size{210, 50}));

    const auto wider = leaf({{7, 0}, {210.5, 44}});
    EXPECT_EQ(wider->value()->frame, (Rect{{120.5, 12}, {90, 20}}));
    EXPECT_EQ(wider->view()->contentSize, (Size{210.5, 50}));

    const auto narrower = leaf({{7, 0}, {209.5, 44}});
    EXPECT_EQ(narrower->value()->frame, (Rect{{127, 12}, {90, 20}}));
    EXPECT_EQ(narrower->view()->contentSize, (Size{359.5, 50}));
}

TEST_F(PallaxCellTest, TheValueTooIsMeasuredInBoldThoughItsLabelIsRegular) {
    metrics.extents.clear();
    const auto cell = leaf({{0, 0}, {320, 44}});
    EXPECT_EQ(metrics.measured, (std::vector<std::pair<std::string, ui::Font>>{
                                    {"key", kBold15}, {"value", kBold15}}));
    EXPECT_EQ(cell->value()->frame.size.width, 5 * FakeTextMetrics::kBoldWidth);
    EXPECT_EQ(cell->value()->font, kRegular15);
}

TEST_F(PallaxCellTest, TheViewIsAlways50PointsHigh) {
    for (const double height : {0.0, 20.0, 44.0, 400.0}) {
        const auto cell = leaf({{0, 0}, {320, height}});
        EXPECT_EQ(cell->view()->frame.size.height, 50);
        EXPECT_EQ(cell->view()->contentSize.height, 50);
    }
}

TEST_F(PallaxCellTest, ABranchCellLaidOutAsALeafPlacesItsKeyOnly) {
    const auto cell = branch({{0, 0}, {320, 44}});
    cell->setLayout();
    EXPECT_EQ(cell->key()->frame, (Rect{{10, 13}, {60, 18}}));
    EXPECT_EQ(cell->value(), nullptr);
    EXPECT_EQ(cell->view(), nullptr);
}

TEST_F(PallaxCellTest, ALeafCellLaidOutAsABranchKeepsItsViewAsItWas) {
    const auto cell = leaf({{0, 0}, {200, 44}});
    cell->setContentBounds({{2, 0}, {300, 30}});
    cell->key()->text = "other";
    metrics.extents["other"] = {80, 10};
    cell->setLayoutKey();
    EXPECT_EQ(cell->key()->frame, (Rect{{12, 10}, {80, 10}}));
    EXPECT_EQ(cell->value()->frame, (Rect{{120, 12}, {90, 20}}));
    EXPECT_EQ(cell->view()->contentSize, (Size{350, 50}));
    EXPECT_EQ(cell->view()->frame, (Rect{{0, 0}, {200, 50}}));
}

TEST_F(PallaxCellTest, WithoutAKeyLabelTheLayoutGivesItNoRoom) {
    const auto cell = make(PallaxCell::Kind::Leaf, {{0, 0}, {140, 44}});
    cell->setKey(nullptr);
    cell->value()->text = "value";
    cell->setLayout();
    EXPECT_EQ(cell->value()->frame, (Rect{{60, 12}, {90, 20}})) << "0 + 10 + 0 + 50";
    EXPECT_EQ(cell->view()->contentSize, (Size{230, 50}));
    cell->setLayoutKey();
    EXPECT_EQ(cell->key(), nullptr);
}

} // namespace
} // namespace pallax
