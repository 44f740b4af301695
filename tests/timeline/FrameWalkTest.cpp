#include "timeline/FrameWalk.h"

#include "tests/timeline/TimelineFixture.h"

#include <gtest/gtest.h>

#include <string>

namespace pallax {
namespace {

namespace any = doubles::any;

/// A line for each leaf.
std::string leavesOf(const FrameRef& frame) {
    std::string text;
    if (frame == nullptr) {
        return "none";
    }
    const auto add = [&](const auto& self, const PallaxModelNode& node,
                         const std::string& path) -> void {
        if (node.value() != nullptr) {
            text += path + " " + node.value()->description() + "\n";
        }
        if (node.childNodes() != nullptr) {
            for (const NodeRef& child : *node.childNodes()) {
                self(self, *child, childPath(path, child->displayName()));
            }
        }
    };
    if (frame->root() != nullptr) {
        add(add, *frame->root(), "/");
    }
    return text;
}

class FrameWalkTest : public testing::TestWithParam<const char*> {};

INSTANTIATE_TEST_SUITE_P(All, FrameWalkTest, testing::ValuesIn(technologyNames()));

/// A new walk has decoded nothing on the way.
TEST_P(FrameWalkTest, TheWayToAnInstantDoesNotMatter) {
    EXPECT_TRUE(doubles::holds([] {
        TimelineFixture fixture(GetParam());
        fixture.drive(any::bits(), std::chrono::seconds(any::between(1, 30)), 20);
        const auto timeline = fixture.indexed(
            TimelineFixture::closeKeyFrames(static_cast<std::uint64_t>(any::between(100, 600))));
        FrameWalk walk(*timeline);
        for (int steps = any::between(1, 8); steps > 0; --steps) {
            const std::uint64_t instant = any::index(fixture.journal.size() + 1);
            const auto frame = walk.at(instant);
            const auto expected = FrameWalk(*timeline).at(instant);
            RC_ASSERT(frame.has_value() == expected.has_value());
            if (frame) {
                RC_ASSERT(leavesOf(frame->frame) == leavesOf(expected->frame));
                RC_ASSERT(leavesOf(frame->before) == leavesOf(expected->before));
                RC_ASSERT(frame->frame->time() == expected->frame->time());
                RC_ASSERT(frame->frame->changed() == expected->frame->changed());
            }
        }
    }));
}

TEST(FrameWalk, AStepBackDecodesLittle) {
    TimelineFixture fixture("lte");
    fixture.drive(1, std::chrono::seconds(200));
    const auto timeline = fixture.indexed(TimelineFixture::closeKeyFrames(100000));
    FrameWalk walk(*timeline);
    (void)walk.at(7000);
    const std::uint64_t given = fixture.journal.given();
    (void)walk.at(6990);
    // The stamps are read from the key frame on, to find the tick before.
    EXPECT_LT(fixture.journal.given() - given, 7000U + 1000U);
}

} // namespace
} // namespace pallax
