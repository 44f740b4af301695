#include "tests/cli/EndToEndScreen.h"

namespace pallax {
namespace {

using doubles::eventually;
using doubles::PallaxProcess;

/// A viewer that shows nothing that identifies a person.
class EndToEndSafe : public EndToEndScreen {
protected:
    static constexpr const char* kCopiedIccid = "ODk0OTAyMDAwMDAxMjM0NTY3MA=="; ///< in base64

    /// Nothing that the terminal has got from there on, copied texts included, is of the identity.
    static void expectNoIdentity(const PallaxTerminal& terminal, std::size_t from = 0) {
        const std::string bytes = terminal.bytes().substr(from);
        EXPECT_EQ(bytes.find("0123456"), std::string::npos);
        EXPECT_EQ(bytes.find(kCopiedIccid), std::string::npos);
    }
    /// Opens the section with the cursor on the ICCID.
    static void openIccid(PallaxTerminal& terminal) {
        terminal.type("/sim info\r");
        ASSERT_TRUE(terminal.shows("1 of 26"));
        terminal.type("\r/iccid\r");
        ASSERT_TRUE(terminal.shows("▌EF-ICCID"));
    }
    /// Looks at the ICCID in every way that has keys: copies it, explains it, puts it into a graph,
    /// finds it in a frame and in the recording, lists events and asks in SQL.
    static void useEveryKey(PallaxTerminal& terminal) {
        terminal.type("y");
        ASSERT_TRUE(terminal.shows(std::string("Copied: ") + kMaskedIccid));
        terminal.type("i");
        ASSERT_TRUE(terminal.shows("EF-ICCID"));
        terminal.type(std::string("y") + kEscape + "vV");
        (void)terminal.settled();
        terminal.type(kEscape);
        terminal.type("f8949");
        ASSERT_TRUE(terminal.shows("Find in this frame"));
        (void)terminal.settled();
        terminal.type("\t");
        ASSERT_TRUE(terminal.shows("Find in the whole recording"));
        (void)terminal.settled();
        terminal.type(std::string(kEscape) + kEscape + "e");
        (void)terminal.settled();
        terminal.type(kEscape);
        terminal.type(";select distinct text from sample where field like '%iccid'\r");
        ASSERT_TRUE(terminal.shows("1 row"));
        terminal.type(std::string("y") + kEscape + "m,d");
        (void)terminal.settled();
        terminal.type(std::string(kEscape) + "$");
    }
};

TEST_F(EndToEndSafe, PrintsWhatTheMaskedRecordingHolds) {
    const std::string copy = world.path("copy.pcap");
    ASSERT_EQ(run({"mask", withSim(), "-o", copy}).status, 0);
    const Run safe = run({withSim(), "--print", "--safe", "--speed", "max"});
    EXPECT_EQ(safe.status, 0);
    EXPECT_NE(safe.out.find(std::string("EF-ICCID: ") + kMaskedIccid + "\n"), std::string::npos);
    EXPECT_EQ(safe.out, run({copy, "--print", "--speed", "max"}).out);
}

TEST_F(EndToEndSafe, NoKeyShowsFindsOrSavesAnIdentity) {
    PallaxTerminal terminal(world, {withSim(), "--safe", "--speed", "max"}, {});
    ASSERT_TRUE(terminal.shows("End of the recording"));
    terminal.type("/sim info\r");
    ASSERT_TRUE(terminal.shows("1 of 26"));
    terminal.type("\r");
    ASSERT_TRUE(terminal.shows("Pallax › SIM Info"));
    ASSERT_TRUE(terminal.shows(kMaskedIccid));
    EXPECT_TRUE(terminal.shows("Net"));
    terminal.type("i"); // the page of the value
    ASSERT_TRUE(terminal.shows(kMaskedIccid));
    terminal.type(kEscape);
    terminal.type(","); // the past comes from what has been received
    ASSERT_TRUE(terminal.shows("held"));
    EXPECT_TRUE(terminal.showsNoMore(kIccid));
    terminal.type("$s");
    ASSERT_TRUE(terminal.shows("Save snapshot"));
    terminal.type("\r\r");
    ASSERT_TRUE(terminal.shows("Saved " + snapshots));
    terminal.type("j"); // removes the message
    ASSERT_TRUE(terminal.showsNoMore("Saved "));
    terminal.type("h");
    ASSERT_TRUE(terminal.showsNoMore("Pallax › "));
    terminal.type(kEscape); // removes the filter
    ASSERT_TRUE(terminal.shows("PDP Context Info"));
    terminal.type("q");
    EXPECT_EQ(terminal.wait(), 0);
    const auto saved = filesIn(snapshots);
    ASSERT_EQ(saved.size(), 1U);
    EXPECT_EQ(contentOf(saved.front()).find(kIccid), std::string::npos);
    EXPECT_EQ(run({"mask", "--check", saved.front()}).status, 0);
}

TEST_F(EndToEndSafe, AKeyHidesIdentitiesAndShowsThemAgain) {
    PallaxTerminal terminal(world, {withSim(), "--speed", "max"}, {});
    const auto openSim = [&] {
        ASSERT_TRUE(terminal.shows("End of the recording"));
        terminal.type("/sim info\r");
        ASSERT_TRUE(terminal.shows("1 of 26"));
        terminal.type("\r");
        ASSERT_TRUE(terminal.shows("Pallax › SIM Info"));
    };
    openSim();
    ASSERT_TRUE(terminal.shows(kIccid));
    terminal.type("x");
    ASSERT_TRUE(terminal.showsNoMore(kIccid));
    ASSERT_TRUE(terminal.shows("safe"));
    openSim();
    ASSERT_TRUE(terminal.shows(kMaskedIccid));
    terminal.type(",");
    ASSERT_TRUE(terminal.shows("held"));
    ASSERT_TRUE(terminal.shows(kMaskedIccid));
    EXPECT_TRUE(terminal.showsNoMore(kIccid));
    terminal.type(";select count(*) as found from sample where text like '8949%'\r");
    ASSERT_TRUE(terminal.shows("1 row"));
    EXPECT_TRUE(terminal.showsNoMore("89490"));
    terminal.type(std::string(kEscape) + "x");
    ASSERT_TRUE(terminal.showsNoMore("safe"));
    openSim();
    EXPECT_TRUE(terminal.shows(kIccid));
}

TEST_F(EndToEndSafe, NoKeyUndoesTheOption) {
    PallaxTerminal terminal(world, {withSim(), "--safe", "--speed", "max"}, {});
    ASSERT_TRUE(terminal.shows("End of the recording"));
    ASSERT_TRUE(terminal.shows("safe"));
    terminal.type("x");
    EXPECT_TRUE(terminal.shows("The viewer was started with --safe and stays so."));
    terminal.type("j");
    EXPECT_TRUE(terminal.shows("safe"));
}

TEST_F(EndToEndSafe, NothingThatTheTerminalGetsIsAnIdentity) {
    PallaxTerminal terminal(world, {withSim(), "--safe", "--speed", "max"}, {100, 30});
    ASSERT_TRUE(terminal.shows("End of the recording"));
    openIccid(terminal);
    useEveryKey(terminal);
    terminal.type("R"); // starts afresh
    (void)terminal.settled();
    expectNoIdentity(terminal);
}

TEST_F(EndToEndSafe, NothingThatTheTerminalGetsAfterTheKeyIsAnIdentity) {
    PallaxTerminal terminal(world, {withSim(), "--speed", "max"}, {100, 30});
    ASSERT_TRUE(terminal.shows("End of the recording"));
    openIccid(terminal);
    ASSERT_TRUE(terminal.shows(kIccid));
    terminal.type("y");
    ASSERT_TRUE(terminal.shows(std::string("Copied: ") + kIccid));
    EXPECT_NE(terminal.bytes().find(kCopiedIccid), std::string::npos);
    terminal.type("mvix"); // marked, in a graph, and on the page of a value
    ASSERT_TRUE(terminal.showsNoMore(kIccid));
    ASSERT_TRUE(terminal.shows("safe"));
    (void)terminal.settled();
    const std::size_t begin = terminal.bytes().size();
    openIccid(terminal);
    useEveryKey(terminal);
    terminal.type("s");
    ASSERT_TRUE(terminal.shows("Save snapshot"));
    terminal.type("\r\r");
    ASSERT_TRUE(terminal.shows("Saved " + snapshots));
    expectNoIdentity(terminal, begin);
    const auto saved = filesIn(snapshots);
    ASSERT_EQ(saved.size(), 1U);
    EXPECT_EQ(contentOf(saved.front()).find("0123456"), std::string::npos);
    EXPECT_EQ(run({"mask", "--check", saved.front()}).status, 0);
}

TEST_F(EndToEndSafe, TheKeyHidesTheIdentitiesOfAllModems) {
    const std::string recording = withSim();
    const PallaxProcess one(world, {"service", "--name", "one", "--play", recording, "--loop"});
    const PallaxProcess other(world, {"service", "--name", "other", "--play", recording, "--loop"});
    ASSERT_TRUE(eventually([this] { return run({"service", "--list"}).out == "one\nother\n"; }));
    PallaxTerminal terminal(world, {"--connect", "one", "--connect", "other"}, {160, 24});
    ASSERT_TRUE(terminal.shows("Zorell_GSM · other"));
    const auto openBoth = [&terminal] {
        for (const char* modem : {"1", "2"}) {
            terminal.type(std::string(modem) + "/sim info\r");
            ASSERT_TRUE(terminal.shows("1 of 26"));
            terminal.type("\r");
            ASSERT_TRUE(terminal.showsNoMore("1 of 26"));
        }
    };
    openBoth();
    const auto identities = [&terminal] {
        const std::string text = terminal.screen().text();
        int count = 0;
        for (auto at = text.find(kIccid); at != std::string::npos; at = text.find(kIccid, at + 1)) {
            ++count;
        }
        return count;
    };
    ASSERT_TRUE(terminal.shows(kIccid));
    ASSERT_TRUE(eventually([&] {
        (void)terminal.settled();
        return identities() == 2;
    }));
    terminal.type("x");
    ASSERT_TRUE(terminal.showsNoMore(kIccid));
    (void)terminal.settled();
    const std::size_t begin = terminal.bytes().size();
    openBoth();
    ASSERT_TRUE(terminal.shows(kMaskedIccid));
    (void)terminal.settled();
    expectNoIdentity(terminal, begin);
}

TEST_F(EndToEndSafe, WithoutItTheIdentityIsShown) {
    const Run open = run({withSim(), "--print", "--speed", "max"});
    EXPECT_NE(open.out.find(std::string("EF-ICCID: ") + kIccid), std::string::npos);
}

} // namespace
} // namespace pallax
