// Nanoseconds per packet for each UTRAN record class.

#include "LogGenerator/UTRAN/CCTRCHSIRMeasurement.h"
#include "LogGenerator/UTRAN/GSMNeighbhorMeasurements.h"
#include "LogGenerator/UTRAN/RRC_State.h"
#include "LogGenerator/UTRAN/TRCHBLERMeasurement.h"
#include "LogGenerator/UTRAN/UTRANNeighbhorMeasurements.h"
#include "LogGenerator/UTRAN/UTRANServingCellInfo.h"
#include "bench/MeasureRecord.h"
#include "platform/TelephonyConstants.h"
#include "plist/PropertyListCodec.h"

namespace pallax {
namespace {

Record eightNeighbours() {
    return Record(0xD00A).padTo(168 + 8 * 16).at(16, 8 << 1);
}

Record eightGsmNeighbours() {
    return Record(0xD00E).padTo(17 + 8 * 8).at(16, 8);
}

/// Eight transport channels and four composite ones.
Record channels() {
    return Record(0xD00C).padTo(289 + 34 * 8 + 4 * 8).at(15, 4 << 4 | 8 >> 2);
}

/// A serving cell with all numbers that are read.
Record cellMonitor() {
    Dictionary cell;
    cell.setFixed(kHXCellMonitorCellRadioAccessTechnology,
                  Text::fixed(kHXCellMonitorRadioAccessTechnologyUTRAN2));
    cell.setFixed(kHXCellMonitorCellType, Text::fixed(kHXCellMonitorCellTypeServing));
    for (const std::string_view key :
         {kHXCellMonitorLAC, kHXCellMonitorCellId, kHXCellMonitorBandInfo, kHXCellMonitorSCN,
          kHXCellMonitorUARFCN}) {
        cell.setFixed(key, PropertyList::integer(42));
    }
    const auto bytes = serializeBinary(Array{cell});
    return Record(0xFF0001).append(Bytes(*bytes));
}

// One line for each record class and kind of packet.
BENCHMARK_TEMPLATE(measure, RRC_State, zeros<0xD0E0, 15>);
BENCHMARK_TEMPLATE(measure, UTRANServingCellInfo, zeros<0xD0E2, 26>);
BENCHMARK_TEMPLATE(measure, UTRANServingCellInfo, cellMonitor);
BENCHMARK_TEMPLATE(measure, UTRANNeighbhorMeasurements, eightNeighbours);
BENCHMARK_TEMPLATE(measure, GSMNeighbhorMeasurements, eightGsmNeighbours);
BENCHMARK_TEMPLATE(measure, TRCHBLERMeasurement, channels);
BENCHMARK_TEMPLATE(measure, CCTRCHSIRMeasurement, channels);

} // namespace
} // namespace pallax
