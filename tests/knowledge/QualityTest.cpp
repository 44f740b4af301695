#include "knowledge/Quality.h"

#include "tests/doubles/Property.h"

#include <gtest/gtest.h>

#include <string>

namespace pallax {
namespace {

std::string mistakeIn(std::string_view text) {
    const auto profile = parseProfile(text, "mine", "mine.conf");
    return profile ? "" : profile.error().sentence;
}

TEST(Quality, AProfileIsReadFromItsFile) {
    const auto profile = parseProfile("# ours\nsource = survey, 2026\n"
                                      "rsrp = excellent -80, good -90.5,fair -100 ,  poor -120\n"
                                      "rxqual = good 2, poor 6\n"
                                      "sinr = good 10\n",
                                      "mine", "mine.conf");
    ASSERT_TRUE(profile);
    EXPECT_EQ(profile->name, "mine");
    EXPECT_EQ(profile->source, "survey, 2026");
    EXPECT_EQ(profile->borders.size(), 3U);
    EXPECT_EQ(profile->borders.at(Measure::Rsrp), (Borders{{{Grade::Excellent, -80},
                                                            {Grade::Good, -90.5},
                                                            {Grade::Fair, -100},
                                                            {Grade::Poor, -120}}}));
}

TEST(Quality, AValueOnABorderHasItsGrade) {
    const auto profile = parseProfile("rsrp = excellent -80, good -90, fair -100, poor -120\n"
                                      "rxqual = excellent 0, good 2, poor 6\n"
                                      "sinr = good 10",
                                      "mine", "mine.conf");
    ASSERT_TRUE(profile);
    const auto rsrp = [&](double value) { return profile->gradeOf(Measure::Rsrp, value); };
    EXPECT_EQ(rsrp(-44), Grade::Excellent);
    EXPECT_EQ(rsrp(-80), Grade::Excellent);
    EXPECT_EQ(rsrp(-80.01), Grade::Good);
    EXPECT_EQ(rsrp(-90), Grade::Good);
    EXPECT_EQ(rsrp(-97), Grade::Fair);
    EXPECT_EQ(rsrp(-120), Grade::Poor);
    EXPECT_EQ(rsrp(-120.01), Grade::None);
    const auto quality = [&](double value) { return profile->gradeOf(Measure::RxQual, value); };
    EXPECT_EQ(quality(0), Grade::Excellent);
    EXPECT_EQ(quality(1), Grade::Good);
    EXPECT_EQ(quality(2), Grade::Good);
    EXPECT_EQ(quality(6), Grade::Poor);
    EXPECT_EQ(quality(7), Grade::None);
    EXPECT_EQ(profile->gradeOf(Measure::Sinr, 10), Grade::Good);
    EXPECT_EQ(profile->gradeOf(Measure::Sinr, 9), Grade::None) << "one border: more is better";
    EXPECT_EQ(profile->gradeOf(Measure::Rscp, -80), std::nullopt) << "the profile has no borders";
}

TEST(Quality, AMistakeIsOneSentenceWithFileAndLine) {
    EXPECT_EQ(mistakeIn("source = x\nrsp = good 1\n"),
              "mine.conf, line 2: there is no measure \"rsp\".");
    EXPECT_EQ(mistakeIn("rsrp ="), "mine.conf, line 1: it has no borders.");
    for (const char* border : {"good", "good x", "good -90 dBm", "great -90", "none -90", "-90",
                               "good nan", "good inf", "good 1e999", "good - 90"}) {
        EXPECT_EQ(mistakeIn(std::string("rsrp = excellent -80, ") + border),
                  "mine.conf, line 1: a border is a grade and a number, such as \"good -90\", not "
                  "\"" +
                      std::string(border) + "\".");
    }
    for (const char* borders :
         {"good -80, excellent -90", "excellent -80, excellent -90", "excellent -80, good -80",
          "excellent -80, good -90, fair -85", "excellent 1, good 3, fair 2"}) {
        EXPECT_EQ(mistakeIn(std::string("rsrp = ") + borders),
                  "mine.conf, line 1: the borders are not in the order excellent, good, fair, "
                  "poor, with numbers that all descend or all ascend.");
    }
    EXPECT_EQ(mistakeIn("rsrp"), "mine.conf, line 1: a setting is written \"key = value\".");
}

TEST(Quality, AnyTextIsAProfileOrOneSentence) {
    EXPECT_TRUE(doubles::holds([] {
        const std::string text = doubles::any::textOf("rspq=,- \n#0123459.egoodfairpl\t");
        const std::string mistake = mistakeIn(text);
        const bool isSentence = mistake.starts_with("mine.conf, line ") && mistake.ends_with(".");
        RC_ASSERT(mistake.empty() || isSentence);
    }));
}

TEST(Quality, TheProfilesOfTheProgramAreReadAndStateTheirSource) {
    EXPECT_EQ(builtInProfiles().size(), 3U);
    for (const BuiltInProfile& each : builtInProfiles()) {
        const auto profile = builtInProfile(each.name);
        ASSERT_TRUE(profile) << each.name;
        EXPECT_EQ(profile->name, each.name);
        EXPECT_NE(profile->source, "");
        for (const Measure measure : {Measure::Rsrp, Measure::Rsrq, Measure::Sinr, Measure::Rscp,
                                      Measure::EcNo, Measure::RxLev, Measure::CdmaRssi}) {
            ASSERT_TRUE(profile->borders.contains(measure)) << each.name;
            EXPECT_EQ(profile->borders.at(measure).borders.size(), 4U);
        }
    }
    EXPECT_EQ(builtInProfile("mine"), std::nullopt);
}

TEST(Quality, AndroidsBorders) {
    const auto profile = builtInProfile("android");
    EXPECT_EQ(profile->gradeOf(Measure::Rsrp, -97), Grade::Excellent);
    EXPECT_EQ(profile->gradeOf(Measure::Rsrp, -99), Grade::Good);
    EXPECT_EQ(profile->gradeOf(Measure::Rsrp, -129), Grade::None);
    EXPECT_EQ(profile->gradeOf(Measure::RxLev, -104), Grade::Poor);
    EXPECT_EQ(profile->gradeOf(Measure::EcNo, 0), Grade::Good);
    EXPECT_EQ(profile->gradeOf(Measure::Rssi, -60), std::nullopt) << "no bars show it";
}

TEST(Quality, TheStricterProfileIsStricter) {
    const auto field = builtInProfile("field");
    const auto strict = builtInProfile("operator");
    for (const auto& [measure, borders] : field->borders) {
        const auto& stricter = strict->borders.at(measure).borders;
        ASSERT_EQ(borders.borders.size(), stricter.size());
        for (std::size_t index = 0; index < stricter.size(); ++index) {
            EXPECT_TRUE(borders.isSmallerBetter()
                            ? stricter[index].value <= borders.borders[index].value
                            : stricter[index].value >= borders.borders[index].value)
                << infoOf(measure).name;
        }
    }
}

TEST(Quality, MeasuresAndGradesHaveNames) {
    for (const MeasureInfo& each : kMeasures) {
        EXPECT_EQ(measureNamed(each.name), each.measure);
        EXPECT_EQ(infoOf(each.measure).name, each.name);
    }
    EXPECT_EQ(measureNamed("RSRP"), std::nullopt);
    EXPECT_EQ(nameOf(Grade::None), "none");
    EXPECT_EQ(nameOf(Grade::Poor), "poor");
    EXPECT_EQ(nameOf(Grade::Fair), "fair");
    EXPECT_EQ(nameOf(Grade::Good), "good");
    EXPECT_EQ(nameOf(Grade::Excellent), "excellent");
}

} // namespace
} // namespace pallax
