#include "ui/contents/GraphContent.h"

#include "tests/ui/contents/ShownDrive.h"
#include "ui/contents/TimeOfDay.h"

#include <gtest/gtest.h>

namespace pallax {
namespace {

class GraphContentTest : public testing::Test {
protected:
    GraphContentTest() {
        for (const char* field :
             {"lte.serving_cell_measurements.measured_rsrp", "gsm.other_technology",
              "lte.serving_cell_measurements.measured_rsrq",
              "lte.serving_cell_measurements.average_rsrp"}) {
            (void)graph.toggle({field, "", ""});
        }
    }
    std::vector<GraphPlot> plots() { return graphPlots(drive.shown, graph, reading, 50); }

    ShownDrive drive;
    Graph graph;
    CurveReading reading;
};

TEST_F(GraphContentTest, HasAPlotForEachUnitAndALetterForEachCurve) {
    const std::vector<GraphPlot> shown = plots();
    ASSERT_EQ(shown.size(), 2U);
    EXPECT_EQ(shown[0].unit, "dBm");
    ASSERT_EQ(shown[0].curves.size(), 2U);
    EXPECT_EQ(shown[0].curves[0].mark, "a");
    EXPECT_EQ(shown[0].curves[0].name, "Measured RSRP, Serving Cell Measurements");
    EXPECT_EQ(shown[0].curves[1].mark, "c");
    EXPECT_EQ(shown[0].curves[1].number, 2U);
    EXPECT_EQ(shown[1].unit, "dB");
    EXPECT_EQ(shown[1].curves.at(0).mark, "b");
    EXPECT_FALSE(shown[1].curves.at(0).curve.points.empty());
    EXPECT_TRUE(shown[1].curves.at(0).value.ends_with(" dB")) << shown[1].curves.at(0).value;
    EXPECT_EQ(graphWords(drive.shown, reading), "the last 5 minutes");
}

TEST_F(GraphContentTest, AValueOfTheDisplayIsAddedAndTakenAway) {
    const auto toggle = [this](const char* path) {
        return toggleInGraph(graph, drive.shown, path);
    };
    EXPECT_EQ(toggle("/Serving Cell Measurements/Measured RSSI"),
              "In the graph (5 of 6): V opens it.");
    EXPECT_TRUE(graph.contains({"lte.serving_cell_measurements.measured_rssi", "", ""}));
    EXPECT_EQ(toggle("/Serving Cell Measurements/Measured RSSI"), "No longer in the graph.");
    EXPECT_EQ(toggle("/SIM Info/EF-ICCID"), "Only numbers have a curve.");
    EXPECT_EQ(toggle("/Nothing"), "Only numbers have a curve.");
    drive.moment = {};
    EXPECT_EQ(toggle("/Serving Cell Measurements/Measured RSSI"), "Only numbers have a curve.");
}

TEST_F(GraphContentTest, TheCursorReadsAllCurves) {
    (void)plots();
    const CurveWindow window = drive.shown.window();
    reading.fit(window.from, window.to, 60);
    reading.toFirst();
    for (const GraphPlot& plot : plots()) {
        for (const GraphCurve& curve : plot.curves) {
            const CurvePoint* point = pointAt(curve.curve, *reading.cursor());
            EXPECT_EQ(curve.value == "no value", point == nullptr);
        }
    }
    EXPECT_EQ(graphWords(drive.shown, reading), timeOfDay(*reading.cursor(), {}));
}

TEST_F(GraphContentTest, WithoutATimelineThereAreNoCurves) {
    drive.moment = {};
    EXPECT_TRUE(plots().empty());
    EXPECT_EQ(graphWords(drive.shown, reading), "There are no curves yet.");
}

} // namespace
} // namespace pallax
