#include "browsing/KeptNotices.h"

#include <gtest/gtest.h>

#include <optional>
#include <string>
#include <vector>

namespace pallax {
namespace {

TEST(KeptNotices, AreWrittenAtTheEndALineEach) {
    std::vector<std::string> written;
    std::optional<KeptNotices> notices(
        std::in_place, [&written](std::string_view block) { written.emplace_back(block); });
    notices->printLine("Deallocing ZOR_GSMClassIndex");
    notices->printLine("Deallocing ClassIndex");
    EXPECT_EQ(written, std::vector<std::string>());
    notices.reset();
    EXPECT_EQ(written, (std::vector<std::string>{"Deallocing ZOR_GSMClassIndex\n"
                                                 "Deallocing ClassIndex\n"}));
}

TEST(KeptNotices, WithoutANoticeNothingIsWritten) {
    const KeptNotices notices([](std::string_view block) { ADD_FAILURE() << block; });
}

TEST(KeptNotices, ATerminalThatHasGoneMissesThem) {
    KeptNotices notices([](std::string_view /*block*/) {
        throw OutputFailure("Standard output cannot be written: Input/output error.");
    });
    notices.printLine("Deallocing ClassIndex");
}

} // namespace
} // namespace pallax
