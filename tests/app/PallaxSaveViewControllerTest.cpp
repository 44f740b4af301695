#include "app/PallaxSaveViewController.h"

#include "plist/PropertyListCodec.h"
#include "tests/doubles/FakeFileSystem.h"
#include "tests/doubles/FakeToolkit.h"
#include "tests/doubles/InOrder.h"
#include "tests/doubles/ManualClock.h"
#include "tests/doubles/RecordingLog.h"
#include "tests/doubles/SteppedQueue.h"

#include <gtest/gtest.h>

namespace pallax {
namespace {

using namespace doubles; // NOLINT: the vocabulary of these tests
using namespace std::chrono_literals;
using Lines = std::vector<RecordingLog::Line>;

constexpr const char* kStandingPath =
    "/var/mobile/Library/Logs/Faultbox/PallaxSnapshot-1700000000.pallax";

PropertyList entry(const char* description) {
    return Dictionary{{"DisplayState", PropertyList::data({1, 2, 3})},
                      {"Description", description}};
}

/// Notes log lines in the diary of the screen.
class DiaryLog final : public LogSink {
public:
    explicit DiaryLog(ScreenDiary& diary) : _diary(diary) {
        SystemLog::setSink(this, SystemLog::kEverything);
    }
    ~DiaryLog() override { SystemLog::setSink(nullptr); }
    DiaryLog(const DiaryLog&) = delete;
    DiaryLog& operator=(const DiaryLog&) = delete;

    void write(LogPriority priority, std::string_view /*text*/) override {
        _diary.push_back("log " + std::to_string(static_cast<int>(priority)));
    }

private:
    ScreenDiary& _diary;
};

class PallaxSaveViewControllerTest : public testing::Test {
protected:
    std::unique_ptr<PallaxSaveViewController> open(const PropertyList& saveHistory) {
        auto made = std::make_unique<PallaxSaveViewController>(
            PallaxSaveViewController::Surroundings{.toolkit = toolkit,
                                                   .files = files,
                                                   .clock = clock,
                                                   .present = present,
                                                   .queue = queue,
                                                   .snapshotDirectory =
                                                       "/var/mobile/Library/Logs/Faultbox",
                                                   .closeSaveView = [this] { ++closes; },
                                                   .bringUpToDate = [] {}},
            saveHistory);
        screen = made.get();
        return made;
    }
    FakeTextField& field() const { return dynamic_cast<FakeTextField&>(screen->saveDescription()); }
    FakeTableView& table() const {
        return dynamic_cast<FakeTableView&>(screen->saveContentTable());
    }

