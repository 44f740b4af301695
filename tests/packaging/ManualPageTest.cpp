#include "cli/ManualPage.h"

#include "cli/CommandLine.h"
#include "cli/HelpText.h"
#include "knowledge/Quality.h"
#include "tests/doubles/Files.h"
#include "tests/doubles/Pattern.h"
#include "tests/doubles/Shell.h"
#include "ui/pages/KeyHelp.h"

#include <gtest/gtest.h>

#include <filesystem>

namespace pallax {
namespace {

using doubles::contentOf;
using doubles::isInstalled;
using doubles::replaced;
using doubles::runCommand;

/// The page's text without roff markup.
std::string plain(const std::string& page) {
    return replaced(replaced(replaced(page, R"(\\f[BIR])", ""), R"(\\-)", "-"), R"(\\\(ha)", "^");
}

CommandDescription program() {
    return CommandLine().description();
}

TEST(ManualPage, ThereIsOneForTheProgramAndEachCommand) {
    EXPECT_EQ(manualPages(program()),
              (std::vector<std::string>{"pallax",          "pallax-decode", "pallax-record",
                                        "pallax-service",  "pallax-demo",   "pallax-modem",
                                        "pallax-simulate", "pallax-events", "pallax-fields",
                                        "pallax-explain",  "pallax-info",   "pallax-snapshot",
                                        "pallax-sql",      "pallax-status", "pallax-diff",
                                        "pallax-watch",    "pallax-report", "pallax-web",
                                        "pallax-mask",     "pallax-verify", "pallax-store"}));
    EXPECT_EQ(manualPage(program(), "pallax-manual"), "");
}

TEST(ManualPage, EveryOptionIsOnItsPageWithItsValueAndDescription) {
    std::vector<CommandDescription> all = program().commands;
    all.push_back(program());
    for (const CommandDescription& command : all) {
        const std::string name = command.name == "pallax" ? "pallax" : "pallax-" + command.name;
        const std::string page = plain(manualPage(program(), name));
        ASSERT_GE(command.options.size(), 3U);
        for (const OptionDescription& option : command.options) {
            std::string names;
            for (const std::string& each : option.names) {
                names += (names.empty() ? "" : ", ") + each;
            }
            const std::string item =
                ".TP\n" + names + (option.value.empty() ? "" : " " + option.value) + "\n";
            EXPECT_NE(page.find(item + replaced(option.description, "'", "\\(aq") + ".\n"),
                      std::string::npos)
                << item << option.description << "\n"
                << page;
        }
        for (const OptionDescription& argument : command.arguments) {
            EXPECT_NE(page.find(".TP\n" + argument.names.front()), std::string::npos) << page;
        }
        const auto statuses = takenApart(command.footer).statuses;
        ASSERT_GE(statuses.size(), 3U) << name;
        for (const HelpText::Status& status : statuses) {
            EXPECT_NE(page.find(".TP\n" + status.number + "\n" + status.meaning + ".\n"),
                      std::string::npos)
                << page;
        }
    }
}

TEST(ManualPage, TheProgramsListsTheKeysOfTheScreensHelp) {
    const std::string page = plain(manualPage(program(), "pallax"));
    const std::size_t keys = page.find(".SH KEYS\n");
    const std::size_t behind = page.find(".SH EXAMPLES\n");
    ASSERT_LT(keys, behind);
    ASSERT_NE(behind, std::string::npos);
    std::string listed = ".SH KEYS\n";
    for (const terminal::KeyHelp& help : terminal::keyHelp()) {
        listed.append(".TP\n").append(help.keys).append("\n").append(help.meaning).append(".\n");
    }
    EXPECT_EQ(page.substr(keys, behind - keys), listed);
    EXPECT_NE(listed.find(".TP\n/\nfilter rows by name or value.\n"), std::string::npos);
    EXPECT_EQ(plain(manualPage(program(), "pallax-decode")).find("KEYS"), std::string::npos);
}

TEST(ManualPage, TheProgramWritesIt) {
    const auto end = std::get<ParseEnd>(parseOptions({"manual", "pallax-record"}));
    EXPECT_EQ(end.status, kExitSuccess);
    EXPECT_EQ(end.text, manualPage(program(), "pallax-record"));
    EXPECT_TRUE(end.text.starts_with(".\\\" Written by \"pallax manual pallax-record\".\n"
                                     ".TH PALLAX\\-RECORD 1 "));
    const auto wrong = std::get<ParseEnd>(parseOptions({"manual", "pallax-recrod"}));
    EXPECT_EQ(wrong.status, kExitWrongUsage);
    EXPECT_NE(wrong.text.find(". Did you mean \"pallax-record\"?"), std::string::npos);
}

TEST(ManualPage, TheSettingsPageNamesEverySetting) {
    const std::string page = plain(contentOf(PALLAX_SOURCE_DIR "/docs/man/pallax.conf.5"));
    for (const char* setting : {"on-fatal-record", "snapshot-directory", "save-button-marker",
                                "system-log-level", "after-reconnect", "first-screen", "lists",
                                "curves", "journal-hours", "journal-mebibytes", "alarm"}) {
        EXPECT_NE(page.find(std::string(".BR ") + setting), std::string::npos) << setting;
    }
}

TEST(ManualPage, TheSettingsPageNamesEveryMeasure) {
    const std::string page = plain(contentOf(PALLAX_SOURCE_DIR "/docs/man/pallax.conf.5"));
    for (const MeasureInfo& each : kMeasures) {
        EXPECT_NE(page.find(each.name), std::string::npos) << each.name;
    }
}

TEST(ManualPage, TheRecordingPageNamesEveryLinkType) {
    const std::string page = contentOf(PALLAX_SOURCE_DIR "/docs/man/pallax-recording.7");
    for (const RecordedTechnology& each : recordedTechnologies()) {
        const std::string row =
            std::to_string(each.linkType) + "|USER" + std::to_string(each.linkType - 147) + "|" +
            std::string(each.identifier) + "|" + std::string(each.commandName) + "\n";
        EXPECT_NE(page.find(row), std::string::npos) << row;
    }
}

TEST(ManualPage, NoPageMakesTheFormatterComplain) {
    if (!isInstalled("man") || !isInstalled("groff")) {
        GTEST_SKIP() << "man and groff are not installed";
    }
    const doubles::TemporaryFolder folder;
    std::vector<std::string> files{PALLAX_SOURCE_DIR "/docs/man/pallax.conf.5",
                                   PALLAX_SOURCE_DIR "/docs/man/pallax-recording.7",
                                   PALLAX_SOURCE_DIR "/docs/man/pallax-privacy.7",
                                   PALLAX_SOURCE_DIR "/docs/man/pallax-sections.7",
                                   PALLAX_SOURCE_DIR "/docs/man/pallax-sql.7"};
    for (const std::string& name : manualPages(program())) {
        files.push_back(folder.write(name + ".1", manualPage(program(), name)));
    }
    for (const std::string& file : files) {
        const auto man = runCommand("man --warnings -l " + file + " >/dev/null");
        EXPECT_EQ(man.status, 0) << file;
        EXPECT_EQ(man.out, "") << file;
        const auto groff = runCommand("groff -t -man -Tutf8 -ww " + file + " >/dev/null");
        EXPECT_EQ(groff.status, 0) << file;
        EXPECT_EQ(groff.out, "") << file;
    }
}

} // namespace
} // namespace pallax
