#include "app/BrowsingSession.h"

#include "tests/doubles/FakeFileSystem.h"
#include "tests/doubles/FakePreferences.h"
#include "tests/doubles/FakeToolkit.h"
#include "tests/doubles/ModelFixture.h"
#include "tests/doubles/SteppedLoop.h"

#include <memory>
#include <string>
#include <vector>

namespace pallax {
namespace {

using namespace doubles; // NOLINT: the vocabulary of these tests
using namespace std::chrono_literals;

/// A session on its own loop, with a real model and fakes.
class BrowsingSessionTest : public ModelFixture {
protected:
    using Face = std::vector<std::string>;

    BrowsingSessionTest() { model.reset(); } // the session makes its own model

    void SetUp() override {
        ModelFixture::SetUp();
        open({.name = "/drives/drive.pcap"});
    }
    void open(BrowsedSource source, bool startsAfresh = false) {
        session.reset();
        face.clear();
        session = std::make_unique<BrowsingSession>(BrowsingSession::Surroundings{
            .toolkit = toolkit,
            .files = files,
            .preferences = preferences,
            .queue = queue,
            .timers = queue,
            .loop = loop,
            .clock = clock,
            .present = clock,
            .makeModel = [this](ModelObserver& application) { return makeModel(application); },
            .face = {.message = [this](const auto& text) { face.push_back("message " + text); },
                     .note = [this](const auto& text) { face.push_back("note " + text); },
                     .origin =
                         [this](const auto& technology, const auto& name) {
                             face.push_back("origin " + technology + ", " + name);
                         },
                     .oldValues = [this](const auto& time) { face.push_back("old " + time); }},
            .source = std::move(source),
            .isSourceGone = [this] { return isSourceGone; },
            .snapshotDirectory = "/snapshots",
            .saveButtonMarker = "/marker",
            .startsAfreshByItself = startsAfresh});
    }
    std::unique_ptr<PallaxModel> makeModel(ModelObserver& application) {
        return std::make_unique<PallaxModel>(
            PallaxModel::Platform{.ports = ports,
                                  .telephony = telephony,
                                  .queue = queue,
                                  .timers = queue,
                                  .generators = {clock, resources, bundle, standardOutput},
                                  .technologies = kFakeTechnologies},
            application);
    }
    /// Receives a packet that changes the display; the next tick shows it.
    void receive(const PropertyList& display) {
        ports.deliver({1});
        generator().display = display;
    }
    void advance(std::chrono::nanoseconds duration) {
        clock.advance(duration);
        queue.advance(duration);
    }
    void restartLink() {
        ports.endLocal();
        queue.runReady();
    }
    PaneModel& rootPane() const {
        return dynamic_cast<PaneOwner&>(*toolkit.stack->screens().front()).pane();
    }

