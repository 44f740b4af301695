#include "ui/contents/ValueContent.h"

#include "tests/ui/contents/ShownDrive.h"

#include <gtest/gtest.h>

namespace pallax {
namespace {

using Words = std::vector<std::string>;

constexpr const char* kRsrpPath = "/Serving Cell Measurements/Measured RSRP";

class ValueContentTest : public testing::Test {
protected:
    void update(ValueContent& content) {
        drive.displayTime.now =
            *timeOf(*drive.timeline, drive.moment.instant) + std::chrono::seconds(2);
        content.update(std::chrono::seconds(300), "the row");
    }
    ShownDrive drive;
};

TEST_F(ValueContentTest, SaysWhatIsKnownAboutAValue) {
    ValueContent content(drive.shown, kRsrpPath);
    EXPECT_FALSE(content.leaf());
    update(content);
    ASSERT_TRUE(content.leaf());
    EXPECT_EQ(content.leaf()->field, "lte.serving_cell_measurements.measured_rsrp");
    EXPECT_EQ(content.facts().text, content.text());
    EXPECT_TRUE(content.text().ends_with(" dBm")) << content.text();
    EXPECT_TRUE(content.hasCurve());
    EXPECT_TRUE(content.age().ends_with(" old")) << content.age();
    EXPECT_EQ(content.place(), (Words{"Serving Cell Measurements", "Measured RSRP"}));
    const Words lines = content.factLines(" / ");
    ASSERT_EQ(lines.size(), 4U);
    EXPECT_EQ(lines[0], content.facts().meaning);
    EXPECT_NE(lines[2].find(" / log code 0x"), std::string::npos) << lines[2];
    EXPECT_TRUE(lines[3].starts_with("range -")) << lines[3];
}

TEST_F(ValueContentTest, AValueOfNoFieldHasTheTextOfItsRow) {
    ValueContent content(drive.shown, "/Nothing/Known");
    update(content);
    EXPECT_FALSE(content.leaf());
    EXPECT_EQ(content.field(), nullptr);
    EXPECT_EQ(content.facts().text, "the row");
    EXPECT_FALSE(content.hasCurve());
    EXPECT_EQ(content.age(), "");
    EXPECT_EQ(content.place(), (Words{"Nothing", "Known"}));
}

TEST_F(ValueContentTest, StaysWithItsEntry) {
    ValueContent content(drive.shown, "/Neighbor Cells List/0/Measured RSRP");
    update(content);
    ASSERT_TRUE(content.leaf());
    const LeafName leaf = *content.leaf();
    EXPECT_EQ(content.place(), (Words{"Neighbor Cells List", leaf.entry, "Measured RSRP"}));
    drive.moment.instant /= 2;
    update(content);
    EXPECT_EQ(content.leaf(), leaf);
}

TEST_F(ValueContentTest, WithoutTheTimelineThereIsNoCurve) {
    ValueContent content(drive.shown, kRsrpPath);
    drive.moment = {};
    content.update(std::nullopt, std::nullopt);
    EXPECT_FALSE(content.hasCurve());
    EXPECT_EQ(content.text(), "");
}

} // namespace
} // namespace pallax
