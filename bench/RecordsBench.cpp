// Nanoseconds per packet for each record class, with a section attached and no log sink.

#include "LogGenerator/Common/PDPContextList.h"
#include "LogGenerator/Common/SimInfo.h"
#include "LogGenerator/LogPacket.h"
#include "LogGenerator/ZOR_GSM/ActiveSet.h"
#include "LogGenerator/ZOR_GSM/BLER.h"
#include "LogGenerator/ZOR_GSM/DetectedSet.h"
#include "LogGenerator/ZOR_GSM/EquivalentPLMNList.h"
#include "LogGenerator/ZOR_GSM/GPRSInformation.h"
#include "LogGenerator/ZOR_GSM/GSMRRInfo.h"
#include "LogGenerator/ZOR_GSM/GSMServingCell.h"
#include "LogGenerator/ZOR_GSM/GSMSet.h"
#include "LogGenerator/ZOR_GSM/HSDPAInformation.h"
#include "LogGenerator/ZOR_GSM/MobileAllocation.h"
#include "LogGenerator/ZOR_GSM/MonitoredSet.h"
#include "LogGenerator/ZOR_GSM/NeighboringCells.h"
#include "LogGenerator/ZOR_GSM/ProcessCO.h"
#include "LogGenerator/ZOR_GSM/ProcessCS.h"
#include "LogGenerator/ZOR_GSM/ProcessPS.h"
#include "LogGenerator/ZOR_GSM/ServingPLMN.h"
#include "LogGenerator/ZOR_GSM/UMTSRRInfo.h"
#include "LogGenerator/ZOR_GSM/UMTSSet.h"
#include "LogGenerator/ZOR_GSM/VirtualActiveSet.h"
#include "bench/MeasureRecord.h"
#include "platform/TelephonyConstants.h"
#include "plist/PropertyListCodec.h"

#include <string>
#include <string_view>

