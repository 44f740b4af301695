#include "tests/cli/EndToEndScreen.h"
#include "tests/doubles/PropertyListRecord.h"

namespace pallax {
namespace {

/// A viewer that shows nothing that identifies a person.
class EndToEndSafe : public EndToEndScreen {
protected:
    static constexpr const char* kIccid = "8949020000012345670";

    std::string withSim() const {
        using std::chrono::milliseconds;
        return record("sim.pcap",
                      {{milliseconds(0), registration(1)},
                       {milliseconds(500),
                        doubles::textRecord(kSimFiles, std::string("{kSimFile_ICCID = ") + kIccid +
                                                           "; kSimFile_PNN = Net;}")
                            .prefixed()},
                       {milliseconds(3000), registration(2)}});
    }
};

TEST_F(EndToEndSafe, PrintsWhatTheMaskedRecordingHolds) {
    const std::string copy = world.path("copy.pcap");
    ASSERT_EQ(run({"mask", withSim(), "-o", copy}).status, 0);
    const Run safe = run({withSim(), "--print", "--safe", "--speed", "max"});
    EXPECT_EQ(safe.status, 0);
    EXPECT_NE(safe.out.find("EF-ICCID: 0000000000000000000\n"), std::string::npos);
    EXPECT_EQ(safe.out, run({copy, "--print", "--speed", "max"}).out);
}

TEST_F(EndToEndSafe, NoKeyShowsFindsOrSavesAnIdentity) {
    PallaxTerminal terminal(world, {withSim(), "--safe", "--speed", "max"}, {});
    ASSERT_TRUE(terminal.shows("End of the recording"));
    terminal.type("/sim info\r");
    ASSERT_TRUE(terminal.shows("1 of 26"));
    terminal.type("\r");
    ASSERT_TRUE(terminal.shows("Pallax › SIM Info"));
    ASSERT_TRUE(terminal.shows("0000000000000000000"));
    EXPECT_TRUE(terminal.shows("Net"));
    terminal.type("i"); // the page of the value
    ASSERT_TRUE(terminal.shows("0000000000000000000"));
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
    ASSERT_TRUE(terminal.shows("0000000000000000000"));
    terminal.type(",");
    ASSERT_TRUE(terminal.shows("held"));
    ASSERT_TRUE(terminal.shows("0000000000000000000"));
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

TEST_F(EndToEndSafe, WithoutItTheIdentityIsShown) {
    const Run open = run({withSim(), "--print", "--speed", "max"});
    EXPECT_NE(open.out.find(std::string("EF-ICCID: ") + kIccid), std::string::npos);
}

} // namespace
} // namespace pallax
