#include "ui/drawing/Tints.h"

#include "ui/contents/Graph.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <array>
#include <cmath>
#include <set>

namespace pallax::terminal {
namespace {

constexpr std::array kAll{Tint::Green, Tint::Blue,   Tint::Orange,
                          Tint::Red,   Tint::Purple, Tint::Violet};
constexpr int kDirect = 1 << 24;

using Numbers = std::array<double, 3>;
using Matrix = std::array<Numbers, 3>;

Numbers product(const Matrix& matrix, const Numbers& numbers) {
    Numbers result{};
    for (std::size_t row = 0; row < result.size(); ++row) {
        for (std::size_t column = 0; column < numbers.size(); ++column) {
            result.at(row) += matrix.at(row).at(column) * numbers.at(column);
        }
    }
    return result;
}

/// What eyes see, in linear red, green and blue: all colours, without the red and without the
/// green receptors (Machado, Oliveira and Fernandes 2009, severity 1).
constexpr std::array<Matrix, 3> kEyes{{{{{1, 0, 0}, {0, 1, 0}, {0, 0, 1}}},
                                       {{{0.152286, 1.052583, -0.204868},
                                         {0.114503, 0.786281, 0.099216},
                                         {-0.003882, -0.048116, 1.051998}}},
                                       {{{0.367322, 0.860646, -0.227968},
                                         {0.280085, 0.672501, 0.047413},
                                         {-0.011820, 0.042940, 0.968881}}}}};

/// From linear red, green and blue to CIE XYZ with the white point at 1.
constexpr Matrix kXyz{
    {{0.4339, 0.3762, 0.1899}, {0.2126, 0.7152, 0.0722}, {0.0177, 0.1095, 0.8728}}};

/// Linear red, green and blue of a tint.
Numbers linear(Tint tint) {
    const int color = colorOf(tint, kDirect).value();
    Numbers numbers{};
    for (std::size_t index = 0; index < numbers.size(); ++index) {
        const double part = (color >> (16 - 8 * index) & 0xFF) / 255.0;
        numbers.at(index) = part <= 0.04045 ? part / 12.92 : std::pow((part + 0.055) / 1.055, 2.4);
    }
    return numbers;
}

Numbers lab(const Matrix& eye, Tint tint) {
    Numbers seen = product(eye, linear(tint));
    for (double& part : seen) {
        part = std::clamp(part, 0.0, 1.0);
    }
    Numbers xyz = product(kXyz, seen);
    for (double& part : xyz) {
        part = part > 0.008856 ? std::cbrt(part) : 7.787 * part + 16.0 / 116;
    }
    return {116 * xyz[1] - 16, 500 * (xyz[0] - xyz[1]), 200 * (xyz[1] - xyz[2])};
}

TEST(Tints, CanBeReadOnABlackAndOnAWhiteBackground) {
    for (const Tint tint : kAll) {
        const double luminance = product(kXyz, linear(tint))[1];
        EXPECT_GT(1.05 / (luminance + 0.05), 2.8) << static_cast<int>(tint);
        EXPECT_GT((luminance + 0.05) / 0.05, 2.8) << static_cast<int>(tint);
    }
}

TEST(Tints, AreToldApartByPeopleWithColourBlindness) {
    constexpr double kLeast = 15; // CIE 1976; 2.3 can just be noticed
    for (const Matrix& eye : kEyes) {
        for (const Tint one : kAll) {
            for (const Tint other : kAll) {
                const Numbers a = lab(eye, one);
                const Numbers b = lab(eye, other);
                const double distance = std::hypot(a[0] - b[0], a[1] - b[1], a[2] - b[2]);
                EXPECT_TRUE(one == other || distance > kLeast)
                    << static_cast<int>(one) << " and " << static_cast<int>(other) << ": "
                    << distance;
            }
        }
    }
}

TEST(Tints, ATerminalGetsTheColoursThatItHas) {
    struct {
        int colors;
        std::array<std::optional<int>, 6> expected;
    } const cases[]{
        {0, {}},
        {2, {}},
        {7, {}},
        {8, {2, 6, 3, 1, 5, 4}},
        {16, {2, 6, 3, 1, 5, 4}},
        {88, {2, 6, 3, 1, 5, 4}},
        {256, {29, 32, 172, 160, 139, 63}},
        {kDirect, {0x00875F, 0x0087D7, 0xD78700, 0xD70000, 0xAF87AF, 0x5F5FFF}},
    };
    for (const auto& each : cases) {
        EXPECT_EQ(colorOf(Tint::None, each.colors), std::nullopt);
        for (std::size_t index = 0; index < kAll.size(); ++index) {
            EXPECT_EQ(colorOf(kAll.at(index), each.colors), each.expected.at(index))
                << index << " of " << each.colors;
        }
    }
}

TEST(Tints, OfGrades) {
    EXPECT_EQ(tintOf(Grade::Excellent), Tint::Green);
    EXPECT_EQ(tintOf(Grade::Good), Tint::Blue);
    EXPECT_EQ(tintOf(Grade::Fair), Tint::Orange);
    EXPECT_EQ(tintOf(Grade::Poor), Tint::Red);
    EXPECT_EQ(tintOf(Grade::None), Tint::Red);
}

TEST(Tints, TheCurvesOfAGraphDiffer) {
    std::set<Tint> tints;
    for (std::size_t index = 0; index < Graph::kMost; ++index) {
        tints.insert(tintOfCurve(index));
    }
    EXPECT_EQ(tints.size(), Graph::kMost);
    EXPECT_EQ(tints.count(Tint::None), 0U);
    EXPECT_EQ(tintOfCurve(kAll.size()), tintOfCurve(0));
}

} // namespace
} // namespace pallax::terminal
