#include "platform/TelephonyConstants.h"
#include "plist/PropertyListCodec.h"
#include "simulator/common/PropertyListRecord.h"
#include "tests/doubles/Pattern.h"
#include "tests/doubles/RecordBuilder.h"
#include "tests/doubles/Shell.h"
#include "tests/doubles/TextPropertyList.h"
#include "tests/reference/DisplayComparison.h"
#include "tests/reference/ReferenceFixture.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <map>
#include <ostream>
#include <string>
#include <vector>

// Compares the bytes that the protocol analyser marks for a field with the bytes in its
// description.

namespace pallax {
namespace {

struct MarkedBytes {
    std::size_t first;
    std::size_t length;

    bool operator==(const MarkedBytes&) const = default;
};

std::ostream& operator<<(std::ostream& out, const MarkedBytes& bytes) {
    return out << bytes.length << " bytes at " << bytes.first;
}

/// By key.
using Marks = std::map<std::string, MarkedBytes>;

const std::string kSamples = PALLAX_SOURCE_DIR "/samples/";

/// The marks of the fields of `filter`, in the first packet of a recording that has one of them.
Marks marked(const std::string& recording, const std::string& filter) {
    const auto run = doubles::runCommand("LC_ALL=C.UTF-8 tshark -X lua_script:" PALLAX_SOURCE_DIR
                                         "/extras/wireshark/pallax.lua -r " +
                                         recording + " -Y " + filter + " -T pdml 2>/dev/null");
    EXPECT_EQ(run.status, 0);
    const std::string packet = run.out.substr(0, run.out.find("</packet>"));
    const std::string section = filter.substr(0, filter.rfind('.'));
    const std::string field("<field name=\"" + section +
                            "\\.[^\"]*\" showname=\"([^\":]*): [^\"]*\" size=\"([0-9]+)\" "
                            "pos=\"([0-9]+)\"");
    Marks marks;
    for (const auto& found : doubles::matchesIn(packet, field)) {
        std::string key = found[1];
        if (const std::size_t at = key.find("&lt;"); at != std::string::npos) {
            key.replace(at, 4, "<");
        }
        marks.emplace(key, MarkedBytes{std::stoul(found[3]), std::stoul(found[2])});
    }
    return marks;
}

/// From the first to the last byte of a field.
MarkedBytes markedBytesOf(const FieldDescription& field) {
    constexpr std::size_t kPrefix = 2; // in every packet of the samples
    const std::vector<Extent> extents =
        field.position ? std::vector<Extent>{extentOf(*field.position)} : field.read;
    std::size_t first = extents.at(0).byte;
    std::size_t end = first;
    for (const Extent& extent : extents) {
        first = std::min(first, extent.byte);
        end = std::max(end, extent.byte + extent.length);
    }
    return {kPrefix + first, end - first};
}

/// The same according to the description of a section's code.
Marks described(const std::string& technology, const std::string& sectionName, LogCode logCode) {
    const auto technologies = doubles::reference();
    const auto ofTechnology =
        std::find_if(technologies.begin(), technologies.end(),
                     [&](const auto& each) { return each.technology->commandName == technology; });
    const auto section = std::find_if(ofTechnology->sections.begin(), ofTechnology->sections.end(),
                                      [&](const auto& each) { return each.name == sectionName; });
    const auto code = std::find_if(section->codes.begin(), section->codes.end(),
                                   [&](const auto& each) { return each.logCode == logCode; });
    Marks marks;
    for (const FieldDescription& field : code->fields) {
        marks.emplace(field.key, markedBytesOf(field));
    }
    return marks;
}

class DissectorRanges : public testing::Test {
protected:
    void SetUp() override {
        if (!doubles::isInstalled("tshark")) {
            GTEST_SKIP() << "tshark is not installed";
        }
    }
};

TEST_F(DissectorRanges, AFieldMarksTheBytesThatHoldIt) {
    const Marks marks =
        marked(kSamples + "lte-drive.pcap", "pallax_lte.serving_cell_info.download_frequency");
    EXPECT_EQ(marks, described("lte", "Serving Cell Info", 0xB0C2));
    EXPECT_EQ(marks.size(), 8U);
    EXPECT_EQ(marks.at("Physical Cell ID"), (MarkedBytes{2 + 14, 2}));
    EXPECT_EQ(marks.at("Download Bandwidth"), (MarkedBytes{2 + 20, 1}));
}

TEST_F(DissectorRanges, AFieldOfBitsMarksTheBytesThatTheyLieIn) {
    const Marks marks =
        marked(kSamples + "lte-drive.pcap", "pallax_lte.serving_cell_measurements.max_ue_tx_power");
    EXPECT_EQ(marks, described("lte", "Serving Cell Measurements", 0xB17F));
    EXPECT_EQ(marks.at("Max UE Tx Power"), (MarkedBytes{2 + 27, 2}));
}

TEST_F(DissectorRanges, AComputedFieldMarksAllThatItIsMadeOf) {
    const Marks marks =
        marked(kSamples + "umts-drive.pcap", "pallax_gsm.serving_plmn.mobile_network_code");
    const Marks told = described("gsm", "Serving PLMN", 0x7135);
    for (const auto& [key, bytes] : marks) {
        EXPECT_EQ(bytes, told.at(key)) << key;
    }
    EXPECT_EQ(marks.at("Mobile Country Code"), (MarkedBytes{2 + 15, 2}));
    EXPECT_EQ(marks.at("Mobile Network Code"), (MarkedBytes{2 + 16, 2}));
}

/// The position of bytes that a packet contains once.
MarkedBytes placeOf(const ByteBuffer& packet, const std::string& bytes) {
    const std::string text(packet.begin(), packet.end());
    const std::size_t at = text.find(bytes);
    EXPECT_NE(at, std::string::npos);
    EXPECT_EQ(text.find(bytes, at + 1), std::string::npos);
    return {at, bytes.size()};
}

TEST_F(DissectorRanges, AValueOfAPropertyListMarksTheBytesThatHoldIt) {
    const doubles::TemporaryFolder folder;
    const PropertyList list =
        Array{Dictionary{{kHXCellMonitorCellRadioAccessTechnology.data(),
                          kHXCellMonitorRadioAccessTechnologyGSM.data()},
                         {kHXCellMonitorCellType.data(), kHXCellMonitorCellTypeServing.data()},
                         {kHXCellMonitorCellId.data(), PropertyList::integer(4711)},
                         {kHXCellMonitorARFCN.data(), PropertyList::integer(-2)}}};
    const std::string xml = *serializeXml(list);
    const ByteBuffer inXml =
        doubles::Record(kCellMonitorCode).append(ByteBuffer(xml.begin(), xml.end())).prefixed();
    const ByteBuffer inBinary =
        doubles::Record(kCellMonitorCode).append(*serializeBinary(list)).prefixed();
    for (const ByteBuffer& packet : {inXml, inBinary}) {
        const bool isXml = packet == inXml;
        const Marks marks = marked(doubles::recordingOf(folder, "gsm", {packet}),
                                   "pallax_gsm.gsm_serving_cell.cell_id");
        EXPECT_EQ(marks.size(), 2U);
        EXPECT_EQ(marks.at("Cell ID"), placeOf(packet, isXml ? "4711" : "\x11\x12\x67"));
        EXPECT_EQ(marks.at("ARFCN"),
                  placeOf(packet, isXml ? "-2" : "\x13\xFF\xFF\xFF\xFF\xFF\xFF\xFF\xFE"));
    }
}

TEST_F(DissectorRanges, AFoldedValueOfAnObjectMarksItsOwnBytes) {
    const doubles::TemporaryFolder folder;
    const PropertyList object =
        Dictionary{{"Serving Cell",
                    Dictionary{{"ARFCN", "62"}, {"Rx Level", Dictionary{{"Value", "-61 dBm"}}}}}};
    const std::string xml = *serializeXml(object);
    const std::string text = doubles::textForm(object);
    const ByteBuffer inXml(xml.begin(), xml.end());
    const ByteBuffer inText(text.begin(), text.end());
    for (const ByteBuffer& packet : {inXml, inText, *serializeBinary(object)}) {
        const std::string before = packet == inXml ? "" : packet == inText ? "\"" : "\x57";
        const std::string behind = packet == inText ? "\"" : "";
        const Marks marks =
            marked(doubles::recordingOf(folder, "ifx", {packet}), "pallax_ifx.serving_cell.arfcn");
        EXPECT_EQ(marks.size(), 2U);
        EXPECT_EQ(marks.at("Rx Level"), placeOf(packet, before + "-61 dBm" + behind));
    }
}

} // namespace
} // namespace pallax
