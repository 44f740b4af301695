#include "tests/cli/EndToEnd.h"

#include <algorithm>
#include <cstdlib>
#include <fstream>

namespace pallax {
namespace {

using std::chrono::milliseconds;

/// The greatest memory use of `decode`.
class EndToEndMemory : public EndToEnd {
protected:
    void SetUp() override {
#ifdef PALLAX_SANITIZED
        GTEST_SKIP() << "a sanitizer keeps freed memory";
#endif
        if (std::getenv("PALLAX_TEST_PROGRAM") != nullptr) {
            GTEST_SKIP() << "another program runs it";
        }
    }

    /// A drive of that length, with fifty packets each second.
    std::string drive(const std::string& length) const {
        const std::string path = world.path(length + ".pcap");
        EXPECT_EQ(run({"simulate", "gsm", "--rate", "50", "--seconds", length, "-o", path}).status,
                  0);
        return path;
    }

    /// The greatest memory use while the program decoded a recording, in KiB.
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

    /// Below the limit of 24 MiB for a decoder, for any recording.
    static constexpr long kMost = 24L * 1024;

private:
    /// 0 after the process has ended.
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
    const std::string recording = drive("3000"); // 26 MB
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
