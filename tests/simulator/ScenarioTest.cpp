#include "simulator/Scenario.h"

#include "simulator/ReportMix.h"
#include "simulator/lte/LteModem.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <cmath>
#include <set>

namespace pallax {
namespace {

constexpr int kMinute = 300; // steps

TEST(Random, IsTheSameOnEveryMachine) {
    Random random(1);
    EXPECT_EQ(random.next(), 12966619160104079557U);
    EXPECT_EQ(random.next(), 9600361134598540522U);
    EXPECT_EQ(random.next(), 10590380919521690900U);
}

TEST(Random, ItsNormalNumbersHaveMeanZeroAndDeviationOneAndABound) {
    Random random(7);
    constexpr int kCount = 100000;
    double sum = 0;
    double squares = 0;
    for (int count = 0; count < kCount; ++count) {
        const double number = random.normal();
        ASSERT_LE(std::abs(number), 3.5);
        sum += number;
        squares += number * number;
    }
    EXPECT_NEAR(sum / kCount, 0, 0.02);
    EXPECT_NEAR(squares / kCount, 1, 0.02);
}

TEST(Route, IsClosedAndGoesOnInSmallSteps) {
    for (std::uint64_t seed = 0; seed < 20; ++seed) {
        Random random(seed);
        const Route route(random);
        EXPECT_GT(route.length_m(), 5000);
        const auto gap = [&](double from_m, double to_m) {
            const PlanePoint from = route.at(from_m);
            const PlanePoint to = route.at(to_m);
            return std::hypot(from.x_m - to.x_m, from.y_m - to.y_m);
        };
        for (double place_m = 0; place_m < 2 * route.length_m(); place_m += 10) {
            EXPECT_LE(gap(place_m, place_m + 10), 10.001) << place_m;
        }
        EXPECT_LT(gap(0, route.length_m()), 0.001);
    }
}

TEST(Scenario, ACellIsLeftOnlyForOneThatIsBetter) {
    for (std::uint64_t seed = 0; seed < 20; ++seed) {
        Scenario scenario(LteModem::plan(), seed);
        const RadioLayer& layer = scenario.layer(0);
        int changes = 0;
        for (int step = 0; step < 10 * kMinute; ++step) {
            const std::size_t before = layer.camped();
            scenario.step();
            if (layer.camped() != before) {
                ++changes;
                EXPECT_TRUE(scenario.hasNewServingCell());
                EXPECT_GE(layer.campedLevel_dbm(), layer.level_dbm(before) + 3);
            }
            EXPECT_EQ(
                std::count(layer.neighbours().begin(), layer.neighbours().end(), layer.camped()),
                0);
            EXPECT_TRUE(std::is_sorted(layer.neighbours().begin(), layer.neighbours().end(),
                                       [&](std::size_t a, std::size_t b) {
                                           return layer.level_dbm(a) > layer.level_dbm(b);
                                       }));
        }
        EXPECT_TRUE(changes >= 4 && changes <= 150) << changes << " in ten minutes";
    }
}

TEST(Scenario, LevelsMoveSmoothly) {
    constexpr double kLargestStepDb = 4;
    Scenario scenario(LteModem::plan(), 11);
    const RadioLayer& layer = scenario.layer(0);
    std::vector<double> before;
    for (int step = 0; step < 10 * kMinute; ++step) {
        before.clear();
        for (std::size_t cell = 0; cell < layer.cells().size(); ++cell) {
            before.push_back(layer.level_dbm(cell));
        }
        scenario.step();
        for (std::size_t cell = 0; cell < layer.cells().size(); ++cell) {
            EXPECT_LE(std::abs(layer.level_dbm(cell) - before[cell]), kLargestStepDb);
        }
    }
}

TEST(Scenario, NoTwoCellsOfALayerShareACode) {
    const Scenario scenario(LteModem::plan(), 3);
    for (std::size_t layer = 0; layer < LteModem::plan().layers.size(); ++layer) {
        std::set<unsigned> codes;
        for (const Cell& cell : scenario.layer(layer).cells()) {
            codes.insert(cell.code);
        }
        EXPECT_EQ(codes.size(), scenario.layer(layer).cells().size());
    }
}

TEST(Scenario, APhoneRegistersBeforeItsFirstSessionAndRestsBetweenSessions) {
    using Phase = Activity::Phase;
    for (std::uint64_t seed = 0; seed < 50; ++seed) {
        Scenario scenario(LteModem::plan(), seed);
        std::vector<Phase> phases = {scenario.activity().phase()};
        for (int step = 0; step < 3 * kMinute; ++step) {
            scenario.step();
            if (scenario.activity().hasChanged()) {
                phases.push_back(scenario.activity().phase());
            }
            const double load = scenario.activity().load();
            EXPECT_EQ(load > 0, scenario.activity().isConnected());
            EXPECT_LE(load, 1);
        }
        const std::vector<Phase> start(phases.begin(), phases.begin() + 4);
        EXPECT_EQ(start, (std::vector<Phase>{Phase::Off, Phase::Searching, Phase::Registering,
                                             Phase::Idle}));
        EXPECT_GE(std::count(phases.begin(), phases.end(), Phase::Connected), 2);
        for (std::size_t index = 1; index < phases.size(); ++index) {
            if (phases[index] == Phase::Connected) {
                EXPECT_EQ(phases[index - 1], Phase::Connecting);
            }
        }
    }
}

TEST(ReportMix, GivesEachKindItsShareAndNoneWithoutOne) {
    ReportMix<4> mix;
    std::array<int, 4> counts{};
    for (int count = 0; count < 1000; ++count) {
        ++counts[mix.next({70, 0, 20, 10})];
    }
    EXPECT_EQ(counts, (std::array<int, 4>{700, 0, 200, 100}));
}

} // namespace
} // namespace pallax
