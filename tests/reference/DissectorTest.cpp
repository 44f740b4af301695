#include "samples/Samples.h"
#include "tests/doubles/Shell.h"
#include "tests/reference/DisplayComparison.h"

#include <gtest/gtest.h>

#include <map>
#include <sstream>

// Compares the protocol analyser with the dissector to the output of `pallax decode` after each
// packet, for log records with fields in bytes.

namespace pallax {
namespace {

using doubles::AnalyserItem;
using doubles::compareRecording;
using doubles::runCommand;

class Dissector : public testing::Test {
protected:
    void SetUp() override {
        if (!doubles::isInstalled("tshark")) {
            GTEST_SKIP() << "tshark is not installed";
        }
    }

    /// The first packet of each log code in a sample, without property lists.
    static std::vector<ByteBuffer> oneOfEachCode(const SampleRecording& sample) {
        std::map<unsigned, ByteBuffer> packets;
        for (const TimedPacket& packet : sample.packets()) {
            constexpr std::size_t kPrefix = 2;
            constexpr std::size_t kCode = kPrefix + 3;
            if (packet.data.at(kPrefix) == 1) {
                packets.emplace(packet.data.at(kCode) | packet.data.at(kCode + 1) << 8U,
                                packet.data);
            }
        }
        std::vector<ByteBuffer> all;
        for (auto& [code, packet] : packets) {
            all.push_back(std::move(packet));
        }
        return all;
    }

    std::string recordingOf(const SampleRecording& sample,
                            const std::vector<ByteBuffer>& packets) const {
        return doubles::recordingOf(_folder, sample.technology, packets);
    }

    static bool hasLogRecords(const SampleRecording& sample) { return sample.technology != "ifx"; }

    doubles::TemporaryFolder _folder;
};

TEST_F(Dissector, ShowsTheSamplesAsTheyAreDecoded) {
    for (const SampleRecording& sample : samples()) {
        if (hasLogRecords(sample)) {
            SCOPED_TRACE(sample.fileName);
            const std::string path = PALLAX_SOURCE_DIR "/samples/" + std::string(sample.fileName);
            EXPECT_GT(compareRecording(path, sample.technology).values, 50U);
        }
    }
}

TEST_F(Dissector, ShowsPacketsThatAreCutAsTheyAreDecoded) {
    for (const SampleRecording& sample : samples()) {
        if (!hasLogRecords(sample) || sample.fileName == "gsm-attach.pcap") {
            continue;
        }
        SCOPED_TRACE(sample.fileName);
        std::vector<ByteBuffer> cut;
        for (const ByteBuffer& packet : oneOfEachCode(sample)) {
            const std::size_t step = packet.size() > 400 ? 17 : 1;
            for (std::size_t length = 1; length <= packet.size(); length += step) {
                cut.emplace_back(packet.begin(),
                                 packet.begin() + static_cast<std::ptrdiff_t>(length));
            }
        }
        EXPECT_GT(compareRecording(recordingOf(sample, cut), sample.technology).values, 200U);
    }
}

TEST_F(Dissector, ShowsPacketsOfAnyBytesAsTheyAreDecoded) {
    for (const SampleRecording& sample : samples()) {
        if (!hasLogRecords(sample) || sample.fileName == "gsm-attach.pcap") {
            continue;
        }
        SCOPED_TRACE(sample.fileName);
        constexpr std::size_t kBody = 15; // behind prefix and header
        constexpr int kTimes = 40;
        std::uint32_t random = 1;
        std::vector<ByteBuffer> spoilt;
        for (const ByteBuffer& packet : oneOfEachCode(sample)) {
            for (int time = 0; time < kTimes; ++time) {
                ByteBuffer bytes = packet;
                for (std::size_t at = kBody; at < bytes.size(); ++at) {
                    random = random * 1664525U + 1013904223U;
                    const bool keep = at < bytes.size() / 4 && time % 2 == 0;
                    bytes[at] = keep ? bytes[at] : static_cast<std::uint8_t>(random >> 24U);
                }
                spoilt.push_back(std::move(bytes));
            }
        }
        EXPECT_GT(compareRecording(recordingOf(sample, spoilt), sample.technology).values, 500U);
    }
}

TEST_F(Dissector, TellsHeaderAndLogCode) {
    const SampleRecording& sample = samples()[3];
    ASSERT_EQ(sample.technology, "lte");
    const ByteBuffer antennas = oneOfEachCode(sample).front();
    ByteBuffer ofUnknownCode = antennas;
    ofUnknownCode.at(5) = 0x99;
    ByteBuffer ofInvalidType = antennas;
    ofInvalidType.at(2) = 7;
    const ByteBuffer prefix{0x81, 0x00};
    const auto packets = doubles::packetsIn(
        doubles::dissected(
            recordingOf(sample, {antennas, ofUnknownCode, ofInvalidType, prefix, {0x01}}), "lte"),
        "LTE log record");
    const auto labelsOf = [&](std::size_t packet) {
        std::vector<std::string> labels{packets.at(packet).label};
        for (const AnalyserItem& item : packets.at(packet).items) {
            labels.push_back(item.label);
        }
        return labels;
    };
    using Labels = std::vector<std::string>;
    EXPECT_EQ(labelsOf(0), (Labels{"LTE log record", "Log type: 0x01",
                                   "Log code: 0xB0C1, Antennas of the serving cell",
                                   "Name: Antennas of the serving cell", "[Record length: 22]",
                                   "Serving Cell Info"}));
    EXPECT_EQ(labelsOf(1), (Labels{"LTE log record", "Log type: 0x01", "Log code: 0xB099",
                                   "Name: unknown", "[Record length: 22]"}));
    EXPECT_EQ(labelsOf(2), (Labels{"LTE log record (invalid log type)", "Log type: 0x07",
                                   "Log code: 0xB0C1, Antennas of the serving cell",
                                   "Name: Antennas of the serving cell", "[Record length: 22]"}));
    EXPECT_EQ(labelsOf(3), (Labels{"LTE log record (too short)"}));
    EXPECT_EQ(labelsOf(4), (Labels{"LTE log record (too short)"}));
}

TEST_F(Dissector, FieldsCanBeFilteredByTheirNumbers) {
    const auto run = runCommand(
        "tshark -X lua_script:" PALLAX_SOURCE_DIR
        "/extras/wireshark/pallax.lua -r " PALLAX_SOURCE_DIR
        "/samples/lte-drive.pcap -Y 'pallax_lte.serving_cell_measurements.measured_rsrp < -90' "
        "-T fields -e pallax_lte.serving_cell_measurements.measured_rsrp 2>/dev/null");
    EXPECT_EQ(run.status, 0);
    std::istringstream lines(run.out);
    std::size_t count = 0;
    for (double level = 0; lines >> level; ++count) {
        EXPECT_LT(level, -90.0);
    }
    EXPECT_GT(count, 3U);
}

} // namespace
} // namespace pallax
