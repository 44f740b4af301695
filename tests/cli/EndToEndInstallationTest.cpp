#include "tests/cli/EndToEnd.h"

#include <fstream>
#include <iterator>
#include <regex>

namespace pallax {
namespace {

using std::chrono::milliseconds;

class EndToEndInstallation : public EndToEnd {
protected:
    static std::string contentOf(const std::string& path) {
        std::ifstream file(path, std::ios::binary);
        return {std::istreambuf_iterator<char>(file), std::istreambuf_iterator<char>()};
    }
};

/// The text with every address in it replaced.
std::string withoutAddresses(const std::string& text) {
    return std::regex_replace(text, std::regex("0x[0-9a-f]{6,}"), "0xADDRESS");
}

TEST_F(EndToEndInstallation, TheSystemLogOfTheSampleHoldsEveryLineInOrder) {
    const std::string log = world.path("log");
    EXPECT_EQ(run({"decode", "--system-log", log, gsmAttach()}).status, 0);
    EXPECT_EQ(withoutAddresses(contentOf(log)),
              contentOf(std::string(PALLAX_SOURCE_DIR) + "/tests/data/gsm-attach.log"));
}

TEST_F(EndToEndInstallation, WithoutDisplayTemplatesThereIsNothingToShow) {
    const std::string recording = record("a.pcap", {{milliseconds(0), registration(0)}});
    world.environment = {"PALLAX_RESOURCES=/nonexistent"};
    for (const Run& failed : {run({"decode", recording}), run({recording, "--print"})}) {
        EXPECT_EQ(failed.status, 1);
        EXPECT_EQ(failed.out, "");
        EXPECT_EQ(failed.err, "pallax: There are no display templates in /nonexistent; "
                              "PALLAX_RESOURCES names their folder.\n");
    }
}

} // namespace
} // namespace pallax
