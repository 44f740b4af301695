#include "text/Roff.h"

#include <gtest/gtest.h>

namespace pallax {
namespace {

TEST(Roff, WritesWhatItWouldTakeForSomethingElseByItsName) {
    EXPECT_EQ(roffText(R"(--log-level a\b "c" 'd' ~/e ^f)"),
              R"(\-\-log\-level a\eb \(dqc\(dq \(aqd\(aq \(ti/e \(haf)");
}

TEST(Roff, ALineThatBeginsWithADotIsNoRequest) {
    EXPECT_EQ(roffText(".conf\n.d a.b\n'e"), "\\&.conf\n\\&.d a.b\n\\(aqe");
}

TEST(Roff, NamesWhatIsBeyondAsciiByItsNumber) {
    EXPECT_EQ(roffText("64 × 1 😀"), R"(64 \[u00D7] 1 \[u1F600])");
    EXPECT_EQ(roffText("a\x80\xFF"), "a\x80\xFF");
}

TEST(Roff, BoldEndsBehindTheText) {
    EXPECT_EQ(roffBold("a-b"), R"(\fBa\-b\fR)");
}

} // namespace
} // namespace pallax
