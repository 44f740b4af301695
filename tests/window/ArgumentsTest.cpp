#include "window/Arguments.h"

#include <gtest/gtest.h>

#include <filesystem>

namespace pallax {
namespace {

/// What a window browses.
BrowseOptions accepted(std::vector<std::string> arguments) {
    auto options = windowOptions(std::move(arguments));
    EXPECT_TRUE(std::holds_alternative<BrowseOptions>(options));
    return std::holds_alternative<BrowseOptions>(options) ? std::get<BrowseOptions>(options)
                                                          : BrowseOptions();
}

std::string refusal(std::vector<std::string> arguments) {
    const auto options = windowOptions(std::move(arguments));
    if (const auto* end = std::get_if<ParseEnd>(&options)) {
        EXPECT_EQ(end->status, kExitWrongUsage);
        return end->text;
    }
    return "";
}

TEST(Arguments, AreThoseOfPallaxThatBrowse) {
    EXPECT_EQ(sourceName(accepted({"drive.pcap", "--speed", "4"}).source), "drive.pcap");
    EXPECT_TRUE(std::holds_alternative<ServiceModem>(accepted({}).source));
    EXPECT_EQ(std::get<ServiceModem>(accepted({"--connect", "car1"}).source).name, "car1");
    EXPECT_TRUE(std::holds_alternative<SimulationOptions>(accepted({"demo", "gsm"}).source));
    EXPECT_TRUE(std::holds_alternative<LocalModem>(accepted({"modem"}).source));
    EXPECT_TRUE(accepted({"drive.pcap", "--safe"}).safe);
}

TEST(Arguments, WhatOnlyATerminalHasIsRefused) {
    EXPECT_EQ(refusal({"--print"}), "pallax-window: --print and --plain write text: use pallax "
                                    "(see pallax-window --help)\n");
    EXPECT_EQ(refusal({"demo", "--plain"}),
              "pallax-window: --print and --plain write text: use pallax "
              "(see pallax-window --help)\n");
    EXPECT_EQ(refusal({"--no-mouse"}),
              "pallax-window: --color and --no-mouse are for the screen of a terminal "
              "(see pallax-window --help)\n");
    EXPECT_EQ(refusal({"--connect", "a", "--connect", "b"}),
              "pallax-window: a window shows one modem: give one --connect, and open another "
              "window (see pallax-window --help)\n");
    EXPECT_EQ(
        refusal({"info", "drive.pcap"}),
        "pallax-window: \"info\" has no window: use pallax info (see pallax-window --help)\n");
}

TEST(Arguments, WrongOnesAreRefusedAsByPallax) {
    EXPECT_EQ(refusal({"--speed", "4"}).substr(0, 8), "pallax: ");
}

TEST(Arguments, HelpIsTheWindows) {
    const auto options = windowOptions({"demo", "--help"});
    const auto& end = std::get<ParseEnd>(options);
    EXPECT_EQ(end.status, kExitSuccess);
    EXPECT_EQ(end.text.substr(0, end.text.find('\n')),
              "Shows what a phone's cellular radio is doing, in a window.");
}

TEST(Arguments, ACompletionIsTheWindows) {
    const auto options = windowOptions({"completion", "bash"});
    const auto& end = std::get<ParseEnd>(options);
    EXPECT_EQ(end.status, kExitSuccess);
    EXPECT_EQ(end.text.substr(0, end.text.find('\n')),
              "# Completion of pallax-window's command line, written by \"pallax-window completion "
              "bash\".");
    EXPECT_EQ(end.text.find("--print"), std::string::npos);
    EXPECT_EQ(end.text.find("decode"), std::string::npos);
    EXPECT_NE(end.text.find("--speed"), std::string::npos);
    EXPECT_EQ(refusal({"manual", "pallax"}),
              "pallax-window: \"manual\" has no window: use pallax manual (see pallax-window "
              "--help)\n");
}

std::optional<std::string> key(std::vector<std::string> arguments) {
    return keyOf(accepted(std::move(arguments)));
}

TEST(Arguments, TwoStartsShowTheSameIfSourceAndOptionsAreTheSame) {
    const std::string folder = std::filesystem::current_path().string();
    EXPECT_EQ(key({"drive.pcap"}), key({folder + "/./drive.pcap"}));
    EXPECT_EQ(key({"modem"}), key({"modem"}));
    EXPECT_EQ(key({}), key({}));
    EXPECT_EQ(key({"demo", "lte"}), key({"demo", "lte"}));
    EXPECT_NE(key({"demo", "lte"}), key({"demo", "gsm"}));
    EXPECT_NE(key({"drive.pcap"}), key({"other.pcap"}));
    EXPECT_NE(key({"drive.pcap"}), key({"drive.pcap", "--safe"}));
    EXPECT_NE(key({"drive.pcap"}), key({"drive.pcap", "--speed", "2"}));
    EXPECT_NE(key({}), key({"--connect", "car1"}));
}

TEST(Arguments, APathThatIsNoneIsLeftToWhoOpensIt) {
    EXPECT_TRUE(key({""}));
}

TEST(Arguments, StandardInputAndALogOfTheShellAreNotShared) {
    EXPECT_EQ(key({"-"}), std::nullopt);
    EXPECT_EQ(key({"drive.pcap", "--log-level", "7"}), std::nullopt);
}

} // namespace
} // namespace pallax
