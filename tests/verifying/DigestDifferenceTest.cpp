#include "verifying/DigestDifference.h"

#include <gtest/gtest.h>

namespace pallax {
namespace {

RecordingDigest digest() {
    RecordingDigest digest;
    digest.technology = "lte";
    digest.packets = 1500;
    digest.first = Time(std::chrono::seconds(1700000000));
    digest.blocks = {"a", "b"};
    digest.decoded = {{{0, "lte.x"}, "1"}, {{1, "lte.x"}, "2"}, {{1, "lte.y"}, "3"}};
    return digest;
}
using Sentences = std::vector<std::string>;

TEST(DigestDifference, OfTheSameIsNone) {
    EXPECT_EQ(differences(digest(), digest()), Sentences{});
    RecordingDigest newer = digest();
    newer.decoder = "0.2.0";
    EXPECT_EQ(differences(digest(), newer), Sentences{}) << "the version alone is no difference";
}

TEST(DigestDifference, NamesFieldsAndMinutesThatDecodeOtherwise) {
    RecordingDigest after = digest();
    after.decoded[{0, "lte.x"}] = "9";
    after.decoded[{1, "lte.x"}] = "9";
    after.decoded.erase({1, "lte.y"});
    after.decoded[{2, "lte.z"}] = "4";
    EXPECT_EQ(differences(digest(), after),
              (Sentences{"lte.x decodes otherwise in the minute from 2023-11-14 22:13:20 +0000 "
                         "and in 1 more",
                         "lte.y decodes otherwise in the minute from 2023-11-14 22:14:20 +0000",
                         "lte.z decodes otherwise in the minute from 2023-11-14 22:15:20 +0000"}));
}

TEST(DigestDifference, NamesPacketsThatHaveChangedAndNotTheirFields) {
    RecordingDigest after = digest();
    after.blocks = {"a", "c"};
    after.decoded.clear();
    EXPECT_EQ(differences(digest(), after), Sentences{"packets 1025 to 1500 have changed"});
}

TEST(DigestDifference, TellsThatPacketsAreMissing) {
    RecordingDigest after = digest();
    after.packets = 1499;
    after.blocks = {"a", "c"};
    EXPECT_EQ(differences(digest(), after), Sentences{"1499 packets instead of 1500"});
}

} // namespace
} // namespace pallax
