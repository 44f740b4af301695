#include "tests/cli/EndToEndScreen.h"

#include <csignal>
#include <memory>

// Several modems on one screen, each behind a service of its own.

namespace pallax {
namespace {

using doubles::eventually;
using doubles::PallaxProcess;
using doubles::PallaxTerminal;

class EndToEndSeveralModems : public EndToEndScreen {
protected:
    EndToEndSeveralModems() : lte(start("car1", "lte")), gsm(start("car2", "gsm")) {
        EXPECT_TRUE(eventually([this] {
            return run({"service", "--list"}).out == "car1\ncar2\n";
        }));
    }
    std::unique_ptr<PallaxProcess> start(const std::string& name, const std::string& technology) {
        return std::make_unique<PallaxProcess>(
            world, std::vector<std::string>{"service", "--name", name, "--simulate", technology,
                                            "--seed", "7", "--speed", "4"});
    }
    PallaxTerminal open(int columns, int rows) {
        return {world, {"--connect", "car1", "--connect", "car2"}, {columns, rows}};
    }
    static void quit(PallaxTerminal& terminal) {
        terminal.type("q");
        EXPECT_EQ(terminal.wait(), 0);
        EXPECT_TRUE(terminal.isRestored());
        EXPECT_EQ(terminal.screen().unknown(), "");
    }

    /// The status of the first modem, with the time of its display.
    static std::string lteTime(const PallaxTerminal& terminal) {
        const std::string text = terminal.screen().text();
        const auto at = text.find("Updated ");
        return at == std::string::npos ? "?" : text.substr(at, 40);
    }

