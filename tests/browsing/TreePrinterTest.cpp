#include "browsing/TreePrinter.h"

#include "tests/doubles/ManualClock.h"

#include <gtest/gtest.h>

namespace pallax {
namespace {

class TreePrinterTest : public testing::Test {
protected:
    explicit TreePrinterTest(TreePrinter::Form used = TreePrinter::Form::Tree) : form(used) {}

    /// The output of a tick with the display `object`.
    std::string tick(const PropertyList& object) {
        PathDictionary paths;
        root = PallaxModelNode::makeTreeFromObject(object, paths);
        printer.updateViewControllerFromModel();
        return std::exchange(written, {});
    }

    std::string written;
    Output output{[this](std::string_view block) { written += block; }};
    doubles::ManualClock clock;
    NodeRef root;
    TreePrinter::Form form;
    TreePrinter printer{output, clock, [this] { return root; }, form};
};

PropertyList display(const char* measured, const char* filtered) {
    return Dictionary{
        {"Serving Cell Measurements",
         Dictionary{{"Version", "1"}, {"E-ARFCN", "1850"}, {"Measured RSRP", measured}}},
        {"Measured Neighbor Cells",
         Array{Dictionary{{"Physical Cell ID", "275"}, {"Filtered RSRP", filtered}}}},
    };
}

TEST_F(TreePrinterTest, PrintsTheTreeAndMarksWhatHasChanged) {
    EXPECT_EQ(tick(display("-95.00 dBm", "-98.00 dBm")), "== 2023-11-14 22:13:20 +0000\n"
                                                         "Serving Cell Measurements\n"
                                                         "  Version: 1\n"
                                                         "  E-ARFCN: 1850\n"
                                                         "  Measured RSRP: -95.00 dBm\n"
                                                         "Measured Neighbor Cells\n"
                                                         "  0\n"
                                                         "    Physical Cell ID: 275\n"
                                                         "    Filtered RSRP: -98.00 dBm\n");
    clock.advance(std::chrono::seconds(2));
    EXPECT_EQ(tick(display("-94.75 dBm", "-98.25 dBm")), "== 2023-11-14 22:13:22 +0000\n"
                                                         "Serving Cell Measurements\n"
                                                         "  Version: 1\n"
                                                         "  E-ARFCN: 1850\n"
                                                         "* Measured RSRP: -94.75 dBm\n"
                                                         "Measured Neighbor Cells\n"
                                                         "  0\n"
                                                         "    Physical Cell ID: 275\n"
                                                         "*   Filtered RSRP: -98.25 dBm\n");
}

TEST_F(TreePrinterTest, ALeafThatWasNotThereIsAChangedOne) {
    EXPECT_EQ(tick(Dictionary{}), "== 2023-11-14 22:13:20 +0000\n");
    EXPECT_EQ(tick(Dictionary{{"Top", "x"}, {"Empty", Array{}}}), "== 2023-11-14 22:13:20 +0000\n"
                                                                  "* Top: x\n"
                                                                  "Empty\n");
    EXPECT_EQ(tick(Dictionary{{"Top", "x"}}), "== 2023-11-14 22:13:20 +0000\n"
                                              "Top: x\n");
}

TEST_F(TreePrinterTest, TwoLeavesOfOneNameChangeOnTheirOwn) {
    const auto rows = [](const char* second) {
        return Dictionary{{"_sorted", "1"}, {"1;RSSI", "a"}, {"2;RSSI", second}};
    };
    (void)tick(rows("b"));
    EXPECT_EQ(tick(rows("b")), "== 2023-11-14 22:13:20 +0000\nRSSI: a\nRSSI: b\n");
    EXPECT_EQ(tick(rows("c")), "== 2023-11-14 22:13:20 +0000\nRSSI: a\n* RSSI: c\n");
}

TEST_F(TreePrinterTest, NoTextCommandsTheTerminal) {
    EXPECT_EQ(tick(Dictionary{{"SPN\n", "\x1B[2J\xFF\u009Bm Zürich"}}),
              "== 2023-11-14 22:13:20 +0000\nSPN\\x0A: \\x1B[2J\uFFFD\\u009Bm Zürich\n");
}

TEST_F(TreePrinterTest, WithoutATreeABlockIsItsHeader) {
    EXPECT_EQ(tick(PropertyList()), "== 2023-11-14 22:13:20 +0000\n");
}

class SentencesTest : public TreePrinterTest {
protected:
    SentencesTest() : TreePrinterTest(TreePrinter::Form::Sentences) {}
};

TEST_F(SentencesTest, ASentenceTellsEachValueThatIsNew) {
    EXPECT_EQ(tick(display("-95.00 dBm", "-98.00 dBm")), "In Serving Cell Measurements:\n"
                                                         "Version: 1\n"
                                                         "E-ARFCN: 1850\n"
                                                         "Measured RSRP: -95.00 dBm\n"
                                                         "In Measured Neighbor Cells, 0:\n"
                                                         "Physical Cell ID: 275\n"
                                                         "Filtered RSRP: -98.00 dBm\n");
    EXPECT_EQ(tick(display("-94.75 dBm", "-98.25 dBm")), "In Serving Cell Measurements:\n"
                                                         "Measured RSRP: -94.75 dBm\n"
                                                         "In Measured Neighbor Cells, 0:\n"
                                                         "Filtered RSRP: -98.25 dBm\n");
    EXPECT_EQ(tick(display("-94.75 dBm", "-98.25 dBm")), "");
    EXPECT_EQ(tick(display("-94.50 dBm", "-98.25 dBm")), "In Serving Cell Measurements:\n"
                                                         "Measured RSRP: -94.50 dBm\n")
        << "each tick says where";
    printer.startAfresh();
    EXPECT_NE(tick(display("-94.50 dBm", "-98.25 dBm")).find("Version: 1\n"), std::string::npos);
}

TEST_F(SentencesTest, ASentenceTellsEachValueThatIsGone) {
    (void)tick(Dictionary{{"A", Dictionary{{"B", "1"}, {"C", "2"}}}, {"Top", "x\n"}});
    EXPECT_EQ(tick(Dictionary{{"Top", "y\n"}, {"Empty", Array{}}}), "Top: y\\x0A\n"
                                                                    "A, B is gone.\n"
                                                                    "A, C is gone.\n");
    EXPECT_EQ(tick(PropertyList()), "Top is gone.\n");
}

TEST_F(SentencesTest, TwoLeavesOfOneNameAreToldApart) {
    const auto rows = [](const char* second) {
        return Dictionary{{"_sorted", "1"}, {"1;RSSI", "a"}, {"2;RSSI", second}};
    };
    EXPECT_EQ(tick(rows("b")), "RSSI: a\nRSSI: b\n");
    EXPECT_EQ(tick(rows("c")), "RSSI: c\n");
    EXPECT_EQ(tick(Dictionary{{"RSSI", "a"}}), "RSSI is gone.\n");
}

TEST_F(TreePrinterTest, SaysOncePerDisconnectionThatItIsConnecting) {
    printer.showConnection(false);
    printer.showConnection(false);
    EXPECT_EQ(std::exchange(written, {}), "Connecting...\n");
    printer.showConnection(true);
    EXPECT_EQ(written, "");
    printer.showConnection(false);
    EXPECT_EQ(written, "Connecting...\n");
}

} // namespace
} // namespace pallax
