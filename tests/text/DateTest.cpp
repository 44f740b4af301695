#include "text/Date.h"

#include <gtest/gtest.h>

namespace pallax {
namespace {

constexpr Date kNovember14{std::chrono::seconds(1700000000)};

TEST(Date, TextIsTheStandardDescriptionInUtc) {
    EXPECT_EQ(dateText(kNovember14), "2023-11-14 22:13:20 +0000");
}

TEST(Date, IsoTextRoundTrips) {
    EXPECT_EQ(isoDateText(kNovember14), "2023-11-14T22:13:20Z");
    EXPECT_EQ(parseIsoDate("2023-11-14T22:13:20Z"), kNovember14);
    EXPECT_EQ(parseIsoDate("1999-12-31T23:59:59Z"), Date(std::chrono::seconds(946684799)));
}

TEST(Date, IsoTextRefusesYearsThatDoNotFit) {
    EXPECT_EQ(isoDateText(kNovember14 + std::chrono::years(9000)), std::nullopt);
}

TEST(Date, ParsingRefusesWhatIsNoDate) {
    for (const char* text :
         {"", "2023-11-14", "2023-11-14T22:13:20", "2023-11-14 22:13:20Z", "2023-02-29T00:00:00Z",
          "2023-13-01T00:00:00Z", "2023-11-14T24:00:00Z", "2023-11-14T22:60:00Z",
          "2023-11-14T22:13:60Z", "20x3-11-14T22:13:20Z", "2023-11-14T22:13:20Z "}) {
        EXPECT_EQ(parseIsoDate(text), std::nullopt) << text;
    }
}

TEST(Date, TimeIsCutToMilliseconds) {
    const Time time = Time(kNovember14) + std::chrono::nanoseconds(7999999);
    EXPECT_EQ(isoTimeText(time), "2023-11-14T22:13:20.007Z");
    EXPECT_EQ(dateOf(time), kNovember14);
    EXPECT_EQ(isoTimeText(Time(std::chrono::nanoseconds(-1))), "1969-12-31T23:59:59.999Z");
}

} // namespace
} // namespace pallax
