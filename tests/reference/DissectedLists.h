#pragma once

#include "platform/TelephonyConstants.h"
#include "plist/PropertyListCodec.h"
#include "simulator/common/PropertyListRecord.h"
#include "tests/doubles/RecordBuilder.h"
#include "tests/doubles/TextPropertyList.h"
#include "tests/reference/DisplayComparison.h"

#include <gtest/gtest.h>

#include <array>
#include <string>
#include <vector>

/// Packets that are property lists.
namespace pallax {

using Packets = std::vector<ByteBuffer>;

inline ByteBuffer bytesOf(const std::string& text) {
    return {text.begin(), text.end()};
}

inline ByteBuffer recordOf(std::uint32_t logCode, const ByteBuffer& list) {
    return doubles::Record(logCode).append(list).prefixed();
}

/// Adds the list as a record, in XML and in binary.
inline void add(Packets& packets, std::uint32_t logCode, const PropertyList& list) {
    packets.push_back(recordOf(logCode, bytesOf(*serializeXml(list))));
    packets.push_back(recordOf(logCode, *serializeBinary(list)));
}

/// A cell with the same number under every key.
inline PropertyList cell(std::string_view technology, std::string_view type,
                         const PropertyList& number) {
    Dictionary entries;
    entries.setFixed(kHXCellMonitorCellRadioAccessTechnology, Text::fixed(technology));
    entries.setFixed(kHXCellMonitorCellType, Text::fixed(type));
    for (const std::string_view key :
         {kHXCellMonitorMCC, kHXCellMonitorMNC, kHXCellMonitorLAC, kHXCellMonitorTAC,
          kHXCellMonitorCellId, kHXCellMonitorPID, kHXCellMonitorBandInfo, kHXCellMonitorARFCN,
          kHXCellMonitorUARFCN, kHXCellMonitorRSSI, kHXCellMonitorSCN, kHXCellMonitorRSCP,
          kHXCellMonitorECN0}) {
        entries.setFixed(key, number);
    }
    return entries;
}

/// A serving and a neighbour cell of every technology.
inline Array cells(const PropertyList& number) {
    Array all;
    for (const std::string_view technology :
         {kHXCellMonitorRadioAccessTechnologyGSM, kHXCellMonitorRadioAccessTechnologyUMTS,
          kHXCellMonitorRadioAccessTechnologyLTE, kHXCellMonitorRadioAccessTechnologyUTRAN2}) {
        for (const std::string_view type :
             {kHXCellMonitorCellTypeServing, kHXCellMonitorCellTypeNeighbor}) {
            all.push_back(cell(technology, type, number));
        }
    }
    return all;
}

inline constexpr auto kSimFiles = std::to_array<const char*>(
    {"kSimFile_ICCID", "kSimFile_MSISDN", "kSimFile_MBDN", "kSimFile_HPPLMN", "kSimFile_LOCI",
     "kSimFile_PSLOCI", "kSimFile_ACC", "kSimFile_AD", "kSimFile_FPLMN", "kSimFile_AHPLMN",
     "kSimFile_RATMODE", "kSimFile_PNN", "kSimFile_OPL", "kSimFile_OPLMNAcT"});

/// Runs the analyser on packets and compares it with the displays.
class DissectedLists : public testing::Test {
protected:
    void SetUp() override {
        if (!doubles::isInstalled("tshark")) {
            GTEST_SKIP() << "tshark is not installed";
        }
    }

    doubles::Compared compare(std::string_view technology, const Packets& packets) const {
        return doubles::compareRecording(doubles::recordingOf(_folder, technology, packets),
                                         technology);
    }

    doubles::TemporaryFolder _folder;
};

} // namespace pallax
