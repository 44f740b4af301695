#include "tests/cli/EndToEnd.h"

namespace pallax {
namespace {

class EndToEndVerify : public EndToEnd {};

TEST_F(EndToEndVerify, TellsThatARecordingIsWhatItWas) {
    const std::string file = gsmAttach();
    const Run unknown = run({"verify", file});
    EXPECT_EQ(unknown.status, 3);
    EXPECT_EQ(unknown.err, "pallax: " + file +
                               " has no digests: unchanged cannot be told; --update writes some "
                               "beside it.\n");
    EXPECT_EQ(run({"verify", "--update", file}).status, 0);
    const Run same = run({"verify", file});
    EXPECT_EQ(same.status, 0);
    EXPECT_EQ(same.out, file + ": 51 packets, as with version 0.1.0\n");
}

TEST_F(EndToEndVerify, TellsThatItIsNot) {
    const std::string file = gsmAttach();
    const std::string other =
        record("other.pcap", {{std::chrono::milliseconds(0), registration(1)}});
    ASSERT_EQ(run({"verify", "--update", file}).status, 0);
    const Run different = run({"verify", "--expect", file + ".pallax-verify", other});
    EXPECT_EQ(different.status, 1);
    EXPECT_EQ(different.out, other + ": 1 packet instead of 51\n");
}

TEST_F(EndToEndVerify, ExpectationsAreAboutOneRecording) {
    const Run two = run({"verify", "--expect", "x", "a.pcap", "b.pcap"});
    EXPECT_EQ(two.status, 2);
    EXPECT_EQ(two.err, "pallax: --expect is about one recording (see pallax verify --help)\n");
}

} // namespace
} // namespace pallax
