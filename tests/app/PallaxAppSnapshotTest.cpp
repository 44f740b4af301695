#include "LogGenerator/Technologies/Technologies.h"
#include "plist/PropertyListCodec.h"
#include "tests/app/AppFixture.h"
#include "tests/doubles/InOrder.h"
#include "tests/doubles/RecordBuilder.h"
#include "tests/doubles/TemplateCheck.h"

#include <algorithm>
#include <map>

namespace pallax {
namespace {

using namespace doubles; // NOLINT: the vocabulary of these tests
using namespace std::chrono_literals;

/// Keeps a file's bytes when it is written, like a disk.
class XmlFiles final : public FileSystem {
public:
    std::map<std::string, std::string> files;
    bool directoryMissing = false;

    bool exists(const std::string& path) const override { return files.contains(path); }
    bool writePropertyList(const std::string& path, const PropertyList& object) override {
        const auto xml = serializeXml(object);
        if (directoryMissing || !xml) {
            return false;
        }
        files[path] = *xml;
        return true;
    }
    /// The root dictionary of the only file.
    DictionaryRef onlyRoot() const {
        EXPECT_EQ(files.size(), 1U);
        if (files.empty()) {
            return nullptr;
        }
        const std::string& xml = files.begin()->second;
        const auto parsed = parsePropertyList(ByteBuffer(xml.begin(), xml.end()));
        EXPECT_TRUE(parsed);
        return parsed ? parsed->dictionary() : nullptr;
    }
};

class SnapshotFixture : public AppFixture {
protected:
    void SetUp() override {
        usedFiles = &disk;
        AppFixture::SetUp();
    }
    void launchWith(std::span<const Technology> table, const char* identifier) {
        spoken = table;
        reply = technology(identifier);
        launch();
        ASSERT_TRUE(appModel->isConnected());
    }
    /// Opens the snapshot screen, types a description and presses "Save".
    void save(const std::string& description) {
        app->showSaveView();
        const auto screen = app->saveViewController();
        ASSERT_NE(screen, nullptr);
        dynamic_cast<FakeTextField&>(screen->saveDescription()).typed = description;
        screen->savePressed();
        queue.runReady();
    }
    /// The file's "Data".
    Array savedData() const {
        const DictionaryRef root = disk.onlyRoot();
        const PropertyList* data = root ? root->find("Data") : nullptr;
        return data != nullptr && data->array() ? *data->array() : Array();
    }
    static std::string text(const PropertyList& entry, const char* key) {
        const PropertyList* value = entry.dictionary() ? entry.dictionary()->find(key) : nullptr;
        return value != nullptr ? value->string().value_or("no string") : "none";
    }
    static ByteBuffer bytes(const PropertyList& entry, const char* key) {
        const PropertyList* value = entry.dictionary() ? entry.dictionary()->find(key) : nullptr;
        const SharedBytes data = value != nullptr ? value->data() : nullptr;
        return data ? *data : ByteBuffer();
    }

