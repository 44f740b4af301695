#include "window/WindowSession.h"

#include "tests/cli/EndToEnd.h"
#include "tests/window/SessionStage.h"

namespace pallax {
namespace {

class WindowSessionTest : public EndToEnd {
protected:
    void SetUp() override {
        if (!doubles::openXDisplay()) {
            GTEST_SKIP() << "Xvfb is not installed";
        }
    }
};

TEST_F(WindowSessionTest, HidingIdentitiesLeavesNothingOfThePagesThatWereOpen) {
    SessionStage stage(withSim());
    stage.open("SIM Info");
    stage.awaitShown(kIccid);
    stage.frame.toggleSearch();
    stage.type(kIccid);
    stage.open("EF-ICCID");
    stage.awaitShown("title: EF-ICCID");
    EXPECT_TRUE(stage.shows(std::string("text: ") + kIccid));
    stage.press(GDK_KEY_f);
    stage.type(kIccid);
    stage.awaitShown(std::string("EF-ICCID | ") + kIccid);
    stage.session->toggleSafe();
    EXPECT_TRUE(stage.session->isSafe());
    EXPECT_FALSE(stage.frame.pages().isOpen());
    EXPECT_TRUE(stage.await([&] { return stage.frame.shownStack()->isAtRoot(); }));
    EXPECT_FALSE(stage.shows(kIccid)) << stage.dump();
    stage.open("SIM Info");
    stage.awaitShown(kMaskedIccid);

    stage.press(GDK_KEY_f);
    EXPECT_TRUE(stage.shows("title: Find a Text"));
    EXPECT_TRUE(stage.shows("field: \"\"")) << stage.dump();
    EXPECT_FALSE(stage.shows("cells")) << stage.dump();
}

TEST_F(WindowSessionTest, ThePlaceInTimeThatWasTypedIsForgottenToo) {
    SessionStage stage(withSim());
    stage.press(GDK_KEY_colon);
    stage.type(std::string("ef_iccid = '") + kIccid + "'");
    EXPECT_TRUE(stage.shows(kIccid));
    stage.session->toggleSafe();
    EXPECT_FALSE(stage.shows(kIccid)) << stage.dump();
}

TEST_F(WindowSessionTest, OneThatWasStartedSafeStaysSo) {
    SessionStage stage(withSim(), true);
    stage.open("SIM Info");
    stage.awaitShown(kMaskedIccid);
    stage.session->toggleSafe();
    stage.awaitShown("text: The viewer was started with --safe and stays so.");
    EXPECT_TRUE(stage.session->isSafe());
    stage.open("EF-ICCID");
    stage.awaitShown(std::string("text: ") + kMaskedIccid);
    EXPECT_FALSE(stage.shows(kIccid)) << stage.dump();
}

} // namespace
} // namespace pallax