    FakeToolkit toolkit;
    FakeFileSystem files;
    FakePreferences preferences;
    SteppedLoop loop{queue};
    bool isSourceGone = false;
    Face face;
    std::unique_ptr<BrowsingSession> session;
};

TEST_F(BrowsingSessionTest, RunsOnAnyLoopUntilItIsQuit) {
    std::string shown;
    queue.after(1s, [this] {
        EXPECT_TRUE(session->isConnected());
        receive(Dictionary{{"SIM", "1"}});
    });
    queue.after(3s, [&] {
        shown = rootPane().row(0).text.value_or("");
        session->quit();
    });
    EXPECT_TRUE(session->run());
    EXPECT_EQ(shown, "1");
    EXPECT_EQ(queue.now(), 3s);
    EXPECT_FALSE(session->hasLostSource());
}

TEST_F(BrowsingSessionTest, AToolkitsOwnLoopDrivesIt) {
    session->start();
    EXPECT_FALSE(session->isConnected());
    ASSERT_TRUE(loop.runReady());
    EXPECT_TRUE(session->isConnected());
    receive(Dictionary{{"SIM", "1"}});
    advance(2s);
    ASSERT_TRUE(loop.runReady());
    EXPECT_EQ(rootPane().row(0).text, "1");
    EXPECT_EQ(rootPane().status(), "Updated 2023-11-14 at 22:13:22");
    session->quit();
    EXPECT_FALSE(loop.runReady());
}

TEST_F(BrowsingSessionTest, SaysWhatTheValuesComeFrom) {
    EXPECT_EQ(face, Face{"origin , drive.pcap"});
    session->start();
    queue.runReady();
    EXPECT_EQ(face, (Face{"origin , drive.pcap", "origin Fake, drive.pcap", "old "}));
}

TEST_F(BrowsingSessionTest, SaysFromWhenTheValuesAreThatARestartedLinkLeavesBehind) {
    session->start();
    queue.runReady();
    receive(Dictionary{{"SIM", "1"}});
    advance(2s);
    advance(7s);
    face.clear();
    restartLink();
    EXPECT_EQ(face, (Face{"origin Fake, drive.pcap", "old 22:13:22"}));
    face.clear();
    session->startAfresh();
    queue.runReady();
    EXPECT_EQ(face,
              (Face{"note ", "origin , drive.pcap", "old ", "origin Fake, drive.pcap", "old "}));
    EXPECT_EQ(rootPane().totalRows(), 0U);
}

TEST_F(BrowsingSessionTest, StartsAfreshByItselfIfTheSettingSaysSo) {
    open({.name = "live modem"}, true);
    session->start();
    queue.runReady();
    receive(Dictionary{{"SIM", "1"}});
    advance(2s);
    restartLink();
    EXPECT_EQ(rootPane().totalRows(), 0U);
    EXPECT_EQ(face.back(), "old ");
}

TEST_F(BrowsingSessionTest, AStreamIsNotPlayedAgain) {
    open({.name = "standard input", .isReadOnce = true});
    session->start();
    queue.runReady();
    const std::size_t before = starts();
    session->startAfresh();
    queue.runReady();
    EXPECT_EQ(face.back(), "message A stream can be played only once");
    EXPECT_EQ(starts(), before);
}

TEST_F(BrowsingSessionTest, SaysWhereASnapshotWentAndWhetherItReplacedAnother) {
    files.present = {"/marker"};
    session->start();
    queue.runReady();
    const auto save = [this] {
        const ui::BarItems& items = toolkit.stack->top().toolbarItems();
        std::get<ui::SaveButton>(items.at(3)).action();
        toolkit.stack->modal->savePressed();
        queue.runReady();
    };
    save();
    EXPECT_EQ(face.back(), "message Saved /snapshots/PallaxSnapshot-1700000000.pallax");
    save();
    EXPECT_EQ(face.back(), "message Replaced /snapshots/PallaxSnapshot-1700000000.pallax");
    files.failWrite = true;
    face.clear();
    save();
    EXPECT_EQ(face, Face{});
}

TEST_F(BrowsingSessionTest, ASourceThatIsGoneAtTwoLooksEndsIt) {
    queue.after(700ms, [this] { isSourceGone = true; });
    EXPECT_FALSE(session->run());
    EXPECT_TRUE(session->hasLostSource());
    EXPECT_EQ(queue.now(), 1500ms) << "gone at 1000 ms and at 1500 ms";
}

TEST_F(BrowsingSessionTest, AQuitBetweenTheLooksIsNoLoss) {
    queue.after(700ms, [this] { isSourceGone = true; });
    queue.after(1200ms, [this] { session->quit(); });
    EXPECT_TRUE(session->run());
}

TEST_F(BrowsingSessionTest, ItsEndSwitchesTheHomeScreenPreferenceOff) {
    session->start();
    EXPECT_EQ(preferences.diary, std::vector<std::string>{});
    session.reset();
    EXPECT_EQ(preferences.diary.size(), 3U);
    EXPECT_FALSE(ports.local());
    queue.advance(10s); // nothing is left to run
}

} // namespace
} // namespace pallax
