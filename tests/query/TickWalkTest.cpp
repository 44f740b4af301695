#include "tests/query/QueryFixture.h"

#include <span>

namespace pallax {
namespace {

namespace any = doubles::any;

class TickWalkTest : public testing::TestWithParam<const char*> {};

INSTANTIATE_TEST_SUITE_P(All, TickWalkTest, testing::ValuesIn(technologyNames()));

TEST_P(TickWalkTest, GoesOnFromWhereItWasAskedForLast) {
    TimelineFixture fixture(GetParam());
    fixture.drive(5, std::chrono::minutes(6), 10);
    // One key frame, so that no nearer one is taken.
    const auto timeline = fixture.indexed(TimelineFixture::closeKeyFrames(100'000));
    Database database;
    addTimelineTables(database, *timeline);
    const auto numbersOf = [&](const char* column) {
        std::vector<std::int64_t> numbers;
        for (const std::string& line :
             linesOf(database, std::string("select ") + column + " from state")) {
            numbers.push_back(std::stoll(line));
        }
        return numbers;
    };
    const auto all = linesOf(database, "select * from state");
    ASSERT_GT(all.size(), 100U);
    for (const char* column : {"packet", "time"}) {
        const auto numbers = numbersOf(column);
        ASSERT_EQ(numbers.size(), all.size());
        const auto isRightBetween = [&](std::int64_t first, std::int64_t last) {
            std::vector<std::string> expected;
            for (std::size_t place = 0; place < all.size(); ++place) {
                if (numbers[place] >= first && numbers[place] <= last) {
                    expected.push_back(all[place]);
                }
            }
            return linesOf(database,
                           formatText("select * from state where %@ between %lld and %lld",
                                      {column, first, last})) == expected;
        };
        constexpr std::size_t kMoreThanAreKept = 70;
        for (const std::int64_t number : std::span(numbers).first(kMoreThanAreKept)) {
            EXPECT_TRUE(isRightBetween(number, number)) << number;
        }
        EXPECT_TRUE(isRightBetween(numbers[0], numbers[9])) << "more have come than are kept";
        const std::int64_t tick = (numbers.back() - numbers.front()) / std::ssize(numbers);
        std::int64_t first = numbers.front();
        EXPECT_TRUE(doubles::holds([&] {
            // Mostly a little later, as a join asks.
            const bool isFar = any::between(0, 9) == 0 || first > numbers.back();
            first = isFar ? any::elementOf(numbers) : first + any::between(-1, 8) * tick / 4;
            RC_ASSERT(isRightBetween(first, first + any::between(0, 24) * tick / 4));
        }));
    }
}

} // namespace
} // namespace pallax
