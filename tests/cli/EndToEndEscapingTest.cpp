#include "tests/cli/EndToEndScreen.h"
#include "tests/doubles/TextPropertyList.h"
#include "text/Utf8.h"

#include <algorithm>

namespace pallax {
namespace {

/// Names, values, settings and options that contain control characters for a terminal.
class EndToEndEscaping : public EndToEndScreen {
protected:
    static constexpr int kIfxLinkType = 147;
    static constexpr const char* kHostile = "\x1b]0;owned\x07\u009b2J\x7f\u202e\u2066\u061c";
    static constexpr const char* kEscaped = "\\x1B]0;owned\\x07\\u009B2J\\x7F\\u202E\\u2066\\u061C";

    std::string hostile(const std::string& name) const {
        const std::string text = doubles::textForm(
            Dictionary{{"Cell", Dictionary{{"Operator", kHostile}, {"ARFCN", "12"}}}});
        return record(name, {{std::chrono::milliseconds(0), {text.begin(), text.end()}}},
                      kIfxLinkType);
    }

    /// The terminal output of a program that ends by itself.
    std::string onTerminal(const std::vector<std::string>& arguments, int status) const {
        PallaxTerminal terminal(world, arguments, {.columns = 200});
        EXPECT_EQ(terminal.wait(), status);
        return terminal.bytes();
    }