namespace pallax {
namespace {

/// Twelve cells of the searcher, three of them active.
Record searcherCells() {
    constexpr unsigned kCells = 12;
    constexpr unsigned kMonitored = 0x20; // set type 1
    Record record(0x417A);
    record.s16(-600).u8(kCells);
    for (unsigned cell = 0; cell < kCells; ++cell) {
        record.u32(0).u16(0).u8(0).u8(cell).u8(cell % 4 == 0 ? 0 : kMonitored).u32(0).u16(0);
    }
    for (unsigned word = 0; word < kCells * 11; ++word) {
        record.u32(200000);
    }
    return record;
}

/// Eight UMTS entries, and eight GSM entries in the same bytes.
Record rankedCells() {
    return Record(0x4005).padTo(15 + 8 * 10).at(13, 8).at(14, 8);
}

/// A serving cell and two neighbours with all numbers that are read.
Record cellMonitor() {
    const auto cell = [](std::string_view type) {
        Dictionary numbers;
        numbers.setFixed(kHXCellMonitorCellRadioAccessTechnology,
                         Text::fixed(kHXCellMonitorRadioAccessTechnologyUMTS));
        numbers.setFixed(kHXCellMonitorCellType, Text::fixed(type));
        for (const std::string_view key :
             {kHXCellMonitorCellId, kHXCellMonitorUARFCN, kHXCellMonitorSCN, kHXCellMonitorRSCP,
              kHXCellMonitorECN0}) {
            numbers.setFixed(key, PropertyList::integer(42));
        }
        return numbers;
    };
    const auto bytes = serializeBinary(Array{cell(kHXCellMonitorCellTypeServing),
                                             cell(kHXCellMonitorCellTypeNeighbor),
                                             cell(kHXCellMonitorCellTypeNeighbor)});
    return Record(0xFF0001).append(Bytes(*bytes));
}

Record transmitPowers() {
    return Record(0x4031).padTo(16 + 8 * 14).at(14, 8).at(20, 88);
}

Record transportChannels() {
    return Record(0x4116).padTo(16 + 8 * 9).at(13, 8);
}

Record harqProcesses() {
    return Record(0x4221).padTo(18 + 8 * 162 + 8 * 9).at(16, 8).at(17, 8);
}

constexpr unsigned kGsmNeighbours = 6;

/// A serving cell and six neighbours.
Record gsmMeasurement() {
    constexpr std::size_t kEntries = 29;
    constexpr std::size_t kEntryLength = 14;
    Record record(0x5137);
    record.padTo(kEntries + kGsmNeighbours * kEntryLength);
    record.at(15, 71).at(16, 34).at(20, 40).at(26, 1).at(28, kGsmNeighbours);
    for (unsigned cell = 0; cell < kGsmNeighbours; ++cell) {
        const std::size_t entry = kEntries + cell * kEntryLength;
        record.at(entry, 62 + cell).at(entry + 2, 80 + cell).at(entry + 3, 20);
    }
    return record;
}

/// The BSICs of the six neighbours.
Record bsicList() {
    Record record(0x51FF);
    record.padTo(15 + kGsmNeighbours * 4).at(14, kGsmNeighbours);
    for (unsigned cell = 0; cell < kGsmNeighbours; ++cell) {
        record.at(15 + cell * 4, 62 + cell).at(15 + cell * 4 + 2, 17 + cell);
    }
    return record;
}

/// Eight hopping channels.
Record mobileAllocation() {
    Record record = Record(0x51F8).padTo(15 + 8 * 2).at(13, 21).at(14, 8);
    for (unsigned channel = 0; channel < 8; ++channel) {
        record.at(15 + channel * 2, 42 + channel * 8);
    }
    return record;
}

Record packetStatus() {
    return Record(0x51FD).padTo(35).at(13, 1).at(14, 2).at(15, 3).at(33, 1);
}

Record rrState() {
    return Record(0x512C).padTo(17).at(13, 5).at(14, 1).at(16, 1);
}

/// 262-42, both domains.
Record servingNetwork() {
    return Record(0x7135).padTo(32).at(14, 3).at(15, 0x62).at(16, 0xF2).at(17, 0x24).at(18, 26);
}

/// 262-20, and a second entry that shares three of its bytes.
Record equivalentNetworks() {
    return Record(0x7150).padTo(17 + 3 + 6).at(16, 2).at(17, 2).at(19, 6).at(20, 2).at(21, 2);
}

/// A state record: registration, MM or GMM.
template <LogCode logCode>
Record mobilityState() {
    return Record(logCode).padTo(16).at(13, 3).at(14, 5).at(15, 1);
}

/// A serving cell of GSM and six neighbours.
Record gsmCellMonitor() {
    const auto cell = [](std::string_view type) {
        Dictionary numbers;
        numbers.setFixed(kHXCellMonitorCellRadioAccessTechnology,
                         Text::fixed(kHXCellMonitorRadioAccessTechnologyGSM));
        numbers.setFixed(kHXCellMonitorCellType, Text::fixed(type));
        for (const std::string_view key :
             {kHXCellMonitorMCC, kHXCellMonitorMNC, kHXCellMonitorLAC, kHXCellMonitorCellId,
              kHXCellMonitorARFCN, kHXCellMonitorRSSI}) {
            numbers.setFixed(key, PropertyList::integer(42));
        }
        return numbers;
    };
    Array cells = {cell(kHXCellMonitorCellTypeServing)};
    for (unsigned neighbour = 0; neighbour < kGsmNeighbours; ++neighbour) {
        cells.emplace_back(cell(kHXCellMonitorCellTypeNeighbor));
    }
    const auto bytes = serializeBinary(cells);
    return Record(0xFF0001).append(Bytes(*bytes));
}

/// The fourteen files that the display shows.
Record simFiles() {
    Dictionary files;
    for (const std::string_view file :
         {"ICCID", "MSISDN", "MBDN", "HPPLMN", "LOCI", "PSLOCI", "ACC", "AD", "FPLMN", "AHPLMN",
          "RATMODE", "PNN", "OPL", "OPLMNAcT"}) {
        files.set("kSimFile_" + std::string(file), "89490200001234567890");
    }
    const auto bytes = serializeBinary(files);
    return Record(0xFF0000).append(Bytes(*bytes));
}

Record packetDataContexts() {
    const auto bytes = serializeBinary(
        Array{Dictionary{{"APN", "internet"}, {"Address", "10.17.4.21"}, {"State", "Active"}},
              Dictionary{{"APN", "mms"}, {"State", "Inactive"}}});
    return Record(0xFF0002).append(Bytes(*bytes));
}

/// Neighbours with known BSICs.
void measureNeighboursWithBsics(benchmark::State& state) {
    NeighboringCells record;
    record.updateSectionRef(Array());
    const ByteBuffer bsics = bsicList().bytes();
    record.updateWithData(LogRecord(Bytes(bsics)), 0x51FF);
    const ByteBuffer bytes = gsmMeasurement().bytes();
    const LogRecord packet{Bytes(bytes)};
    for ([[maybe_unused]] const auto iteration : state) {
        record.updateWithData(packet, 0x5137);
        benchmark::ClobberMemory();
    }
    state.SetItemsProcessed(state.iterations());
}

// One line for each record class and kind of packet.
BENCHMARK_TEMPLATE(measure, ActiveSet, searcherCells);
BENCHMARK_TEMPLATE(measure, DetectedSet, searcherCells);
BENCHMARK_TEMPLATE(measure, MonitoredSet, searcherCells);
BENCHMARK_TEMPLATE(measure, VirtualActiveSet, searcherCells);
BENCHMARK_TEMPLATE(measure, GSMSet, rankedCells);
BENCHMARK_TEMPLATE(measure, UMTSSet, rankedCells);
BENCHMARK_TEMPLATE(measure, UMTSSet, cellMonitor);
BENCHMARK_TEMPLATE(measure, UMTSRRInfo, zeros<0x4125, 14>);
BENCHMARK_TEMPLATE(measure, UMTSRRInfo, zeros<0x4127, 29>);
BENCHMARK_TEMPLATE(measure, UMTSRRInfo, zeros<0x4157, 19>);
BENCHMARK_TEMPLATE(measure, UMTSRRInfo, transmitPowers);
BENCHMARK_TEMPLATE(measure, UMTSRRInfo, cellMonitor);
BENCHMARK_TEMPLATE(measure, BLER, transportChannels);
BENCHMARK_TEMPLATE(measure, HSDPAInformation, harqProcesses);
BENCHMARK_TEMPLATE(measure, ProcessCO, zeros<0x7131, 16>);
BENCHMARK_TEMPLATE(measure, ProcessCS, zeros<0x7131, 16>);
BENCHMARK_TEMPLATE(measure, ProcessPS, zeros<0x7130, 16>);
BENCHMARK_TEMPLATE(measure, ProcessCO, mobilityState<0x7132>);
BENCHMARK_TEMPLATE(measure, ProcessCS, mobilityState<0x7132>);
BENCHMARK_TEMPLATE(measure, ProcessPS, mobilityState<0x7132>);
BENCHMARK_TEMPLATE(measure, ProcessCO, mobilityState<0x7131>);
BENCHMARK_TEMPLATE(measure, ProcessCS, mobilityState<0x7131>);
BENCHMARK_TEMPLATE(measure, ProcessPS, mobilityState<0x7130>);
BENCHMARK_TEMPLATE(measure, GSMServingCell, zeros<0x5134, 26>);
BENCHMARK_TEMPLATE(measure, GSMServingCell, gsmMeasurement);
BENCHMARK_TEMPLATE(measure, GSMServingCell, zeros<0x5076, 17>);
BENCHMARK_TEMPLATE(measure, GSMServingCell, gsmCellMonitor);
BENCHMARK(measureNeighboursWithBsics);
BENCHMARK_TEMPLATE(measure, NeighboringCells, bsicList);
BENCHMARK_TEMPLATE(measure, NeighboringCells, gsmCellMonitor);
BENCHMARK_TEMPLATE(measure, GSMRRInfo, rrState);
BENCHMARK_TEMPLATE(measure, GSMRRInfo, gsmMeasurement);
BENCHMARK_TEMPLATE(measure, MobileAllocation, mobileAllocation);
BENCHMARK_TEMPLATE(measure, GPRSInformation, packetStatus);
BENCHMARK_TEMPLATE(measure, GPRSInformation, gsmMeasurement);
BENCHMARK_TEMPLATE(measure, GPRSInformation, servingNetwork);
BENCHMARK_TEMPLATE(measure, ServingPLMN, servingNetwork);
BENCHMARK_TEMPLATE(measure, ServingPLMN, mobilityState<0x7132>);
BENCHMARK_TEMPLATE(measure, ServingPLMN, gsmCellMonitor);
BENCHMARK_TEMPLATE(measure, EquivalentPLMNList, equivalentNetworks);
BENCHMARK_TEMPLATE(measure, SimInfo, simFiles);
BENCHMARK_TEMPLATE(measure, PDPContextList, packetDataContexts);

} // namespace
} // namespace pallax
