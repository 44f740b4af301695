#include "tests/cli/ParsedOptions.h"

#include <gtest/gtest.h>

#include <filesystem>
#include <fstream>

namespace pallax {
namespace {

TEST(WrongUsage, IsOneClearSentence) {
    EXPECT_EQ(
        refusalOf({"decode", "--every", "day", "a"}),
        "pallax: --every: \"day\" is not one of end|tick|packet (see pallax decode --help)\n");
    EXPECT_EQ(refusalOf({"--speed", "0", "a"}),
              "pallax: --speed: \"0\" is neither a number above 0 nor max (see pallax --help)\n");
    EXPECT_EQ(refusalOf({"decode"}), "pallax: RECORDING is required (see pallax decode --help)\n");
    EXPECT_EQ(refusalOf({"service"}),
              "pallax: the service needs --play, --simulate, --relay, --modem, --status "
              "or --list (see pallax service --help)\n");
    EXPECT_EQ(refusalOf({"a", "decode", "b"}), "pallax: the command \"decode\" must come first, "
                                               "without options before it (see pallax --help)\n");
    EXPECT_EQ(refusalOf({"--print", "decode", "b"}),
              "pallax: the command \"decode\" must come first, without options before it (see "
              "pallax --help)\n");
}

TEST(WrongUsage, OfTheServiceAndTheRecorderIsOneClearSentence) {
    EXPECT_EQ(
        refusalOf({"service", "--relay", "a.pcap"}),
        "pallax: --relay: only -, standard input, can be relayed (see pallax service --help)\n");
    for (const char* wait : {"-1", "1000001", "nan", ""}) {
        EXPECT_EQ(
            refusalOf({"service", "--relay", "-", "--wait", wait}),
            "pallax: --wait: must be a number from 0 to 1000000 (see pallax service --help)\n");
    }
    EXPECT_EQ(refusalOf({"service", "--play", "a.pcap", "--wait", "1"}),
              "pallax: --wait requires --relay (see pallax service --help)\n");
    EXPECT_EQ(refusalOf({"service", "--relay", "-", "--play", "a"}),
              "pallax: --play excludes --relay (see pallax service --help)\n");
    EXPECT_EQ(refusalOf({"service", "--status", "--play", "a"}),
              "pallax: --play excludes --status (see pallax service --help)\n");
    EXPECT_EQ(refusalOf({"record"}), "pallax: FILE is required (see pallax record --help)\n");
    EXPECT_EQ(refusalOf({"record", "--rotate-size", "big", "a"}),
              "pallax: --rotate-size: \"big\" is not a size such as 4096, 64k, 100M or 2G (see "
              "pallax record --help)\n");
    EXPECT_EQ(refusalOf({"record", "--rotate-size", "0", "a"}),
              "pallax: --rotate-size: \"0\" is out of range, which is from 1 to 17179869183G "
              "(see pallax record --help)\n");
    EXPECT_EQ(refusalOf({"record", "--rotate-seconds", "long", "a"}),
              "pallax: --rotate-seconds: \"long\" is not a number of seconds (see pallax record "
              "--help)\n");
    EXPECT_EQ(refusalOf({"record", "--rotate-seconds", "1e10", "a"}),
              "pallax: --rotate-seconds: \"1e10\" is out of range, which is above 0 and up to "
              "1000000000 (see pallax record --help)\n");
    EXPECT_EQ(refusalOf({"record", ""}),
              "pallax: FILE is an empty name (see pallax record --help)\n");
    EXPECT_EQ(refusalOf({"record", "--rotate-size", "1M", "-"}),
              "pallax: standard output is one recording, without --rotate-size and "
              "--rotate-seconds (see pallax record --help)\n");
}

TEST(WrongUsage, WrongArgumentsAreNamed) {
    EXPECT_NE(refusalOf({"--colour", "red"}).find("--colour"), std::string::npos);
    EXPECT_NE(refusalOf({"a.pcap", "b.pcap"}).find("b.pcap"), std::string::npos);
    EXPECT_EQ(refusalOf({"--loop"}), "pallax: --loop requires RECORDING (see pallax --help)\n");
    EXPECT_NE(refusalOf({"--log-level", "8"}).find("--log-level"), std::string::npos);
    EXPECT_NE(refusalOf({"decode", "--technology", "5g", "a"}).find("ifx|gsm|cdma|lte|utran"),
              std::string::npos);
    for (const char* speed : {"-1", "nan", "inf", "fast", "1x", ""}) {
        EXPECT_NE(refusalOf({"--speed", speed, "a"}).find("--speed"), std::string::npos);
    }
}

TEST(WrongUsage, AMistypedCommandOrChoiceIsAnsweredWithTheNearest) {
    EXPECT_EQ(refusalOf({"decod", "x"}),
              "pallax: \"decod\" is neither a command nor a recording. Did you mean \"decode\"? "
              "(see pallax --help)\n");
    EXPECT_EQ(refusalOf({"dmeo"}),
              "pallax: \"dmeo\" is neither a command nor a recording. Did you mean \"demo\"? "
              "(see pallax --help)\n");
    EXPECT_EQ(refusalOf({"simulate", "ltee"}),
              "pallax: TECHNOLOGY: \"ltee\" is not one of ifx|gsm|cdma|lte|utran. Did you mean "
              "\"lte\"? (see pallax simulate --help)\n");
    EXPECT_EQ(refusalOf({"decode", "--every", "tcik", "a"}),
              "pallax: --every: \"tcik\" is not one of end|tick|packet. Did you mean \"tick\"? "
              "(see pallax decode --help)\n");
    EXPECT_EQ(recordingPath(parsed<BrowseOptions>({"drive"}).source), "drive") << "no similar word";
}

TEST(WrongUsage, IsNotARecordingNamedNearlyLikeACommand) {
    const std::string here = std::filesystem::current_path();
    const std::string folder = testing::TempDir() + "pallax-options";
    std::filesystem::create_directories(folder);
    std::filesystem::current_path(folder);
    std::ofstream("decod") << "a recording";
    EXPECT_EQ(recordingPath(parsed<BrowseOptions>({"decod"}).source), "decod");
    std::filesystem::current_path(here);
    std::filesystem::remove_all(folder);
}

TEST(WrongUsage, StandardInputCannotBeLooped) {
    EXPECT_EQ(
        refusalOf({"-", "--loop"}),
        "pallax: standard input can be played only once, not with --loop (see pallax --help)\n");
    EXPECT_EQ(refusalOf({"service", "--play", "-", "--loop"}),
              "pallax: standard input can be played only once, not with --loop (see pallax service "
              "--help)\n");
}

} // namespace
} // namespace pallax