    FakeToolkit toolkit;
    FakeFileSystem files;
    ManualClock clock;
    ManualClock present;
    SteppedQueue queue;
    RecordingLog log;
    int closes = 0;
    PallaxSaveViewController* screen = nullptr;
    PropertyList two = Array{entry("Snapshot (one)"), entry("Snapshot (two)")};
};

TEST_F(PallaxSaveViewControllerTest, CreationLoadsTheLayoutFromTheInterfaceResource) {
    const auto made = open(two);
    EXPECT_EQ(toolkit.diary,
              (ScreenDiary{"make screen 1", "load layout PallaxSaveViewController"}));
    EXPECT_EQ(&table().source, made.get());
}

TEST_F(PallaxSaveViewControllerTest, ViewDidLoadSetsTheDelegateThenCallsOnThenSizesTheList) {
    const auto made = open(two);
    toolkit.take();
    made->viewDidLoad();
    EXPECT_EQ(toolkit.take(),
              (ScreenDiary{"field setDelegate", "screen 1 didLoad", "list sizeToFit"}));
    EXPECT_EQ(field().delegate, made.get());
}

TEST_F(PallaxSaveViewControllerTest, ViewWillAppearTakesTheApplicationsAreaAndDoesNotCallOn) {
    const auto made = open(two);
    toolkit.take();
    made->viewWillAppear(true);
    EXPECT_EQ(toolkit.take(), ScreenDiary{"screen 1 setFrame (0 20 320 460)"});
}

TEST_F(PallaxSaveViewControllerTest, MemoryWarningAndUnloadArePassedOnOnly) {
    const auto made = open(two);
    toolkit.take();
    made->didReceiveMemoryWarning();
    made->viewDidUnload();
    EXPECT_EQ(toolkit.take(),
              (ScreenDiary{"screen 1 didReceiveMemoryWarning", "screen 1 didUnload"}));
}

TEST_F(PallaxSaveViewControllerTest, ThereAreAsManyRowsAsEntries) {
    EXPECT_EQ(open(two)->numberOfRows(), 2U);
    EXPECT_EQ(open(Array())->numberOfRows(), 0U);
    EXPECT_EQ(open(PropertyList())->numberOfRows(), 0U);
}

TEST_F(PallaxSaveViewControllerTest, ARowIsAPlainCellWithTheDescriptionAndACheckMark) {
    const auto made = open(two);
    table().bounds = {{0, 0}, {280, 30}};
    const auto cell = made->cellForRow(1);
    EXPECT_EQ(table().dequeued, std::vector<std::string>{"SaveHistoryContentCell"});
    EXPECT_EQ(cell->style(), ui::CellStyle::Plain);
    EXPECT_EQ(cell->reuseIdentifier(), "SaveHistoryContentCell");
    EXPECT_EQ(cell->textLabel().text, "Snapshot (two)");
    EXPECT_EQ(cell->textLabel().font, (ui::Font{ui::FontFace::Helvetica, 13}));
    EXPECT_EQ(cell->accessory(), ui::CellAccessory::Checkmark);
    EXPECT_EQ(cell->contentBounds(), table().bounds);
}

TEST_F(PallaxSaveViewControllerTest, ACellIsReused) {
    const auto made = open(two);
    const auto first = made->cellForRow(0);
    table().spare = {first};
    const auto second = made->cellForRow(1);
    EXPECT_EQ(second, first);
    EXPECT_EQ(second->textLabel().text, "Snapshot (two)");
    EXPECT_EQ(second->accessory(), ui::CellAccessory::Checkmark);
}

TEST_F(PallaxSaveViewControllerTest, ARowInWordsIsItsDescription) {
    const auto made = open(two);
    const PaneRow text = made->pane().row(0);
    EXPECT_EQ(text.name, "Snapshot (one)");
    EXPECT_EQ(text.text, std::nullopt);
    EXPECT_FALSE(text.isBranch);
    EXPECT_FALSE(text.hasChanged);
}

TEST_F(PallaxSaveViewControllerTest, AnEntryWithoutADescriptionIsAnEmptyRow) {
    const auto made = open(Array{Dictionary(), "no dictionary"});
    ASSERT_EQ(made->numberOfRows(), 2U);
    EXPECT_EQ(made->cellForRow(0)->textLabel().text, "");
    EXPECT_EQ(made->cellForRow(1)->textLabel().text, "");
    EXPECT_EQ(made->cellForRow(1)->accessory(), ui::CellAccessory::Checkmark);
}

TEST_F(PallaxSaveViewControllerTest, SelectingARowOnlyEndsEditingOfTheDescription) {
    const auto made = open(two);
    toolkit.take();
    made->didSelectRow(0);
    made->didSelectRow(std::nullopt);
    EXPECT_EQ(toolkit.take(),
              (ScreenDiary{"field resignFirstResponder", "field resignFirstResponder"}));
    EXPECT_EQ(made->cellForRow(0)->accessory(), ui::CellAccessory::Checkmark);
}

TEST_F(PallaxSaveViewControllerTest, TheReturnKeyEndsEditingAndIsAnsweredYes) {
    const auto made = open(two);
    toolkit.take();
    EXPECT_TRUE(made->textFieldShouldReturn(made->saveDescription()));
    EXPECT_EQ(toolkit.take(), ScreenDiary{"field resignFirstResponder"});
}

TEST_F(PallaxSaveViewControllerTest, ATouchOfTheBackgroundEndsEditing) {
    const auto made = open(two);
    toolkit.take();
    made->backgroundTouched();
    EXPECT_EQ(toolkit.take(), ScreenDiary{"field resignFirstResponder"});
}

TEST_F(PallaxSaveViewControllerTest, SaveWritesTimestampDataAndDescriptionInThisOrder) {
    const auto made = open(two);
    field().typed = "tunnel entrance, call dropped";
    made->savePressed();
    ASSERT_EQ(files.files.size(), 1U);
    EXPECT_EQ(files.files.begin()->first, kStandingPath);
    const DictionaryRef root = files.files.begin()->second.dictionary();
    ASSERT_NE(root, nullptr);
    EXPECT_TRUE(sameInOrder(*root, Dictionary{{"Timestamp", "2023-11-14 22:13:20 +0000"},
                                              {"Data", two},
                                              {"Description", "tunnel entrance, call dropped"}}))
        << files.files.begin()->second.description();
    EXPECT_EQ(log.lines(), Lines{});
    EXPECT_EQ(toolkit.alerts.size(), 0U);
}

TEST_F(PallaxSaveViewControllerTest, TheTimestampIsUTCInAnyZone) {
    clock.setZone({2h, true});
    const auto made = open(two);
    made->savePressed();
    EXPECT_EQ(*files.files.at(kStandingPath).dictionary()->find("Timestamp"),
              PropertyList("2023-11-14 22:13:20 +0000"));
}

TEST_F(PallaxSaveViewControllerTest, AnEmptyFieldWritesAnEmptyDescription) {
    const auto made = open(two);
    made->savePressed();
    const DictionaryRef root = files.files.at(kStandingPath).dictionary();
    ASSERT_TRUE(root->contains("Description"));
    EXPECT_EQ(*root->find("Description"), PropertyList(""));
}

TEST_F(PallaxSaveViewControllerTest, TheRootDictionaryIsEndedByTheFirstMissingValue) {
    const auto snapshot = [](const PropertyList& stamp, const PropertyList& data,
                             const PropertyList& description) {
        return PallaxSaveViewController::snapshot(stamp, data, description);
    };
    EXPECT_TRUE(sameInOrder(snapshot("T", Array(), "D"),
                            {{"Timestamp", "T"}, {"Data", Array()}, {"Description", "D"}}));
    EXPECT_TRUE(sameInOrder(snapshot("T", Array(), {}), {{"Timestamp", "T"}, {"Data", Array()}}));
    EXPECT_TRUE(sameInOrder(snapshot("T", {}, "D"), {{"Timestamp", "T"}}));
    EXPECT_TRUE(sameInOrder(snapshot({}, Array(), "D"), {}));
}

TEST_F(PallaxSaveViewControllerTest, WithoutSaveContentsTheFileHoldsTheTimestampOnly) {
    const auto made = open(PropertyList());
    field().typed = "described all the same";
    made->savePressed();
    EXPECT_TRUE(sameInOrder(*files.files.at(kStandingPath).dictionary(),
                            {{"Timestamp", "2023-11-14 22:13:20 +0000"}}));
}

TEST_F(PallaxSaveViewControllerTest, ItemsAndTimestampAreThoseOfTheCreation) {
    const ArrayRef contents = two.array();
    const auto made = open(two);
    contents->push_back(entry("Snapshot (later)"));
    contents->erase(contents->begin());
    clock.advance(1h);
    present.advance(70s);
    EXPECT_EQ(made->numberOfRows(), 2U);
    EXPECT_EQ(made->pane().row(0).name, "Snapshot (one)");
    made->savePressed();
    const DictionaryRef root =
        files.files.at("/var/mobile/Library/Logs/Faultbox/PallaxSnapshot-1700000070.pallax")
            .dictionary();
    EXPECT_EQ(*root->find("Timestamp"), PropertyList("2023-11-14 22:13:20 +0000"));
    EXPECT_EQ(*root->find("Data"),
              PropertyList(Array{entry("Snapshot (one)"), entry("Snapshot (two)")}));
}

TEST_F(PallaxSaveViewControllerTest, TwoSavesWithinOneSecondWriteTheSameFile) {
    const auto first = open(two);
    field().typed = "first";
    first->savePressed();
    present.advance(999ms);
    const auto second = open(two);
    field().typed = "second";
    second->savePressed();
    ASSERT_EQ(files.files.size(), 1U);
    EXPECT_EQ(*files.files.at(kStandingPath).dictionary()->find("Description"),
              PropertyList("second"));
}

TEST_F(PallaxSaveViewControllerTest, TheFilesNameIsThePresentWhileTheDisplaysClockStands) {
    present.set(Time(1800000000s));
    for (int save = 0; save < 2; ++save) {
        const auto made = open(two);
        made->savePressed();
        present.advance(5s);
    }
    ASSERT_EQ(files.files.size(), 2U) << "neither has replaced the other";
    const std::string folder = "/var/mobile/Library/Logs/Faultbox/";
    for (const char* name :
         {"PallaxSnapshot-1800000000.pallax", "PallaxSnapshot-1800000005.pallax"}) {
        ASSERT_TRUE(files.exists(folder + name)) << name;
        EXPECT_EQ(*files.files.at(folder + name).dictionary()->find("Timestamp"),
                  PropertyList("2023-11-14 22:13:20 +0000"));
    }
}

TEST_F(PallaxSaveViewControllerTest, WhatXmlCannotHoldIsReplacedAndNamedInTheLog) {
    const auto made =
        open(Array{Dictionary{{"Display", Dictionary{{"Cell", Dictionary{{"Name", "a\x1b[31mb"}}},
                                                     {"Fine", "tab\tand line\n"}}},
                              {"Description", "Snapshot (one)"}}});
    field().typed = "typed\x01";
    made->savePressed();
    EXPECT_TRUE(sameInOrder(
        *files.files.at(kStandingPath).dictionary(),
        {{"Timestamp", "2023-11-14 22:13:20 +0000"},
         {"Data", Array{Dictionary{
                      {"Display", Dictionary{{"Cell", Dictionary{{"Name", "a\xEF\xBF\xBD[31mb"}}},
                                             {"Fine", "tab\tand line\n"}}},
                      {"Description", "Snapshot (one)"}}}},
         {"Description", "typed\xEF\xBF\xBD"}}));
    EXPECT_TRUE(serializeXml(files.files.at(kStandingPath)));
    EXPECT_EQ(log.lines(),
              (Lines{{4, "Characters that XML cannot hold are written as U+FFFD in the snapshot's "
                         "/Data/0/Display/Cell/Name"},
                     {4, "Characters that XML cannot hold are written as U+FFFD in the snapshot's "
                         "/Description"}}));
    EXPECT_EQ(toolkit.alerts.size(), 0U);
}

TEST_F(PallaxSaveViewControllerTest, TheScreenIsClosedOnTheQueueAfterTheSave) {
    const auto made = open(two);
    made->savePressed();
    EXPECT_EQ(closes, 0) << "closes only after the action has returned";
    queue.runReady();
    EXPECT_EQ(closes, 1);
}

TEST_F(PallaxSaveViewControllerTest, AFailedWriteIsLoggedAndAlertedAndTheScreenCloses) {
    files.failWrite = true;
    const auto made = open(two);
    toolkit.take();
    made->savePressed();
    EXPECT_EQ(log.lines(),
              (Lines{{3, "Unable to write snapshot to /var/mobile/Library/Logs/Faultbox/"
                         "PallaxSnapshot-1700000000.pallax"}}));
    EXPECT_EQ(toolkit.take(), ScreenDiary{"alert File Error"});
    ASSERT_EQ(toolkit.alerts.size(), 1U);
    EXPECT_EQ(toolkit.alerts[0].title, "File Error");
    EXPECT_EQ(toolkit.alerts[0].message, "Unable to write file to disk");
    EXPECT_EQ(toolkit.alerts[0].button, "Close");
    EXPECT_EQ(closes, 0);
    queue.runReady();
    EXPECT_EQ(closes, 1);
    EXPECT_TRUE(files.files.empty());
}

TEST_F(PallaxSaveViewControllerTest, AFailedWriteIsLoggedBeforeItIsAlerted) {
    files.failWrite = true;
    const auto made = open(two);
    toolkit.take();
    DiaryLog noted(toolkit.diary);
    made->savePressed();
    EXPECT_EQ(toolkit.take(), (ScreenDiary{"log 3", "alert File Error"}));
}

TEST_F(PallaxSaveViewControllerTest, CancelClosesOnTheQueueAndWritesNothing) {
    const auto made = open(two);
    made->cancelPressed();
    EXPECT_EQ(closes, 0);
    queue.runReady();
    EXPECT_EQ(closes, 1);
    EXPECT_TRUE(files.files.empty());
}

TEST_F(PallaxSaveViewControllerTest, WhatIsWrittenIsAPropertyListThatCanBeReadAgain) {
    const auto made = open(two);
    field().typed = "Brücke <&>";
    made->savePressed();
    const PropertyList& written = files.files.at(kStandingPath);
    const auto xml = serializeXml(written);
    ASSERT_TRUE(xml);
    const auto read = parsePropertyList(ByteBuffer(xml->begin(), xml->end()));
    ASSERT_TRUE(read);
    EXPECT_EQ(*read, written);
}

} // namespace
} // namespace pallax
