#include "overview/DisplayValues.h"

#include "overview/Differences.h"
#include "tests/overview/ValuesFixture.h"
#include "tests/timeline/TimelineFixture.h"

namespace pallax {
namespace {

using namespace std::chrono_literals;

TEST(DisplayValues, AreThoseOfThePacketsThatTheDisplayIsFrom) {
    for (const char* name : technologyNames()) {
        SCOPED_TRACE(name);
        TimelineFixture fixture(name);
        fixture.drive(3, 40s);
        const auto timeline = fixture.indexed();
        for (std::uint64_t instant = 1; instant <= timeline->packets(); instant += 97) {
            const PropertyList display = timeline->displayAt(instant);
            EXPECT_EQ(technologyOfDisplay(display, fixture.resources).commandName, name);
            ValuesFixture saved(name);
            giveDisplay(display, ValuesFixture::at(0), saved.fields, saved.values);
            for (const Difference& difference :
                 differencesBetween(timeline->valuesAt(instant), saved.values)) {
                EXPECT_FALSE(difference.field->isShown)
                    << difference.field->name << " of " << difference.entry << " at " << instant
                    << ": " << difference.before.text() << " > " << difference.after.text();
            }
            EXPECT_GT(saved.values.fieldCount(), 0U);
        }
    }
}

TEST(DisplayValues, NumbersAreReadFromTheirTexts) {
    ValuesFixture lte("lte");
    lte.read(5, {{"Serving Cell Measurements",
                  Dictionary{{"Measured RSRP", "-94.75 dBm"}, {"E-ARFCN", "1850"}}},
                 {"Serving Cell Info", Dictionary{{"Download Bandwidth", "20 MHz"}}}});
    const FieldValue* level = lte.values.value("lte.serving_cell_measurements.measured_rsrp");
    ASSERT_NE(level, nullptr);
    EXPECT_EQ(level->number, -94.75);
    EXPECT_EQ(level->text(), "-94.75 dBm");
    EXPECT_EQ(level->read, ValuesFixture::at(5));
    EXPECT_EQ(lte.values.value("lte.serving_cell_measurements.e_arfcn")->number, 1850);
    const FieldValue* label = lte.values.value("lte.serving_cell_info.download_bandwidth");
    EXPECT_EQ(label->text(), "20 MHz");
    EXPECT_TRUE(std::isnan(label->number)) << "a label is no number";
}

TEST(DisplayValues, PilotsAreEntriesByTheirOffset) {
    ValuesFixture cdma("cdma");
    cdma.read(0, {{"EV-DO", Dictionary{{"Active Set", Dictionary{{"_sorted", "_sorted"},
                                                                 {"0;367", "-5.99 dB"},
                                                                 {"odd", "-6.00 dB"},
                                                                 {"2;x", "-7.00 dB"}}}}}});
    std::vector<std::string> entries;
    cdma.values.forEachEntry([&](const EntryValues& entry) {
        entries.push_back(cdma.entries.words(entry.entry) + ": " +
                          entry.values.front().second.text());
    });
    EXPECT_EQ(entries, (std::vector<std::string>{"PN 367: -5.99 dB", "PN 0: -6.00 dB",
                                                 "PN 0 (2): -7.00 dB"}));
}

TEST(DisplayValues, WhatTheRegistryDoesNotHaveIsLeftOut) {
    ValuesFixture lte("lte");
    lte.read(0, {{"Another Section", Dictionary{{"Key", "1"}}}, {"Text", "2"}});
    EXPECT_EQ(lte.values.fieldCount(), 0U);
}

TEST(DisplayValues, ADisplayWithoutAKnownSectionIsOfAnObjectStream) {
    const DirectoryResources resources(PALLAX_SOURCE_DIR "/resources");
    EXPECT_EQ(technologyOfDisplay(Dictionary{{"Anything", "1"}}, resources).commandName, "ifx");
    EXPECT_EQ(technologyOfDisplay(PropertyList(), resources).commandName, "ifx");
}

} // namespace
} // namespace pallax
