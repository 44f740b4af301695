#include "tests/doubles/Shell.h"
#include "tests/reference/ReferenceFixture.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <map>
#include <ostream>
#include <regex>
#include <string>
#include <vector>

// Which bytes the protocol analyser marks for a field, against the bytes that it is described with.

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

/// Of the fields under `filter` in the first packet that has one of them.
Marks marked(const std::string& sample, const std::string& filter) {
    const auto run =
        doubles::runCommand("LC_ALL=C.UTF-8 tshark -X lua_script:" PALLAX_SOURCE_DIR
                            "/extras/wireshark/pallax.lua -r " PALLAX_SOURCE_DIR "/samples/" +
                            sample + " -Y " + filter + " -T pdml 2>/dev/null");
    EXPECT_EQ(run.status, 0);
    const std::string packet = run.out.substr(0, run.out.find("</packet>"));
    const std::string section = filter.substr(0, filter.rfind('.'));
    const std::regex field("<field name=\"" + section +
                           "\\.[^\"]*\" showname=\"([^\":]*): [^\"]*\" size=\"([0-9]+)\" "
                           "pos=\"([0-9]+)\"");
    Marks marks;
    for (std::sregex_iterator found(packet.begin(), packet.end(), field), end; found != end;
         ++found) {
        std::string key = (*found)[1];
        if (const std::size_t at = key.find("&lt;"); at != std::string::npos) {
            key.replace(at, 4, "<");
        }
        marks.emplace(key, MarkedBytes{std::stoul((*found)[3]), std::stoul((*found)[2])});
    }
    return marks;
}

/// From the first byte to the last that a field is read from.
MarkedBytes bytesOf(const FieldDescription& field) {
    constexpr std::size_t kPrefix = 2; // of every packet of the samples
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

/// The same as one code of a section is described.
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
        marks.emplace(field.key, bytesOf(field));
    }
    return marks;
}

class DissectorRanges : public testing::Test {
protected:
    void SetUp() override {
        if (!doubles::isInstalled("tshark")) {
            GTEST_SKIP() << "tshark is not installed: the dissector is not run";
        }
    }
};

TEST_F(DissectorRanges, AFieldMarksTheBytesThatHoldIt) {
    const Marks marks = marked("lte-drive.pcap", "pallax_lte.serving_cell_info.download_frequency");
    EXPECT_EQ(marks, described("lte", "Serving Cell Info", 0xB0C2));
    EXPECT_EQ(marks.size(), 8U);
    EXPECT_EQ(marks.at("Physical Cell ID"), (MarkedBytes{2 + 14, 2}));
    EXPECT_EQ(marks.at("Download Bandwidth"), (MarkedBytes{2 + 20, 1}));
}

TEST_F(DissectorRanges, AFieldOfBitsMarksTheBytesThatTheyLieIn) {
    const Marks marks =
        marked("lte-drive.pcap", "pallax_lte.serving_cell_measurements.max_ue_tx_power");
    EXPECT_EQ(marks, described("lte", "Serving Cell Measurements", 0xB17F));
    EXPECT_EQ(marks.at("Max UE Tx Power"), (MarkedBytes{2 + 27, 2}));
}

TEST_F(DissectorRanges, AComputedFieldMarksAllThatItIsMadeOf) {
    const Marks marks = marked("umts-drive.pcap", "pallax_gsm.serving_plmn.mobile_network_code");
    const Marks told = described("gsm", "Serving PLMN", 0x7135);
    for (const auto& [key, bytes] : marks) {
        EXPECT_EQ(bytes, told.at(key)) << key;
    }
    EXPECT_EQ(marks.at("Mobile Country Code"), (MarkedBytes{2 + 15, 2}));
    EXPECT_EQ(marks.at("Mobile Network Code"), (MarkedBytes{2 + 16, 2}));
}

} // namespace
} // namespace pallax
