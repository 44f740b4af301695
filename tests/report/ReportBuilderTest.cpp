#include "report/ReportBuilder.h"

#include "tests/overview/ValuesFixture.h"

#include <cmath>

namespace pallax {
namespace {

/// A report of displays that a test writes, two seconds apart.
class ReportBuilderTest : public testing::Test {
protected:
    static Dictionary serving(const char* pci, const char* rsrp) {
        return Dictionary{{"Serving Cell Info",
                           Dictionary{{"Physical Cell ID", pci}, {"Download Frequency", "1850"}}},
                          {"Serving Cell Measurements", Dictionary{{"Measured RSRP", rsrp}}}};
    }
    static Dictionary with(Dictionary display, const std::string& key, PropertyList value) {
        display.set(key, std::move(value));
        return display;
    }
    static PropertyList neighbours(const std::vector<std::pair<const char*, const char*>>& cells) {
        Array entries;
        for (const auto& [pci, rsrp] : cells) {
            entries.emplace_back(Dictionary{{"Physical Cell ID", pci}, {"Measured RSRP", rsrp}});
        }
        return PropertyList(std::move(entries));
    }
    void tick(const Dictionary& display, bool isAfterStep = false) {
        _values.values.clear();
        _values.read(second, display);
        report.take({ValuesFixture::at(second), _values.values, display, isAfterStep});
        masked.take({ValuesFixture::at(second), _values.values, display, isAfterStep});
        second += 2;
    }
    const ReportNeighbour* neighbour(const std::string& cell) const {
        for (const ReportNeighbour& each : report.neighbours()) {
            if (each.cell == cell) {
                return &each;
            }
        }
        return nullptr;
    }

