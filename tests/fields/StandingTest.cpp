#include "fields/Standing.h"

#include <gtest/gtest.h>

#include <array>
#include <cmath>

namespace pallax {
namespace {

constexpr auto kLabels = std::to_array<std::string_view>({"Idle", "Camped"});

FieldInfo labelled(const Conversion& conversion) {
    FieldInfo field;
    field.labelled = {conversion};
    return field;
}

TEST(StandingTest, ANumberOutsideItsRangeSaysSo) {
    FieldInfo field;
    EXPECT_EQ(standingOf(field, "700", 700, 700), Standing::Value); // nothing limits it
    field.least = 0;
    field.most = 511;
    EXPECT_EQ(standingOf(field, "0", 0, 0), Standing::Value);
    EXPECT_EQ(standingOf(field, "511", 511, 511), Standing::Value);
    EXPECT_EQ(standingOf(field, "512", 512, 512), Standing::OutOfRange);
    EXPECT_EQ(standingOf(field, "-1", -1, -1), Standing::OutOfRange);
}

TEST(StandingTest, ANumberWithoutALabelIsOutOfRange) {
    const FieldInfo field = labelled(Conversion::label(kLabels));
    EXPECT_EQ(standingOf(field, "Camped", NAN, 1), Standing::Value);
    EXPECT_EQ(standingOf(field, "Unknown", NAN, 2), Standing::OutOfRange);
}

TEST(StandingTest, ANumberThatAnotherRowKnowsIsAValue) {
    FieldInfo field = labelled(Conversion::label(kLabels));
    field.labelled.push_back(Conversion::flag("On", "Off"));
    EXPECT_EQ(standingOf(field, "On", NAN, 2), Standing::Value);
}

TEST(StandingTest, AFlagAndALabelThatHasTheWordForOtherNumbersAreValues) {
    EXPECT_EQ(standingOf(labelled(Conversion::flag("On", "Off")), "Off", NAN, 0), Standing::Value);
    EXPECT_EQ(standingOf(labelled(Conversion::flag("On", "Off")), "On", NAN, 7), Standing::Value);
    EXPECT_EQ(standingOf(labelled(Conversion::label(kLabels, "Idle")), "Idle", NAN, 5),
              Standing::Value);
}

TEST(StandingTest, TheNumberThatMeansThatThereIsNoneIsNotApplicable) {
    const FieldInfo field = labelled(Conversion::number().except(64, "Not Present"));
    EXPECT_EQ(standingOf(field, "Not Present", NAN, 64), Standing::NotApplicable);
    EXPECT_EQ(standingOf(field, "63", 63, 63), Standing::Value);
}

TEST(StandingTest, WhatIsShownWhileTheFieldDoesNotApplySaysSo) {
    FieldInfo field;
    field.otherwise = {"N/A"};
    EXPECT_EQ(standingOf(field, "N/A", NAN, {}), Standing::NotApplicable);
    EXPECT_EQ(standingOf(field, "Camped", NAN, {}), Standing::Value);
}

TEST(StandingTest, OnlyWhatIsNoValueHasAName) {
    EXPECT_EQ(nameOf(Standing::Value), "");
    EXPECT_EQ(nameOf(Standing::NotApplicable), "not applicable");
    EXPECT_EQ(nameOf(Standing::OutOfRange), "out of range");
}

} // namespace
} // namespace pallax
