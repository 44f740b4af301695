#include "overview/StatusWords.h"

#include "fields/Measures.h"

#include <gtest/gtest.h>

#include <cmath>
#include <string>
#include <vector>

namespace pallax {
namespace {

constexpr Time kNow{std::chrono::seconds(1700000000)};

StatusValue level(const char* field, double number, std::chrono::seconds age = {}) {
    return {"level", field, "", number, {}, kNow - age};
}

TEST(StatusWords, AnOperatorHasAsManyPartsAsAreKnown) {
    EXPECT_EQ(operatorWords({NetworkCode{"262", "01"}, "Netz", "Germany"}),
              "Netz 262-01 (Germany)");
    EXPECT_EQ(operatorWords({NetworkCode{"262", "01"}, "", ""}), "262-01");
    EXPECT_EQ(operatorWords({std::nullopt, "Netz", ""}), "Netz");
}

TEST(StatusWords, ACellWithoutAChannelHasNoWordsAboutIt) {
    StatusCell cell;
    cell.site = "cell 7";
    cell.identity = {{"cell", "", "7", 7, {}, kNow}, {"LAC", "", "9", 9, {}, kNow}};
    EXPECT_EQ(identityWords(cell), (std::vector<std::string>{"cell 7", "LAC 9"}));
    EXPECT_EQ(channelWords(cell), std::vector<std::string>());
    cell.channel = StatusValue{"EARFCN", "", "1850", 1850, {}, kNow};
    EXPECT_EQ(channelWords(cell), std::vector<std::string>{"EARFCN 1850"});
    cell.band = "3";
    cell.megahertz = 1870;
    EXPECT_EQ(channelWords(cell),
              (std::vector<std::string>{"EARFCN 1850", "band 3", "1870.0 MHz"}));
}

TEST(StatusWords, TheOldestValueTellsTheAge) {
    const StatusValue fresh = level("", 0, kFresh);
    const StatusValue old = level("", 0, std::chrono::seconds(11));
    EXPECT_EQ(oldAgeWords(kNow, {&fresh}), "");
    EXPECT_EQ(oldAgeWords(kNow, {&fresh, &old}), "11 s ago");
    EXPECT_EQ(oldAgeWords(kNow, {}), "");
}

TEST(StatusWords, ALevelHasItsShareOfItsMeasure) {
    constexpr const char* kRsrp = "lte.serving_cell_measurements.measured_rsrp";
    EXPECT_EQ(shareOf(level(kRsrp, -140)), 0.0);
    EXPECT_EQ(shareOf(level(kRsrp, -92)), 0.5);
    EXPECT_EQ(shareOf(level(kRsrp, -44)), 1.0);
    EXPECT_EQ(shareOf(level(kRsrp, -200)), 0.0);
    EXPECT_EQ(shareOf(level(kRsrp, 0)), 1.0);
    EXPECT_EQ(shareOf(level(kRsrp, NAN)), std::nullopt);
    EXPECT_EQ(shareOf(level("no.such.field", -92)), std::nullopt);
}

TEST(StatusWords, ABetterGradeHasTheGreaterShare) {
    for (const BuiltInProfile& profile : builtInProfiles()) {
        const auto borders = builtInProfile(profile.name)->borders;
        for (const MeasuredField& field : measuredFields()) {
            const auto found = borders.find(field.measure);
            const auto& all =
                found != borders.end() ? found->second.borders : std::vector<Borders::Border>();
            for (std::size_t index = 1; index < all.size(); ++index) {
                EXPECT_GT(shareOf(level(field.name.data(), all[index - 1].value)),
                          shareOf(level(field.name.data(), all[index].value)))
                    << profile.name << " " << field.name;
            }
        }
    }
}

} // namespace
} // namespace pallax
