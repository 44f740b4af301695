#include "masking/PathActions.h"

#include "tests/masking/MaskFixture.h"

#include <gtest/gtest.h>

namespace pallax {
namespace {

TEST(PathActions, AreThoseOfThePlanAndOfKeysThatNameAnIdentity) {
    const MaskPlan plan = planFor("ifx");
    const PathActions actions(plan);
    for (int again = 0; again < 2; ++again) {
        EXPECT_EQ(actions.of({"Serving Cell", "ARFCN"}), MaskAction::Keep);
        EXPECT_EQ(actions.of({"SIM", "EF-ICCID"}), MaskAction::Mask) << "a key";
        EXPECT_EQ(actions.of({"Own Number", "*"}), MaskAction::Mask);
        EXPECT_EQ(actions.of({"SIM", "Slot"}), MaskAction::Keep);
        EXPECT_EQ(actions.of({}), MaskAction::Keep);
    }
    const MaskPlan also = planFor("ifx", {.also = {"bsic"}});
    EXPECT_EQ(PathActions(also).of({"Serving Cell", "BSIC"}), MaskAction::Mask) << "the plan";
}

TEST(PathActions, AreTheSameForMorePathsThanAreRemembered) {
    const MaskPlan plan = planFor("ifx");
    const PathActions actions(plan);
    for (std::size_t index = 0; index < PathActions::kMostRemembered + 2; ++index) {
        EXPECT_EQ(actions.of({"Any", std::to_string(index)}), MaskAction::Keep);
        EXPECT_EQ(actions.of({"IMSI", std::to_string(index)}), MaskAction::Mask);
    }
}

} // namespace
} // namespace pallax
