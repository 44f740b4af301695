#include "tests/app/AppFixture.h"

namespace pallax {
namespace {

using namespace doubles; // NOLINT: the vocabulary of these tests
using namespace std::chrono_literals;

constexpr const char* kMarker =
    "/NorvaneInternal/Library/PreferenceBundles/Carrier Settings.bundle";

/// Notes its requests in the diary of the screens.
class NotingFiles final : public FileSystem {
public:
    explicit NotingFiles(ScreenDiary& diary) : _diary(diary) {}
    bool exists(const std::string& path) const override {
        _diary.push_back("exists " + path);
        return false;
    }
    bool writePropertyList(const std::string& /*path*/, const PropertyList& /*object*/) override {
        return false;
    }

private:
    ScreenDiary& _diary;
};

class PallaxAppTest : public AppFixture {
protected:
    /// The remaining parts of the application object, as a line of a diary.
    std::string remains() const {
        return "message=" + truth(app->updateMessage().has_value()) +
               " saveView=" + truth(app->saveViewController() != nullptr) +
               " window=" + truth(app->window() != nullptr) +
               " ports=" + truth(ports.local() != nullptr);
    }
};

TEST_F(PallaxAppTest, StartUpGoesInItsOrder) {
    NotingFiles noting(toolkit.diary);
    usedFiles = &noting;
    makeApp();
    app->applicationDidFinishLaunching();
    EXPECT_EQ(
        toolkit.take(),
        (ScreenDiary{std::string("exists ") + kMarker, "make window (0 0 320 480)", "make model",
                     "make screen 1", "make table 1", "screen 1 toolbarItemsChanged animated=true",
                     "make stack", "stack setDelegate", "window setRoot", "window addView",
                     "window makeKeyAndVisible", "screen 1 didLoad",
                     "screen 1 willAppear animated=false", "screen 1 titleChanged",
                     "stack showToolbar", "screen 1 toolbarItemsChanged animated=true"}));
    EXPECT_EQ(app->updateMessage(), "Connecting...");
    EXPECT_EQ(stack().delegate, app.get());
    EXPECT_NE(app->window(), nullptr);
}

TEST_F(PallaxAppTest, TheRootPanesFirstStatusIsConnectingWithoutDots) {
    app->applicationDidFinishLaunching();
    ASSERT_EQ(depth(), 1U);
    EXPECT_EQ(statusOf(top()), "Connecting (loading)");
    EXPECT_EQ(top().path(), "/");
}

TEST_F(PallaxAppTest, BeforeTheFirstDataTheRootPaneIsTitledPallaxAndHasNoRows) {
    launch();
    EXPECT_EQ(top().title(), "Pallax");
    EXPECT_EQ(top().numberOfRows(), 0U);
}

TEST_F(PallaxAppTest, ConnectingBeginsOnTheQueueAfterTheFirstScreen) {
    app->applicationDidFinishLaunching();
    EXPECT_EQ(ports.diary, Diary{}) << "the model's creation does not connect";
    queue.runReady();
    EXPECT_TRUE(appModel->isConnected());
}

TEST_F(PallaxAppTest, TheQueuedCallIsTheModelsRestart) {
    app->applicationDidFinishLaunching();
    appModel->startMonitor();
    ASSERT_EQ(starts(), 1U);
    queue.runReady();
    EXPECT_EQ(starts(), 2U) << "a plain start would not restart a running monitor";
}

TEST_F(PallaxAppTest, AnApplicationThatIsGoneIsNotStarted) {
    app->applicationDidFinishLaunching();
    app.reset();
    queue.runReady();
    EXPECT_EQ(ports.diary, Diary{});
}

TEST_F(PallaxAppTest, AnApplicationThatHasTerminatedIsNotStarted) {
    app->applicationDidFinishLaunching();
    app->applicationWillTerminate();
    queue.runReady();
    EXPECT_EQ(ports.diary, Diary{});
}

TEST_F(PallaxAppTest, TheStackForgetsItsDelegateBeforeTheApplicationEnds) {
    launch();
    toolkit.take();
    app.reset();
    EXPECT_EQ(toolkit.take(), (ScreenDiary{"stack clearDelegate", "window released"}));
}

TEST_F(PallaxAppTest, TheSaveButtonIsOfferedWhereTheMarkerPathExists) {
    files.present = {kMarker};
    launch();
    EXPECT_TRUE(app->allowSaveButton());
    EXPECT_TRUE(offersSave(top()));
    tick(Dictionary{{"Section", Dictionary()}});
    openRow("Section");
    EXPECT_TRUE(offersSave(top()));
}

TEST_F(PallaxAppTest, WithoutTheMarkerPathNoPaneShowsASaveButton) {
    launch();
    EXPECT_FALSE(app->allowSaveButton());
    EXPECT_FALSE(offersSave(top()));
    tick(Dictionary{{"Section", Dictionary()}});
    openRow("Section");
    EXPECT_FALSE(offersSave(top()));
    EXPECT_FALSE(offersSave(pane(0)));
}

TEST_F(PallaxAppTest, WithoutTheMarkerPathTheSaveViewIsReachedByADirectCall) {
    launch();
    app->showSaveView();
    EXPECT_NE(app->saveViewController(), nullptr);
}

TEST_F(PallaxAppTest, TheMarkerPathIsASetting) {
    saveButtonMarker = "/somewhere/else";
    makeApp();
    files.present = {kMarker};
    app->getSaveButtonPref();
    EXPECT_FALSE(app->allowSaveButton());
    files.present = {"/somewhere/else"};
    app->getSaveButtonPref();
    EXPECT_TRUE(app->allowSaveButton());
    files.present = {};
    app->getSaveButtonPref();
    EXPECT_FALSE(app->allowSaveButton());
}

TEST_F(PallaxAppTest, SetGSMRSSIStoresSynchronizesAndPostsInThisOrder) {
    app->_setGSMRSSI(true);
    EXPECT_EQ(preferences.diary,
              (Diary{"set com.norvane.plinthe PLShowGSMRSSI", "synchronize com.norvane.plinthe",
                     "post com.norvane.plinthe PLShowGSMRSSI"}));
    EXPECT_EQ(*preferences.domain("com.norvane.plinthe").find("PLShowGSMRSSI"),
              PropertyList::boolean(true));
}

TEST_F(PallaxAppTest, TheNoticeIsPostedThoughTheDomainCouldNotBeSynchronized) {
    preferences.failSynchronize = true;
    app->_setGSMRSSI(false);
    EXPECT_EQ(preferences.diary.back(), "post com.norvane.plinthe PLShowGSMRSSI");
}

TEST_F(PallaxAppTest, EveryExitSwitchesTheGSMSignalStrengthOff) {
    app->applicationWillTerminate(); // also before the launch
    EXPECT_EQ(*preferences.domain("com.norvane.plinthe").find("PLShowGSMRSSI"),
              PropertyList::boolean(false));
    makeApp();
    launch();
    app->applicationWillTerminate();
    EXPECT_EQ(preferences.diary.size(), 6U);
    EXPECT_EQ(preferences.diary.back(), "post com.norvane.plinthe PLShowGSMRSSI");
}

TEST_F(PallaxAppTest, NothingEverSwitchesTheGSMSignalStrengthOn) {
    launch();
    tick(Dictionary{{"Section", Dictionary()}});
    EXPECT_EQ(preferences.diary, Diary{});
}

/// Notes the application's parts when a preference is written.
class WitnessPreferences final : public Preferences {
public:
    WitnessPreferences(ScreenDiary& diary, std::function<std::string()> remains)
        : _diary(diary), _remains(std::move(remains)) {}
    void setValue(std::string_view key, const PropertyList& value,
                  std::string_view /*domain*/) override {
        _diary.push_back("set " + std::string(key) + "=" + truth(value.boolean().value()) + " " +
                         _remains());
    }
    bool synchronize(std::string_view /*domain*/) override { return true; }
    void postChangedNotice(std::string_view /*domain*/, std::string_view /*key*/) override {}

private:
    ScreenDiary& _diary;
    std::function<std::string()> _remains;
};

/// Notes the application's parts when it is hidden and when it is released.
class WitnessWindow final : public ui::Window {
public:
    WitnessWindow(ScreenDiary& diary, std::function<std::string()> remains)
        : _diary(diary), _remains(std::move(remains)) {}
    ~WitnessWindow() override { _diary.push_back("window released " + _remains()); }
    WitnessWindow(const WitnessWindow&) = delete;
    WitnessWindow& operator=(const WitnessWindow&) = delete;
    void setRoot(ui::NavigationStack& /*stack*/) override {}
    void addView(ui::NavigationStack& /*stack*/) override {}
    void makeKeyAndVisible() override {}
    void takeOffScreen() override { _diary.push_back("window takeOffScreen " + _remains()); }

private:
    ScreenDiary& _diary;
    std::function<std::string()> _remains;
};

TEST_F(PallaxAppTest, ShutdownGoesInItsOrder) {
    WitnessPreferences witness(toolkit.diary, [this] { return remains(); });
    usedPreferences = &witness;
    makeApp();
    launch();
    app->showSaveView();
    app->setWindow(std::make_unique<WitnessWindow>(toolkit.diary, [this] { return remains(); }));
    toolkit.take();
    app->applicationWillTerminate();
    EXPECT_EQ(
        toolkit.take(),
        (ScreenDiary{"set PLShowGSMRSSI=false message=true saveView=true window=true ports=true",
                     "window takeOffScreen message=false saveView=false window=true ports=true",
                     // The application clears the field before the window is destroyed.
                     "window released message=false saveView=false window=false ports=true"}));
    EXPECT_EQ(remains(), "message=false saveView=false window=false ports=false");
}

TEST_F(PallaxAppTest, ShutdownTearsTheModelDownWithoutARestart) {
    launch();
    app->applicationWillTerminate();
    EXPECT_EQ(ports.local(), nullptr);
    EXPECT_EQ(ports.remote(), nullptr);
    EXPECT_TRUE(FakeGenerator::living.empty());
    queue.advance(60s);
    EXPECT_EQ(starts(), 1U);
}

TEST_F(PallaxAppTest, AfterShutdownAnUpdateDoesNoHarm) {
    launch();
    tick(Dictionary{{"Section", Dictionary()}});
    app->applicationWillTerminate();
    app->updateViewControllerFromModel();
    EXPECT_EQ(statusOf(top()), "Connecting... (loading)");
    EXPECT_EQ(top().numberOfRows(), 0U);
}

TEST_F(PallaxAppTest, BeforeTheLaunchAnUpdateDoesNoHarm) {
    app->updateViewControllerFromModel();
    app->closeSaveView();
    EXPECT_EQ(app->navigationController(), nullptr);
    EXPECT_EQ(toolkit.diary, ScreenDiary{});
}

TEST_F(PallaxAppTest, ThePropertiesHoldWhatTheyAreGiven) {
    launch();
    app->setUpdateMessage("a message");
    EXPECT_EQ(app->updateMessage(), "a message");
    app->setUpdateMessage(std::nullopt);
    EXPECT_EQ(app->updateMessage(), std::nullopt);
    app->setAllowSaveButton(true);
    EXPECT_TRUE(app->allowSaveButton());
    app->showSaveView();
    app->setSaveViewController(nullptr);
    EXPECT_EQ(app->saveViewController(), nullptr);
    app->setWindow(nullptr);
    EXPECT_EQ(app->window(), nullptr);
}

} // namespace
} // namespace pallax
