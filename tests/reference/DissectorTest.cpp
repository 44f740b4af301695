#include "host/RecordingWriter.h"
#include "samples/Samples.h"
#include "tests/doubles/Files.h"
#include "tests/doubles/Shell.h"
#include "tests/reference/AnalyserTree.h"
#include "tests/reference/ReferenceFixture.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>
#include <nlohmann/json.hpp>

#include <algorithm>
#include <sstream>

// The protocol analyser with the dissector against what `pallax decode` shows after each packet.

namespace pallax {
namespace {

using doubles::AnalyserItem;
using doubles::runCommand;
using Json = nlohmann::json;

/// The display after each packet.
std::vector<Json> decoded(const std::string& recording) {
    const auto run = runCommand(PALLAX_BINARY_DIR "/pallax decode --every packet " + recording);
    EXPECT_EQ(run.status, 0) << run.out;
    std::vector<Json> displays;
    std::istringstream lines(run.out);
    for (std::string line; std::getline(lines, line);) {
        displays.push_back(Json::parse(line)["display"]);
    }
    return displays;
}

std::string dissected(const std::string& recording, const std::string& technology) {
    const auto run = runCommand("LC_ALL=C.UTF-8 tshark -X lua_script:" PALLAX_SOURCE_DIR
                                "/extras/wireshark/pallax.lua -V -O pallax_" +
                                technology + " -r " + recording);
    EXPECT_EQ(run.status, 0) << run.out;
    EXPECT_EQ(run.out.find("Lua Error"), std::string::npos) << run.out.substr(0, 2000);
    EXPECT_EQ(run.out.find("Malformed"), std::string::npos);
    return run.out;
}

/// The dissector against the displays of one recording.
class Comparison {
public:
    /// How many values were the same.
    std::size_t compared() const { return _compared; }

    /// `packet` is what the analyser shows, `before` and `after` the display around it.
    void compare(const AnalyserItem& packet, const Json& before, const Json& after) {
        const bool hasPropertyList =
            std::any_of(packet.items.begin(), packet.items.end(),
                        [](const AnalyserItem& item) { return item.label.starts_with("For "); });
        for (const AnalyserItem& item : packet.items) {
            if (isSection(item)) {
                compareSection(item, sectionOf(after, item.label));
            }
        }
        if (!hasPropertyList) {
            expectChangesShown(packet, "", before, after);
        }
    }

private:
    static bool isSection(const AnalyserItem& item) {
        return !item.hasValue() && !item.label.starts_with("For ") &&
               !item.label.starts_with("Property list") && !item.label.ends_with(")");
    }

    static const Json& sectionOf(const Json& display, const std::string& path) {
        static const Json kNone;
        const std::size_t slash = path.find(" / ");
        const std::string key = path.substr(0, slash);
        if (!display.is_object() || !display.contains(key)) {
            return kNone;
        }
        return slash == std::string::npos ? display[key]
                                          : sectionOf(display[key], path.substr(slash + 3));
    }

    void compareSection(const AnalyserItem& section, const Json& display) {
        if (display.is_array()) {
            compareList(section, display);
        } else {
            compareKeys(section, display);
        }
    }

    void compareKeys(const AnalyserItem& holder, const Json& display) {
        for (const AnalyserItem& item : holder.items) {
            if (item.label == "Not displayed") {
                continue;
            }
            ASSERT_TRUE(display.is_object() && display.contains(item.key()))
                << holder.label << ", " << item.label << ", " << display;
            const Json& shown = display[item.key()];
            if (shown.is_array()) {
                compareList(item, shown);
            } else if (shown.is_object()) {
                compareKeys(item, shown);
                EXPECT_EQ(item.items.size() + 1, shown.size()) << item.label; // and "_sorted"
            } else {
                EXPECT_EQ(item.value(), shown.get<std::string>()) << holder.label << item.label;
                ++_compared;
            }
        }
    }

    void compareList(const AnalyserItem& holder, const Json& list) {
        if (holder.find("Not displayed") != nullptr) {
            return;
        }
        ASSERT_EQ(holder.items.size(), list.size()) << holder.label << list;
        for (std::size_t index = 0; index < list.size(); ++index) {
            const AnalyserItem& entry = holder.items[index];
            if (list[index].is_object()) {
                compareKeys(entry, list[index]);
                EXPECT_EQ(entry.items.size(), list[index].size()) << holder.label << list[index];
            } else {
                EXPECT_EQ(entry.label, list[index].get<std::string>()) << holder.label;
                ++_compared;
            }
        }
    }

    /// Whatever the packet has changed is something that the analyser shows.
    void expectChangesShown(const AnalyserItem& packet, const std::string& path, const Json& before,
                            const Json& after) {
        for (const auto& [key, value] : after.items()) {
            const bool isNew = !before.is_object() || !before.contains(key);
            if (!isNew && before[key] == value) {
                continue;
            }
            const AnalyserItem* section = path.empty() ? nullptr : packet.find(path);
            if (value.is_object() && !value.contains("_sorted")) {
                const std::string inner = path.empty() ? key : path + " / " + key;
                expectChangesShown(packet, inner, isNew ? Json() : before[key], value);
            } else if (path.empty()) {
                EXPECT_TRUE(value.empty() || packet.find(key) != nullptr) << key << value;
            } else if (value != "") {
                EXPECT_TRUE(section != nullptr && section->find(key) != nullptr)
                    << packet.label << ", " << path << ", " << key << ": " << value;
            }
        }
    }

