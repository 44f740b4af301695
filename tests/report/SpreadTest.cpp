#include "report/Spread.h"

#include "tests/doubles/Property.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <cmath>
#include <vector>

namespace pallax {
namespace {

namespace any = doubles::any;

TEST(Spread, WeighsEachValueByItsTime) {
    Spread spread;
    spread.add(-100, 1);
    spread.add(-90, 8);
    spread.add(-80, 1);
    EXPECT_EQ(spread.total(), 10);
    EXPECT_EQ(spread.least(), -100);
    EXPECT_EQ(spread.most(), -80);
    EXPECT_EQ(spread.quantile(0.05), -100);
    EXPECT_EQ(spread.quantile(0.5), -90);
    EXPECT_EQ(spread.quantile(0.95), -80);
}

TEST(Spread, SharesAreTheBestGradeFirst) {
    Spread spread;
    spread.add(-85, 3); // the border belongs to the better grade
    spread.add(-100, 6);
    spread.add(-130, 1);
    const Borders borders{{{Grade::Excellent, -85}, {Grade::Fair, -105}, {Grade::Poor, -115}}};
    const auto shares = spread.shares(borders);
    ASSERT_EQ(shares.size(), 4U);
    EXPECT_EQ(shares[0].grade, Grade::Excellent);
    EXPECT_EQ(shares[0].share, 0.3);
    EXPECT_EQ(shares[1].grade, Grade::Fair);
    EXPECT_EQ(shares[1].share, 0.6);
    EXPECT_EQ(shares[2].grade, Grade::Poor);
    EXPECT_EQ(shares[2].share, 0);
    EXPECT_EQ(shares[3].grade, Grade::None);
    EXPECT_EQ(shares[3].share, 0.1);
}

TEST(Spread, LeavesOutWhatIsNoValueOrNoTime) {
    Spread spread;
    spread.add(NAN, 1);
    spread.add(-80, 0);
    spread.add(-80, -1);
    EXPECT_TRUE(spread.isEmpty());
    spread.add(1e300, 1);
    EXPECT_EQ(spread.most(), 10000) << "numbers that nothing measures are limited";
}

TEST(Spread, AgreesWithSortedValues) {
    EXPECT_TRUE(doubles::holds([] {
        Spread spread;
        std::vector<double> seconds; // a value for each second
        const int count = any::between(1, 60);
        for (int i = 0; i < count; ++i) {
            const double value = any::between(-500, 500) / 4.0;
            const int held = any::between(1, 5);
            spread.add(value, held);
            seconds.insert(seconds.end(), static_cast<std::size_t>(held), value);
        }
        std::sort(seconds.begin(), seconds.end());
        const double share = any::between(1, 100) / 100.0;
        const auto place = static_cast<std::size_t>(
            std::ceil(share * static_cast<double>(seconds.size()) - 1e-9));
        RC_ASSERT(spread.quantile(share) == seconds[place - 1] ||
                  spread.quantile(share) == seconds[std::min(place, seconds.size() - 1)]);
    }));
}

} // namespace
} // namespace pallax
