#include "decoding/SnapshotDisplay.h"

#include "decoding/DroppedNotices.h"
#include "decoding/SnapshotText.h"
#include "host/Snapshot.h"
#include "monitor/DisplayDriver.h"
#include "plist/PropertyListCodec.h"
#include "tests/doubles/FakeBundle.h"
#include "tests/doubles/FakeResources.h"
#include "tests/doubles/ManualClock.h"

#include <gtest/gtest.h>

namespace pallax {
namespace {

PropertyList cell(const char* name) {
    return Dictionary{{"Cell", Dictionary{{"Name", name}}}};
}

class SnapshotDisplayTest : public testing::Test {
protected:
    void begin(SnapshotDisplays displays) {
        driver.setGenerator(LogGenerator::generatorFromTechnology(
            "Snapshot", technologiesWithSnapshots(displays), {clock, resources, bundle, notices}));
        ASSERT_NE(driver.generator(), nullptr);
    }
    void message(const char* title, const char* name) {
        driver.update(*serializeBinary(Dictionary{{kSnapshotSaved, "then"},
                                                  {kSnapshotDescription, "here"},
                                                  {kSnapshotTitle, title},
                                                  {kSnapshotDisplay, cell(name)}}));
    }

    doubles::ManualClock clock;
    doubles::FakeResources resources;
    doubles::FakeBundle bundle;
    DroppedNotices notices;
    DisplayDriver driver;
};

TEST_F(SnapshotDisplayTest, OneByOneEachIsTheDisplay) {
    begin(SnapshotDisplays::OneByOne);
    EXPECT_TRUE(driver.display().isNull());
    message("one", "A");
    EXPECT_EQ(driver.display(), cell("A"));
    message("two", "B");
    EXPECT_EQ(driver.generate(), cell("B"));
}

TEST_F(SnapshotDisplayTest, TogetherEachIsASection) {
    begin(SnapshotDisplays::Together);
    message("one", "A");
    message("two", "B");
    message("two", "C");
    EXPECT_EQ(driver.display(),
              PropertyList(Dictionary{
                  {"Snapshot",
                   Dictionary{{"Saved", "then"},
                              {"Description", "here"},
                              {"Note", "Displays that share a section all show it as it was when "
                                       "the snapshot was saved."}}},
                  {"one", cell("A")},
                  {"two", cell("B")},
                  {"two, 2", cell("C")}}));
    EXPECT_EQ(driver.saveContents(), PropertyList(Array{}));
}

TEST_F(SnapshotDisplayTest, OtherMessagesAreIgnored) {
    begin(SnapshotDisplays::Together);
    const ByteBuffer text{'n', 'o', ' ', '{'};
    driver.update(text);
    driver.update({});
    EXPECT_TRUE(driver.display().isNull());
}

TEST(SnapshotText, TellsDisplaysAndLog) {
    Snapshot snapshot{"then", "here", {{"Snapshot x", Time(), cell("A")}}, nullptr};
    snapshot.description = "he\nre";
    std::string text;
    appendSnapshotText(text, "s\n.pallax", snapshot);
    EXPECT_EQ(text, "s\\x0A.pallax\n"
                    "  format      snapshot\n"
                    "  saved       then\n"
                    "  description he\\x0Are\n"
                    "  displays    1\n"
                    "              Snapshot x\n"
                    "  DLF log     none\n"
                    "  sections    Displays that share a section all show it as it was when the "
                    "snapshot was saved.\n");
    snapshot.dlf = PropertyList::data({1, 2}).data();
    snapshot.description = "here";
    std::string json;
    appendSnapshotJson(json, "s.pallax", snapshot);
    EXPECT_EQ(json, R"({"file":"s.pallax","format":"snapshot","saved":"then","description":"here",)"
                    R"("displays":[{"description":"Snapshot x","time":"1970-01-01T00:00:00.000Z",)"
                    R"("sections":["Cell"]}],"dlf_bytes":2,"note":"Displays that share a section )"
                    R"(all show it as it was when the snapshot was saved.","error":null})"
                    "\n");
}

} // namespace
} // namespace pallax