    int second = 0;
    NetworkNames names;
    QualityProfile profile = *builtInProfile(kDefaultProfile);
    ReportBuilder report{names, profile};
    ReportBuilder masked{names, profile, [](const auto& path) { return path.back() == "APN"; }};

private:
    ValuesFixture _values{"lte"};
};

TEST_F(ReportBuilderTest, ALevelStandsForTheTimeUntilTheNextTick) {
    tick(serving("182", "-90.00 dBm"));
    tick(serving("182", "-100.00 dBm"));
    second += 3; // the next tick is five seconds after this one
    tick(serving("182", "-80.00 dBm"));
    report.finish();
    ASSERT_EQ(report.measures().size(), 1U);
    const ReportMeasure& rsrp = report.measures()[0];
    EXPECT_EQ(rsrp.system, "LTE");
    EXPECT_EQ(rsrp.name, "RSRP");
    EXPECT_EQ(rsrp.unit, "dBm");
    EXPECT_EQ(rsrp.spread.total(), 9) << "2 s, 5 s, and one interval after the last tick";
    EXPECT_EQ(rsrp.spread.quantile(0.5), -100);
    EXPECT_EQ(rsrp.spread.least(), -100);
    EXPECT_EQ(rsrp.spread.most(), -80);
}

TEST_F(ReportBuilderTest, ALevelIsNotKnownForLongerThanTenSeconds) {
    tick(serving("182", "-90.00 dBm"));
    second += 60;
    tick(serving("182", "-90.00 dBm"));
    report.finish();
    EXPECT_EQ(report.measures()[0].spread.total(), 12);
    ASSERT_EQ(report.stays().size(), 1U) << "the phone is where it was";
}

TEST_F(ReportBuilderTest, ASeriesChangesWithItsValueAndEndsWithoutOne) {
    tick(serving("182", "-90.00 dBm"));
    tick(serving("182", "-90.00 dBm"));
    tick(serving("182", "-91.50 dBm"));
    tick({});
    const auto& changes = report.measures()[0].series.changes();
    ASSERT_EQ(changes.size(), 3U);
    EXPECT_EQ(changes[0].tick, 0U);
    EXPECT_EQ(changes[0].value, -90.0F);
    EXPECT_EQ(changes[1].tick, 2U);
    EXPECT_EQ(changes[1].value, -91.5F);
    EXPECT_EQ(changes[2].tick, 3U);
    EXPECT_TRUE(std::isnan(changes[2].value));
}

TEST_F(ReportBuilderTest, AStayEndsWithAnotherCell) {
    tick(serving("182", "-90.00 dBm"));
    tick(serving("182", "-90.00 dBm"));
    tick(serving("183", "-90.00 dBm"));
    tick(serving("182", "-90.00 dBm"));
    report.finish();
    ASSERT_EQ(report.stays().size(), 3U);
    EXPECT_EQ(report.stays()[0].cell, "PCI 182");
    EXPECT_EQ(report.stays()[0].system, "LTE");
    EXPECT_EQ(report.stays()[0].details,
              (std::vector<std::string>{"EARFCN 1850", "band 3", "1870.0 MHz"}));
    EXPECT_EQ(report.stays()[0].from, ValuesFixture::at(0));
    EXPECT_EQ(report.stays()[0].to, ValuesFixture::at(4));
    EXPECT_EQ(report.stays()[1].cell, "PCI 183");
    EXPECT_EQ(report.stays()[2].cell, "PCI 182");
    EXPECT_EQ(report.stays()[2].to, ValuesFixture::at(8));
}

TEST_F(ReportBuilderTest, NothingHoldsOverAStepOfTheClock) {
    tick(serving("182", "-90.00 dBm"));
    second = -1000;
    tick(serving("182", "-90.00 dBm"), true);
    report.finish();
    EXPECT_EQ(report.measures()[0].spread.total(), 4);
    EXPECT_EQ(report.stays().size(), 2U);
    ASSERT_EQ(report.stretches().size(), 2U);
    EXPECT_EQ(report.stretches()[1].tick, 1U);
    EXPECT_EQ(report.stays()[0].stretch, 0U);
    EXPECT_EQ(report.stays()[1].stretch, 1U);
}

TEST_F(ReportBuilderTest, ANeighbourIsComparedWithTheServingCell) {
    const auto display = [](const char* serving, const char* level) {
        return with(ReportBuilderTest::serving("182", serving), "Neighbor Cells List",
                    neighbours({{"285", level}, {"182", "-50.00 dBm"}}));
    };
    tick(display("-90.00 dBm", "-95.25 dBm"));
    tick(display("-90.00 dBm", "-95.00 dBm"));
    tick(display("-90.00 dBm", "-89.00 dBm"));
    report.finish();
    const ReportNeighbour* cell = neighbour("PCI 285");
    ASSERT_NE(cell, nullptr);
    EXPECT_EQ(cell->spread.total(), 6);
    EXPECT_EQ(cell->spread.most(), -89);
    EXPECT_EQ(cell->near, 4) << "5 dB are near, 5.25 dB are not";
    EXPECT_EQ(cell->stronger, 2);
    EXPECT_FALSE(cell->isServing);
}

TEST_F(ReportBuilderTest, ACellThatNoListHadIsToldWhenItServes) {
    tick(with(serving("182", "-90.00 dBm"), "Neighbor Cells List",
              neighbours({{"285", "-95.00 dBm"}})));
    tick(serving("285", "-90.00 dBm")); // it was in the list
    tick(serving("182", "-90.00 dBm")); // it was not
    report.finish();
    EXPECT_EQ(neighbour("PCI 285")->unlisted, 0U);
    EXPECT_TRUE(neighbour("PCI 285")->isServing);
    EXPECT_EQ(neighbour("PCI 182")->unlisted, 1U);
}

TEST_F(ReportBuilderTest, ADetectedCellCountsTheTimeWithoutAList) {
    const PropertyList detected(Array{Dictionary{{"Physical Cell ID", "82"}}});
    tick(with(serving("182", "-90.00 dBm"), "Detected Cells", detected));
    tick(serving("182", "-90.00 dBm"));
    report.finish();
    ASSERT_NE(neighbour("PCI 82"), nullptr);
    EXPECT_EQ(neighbour("PCI 82")->detected, 2);
    EXPECT_TRUE(neighbour("PCI 82")->spread.isEmpty());
}

TEST_F(ReportBuilderTest, AContextIsThereAsLongAsTheDisplayHasIt) {
    const PropertyList context(Array{Dictionary{{"APN", "internet"}, {"State", "Active"}}});
    tick(with(serving("182", "-90.00 dBm"), "PDP Context Info", context));
    tick(with(serving("182", "-90.00 dBm"), "PDP Context Info", context));
    tick(serving("182", "-90.00 dBm"));
    report.finish();
    ASSERT_EQ(report.contexts().size(), 1U);
    const auto& spans = report.contexts().at("internet").spans();
    ASSERT_EQ(spans.size(), 1U);
    EXPECT_EQ(spans[0].to - spans[0].from, std::chrono::seconds(4));
    EXPECT_EQ(spans[0].text, "Active");
}

TEST_F(ReportBuilderTest, AMaskedContextHasANumberInsteadOfItsName) {
    const Dictionary one{{"APN", "00000000"}, {"State", "000000"}};
    const PropertyList two(Array{one, one});
    tick(with(serving("182", "-90.00 dBm"), "PDP Context Info", PropertyList(Array{one})));
    tick(with(serving("182", "-90.00 dBm"), "PDP Context Info", two));
    masked.finish();
    ASSERT_EQ(masked.contexts().size(), 2U) << "though their zeros are the same";
    ASSERT_TRUE(masked.contexts().contains("context 1") && masked.contexts().contains("context 2"));
    const auto& spans = masked.contexts().at("context 2").spans();
    ASSERT_EQ(spans.size(), 1U);
    EXPECT_EQ(spans[0].from, ValuesFixture::at(2));
    EXPECT_EQ(spans[0].text, "there");
}

TEST_F(ReportBuilderTest, KeepsABoundedNumberOfNeighboursAndSaysSo) {
    Array entries;
    for (std::size_t pci = 0; pci < ReportBuilder::kMostNeighbours + 1; ++pci) {
        entries.emplace_back(
            Dictionary{{"Physical Cell ID", std::to_string(pci)}, {"Measured RSRP", "-95.00 dBm"}});
    }
    tick(with({}, "Neighbor Cells List", PropertyList(std::move(entries))));
    report.finish();
    EXPECT_EQ(report.neighbours().size(), ReportBuilder::kMostNeighbours);
    EXPECT_EQ(report.notes(),
              std::vector<std::string>{"Only the first 512 neighbouring cells are in the report."});
}

} // namespace
} // namespace pallax
