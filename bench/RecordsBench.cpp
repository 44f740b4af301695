// Nanoseconds that one packet costs each record class, with a section attached and no log sink.

#include "LogGenerator/ZOR_GSM/ActiveSet.h"
#include "LogGenerator/ZOR_GSM/BLER.h"
#include "LogGenerator/ZOR_GSM/DetectedSet.h"
#include "LogGenerator/ZOR_GSM/GSMSet.h"
#include "LogGenerator/ZOR_GSM/HSDPAInformation.h"
#include "LogGenerator/ZOR_GSM/MonitoredSet.h"
#include "LogGenerator/ZOR_GSM/ProcessCO.h"
#include "LogGenerator/ZOR_GSM/ProcessCS.h"
#include "LogGenerator/ZOR_GSM/ProcessPS.h"
#include "LogGenerator/ZOR_GSM/UMTSRRInfo.h"
#include "LogGenerator/ZOR_GSM/UMTSSet.h"
#include "LogGenerator/ZOR_GSM/VirtualActiveSet.h"
#include "bench/MeasureRecord.h"
#include "platform/PropertyListCodec.h"
#include "platform/TelephonyConstants.h"

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

/// Eight UMTS entries, and eight GSM entries over the same bytes.
Record rankedCells() {
    return Record(0x4005).padTo(15 + 8 * 10).at(13, 8).at(14, 8);
}

/// A serving cell and two neighbours with the numbers that are read of them.
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

} // namespace
} // namespace pallax
