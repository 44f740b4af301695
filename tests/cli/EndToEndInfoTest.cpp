#include "tests/cli/EndToEnd.h"
#include "tests/doubles/Compression.h"

#include <nlohmann/json.hpp>

#include <fstream>
#include <sstream>

namespace pallax {
namespace {

class EndToEndInfo : public EndToEnd {
protected:
    /// Writes the sample, compressed, and returns its path.
    std::string compressedAttach(std::string (*compress)(std::string_view)) const {
        const std::string plain = doubles::contentOf(gsmAttach());
        const std::string path = world.path("attach.compressed");
        std::ofstream(path, std::ios::binary) << compress(plain);
        return path;
    }
};

TEST_F(EndToEndInfo, TellsWhatARecordingHolds) {
    const Run text = run({"info", gsmAttach()});
    EXPECT_EQ(text.status, 0);
    EXPECT_EQ(text.err, "");
    EXPECT_TRUE(text.out.starts_with(gsmAttach() + R"(
  format      pcap
  technology  gsm (link type 148)
  packets     51 (1.7 a second)
  first       2023-11-14 22:13:20 +0000
  last        2023-11-14 22:13:49 +0000
  duration    29.5 s
  gaps        none
  steps back  none
  bad stamps  none
  unknown     0
  damaged     0

   packets  code      record
        25  0x7131    State of mobility management -> /Process CO, /Process CS
)")) << text.out;
}

TEST_F(EndToEndInfo, WritesAnObjectForEachFile) {
    const Run json = run({"info", "--json", gsmAttach(), world.path("missing.pcap"),
                          compressedAttach(doubles::zstdOf)});
    EXPECT_EQ(json.status, 1);
    EXPECT_EQ(json.err, "pallax: " + world.path("missing.pcap") +
                            " cannot be opened: No such file or directory.\n");
    std::istringstream lines(json.out);
    for (const char* format : {"pcap", "zstd of pcap"}) {
        std::string line;
        ASSERT_TRUE(std::getline(lines, line));
        const auto file = nlohmann::json::parse(line);
        EXPECT_EQ(file["format"], format);
        EXPECT_EQ(file["packets"], 51);
        EXPECT_EQ(file["technology"], "gsm");
    }
}

TEST_F(EndToEndInfo, TellsWhatIsBeforeTheCut) {
    const std::string whole = doubles::contentOf(compressedAttach(doubles::gzipOf));
    const std::string path = world.path("cut.gz");
    std::ofstream(path, std::ios::binary) << whole.substr(0, whole.size() - 4);
    const Run cut = run({"info", path});
    EXPECT_EQ(cut.status, 1);
    EXPECT_EQ(cut.err, "pallax: " + path + " ends in the middle of a packet.\n");
    EXPECT_NE(cut.out.find("\n  packets     51 "), std::string::npos) << cut.out;
}

TEST_F(EndToEndInfo, ReadsStandardInput) {
    EXPECT_TRUE(run({"info", "-"}, compressedAttach(doubles::gzipOf))
                    .out.starts_with("standard input\n"
                                     "  format      gzip "
                                     "of pcap\n"));
}

TEST_F(EndToEndInfo, CompressedRecordingsAreReadWhereverPlainOnesAre) {
    const std::string decoded = run({"decode", "--every", "packet", gsmAttach()}).out;
    const std::string printed = run({gsmAttach(), "--print", "--speed", "max"}).out;
    for (const auto& compress : {doubles::gzipOf, doubles::zstdOf}) {
        const std::string path = compressedAttach(compress);
        EXPECT_EQ(run({"decode", "--every", "packet", path}).out, decoded);
        EXPECT_EQ(run({"decode", "--every", "packet", "-"}, path).out, decoded);
        EXPECT_EQ(run({path, "--print", "--speed", "max"}).out, printed);
    }
}

TEST_F(EndToEndInfo, ACompressedStreamIsRelayed) {
    const std::string expected = run({"decode", gsmAttach()}).out;
    doubles::PallaxProcess service(world, {"service", "--relay", "-"},
                                   compressedAttach(doubles::gzipOf));
    ASSERT_TRUE(doubles::eventually([this] { return !world.sockets().empty(); }));
    const std::string recorded = world.path("relayed.pcapng");
    EXPECT_EQ(run({"record", recorded}).status, 0);
    EXPECT_EQ(service.wait(), 0);
    EXPECT_EQ(run({"decode", recorded}).out, expected);
}

} // namespace
} // namespace pallax