    XmlFiles disk;
};

class SaveViewTest : public SnapshotFixture {};

TEST_F(SaveViewTest, ShowSaveViewPresentsTheModelsSaveContentsModallyAndAnimated) {
    launchWith(kHistoryTechnologies, "History");
    tick(Dictionary{{"SIM", "in"}});
    toolkit.take();
    app->showSaveView();
    ASSERT_NE(app->saveViewController(), nullptr);
    EXPECT_EQ(stack().modal, app->saveViewController());
    EXPECT_EQ(toolkit.take(), (ScreenDiary{"make screen 2", "load layout PallaxSaveViewController",
                                           "stack presentModal animated=true", "field setDelegate",
                                           "screen 2 didLoad", "list sizeToFit",
                                           "screen 2 setFrame (0 20 320 460)"}));
    ASSERT_EQ(app->saveViewController()->numberOfRows(), 1U);
    EXPECT_EQ(app->saveViewController()->pane().row(0).name,
              "Snapshot (2023-11-14 22:13:22 +0000)");
}

TEST_F(SaveViewTest, PressingSaveTwiceQuicklyOpensOneSnapshotScreen) {
    disk.files[std::string(PallaxApp::kSaveButtonMarker)] = "";
    launchWith(kHistoryTechnologies, "History");
    const auto action = std::get<ui::SaveButton>(top().toolbarItems().at(3)).action;
    action();
    const auto screen = app->saveViewController();
    action();
    EXPECT_EQ(app->saveViewController(), screen);
    const ScreenDiary diary = toolkit.take();
    EXPECT_EQ(std::count(diary.begin(), diary.end(), "stack presentModal animated=true"), 1);
}

TEST_F(SaveViewTest, CloseSaveViewDismissesAnimatedAndReleases) {
    launchWith(kHistoryTechnologies, "History");
    app->showSaveView();
    const std::weak_ptr<PallaxSaveViewController> screen = app->saveViewController();
    toolkit.take();
    app->closeSaveView();
    EXPECT_EQ(toolkit.take(), ScreenDiary{"stack dismissModal animated=true"});
    EXPECT_EQ(app->saveViewController(), nullptr);
    EXPECT_TRUE(screen.expired());
}

TEST_F(SaveViewTest, CloseSaveViewWithoutASnapshotScreenDoesNothing) {
    launchWith(kHistoryTechnologies, "History");
    toolkit.take();
    app->closeSaveView();
    EXPECT_EQ(toolkit.take(), ScreenDiary{});
}

TEST_F(SaveViewTest, CancelClosesTheScreenAndWritesNothing) {
    launchWith(kHistoryTechnologies, "History");
    app->showSaveView();
    app->saveViewController()->cancelPressed();
    EXPECT_NE(app->saveViewController(), nullptr) << "closes only after the action has returned";
    queue.runReady();
    EXPECT_EQ(app->saveViewController(), nullptr);
    EXPECT_TRUE(disk.files.empty());
}

TEST_F(SaveViewTest, AClosedScreenMayBeOpenedAgain) {
    launchWith(kHistoryTechnologies, "History");
    save("first");
    EXPECT_EQ(app->saveViewController(), nullptr);
    app->showSaveView();
    EXPECT_NE(app->saveViewController(), nullptr);
}

TEST_F(SaveViewTest, ACloseThatComesAfterTheApplicationsEndDoesNothing) {
    launchWith(kHistoryTechnologies, "History");
    app->showSaveView();
    app->saveViewController()->cancelPressed();
    app->applicationWillTerminate();
    app.reset();
    queue.runReady();
    EXPECT_EQ(toolkit.diary.back(), "stack clearDelegate");
}

TEST_F(SaveViewTest, TheSnapshotScreenDoesNotFollowNewData) {
    launchWith(kHistoryTechnologies, "History");
    tick(Dictionary{{"SIM", "in"}});
    app->showSaveView();
    tick(Dictionary{{"SIM", "out"}});
    EXPECT_EQ(app->saveViewController()->numberOfRows(), 1U);
    EXPECT_EQ(rowsOf(top()), "SIM=out") << "the pane below is updated";
}

TEST_F(SaveViewTest, WithoutAGeneratorTheFileHoldsTheTimestampOnly) {
    reply = {};
    launch();
    save("described");
    const DictionaryRef root = disk.onlyRoot();
    ASSERT_NE(root, nullptr);
    EXPECT_TRUE(sameInOrder(*root, {{"Timestamp", "2023-11-14 22:13:20 +0000"}}));
}

TEST_F(SaveViewTest, RightAfterLaunchTheDataIsAnEmptyArray) {
    launchWith(kHistoryTechnologies, "History");
    save("");
    const DictionaryRef root = disk.onlyRoot();
    ASSERT_NE(root, nullptr);
    EXPECT_TRUE(sameInOrder(
        *root,
        {{"Timestamp", "2023-11-14 22:13:20 +0000"}, {"Data", Array()}, {"Description", ""}}));
}

TEST_F(SaveViewTest, AfterTenRebuildsTheDataAreTheLastFiveHistoryEntriesOldestFirst) {
    launchWith(kHistoryTechnologies, "History");
    for (int rebuild = 0; rebuild < 10; ++rebuild) {
        tick(Dictionary{{"SIM", std::to_string(rebuild)}});
    }
    save("");
    std::vector<std::string> dates;
    for (const PropertyList& entry : savedData()) {
        dates.push_back(text(entry, "Date"));
    }
    EXPECT_EQ(dates,
              (std::vector<std::string>{"2023-11-14 22:13:32 +0000", "2023-11-14 22:13:34 +0000",
                                        "2023-11-14 22:13:36 +0000", "2023-11-14 22:13:38 +0000",
                                        "2023-11-14 22:13:40 +0000"}));
}

TEST_F(SaveViewTest, TheSnapshotGoesToTheBuiltInDirectoryUnlessAnotherIsSet) {
    launchWith(kHistoryTechnologies, "History");
    save("");
    EXPECT_TRUE(disk.exists("/var/mobile/Library/Logs/Faultbox/PallaxSnapshot-1700000000.pallax"));
    snapshotDirectory = "/elsewhere/snapshots";
    makeApp();
    launchWith(kHistoryTechnologies, "History");
    save("");
    EXPECT_TRUE(disk.exists("/elsewhere/snapshots/PallaxSnapshot-1700000000.pallax"));
}

TEST_F(SaveViewTest, IntoAMissingDirectoryTheAlertStaysOverTheClosedScreenAndTheViewerGoesOn) {
    disk.directoryMissing = true;
    launchWith(kHistoryTechnologies, "History");
    tick(Dictionary{{"SIM", "in"}});
    log.take();
    toolkit.take();
    save("lost");
    EXPECT_EQ(log.take(),
              (Lines{{3, "Unable to write snapshot to /var/mobile/Library/Logs/Faultbox/"
                         "PallaxSnapshot-1700000002.pallax"}}));
    ASSERT_EQ(toolkit.alerts.size(), 1U);
    EXPECT_EQ(toolkit.alerts[0].title, "File Error");
    const ScreenDiary diary = toolkit.take();
    ASSERT_GE(diary.size(), 2U);
    EXPECT_EQ(diary[diary.size() - 2], "alert File Error");
    EXPECT_EQ(diary.back(), "stack dismissModal animated=true");
    EXPECT_EQ(app->saveViewController(), nullptr);
    EXPECT_TRUE(disk.files.empty());

    tick(Dictionary{{"SIM", "out"}});
    EXPECT_EQ(rowsOf(top()), "SIM=out");
    EXPECT_EQ(statusOf(top()), "Updated 2023-11-14 at 22:13:24");
    disk.directoryMissing = false;
    save("found");
    EXPECT_EQ(disk.files.size(), 1U);
}

TEST_F(SaveViewTest, OfTheObjectStreamModemItHoldsTheHistoryAndNoDLF) {
    launchWith(technologies(), "IFX");
    for (int message = 0; message < 10; ++message) {
        const std::string sent = "{ Cell = { ARFCN = " + std::to_string(message) + "; }; }";
        ports.deliver(ByteBuffer(sent.begin(), sent.end()));
        advance(PallaxModel::kDisplayInterval);
    }
    EXPECT_EQ(rowsOf(top()), "Cell=9");
    save("no raw records");
    const Array data = savedData();
    ASSERT_EQ(data.size(), LogGenerator::kHistoryLength);
    for (std::size_t entry = 0; entry < data.size(); ++entry) {
        const std::string arfcn = std::to_string(5 + entry);
        EXPECT_EQ(*data[entry].dictionary()->find("Display"),
                  PropertyList(Dictionary{{"Cell", arfcn}}));
        EXPECT_EQ(*data[entry].dictionary()->find("DisplayState"),
                  PropertyList(Dictionary{{"Cell", Dictionary{{"ARFCN", arfcn}}}}));
        EXPECT_FALSE(data[entry].dictionary()->contains("DLF"));
    }
}

TEST_F(SaveViewTest, TheDisplaysOfTheHistoryShareTheirSectionsWithWhatArrivesBeforeTheSave) {
    const auto onChannel = [](unsigned channel) {
        return Record(0x1183).u8(channel).padTo(50).prefixed();
    };
    resources.add("C2KTemplate", Dictionary{{"Serving", Dictionary{{"Channel", "kChannel"}}}});
    launchWith(technologies(), "Zorell_CDMA");
    ports.deliver(onChannel(25));
    advance(PallaxModel::kDisplayInterval);
    app->showSaveView();
    ports.deliver(onChannel(26));
    queue.runReady();
    app->saveViewController()->savePressed();
    EXPECT_EQ(savedData().front().dictionary()->find("Display")->description(),
              "{ Serving = { Channel = 26; }; }");
}

/// A technology with its real generator and template, and a log code that its records read.
struct RealTechnology {
    const char* identifier;
    const char* templateName;
    LogCode logCode;
};

class RealSnapshotTest : public SnapshotFixture,
                         public testing::WithParamInterface<RealTechnology> {
protected:
    static constexpr std::size_t kHeader = 161; ///< the DLF's version report

    void SetUp() override {
        SnapshotFixture::SetUp();
        const std::string name = GetParam().templateName;
        resources.add(name, propertyListFile(PALLAX_SOURCE_DIR "/resources/" + name + ".plist"));
        launchWith(technologies(), GetParam().identifier);
    }
    /// A message from the log channel, identified by `mark`.
    static ByteBuffer message(unsigned mark) {
        return Record(GetParam().logCode).padTo(60).u8(mark).prefixed();
    }
    /// Runs ten ticks; tick n (from 1) has n messages. Returns the captures of the last five.
    std::vector<ByteBuffer> tenTicks() {
        std::vector<ByteBuffer> captures;
        unsigned mark = 0;
        for (std::size_t number = 1; number <= 10; ++number) {
            ByteBuffer capture;
            for (std::size_t packet = 0; packet < number; ++packet) {
                const ByteBuffer sent = message(++mark);
                ports.deliver(sent);
                capture.insert(capture.end(), sent.begin(), sent.end());
            }
            advance(PallaxModel::kDisplayInterval);
            captures.push_back(std::move(capture));
        }
        return {captures.end() - 5, captures.end()};
    }
};

TEST_P(RealSnapshotTest, AfterTenTicksItHoldsFiveHistoryEntriesAndTheDLFOldestFirst) {
    const std::vector<ByteBuffer> captures = tenTicks();
    EXPECT_GT(top().numberOfRows(), 0U);
    save("tunnel entrance");

    const DictionaryRef root = disk.onlyRoot();
    ASSERT_NE(root, nullptr);
    EXPECT_EQ(*root->find("Timestamp"), PropertyList("2023-11-14 22:13:40 +0000"));
    EXPECT_EQ(*root->find("Description"), PropertyList("tunnel entrance"));
    const Array data = savedData();
    ASSERT_EQ(data.size(), 6U);
    std::size_t captured = 0;
    for (std::size_t entry = 0; entry < captures.size(); ++entry) {
        const std::string date = "2023-11-14 22:13:" + std::to_string(32 + 2 * entry) + " +0000";
        EXPECT_EQ(text(data[entry], "Date"), date);
        EXPECT_EQ(text(data[entry], "Description"), "Snapshot (" + date + ")");
        EXPECT_EQ(bytes(data[entry], "DisplayState"), captures[entry]) << "as captured";
        EXPECT_EQ(data[entry].dictionary()->find("Display")->typeName(), "dictionary");
        EXPECT_EQ(*data[entry].dictionary()->find("ExtraInfo"), PropertyList(Dictionary()));
        captured += captures[entry].size() - 1;
    }
    EXPECT_EQ(text(data[5], "Description"),
              "DLF binary (" + std::to_string(kHeader + captured) + " bytes)");
}

TEST_P(RealSnapshotTest, TheDLFIs161BytesPlusTheCapturesWithoutEachFirstByte) {
    const std::vector<ByteBuffer> captures = tenTicks();
    save("");
    const Array data = savedData();
    ASSERT_EQ(data.size(), 6U);
    const ByteBuffer dlf = bytes(data[5], "DLF");
    ByteBuffer expected;
    for (const ByteBuffer& capture : captures) {
        expected.insert(expected.end(), capture.begin() + 1, capture.end());
    }
    ASSERT_EQ(dlf.size(), kHeader + expected.size());
    EXPECT_EQ(ByteBuffer(dlf.begin() + kHeader, dlf.end()), expected);
    EXPECT_EQ(ByteBuffer(dlf.begin(), dlf.begin() + 4), (ByteBuffer{0xA1, 0x00, 0xFD, 0x1F}));
    EXPECT_EQ(std::string(dlf.begin() + 16, dlf.begin() + 22), "Pallax");
}

TEST_P(RealSnapshotTest, RightAfterLaunchTheDataIsTheDLFEntryAlone) {
    save("");
    const Array data = savedData();
    ASSERT_EQ(data.size(), 1U);
    EXPECT_EQ(text(data[0], "Description"), "DLF binary (161 bytes)");
    EXPECT_EQ(bytes(data[0], "DLF").size(), kHeader);
}

TEST_P(RealSnapshotTest, TheSavedDisplayIsThatOfThePane) {
    (void)tenTicks();
    save("");
    const Array data = savedData();
    ASSERT_EQ(data.size(), 6U);
    PathDictionary paths;
    const NodeRef saved =
        PallaxModelNode::makeTreeFromObject(*data[4].dictionary()->find("Display"), paths);
    PallaxPaneController again(toolkit, *app, saved, "/");
    EXPECT_EQ(rowsOf(again), rowsOf(top()));
    EXPECT_NE(rowsOf(top()), "");
}

INSTANTIATE_TEST_SUITE_P(Technologies, RealSnapshotTest,
                         testing::Values(RealTechnology{"Zorell_GSM", "ZOR_GSM", 0x4125},
                                         RealTechnology{"Zorell_LTE", "LTE", 0xB17F},
                                         RealTechnology{"Zorell_UTRAN2", "UTRAN", 0xD0E0}),
                         [](const auto& param) { return std::string(param.param.templateName); });

} // namespace
} // namespace pallax
