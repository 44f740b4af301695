#include "tests/cli/EndToEnd.h"
#include "tests/doubles/Files.h"
#include "tests/doubles/Pattern.h"

namespace pallax {
namespace {

using doubles::contentOf;

class EndToEndSystemLog : public EndToEnd {};

/// The text with every address in it replaced.
std::string withoutAddresses(const std::string& text) {
    return doubles::replaced(text, "0x[0-9a-f]{6,}", "0xADDRESS");
}

TEST_F(EndToEndSystemLog, OfTheSampleHoldsEveryLineInOrder) {
    const std::string log = world.path("log");
    EXPECT_EQ(run({"decode", "--system-log", log, gsmAttach()}).status, 0);
    EXPECT_EQ(withoutAddresses(contentOf(log)),
              contentOf(PALLAX_SOURCE_DIR "/tests/data/gsm-attach.log"));
}

} // namespace
} // namespace pallax