    /// The first control character other than line ends and tabs.
    static std::string commandIn(const std::string& bytes) {
        for (std::size_t at = 0; at < bytes.size();) {
            const Utf8CodePoint character = utf8At(bytes, at);
            const char32_t code = character.value;
            const bool isLine = code == '\n' || code == '\r' || code == '\t';
            const bool isControl = code < 0x20 || (code >= 0x7F && code < 0xA0);
            const bool turns = code == 0x061C || code == 0x200E || code == 0x200F ||
                               (code >= 0x202A && code <= 0x202E) ||
                               (code >= 0x2066 && code <= 0x2069);
            if (character.size == 0 || turns || (isControl && !isLine)) {
                return "U+" + std::to_string(code) + " at byte " + std::to_string(at);
            }
            at += character.size;
        }
        return "";
    }
};

TEST_F(EndToEndEscaping, DecodedDataCommandsNoTerminal) {
    const std::string recording = hostile("a.pcap");
    const std::string csv = onTerminal({"decode", "--format", "csv", recording}, 0);
    EXPECT_EQ(commandIn(csv), "");
    EXPECT_EQ(csv, std::string("time,path,value,number,unit\r\n"
                               "2023-11-14T22:13:22.000Z,/Cell/Operator,") +
                       kEscaped + ",,\r\n2023-11-14T22:13:22.000Z,/Cell/ARFCN,12,,\r\n");
    const std::string json = onTerminal({"decode", recording}, 0);
    EXPECT_EQ(json, "{\"Cell\":{\"Operator\":\"\\u001b]0;owned\\u0007\\u009b2J\\u007f"
                    "\\u202E\\u2066\\u061C\",\"ARFCN\":\"12\"}}\r\n");
    const std::string several = onTerminal({"decode", recording, hostile("b.pcap")}, 0);
    EXPECT_EQ(several, json + json) << "the same as decoding them one by one";
}

TEST_F(EndToEndEscaping, NoSectionOfATemplateCommandsTheTerminalThatListsItsFields) {
    const std::string section = std::string("Owned") + kHostile;
    std::ofstream(world.path("C2KTemplate.plist"))
        << doubles::textForm(Dictionary{{section.c_str(), Dictionary{{"Channel", "kChannel"}}}});
    world.environment = {"PALLAX_RESOURCES=" + world.path()};
    const std::string text = onTerminal({"fields", "cdma"}, 0);
    EXPECT_EQ(commandIn(text), "") << text;
    EXPECT_NE(text.find(std::string("/Owned") + kEscaped + "/Channel"), std::string::npos) << text;
    const std::string json = onTerminal({"fields", "--json", "cdma"}, 0);
    EXPECT_EQ(commandIn(json), "") << json;
    EXPECT_NE(json.find("/Owned\\u001b]0;owned"), std::string::npos) << json;
    EXPECT_NE(run({"fields", "cdma"}).out.find("/" + section + "/Channel"), std::string::npos)
        << "a pipe gets it unchanged";
}

TEST_F(EndToEndEscaping, APipeGetsCsvAsTheModemSentItAndJsonWithoutControlCharacters) {
    const std::string recording = hostile("a.pcap");
    const Run csv = run({"decode", "--format", "csv", recording});
    EXPECT_NE(csv.out.find(std::string("/Cell/Operator,") + kHostile + ",,\n"), std::string::npos)
        << csv.out;
    EXPECT_EQ(run({"decode", recording}).out,
              "{\"Cell\":{\"Operator\":\"\\u001b]0;owned\\u0007\\u009b2J\\u007f"
              "\u202e\u2066\u061c\",\"ARFCN\":\"12\"}}\n");
}

TEST_F(EndToEndEscaping, NoFileNameSettingOrOptionInASentenceCommandsTheTerminal) {
    const std::string name = std::string("no") + kHostile + ".pcap";
    const std::string escaped = std::string("no") + kEscaped + ".pcap";
    const std::vector<std::vector<std::string>> commands{
        {"decode", name},
        {"decode", name, name},
        {name},
        {"service", "--play", name},
        {"simulate", "lte", "--seconds", "1", "-o", "missing/" + name},
        {"decode", "--system-log", "missing/" + name, lteDrive()},
    };
    for (const auto& command : commands) {
        const std::string told = onTerminal(command, 1);
        EXPECT_EQ(commandIn(told), "") << told;
        EXPECT_NE(told.find(escaped), std::string::npos) << told;
        const Run piped = run(command);
        EXPECT_EQ(commandIn(piped.err), "") << piped.err;
        EXPECT_NE(piped.err.find(escaped), std::string::npos) << piped.err;
    }
    const std::string option = onTerminal({"decode", lteDrive(), "--format", kHostile}, 2);
    EXPECT_EQ(commandIn(option), "") << option;
    EXPECT_NE(option.find(kEscaped), std::string::npos) << option;
    const std::string technology = onTerminal({"fields", kHostile}, 2);
    EXPECT_EQ(commandIn(technology), "") << technology;
    EXPECT_NE(technology.find(kEscaped), std::string::npos) << technology;

    const std::string word = onTerminal({"explain", kHostile}, 1);
    EXPECT_EQ(commandIn(word), "") << word;
    EXPECT_NE(word.find(kEscaped), std::string::npos) << word;

    std::ofstream(world.path("config/pallax/pallax.conf"))
        << "on-fatal-record = " << kHostile << "\n";
    const std::string setting = onTerminal({"demo", "lte"}, 1);
    EXPECT_EQ(setting, "pallax: " + world.path("config/pallax/pallax.conf") +
                           ", line 1: on-fatal-record is \"stop\" or \"skip\", not \"" + kEscaped +
                           "\".\r\n");
}

TEST_F(EndToEndEscaping, OnTheScreenAndInThePrintedTreeAValueIsEscapedToo) {
    const std::string recording = hostile("a.pcap");
    const std::string printed = onTerminal({recording, "--print", "--speed", "max"}, 0);
    EXPECT_EQ(commandIn(printed), "") << printed;
    EXPECT_NE(printed.find(std::string("  Operator: ") + kEscaped + "\r\n"), std::string::npos)
        << printed;
    PallaxTerminal terminal(world, {recording, "--speed", "max"}, {});
    ASSERT_TRUE(terminal.shows("Cell"));
    terminal.type("\r");
    EXPECT_TRUE(terminal.shows(kEscaped));
    EXPECT_EQ(terminal.screen().unknown(), "");
    terminal.type("qq");
    EXPECT_EQ(terminal.wait(), 0);
    EXPECT_EQ(terminal.bytes().find("\u202e"), std::string::npos);
    EXPECT_EQ(terminal.bytes().find("\u009b"), std::string::npos);
    EXPECT_EQ(terminal.bytes().find("\x1b]0;owned"), std::string::npos);
}

} // namespace
} // namespace pallax
