#include "masking/Permutation.h"

#include "tests/masking/MaskFixture.h"

#include <set>

namespace pallax {
namespace {

TEST(Permutation, GivesEachNumberOfARangeItsOwn) {
    const Permutation permutation(keyed(1));
    for (const unsigned width : {1U, 8U, 12U}) {
        std::set<std::uint64_t> results;
        const std::uint64_t count = std::uint64_t{1} << width;
        for (std::uint64_t number = 0; number < count; ++number) {
            const std::uint64_t result = permutation.of(number, width);
            EXPECT_LT(result, count);
            results.insert(result);
        }
        EXPECT_EQ(results.size(), count);
    }
}

TEST(Permutation, KeepsTheNumberOfDecimalDigits) {
    const Permutation permutation(keyed(1));
    std::set<std::uint64_t> results;
    for (std::uint64_t number = 100; number < 1000; ++number) {
        const std::uint64_t result = permutation.ofDecimal(number);
        EXPECT_GE(result, 100U);
        EXPECT_LT(result, 1000U);
        results.insert(result);
    }
    EXPECT_EQ(results.size(), 900U);
}

TEST(Permutation, DependsOnTheKeyAndNotOnTheWidthOfTheField) {
    const std::uint64_t cell = 0x1234567;
    const Permutation permutation(keyed(1));
    EXPECT_EQ(permutation.of(cell, 28), permutation.of(cell, 32));
    EXPECT_NE(permutation.of(cell, 28), cell);
    EXPECT_NE(permutation.of(cell, 28), Permutation(keyed(2)).of(cell, 28));
    EXPECT_EQ(permutation.of(0, 16), 0U);
}

} // namespace
} // namespace pallax