    std::size_t _compared = 0;
};

std::size_t compareRecording(const std::string& recording, const std::string& technology,
                             const std::string& title) {
    const std::vector<Json> displays = decoded(recording);
    const auto packets =
        doubles::packetsIn(dissected(recording, technology), title + " log record");
    EXPECT_EQ(packets.size(), displays.size());
    Comparison comparison;
    Json before;
    for (std::size_t index = 0; index < std::min(packets.size(), displays.size()); ++index) {
        SCOPED_TRACE("packet " + std::to_string(index + 1));
        comparison.compare(packets[index], before, displays[index]);
        if (testing::Test::HasFailure()) {
            break;
        }
        before = displays[index];
    }
    return comparison.compared();
}

class Dissector : public testing::Test {
protected:
    Dissector() : _technologies(doubles::reference()) {}

    void SetUp() override {
        if (!doubles::isInstalled("tshark")) {
            GTEST_SKIP() << "tshark is not installed: the dissector is not run";
        }
    }

    std::string titleOf(std::string_view commandName) const {
        for (const TechnologyReference& each : _technologies) {
            if (each.technology->commandName == commandName) {
                return std::string(each.title);
            }
        }
        return "";
    }

    /// Of each log code of a sample, property lists apart, the first packet.
    static std::vector<ByteBuffer> oneOfEachCode(const Sample& sample) {
        std::map<unsigned, ByteBuffer> packets;
        for (const SamplePacket& packet : sample.packets()) {
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

    /// A recording of the packets, a second apart.
    std::string recordingOf(const Sample& sample, const std::vector<ByteBuffer>& packets) const {
        std::string path = _folder.path(std::string(sample.technology) + ".pcap");
        auto created =
            RecordingWriter::create(path, technologyOfCommandName(sample.technology)->linkType);
        EXPECT_TRUE(created);
        Time time = kSampleStart;
        for (const ByteBuffer& packet : packets) {
            EXPECT_EQ((*created)->write(time, packet), std::nullopt);
            time += std::chrono::seconds(1);
        }
        return path;
    }

    static bool hasLogRecords(const Sample& sample) { return sample.technology != "ifx"; }

    std::vector<TechnologyReference> _technologies;
    doubles::TemporaryFolder _folder;
};

TEST_F(Dissector, ShowsTheSamplesAsTheyAreDecoded) {
    for (const Sample& sample : samples()) {
        if (hasLogRecords(sample)) {
            SCOPED_TRACE(sample.fileName);
            const std::string path = PALLAX_SOURCE_DIR "/samples/" + std::string(sample.fileName);
            EXPECT_GT(
                compareRecording(path, std::string(sample.technology), titleOf(sample.technology)),
                50U);
        }
    }
}

TEST_F(Dissector, ShowsPacketsThatAreCutAsTheyAreDecoded) {
    for (const Sample& sample : samples()) {
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
        EXPECT_GT(compareRecording(recordingOf(sample, cut), std::string(sample.technology),
                                   titleOf(sample.technology)),
                  200U);
    }
}

TEST_F(Dissector, ShowsPacketsOfAnyBytesAsTheyAreDecoded) {
    for (const Sample& sample : samples()) {
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
        EXPECT_GT(compareRecording(recordingOf(sample, spoilt), std::string(sample.technology),
                                   titleOf(sample.technology)),
                  500U);
    }
}

TEST_F(Dissector, ShowsTheKeysOfXmlPropertyLists) {
    const auto run = dissected(PALLAX_SOURCE_DIR "/samples/ifx-stream.pcap", "ifx");
    const auto packets = doubles::packetsIn(run, "IFX log record");
    ASSERT_EQ(packets.size(), 30U);
    // The forms of a message take turns: XML, binary, text.
    const AnalyserItem& xml = packets[0].items.at(0);
    EXPECT_TRUE(xml.label.starts_with("Property list, XML, ")) << xml.label;
    std::vector<std::string> labels;
    for (const AnalyserItem& item : xml.items) {
        labels.push_back(item.label);
    }
    EXPECT_THAT(labels,
                testing::IsSupersetOf({"Name: Sample Net", "MCC: 262", "ARFCN: 62", "BSIC: 2,3",
                                       "C1: 42", "LAC: 6699", "Cell ID: 20817"}));
    for (const std::size_t other : {1U, 2U}) {
        const AnalyserItem& item = packets[other].items.at(0);
        EXPECT_TRUE(item.label.starts_with("Property list, ")) << item.label;
        EXPECT_TRUE(item.items.empty());
    }
}

TEST_F(Dissector, TellsHeaderAndLogCode) {
    const Sample& sample = samples()[3];
    ASSERT_EQ(sample.technology, "lte");
    const ByteBuffer antennas = oneOfEachCode(sample).front();
    ByteBuffer ofUnknownCode = antennas;
    ofUnknownCode.at(5) = 0x99;
    ByteBuffer ofInvalidType = antennas;
    ofInvalidType.at(2) = 7;
    const ByteBuffer prefix{0x81, 0x00};
    const auto packets = doubles::packetsIn(
        dissected(recordingOf(sample, {antennas, ofUnknownCode, ofInvalidType, prefix, {0x01}}),
                  "lte"),
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
