#include "ui/contents/SearchContent.h"

#include "app/tree/PallaxModelNode.h"
#include "plist/PropertyList.h"
#include "tests/ui/pages/SampleTimeline.h"

#include <gtest/gtest.h>

namespace pallax {
namespace {

class SearchContentTest : public testing::Test {
protected:
    static NodeRef tree(const char* rsrp) {
        PathDictionary paths;
        return PallaxModelNode::makeTreeFromObject(
            Dictionary{{"Serving", Dictionary{{"RSRP", rsrp}, {"RSRQ", "-9 dB"}}}}, paths);
    }
    void recordDrive() {
        drive.emplace();
        moment = {drive->timeline.get(), drive->timeline->packets()};
    }
    std::string words(std::size_t row) const {
        std::string text;
        for (const TableCell& cell : table.content().rows[row].cells) {
            text += (text.empty() ? "" : " | ") + cell.text;
        }
        return text;
    }

    NodeRef root = tree("-94 dBm");
    std::optional<terminal::SampleTimeline> drive;
    Moment moment;
    bool mayGoOn = true;
    const EntryPartAt partAt = [](const std::string& /*path*/) { return EntryPart::None; };
    TextFinder finder{{.root = [this] { return root; },
                       .partAt = partAt,
                       .moment = [this] { return moment; },
                       .mayGoOn =
                           [this] {
                               stateDuring = content.state();
                               return mayGoOn;
                           }}};
    std::vector<std::string> went;
    SearchContent content{
        {.finder = finder,
         .goToRow = [this](const std::string& text,
                           const FoundRow& row) { went.push_back(text + " " + row.name); },
         .goToPacket =
             [this](const std::string& text, std::uint64_t packet) {
                 went.push_back(text + " " + std::to_string(packet));
             },
         .ahead = [] { return std::chrono::seconds(0); },
         .wording = [](std::string each) { return "(" + each + ")"; }}};
    std::optional<SearchState> stateDuring;
    TableModel table;
};

TEST_F(SearchContentTest, FindsRowsOfTheFrame) {
    EXPECT_EQ(content.state(), SearchState::NothingTyped);
    EXPECT_FALSE(content.goThere(table));
    content.search(table, "rsr", SearchScope::Frame);
    EXPECT_EQ(content.state(), SearchState::Found);
    ASSERT_EQ(table.shownRows(), 2U);
    EXPECT_EQ(words(0), "RSRP | -94 dBm | Serving");
    table.moveCursorTo(1);
    EXPECT_TRUE(content.goThere(table));
    EXPECT_EQ(went, (std::vector<std::string>{"rsr RSRQ"}));
    content.search(table, "nothing", SearchScope::Frame);
    EXPECT_EQ(content.state(), SearchState::NotInFrame);
    EXPECT_FALSE(content.goThere(table));
}

TEST_F(SearchContentTest, AnotherFrameIsSearchedAgain) {
    content.search(table, "dBm", SearchScope::Frame);
    const auto version = table.version();
    content.refresh(table);
    EXPECT_EQ(table.version(), version);
    root = tree("-97 dBm");
    content.refresh(table);
    EXPECT_EQ(words(0), "RSRP | -97 dBm | Serving");
}

TEST_F(SearchContentTest, FindsInstantsOfTheRecording) {
    content.search(table, "context down", SearchScope::Recording);
    EXPECT_EQ(content.state(), SearchState::NothingToSearch);
    recordDrive();
    content.search(table, "context down", SearchScope::Recording);
    EXPECT_EQ(stateDuring, SearchState::Searching);
    EXPECT_EQ(content.state(), SearchState::Found);
    EXPECT_EQ(words(0), "22:13:59 | context-down | (context down: internet) | ");
    EXPECT_TRUE(content.goThere(table));
    EXPECT_EQ(went, (std::vector<std::string>{
                        "context down " + std::to_string(drive->timeline->events()[2].packet)}));
    content.search(table, "no such text", SearchScope::Recording);
    EXPECT_EQ(content.state(), SearchState::NotInRecording);
}

TEST_F(SearchContentTest, ASearchThatIsStoppedSaysSo) {
    recordDrive();
    mayGoOn = false;
    content.search(table, "no such text", SearchScope::Recording);
    EXPECT_TRUE(content.isStopped());
    EXPECT_EQ(content.state(), SearchState::Stopped);
    mayGoOn = true;
    content.search(table, "no such text", SearchScope::Recording);
    EXPECT_FALSE(content.isStopped());
    EXPECT_EQ(content.state(), SearchState::NotInRecording);
}

} // namespace
} // namespace pallax