    std::unique_ptr<PallaxProcess> lte;
    std::unique_ptr<PallaxProcess> gsm;
};

TEST_F(EndToEndSeveralModems, OnAWideScreenAreSideBySide) {
    PallaxTerminal terminal = open(160, 24);
    EXPECT_TRUE(terminal.shows("Zorell_LTE · car1 │ Pallax"));
    EXPECT_TRUE(terminal.shows("Zorell_GSM · car2"));
    EXPECT_TRUE(terminal.shows("▌Serving Cell Info"));
    EXPECT_TRUE(terminal.shows("▌Serving PLMN"));
    terminal.type("\x0e\r"); // Ctrl-N, Enter
    EXPECT_TRUE(terminal.shows("Pallax › Serving PLMN"));
    EXPECT_TRUE(terminal.shows("▌Serving Cell Info")) << "the other side stays as it is";
    terminal.type("1o");
    EXPECT_TRUE(terminal.shows("Pallax › Overview"));
    EXPECT_TRUE(terminal.shows("Pallax › Serving PLMN"));
    terminal.resize(100, 24);
    EXPECT_TRUE(terminal.showsNoMore("Serving PLMN"));
    EXPECT_TRUE(terminal.shows("[1 car1] 2 car2"));
    terminal.resize(170, 24);
    EXPECT_TRUE(terminal.shows("Pallax › Serving PLMN"));
    terminal.type("o");
    EXPECT_TRUE(terminal.showsNoMore("Overview"));
    quit(terminal);
}

TEST_F(EndToEndSeveralModems, OnANarrowScreenAreSwitchedByNumbers) {
    PallaxTerminal terminal = open(80, 24);
    EXPECT_TRUE(terminal.shows("[1 car1] 2 car2"));
    EXPECT_TRUE(terminal.shows("Zorell_LTE · car1"));
    terminal.type("2");
    EXPECT_TRUE(terminal.shows(" 1 car1 [2 car2]"));
    EXPECT_TRUE(terminal.shows("Zorell_GSM · car2"));
    EXPECT_TRUE(terminal.showsNoMore("Zorell_LTE"));
    terminal.type("/1");
    EXPECT_TRUE(terminal.shows(" / 1")) << "a number that is typed into a filter is text";
    EXPECT_TRUE(terminal.shows("[2 car2]"));
    terminal.type("\x1b");
    EXPECT_TRUE(terminal.showsNoMore(" / 1"));
    terminal.type("1");
    EXPECT_TRUE(terminal.shows("[1 car1]"));
    quit(terminal);
}

TEST_F(EndToEndSeveralModems, OneServiceCanEndAndComeBackWhileTheOtherGoesOn) {
    PallaxTerminal terminal = open(160, 24);
    ASSERT_TRUE(terminal.shows("▌Serving PLMN"));
    ASSERT_TRUE(terminal.shows("▌Serving Cell Info"));
    gsm->signal(SIGKILL);
    (void)gsm->wait();
    ASSERT_TRUE(terminal.shows("car2  connecting: no service"));
    EXPECT_TRUE(terminal.shows("No telephony service named car2 is running; waiting"));
    terminal.type("1o");
    const std::string shown = lteTime(terminal);
    EXPECT_TRUE(terminal.showsNoMore(shown)) << "the other one goes on";
    EXPECT_TRUE(terminal.shows("Zorell_LTE · car1 │"));
    gsm = start("car2", "gsm");
    EXPECT_TRUE(terminal.showsNoMore("connecting: no service"));
    EXPECT_TRUE(terminal.shows("values from before "));
    terminal.type("o");
    quit(terminal);
}

TEST_F(EndToEndSeveralModems, HoldTimeEachForItself) {
    PallaxTerminal terminal = open(160, 24);
    ASSERT_TRUE(terminal.shows("▌Serving PLMN"));
    ASSERT_TRUE(terminal.shows("▌Serving Cell Info"));
    terminal.type(" ");
    EXPECT_TRUE(terminal.shows("held, "));
    terminal.type("2");
    EXPECT_TRUE(terminal.shows("held, ")) << "the first is held still";
    terminal.type("$");
    EXPECT_TRUE(terminal.shows("held, ")) << "the second is in the present anyway";
    terminal.type("1$");
    EXPECT_TRUE(terminal.showsNoMore("held, "));
    quit(terminal);
}

TEST_F(EndToEndSeveralModems, ASnapshotIsOfTheModemWithTheKeyboard) {
    PallaxTerminal terminal = open(80, 24);
    terminal.type("2");
    ASSERT_TRUE(terminal.shows("▌Serving PLMN"));
    ASSERT_TRUE(terminal.shows("s Save"));
    terminal.type("s");
    ASSERT_TRUE(terminal.shows("Save snapshot"));
    terminal.type("1\r\r"); // a number in the description
    EXPECT_TRUE(terminal.shows("Saved " + snapshots));
    EXPECT_TRUE(terminal.shows("[2 car2]"));
    quit(terminal);
    std::string content;
    for (const std::string& file : filesIn(snapshots)) {
        content += contentOf(file);
    }
    EXPECT_NE(content.find("Serving PLMN"), std::string::npos);
    EXPECT_EQ(content.find("E-ARFCN"), std::string::npos);
}

TEST_F(EndToEndSeveralModems, AreNotPrinted) {
    for (const std::string& form :
         {std::string("--print"), std::string("--plain"), std::string()}) {
        std::vector<std::string> arguments{"--connect", "car1", "--connect", "car2"};
        if (!form.empty()) {
            arguments.push_back(form);
        }
        const Run refused = run(arguments);
        EXPECT_EQ(refused.status, 2);
        EXPECT_EQ(refused.out, "");
        EXPECT_EQ(refused.err, "pallax: Several modems are shown only on the screen of a "
                               "terminal: give one --connect.\n");
    }
}

TEST_F(EndToEndSeveralModems, OneWithANameShowsItInTheTitle) {
    PallaxTerminal terminal(world, {"--connect", "car2"}, {});
    EXPECT_TRUE(terminal.shows("Zorell_GSM · car2"));
    EXPECT_TRUE(terminal.screen().text().starts_with(" Pallax ")) << "it has the whole screen";
    quit(terminal);
}

TEST_F(EndToEndSeveralModems, AMissingOneIsWaitedFor) {
    PallaxTerminal terminal(world, {"--connect", "car9"}, {});
    EXPECT_TRUE(terminal.shows("car9  connecting: no service"));
    EXPECT_TRUE(terminal.shows("No telephony service named car9 is running; waiting"));
    quit(terminal);
}

} // namespace
} // namespace pallax
