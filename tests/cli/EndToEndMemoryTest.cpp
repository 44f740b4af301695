#include "tests/cli/EndToEnd.h"

#include <algorithm>
#include <cstdlib>
#include <fstream>

namespace pallax {
namespace {

using std::chrono::milliseconds;

/// What `decode` holds in memory at most.
class EndToEndMemory : public EndToEnd {
protected:
    void SetUp() override {
#ifdef PALLAX_SANITIZED
        GTEST_SKIP() << "a sanitizer keeps what was freed";
#endif
        if (std::getenv("PALLAX_TEST_PROGRAM") != nullptr) {
            GTEST_SKIP() << "the program runs under another";
        }
    }

    /// A drive of so many seconds, fifty packets in each.
    std::string drive(const std::string& length) const {
        const std::string path = world.path(length + ".pcap");
        EXPECT_EQ(run({"simulate", "gsm", "--rate", "50", "--seconds", length, "-o", path}).status,
                  0);
        return path;
    }

    /// The most that the program has held while it decoded a recording, in KiB.
    long peakOf(std::vector<std::string> options, const std::string& recording) const {
        options.insert(options.begin(), "decode");
        options.push_back(recording);
        doubles::PallaxProcess decoder(world, options, "/dev/null", "/dev/null");
        long peak = 0;
        EXPECT_TRUE(doubles::eventually([&] {
            const long now = peakOf(decoder.id());
            peak = std::max(peak, now);
            return peak != 0 && now == 0;
        }));
        EXPECT_EQ(decoder.wait(), 0) << decoder.err();
        return peak;
    }

    /// Under the 24 MiB that a decoder may take, whatever the recording.
    static constexpr long kMost = 24L * 1024;

private:
    /// 0 when it has ended.
    static long peakOf(pid_t process) {
        std::ifstream status("/proc/" + std::to_string(process) + "/status");
        std::string word;
        while (status >> word && word != "VmHWM:") {
        }
        long kibibytes = 0;
        status >> kibibytes;
        return kibibytes;
    }
};

TEST_F(EndToEndMemory, DoesNotGrowWithTheRecordingHoweverItIsShown) {
    const std::string recording = drive("3000"); // of 26 MB
    EXPECT_LT(peakOf({"--every", "end"}, recording), kMost);
    EXPECT_LT(peakOf({"--every", "tick"}, recording), kMost);
    EXPECT_LT(peakOf({"--every", "tick", "--format", "csv"}, recording), kMost);
    EXPECT_LT(peakOf({"--every", "packet"}, drive("100")), kMost) << "25 MB of displays";
}

TEST_F(EndToEndMemory, DoesNotGrowWhereEveryPacketBearsOneTime) {
    constexpr std::size_t kPackets = 20'000;
    constexpr std::size_t kPacketLength = 2048;
    ByteBuffer bytes = registration(2);
    bytes.resize(kPacketLength);
    const std::string recording =
        record("a.pcap", std::vector<Packet>(kPackets, {milliseconds(0), bytes}));
    EXPECT_LT(peakOf({"--every", "end"}, recording), kMost);
}

} // namespace
} // namespace pallax
