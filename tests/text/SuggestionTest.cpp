#include "text/Suggestion.h"

#include <gtest/gtest.h>

namespace pallax {
namespace {

const std::vector<std::string> kNames{"decode", "demo", "record", "lte"};

TEST(Suggestion, TheDistanceCountsLettersPutInLeftOutReplacedAndSwapped) {
    EXPECT_EQ(editDistance("decode", "decode"), 0U);
    EXPECT_EQ(editDistance("decod", "decode"), 1U);
    EXPECT_EQ(editDistance("decoode", "decode"), 1U);
    EXPECT_EQ(editDistance("dekode", "decode"), 1U);
    EXPECT_EQ(editDistance("dceode", "decode"), 1U);
    EXPECT_EQ(editDistance("", "demo"), 4U);
    EXPECT_EQ(editDistance("demo", ""), 4U);
    EXPECT_EQ(editDistance("abc", "xyz"), 3U);
}

TEST(Suggestion, TheNearestNameIsMeantWhereOneLetterInThreeIsWrongAtMost) {
    EXPECT_EQ(nearestName("dcode", kNames), "decode");
    EXPECT_EQ(nearestName("recrod", kNames), "record");
    EXPECT_EQ(nearestName("ltee", kNames), "lte");
    EXPECT_EQ(nearestName("lt", kNames), "lte");
    EXPECT_EQ(nearestName("gsm", kNames), "");
    EXPECT_EQ(nearestName("drive.pcap", kNames), "");
    EXPECT_EQ(nearestName("", kNames), "");
    EXPECT_EQ(nearestName(std::string(100000, 'd'), kNames), "");
}

TEST(Suggestion, TheSentenceEndsWithTheQuestionOrWithNothing) {
    EXPECT_EQ(suggestion("dem", kNames), ". Did you mean \"demo\"?");
    EXPECT_EQ(suggestion("gsm", kNames), "");
}

} // namespace
} // namespace pallax
