#include "web/SeriesJson.h"

#include "tests/doubles/Property.h"

#include <gtest/gtest.h>
#include <nlohmann/json.hpp>

#include <algorithm>
#include <cmath>
#include <limits>

namespace pallax {
namespace {

using namespace std::chrono_literals;

constexpr Time kStart = Time(1700000001s);

std::vector<Time> ticksEvery2s(std::size_t count) {
    std::vector<Time> ticks;
    for (std::size_t index = 0; index < count; ++index) {
        ticks.push_back(kStart + 2s * static_cast<int>(index));
    }
    return ticks;
}

const SeriesRange kAll{Time(0s), Time(2000000000s), 1000};

TEST(SeriesJson, HasTheValueThatHoldsAtEachTick) {
    HeldSeries rsrp;
    rsrp.add(1, -94.5);
    rsrp.add(3, NAN);
    rsrp.add(4, -80.25);
    HeldSeries none;
    EXPECT_EQ(seriesJson(ticksEvery2s(5), std::vector<const HeldSeries*>{&rsrp, &none}, kAll),
              "{\"times\":[1700000001,1700000003,1700000005,1700000007,1700000009],"
              "\"values\":[[null,-94.5,-94.5,null,-80.25],[null,null,null,null,null]]}");
}

TEST(SeriesJson, OfARangeBeginsWithWhatHeldBefore) {
    HeldSeries rsrp;
    rsrp.add(0, -94.5);
    const std::vector<const HeldSeries*> series{&rsrp};
    EXPECT_EQ(seriesJson(ticksEvery2s(5), series, {kStart + 3s, kStart + 6s, 1000}),
              "{\"times\":[1700000005,1700000007],\"values\":[[-94.5,-94.5]]}");
    EXPECT_EQ(seriesJson(ticksEvery2s(5), series, {kStart + 6s, kStart + 3s, 1000}),
              "{\"times\":[],\"values\":[[]]}");
    EXPECT_EQ(seriesJson({}, {}, kAll), "{\"times\":[],\"values\":[]}");
}

TEST(SeriesJson, TimesAscendWhereTheClockWasSetBack) {
    HeldSeries rsrp;
    rsrp.add(0, -1);
    rsrp.add(2, -2);
    rsrp.add(3, -3);
    EXPECT_EQ(seriesJson({kStart, kStart + 10s, kStart + 4s, kStart + 12s},
                         std::vector<const HeldSeries*>{&rsrp}, kAll),
              "{\"times\":[1700000001,1700000011,1700000013],\"values\":[[-1,-1,-3]]}");
}

TEST(SeriesJson, OfAStretchHasItsTicksAlone) {
    HeldSeries rsrp;
    rsrp.add(0, -1);
    rsrp.add(2, -2);
    rsrp.add(3, -3);
    const std::vector<Time> ticks{kStart, kStart + 2s, kStart, kStart + 2s};
    const std::vector<const HeldSeries*> series{&rsrp};
    SeriesRange range = kAll;
    range.end = 2;
    EXPECT_EQ(seriesJson(ticks, series, range),
              "{\"times\":[1700000001,1700000003],\"values\":[[-1,-1]]}");
    range.first = 2;
    range.end = 4;
    EXPECT_EQ(seriesJson(ticks, series, range),
              "{\"times\":[1700000001,1700000003],\"values\":[[-2,-3]]}");
}

TEST(SeriesJson, HasAHoleWhereTimeIsMissing) {
    HeldSeries rsrp;
    rsrp.add(0, -1);
    rsrp.add(2, -2);
    const std::vector<const HeldSeries*> series{&rsrp};
    const std::vector<Time> ticks{kStart, kStart + 2s, kStart + 13s, kStart + 15s};
    const char* drawn = "{\"times\":[1700000001,1700000003,1700000003.001,1700000014,1700000016],"
                        "\"values\":[[-1,-1,null,-2,-2]]}";
    EXPECT_EQ(seriesJson(ticks, series, kAll), drawn);
    EXPECT_EQ(seriesJson(ticks, series, {Time(0s), Time(2000000000s), 2}), drawn)
        << "also between runs of ticks";
}

TEST(SeriesJson, OfManyTicksNoPeakIsLost) {
    EXPECT_TRUE(doubles::holds([] {
        namespace any = doubles::any;
        const auto count = static_cast<std::uint32_t>(any::between(1, 500));
        const std::size_t points = static_cast<std::size_t>(any::between(0, 60));
        HeldSeries series;
        std::vector<double> values;
        for (std::uint32_t tick = 0; tick < count; ++tick) {
            values.push_back(any::between(-140, -40));
            series.add(tick, values.back());
        }
        const auto parsed = nlohmann::json::parse(
            seriesJson(ticksEvery2s(count), std::vector<const HeldSeries*>{&series},
                       {Time(0s), Time(2000000000s), points}));
        const auto times = parsed["times"].get<std::vector<double>>();
        const auto drawn = parsed["values"][0].get<std::vector<double>>();
        RC_ASSERT(times.size() == drawn.size());
        RC_ASSERT(times.size() <= std::max<std::size_t>(points, 2) + 2);
        RC_ASSERT(std::adjacent_find(times.begin(), times.end(), std::greater_equal<>()) ==
                  times.end());
        RC_ASSERT(*std::min_element(drawn.begin(), drawn.end()) ==
                  *std::min_element(values.begin(), values.end()));
        RC_ASSERT(*std::max_element(drawn.begin(), drawn.end()) ==
                  *std::max_element(values.begin(), values.end()));
    }));
}

} // namespace
} // namespace pallax
