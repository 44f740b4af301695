#include "tests/cli/EndToEnd.h"
#include "tests/doubles/Files.h"
#include "tests/doubles/Pattern.h"
#include "tests/doubles/Shell.h"

#include <algorithm>
#include <csignal>
#include <fstream>

namespace pallax {
namespace {

class EndToEndVerify : public EndToEnd {
protected:
    static constexpr std::size_t kBlockOfPacket = 52; // with its frame, head and 18 bytes
    static constexpr std::size_t kInPacket700 = 92 + 699 * kBlockOfPacket + 40;

    std::string write(const std::string& name, const std::string& content) const {
        std::ofstream(world.path(name), std::ios::binary) << content;
        return world.path(name);
    }
    /// A recording that `pallax record` has made of so many packets.
    std::string recorded(unsigned count, std::vector<std::string> options = {}) const {
        std::vector<Packet> packets;
        for (unsigned index = 0; index < count; ++index) {
            packets.emplace_back(std::chrono::milliseconds(10) * index, registration(index % 3));
        }
        doubles::PallaxProcess service(
            world, {"service", "--play", record("a.pcap", packets), "--speed", "max"});
        EXPECT_TRUE(doubles::eventually([this] { return !world.sockets().empty(); }));
        const std::string file = world.path("drive.pcapng");
        options.insert(options.begin(), {"record", file});
        EXPECT_EQ(run(options).status, 0);
        service.signal(SIGTERM);
        service.wait();
        return file;
    }
};

TEST_F(EndToEndVerify, TellsThatARecordingIsWhatItWas) {
    const std::string file = gsmAttach();
    const Run unknown = run({"verify", file});
    EXPECT_EQ(unknown.status, 3);
    EXPECT_EQ(unknown.err,
              "pallax: " + file +
                  " has no digests: its 51 packets can be read to the end, but whether they are "
                  "unchanged cannot be told; --update writes some beside it.\n");
    EXPECT_EQ(run({"verify", "--update", file}).status, 0);
    const Run same = run({"verify", file});
    EXPECT_EQ(same.status, 0);
    EXPECT_EQ(same.out, file + ": 51 packets, as with version 0.2.0\n");
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

TEST_F(EndToEndVerify, ARecorderWritesWhatItNeedsToKnow) {
    const std::string file = recorded(1500);
    const Run whole = run({"verify", file});
    EXPECT_EQ(whole.status, 0);
    EXPECT_EQ(whole.out, file + ": 1500 packets, whole and unchanged\n");
    std::string content = doubles::contentOf(file);
    content[kInPacket700] ^= 1;
    const std::string damaged = write("damaged.pcapng", content);
    const Run changed = run({"verify", damaged});
    EXPECT_EQ(changed.status, 1);
    EXPECT_EQ(changed.out, damaged + ": packets 1 to 1024, or their digest, have changed\n");
    EXPECT_EQ(run({"verify", "--update", damaged}).status, 1) << "damage is not what is expected";
}

TEST_F(EndToEndVerify, EachPartOfARecordingIsWhole) {
    const std::string file = recorded(200, {"--rotate-size", "8192"});
    const Run first = run({"verify", world.path("drive-0001.pcapng")});
    EXPECT_EQ(first.status, 0) << first.err;
    EXPECT_TRUE(first.out.ends_with(" packets, whole and unchanged\n")) << first.out;
    EXPECT_EQ(run({"verify", world.path("drive-0002.pcapng")}).status, 0);
}

TEST_F(EndToEndVerify, WhatAKilledRecorderLeavesIsKnownUpToItsLastDigest) {
    const std::string content = doubles::contentOf(recorded(1500));
    const std::string file =
        write("killed.pcapng", content.substr(0, content.size() - 68)); // without its end
    const Run killed = run({"verify", file});
    EXPECT_EQ(killed.status, 3);
    EXPECT_EQ(killed.out, file +
                              ": packets 1 to 1024 are unchanged; 476 packets after them "
                              "without a digest: the recorder was killed, or the end is cut off\n");
    const std::string early = doubles::contentOf(recorded(20, {"--overwrite"}));
    const std::string none = write("early.pcapng", early.substr(0, early.size() - 68));
    const Run unknown = run({"verify", none});
    EXPECT_EQ(unknown.status, 3);
    EXPECT_EQ(unknown.err, "pallax: " + none +
                               " has no digests (a recorder that is killed before 1,024 packets "
                               "leaves none): its 20 packets can be read to the end, but whether "
                               "they are unchanged cannot be told; --update writes some beside "
                               "it.\n");
}

TEST_F(EndToEndVerify, AMaskedCopyIsWholeAndAMaskedDamageIsNot) {
    const std::string file = recorded(1500);
    const std::string copy = world.path("copy.pcapng");
    ASSERT_EQ(run({"mask", "--also", "mm_service_state", file, "-o", copy}).status, 0);
    EXPECT_NE(doubles::contentOf(copy), doubles::contentOf(file)) << "its digests would do";
    EXPECT_EQ(run({"verify", copy}).out, copy + ": 1500 packets, whole and unchanged\n");
    std::string content = doubles::contentOf(file);
    content[kInPacket700] ^= 1;
    const std::string damaged = write("damaged.pcapng", content);
    const Run masked = run({"mask", damaged, "-o", copy});
    EXPECT_NE(masked.err.find("pallax: " + damaged +
                              " has changed since it was recorded; pallax verify will say so of " +
                              copy + ", too.\n"),
              std::string::npos)
        << masked.err;
    EXPECT_EQ(run({"verify", copy}).out,
              copy + ": packets 1 to 1024, or their digest, have changed\n");
}

TEST_F(EndToEndVerify, OtherReadersSkipTheDigests) {
    if (!doubles::isInstalled("tshark") || !doubles::isInstalled("capinfos")) {
        GTEST_SKIP() << "tshark and capinfos are not installed";
    }
    const std::string file = recorded(1500);
    const auto packets =
        doubles::runCommand("(tshark -r " + file + " -T fields -e frame.number 2>/dev/null)");
    EXPECT_EQ(packets.status, 0);
    EXPECT_EQ(std::count(packets.out.begin(), packets.out.end(), '\n'), 1500) << packets.out;
    const auto infos = doubles::runCommand("capinfos -cM " + file + " 2>&1");
    EXPECT_EQ(infos.status, 0);
    EXPECT_NE(infos.out.find("Number of packets:   1500\n"), std::string::npos) << infos.out;
}

TEST_F(EndToEndVerify, ExpectationsAreAboutOneRecording) {
    const Run two = run({"verify", "--expect", "x", "a.pcap", "b.pcap"});
    EXPECT_EQ(two.status, 2);
    EXPECT_EQ(two.err, "pallax: --expect is about one recording (see pallax verify --help)\n");
}

} // namespace
} // namespace pallax
