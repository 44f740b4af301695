// Nanoseconds per packet for each LTE record class, with a section attached and no log sink.

#include "LogGenerator/LTE/ConnectedModeMeasurementMisc.h"
#include "LogGenerator/LTE/DetectedCells.h"
#include "LogGenerator/LTE/LTEServingCellInfo.h"
#include "LogGenerator/LTE/MeasuredNeighborCells.h"
#include "LogGenerator/LTE/NeighborCellsList.h"
#include "LogGenerator/LTE/NeighborMeasurementMisc.h"
#include "LogGenerator/LTE/ReselectionCandidatesList.h"
#include "LogGenerator/LTE/ReselectionCandidatesMisc.h"
#include "LogGenerator/LTE/ServingCellMeasurement.h"
#include "bench/MeasureRecord.h"
#include "platform/TelephonyConstants.h"
#include "plist/PropertyListCodec.h"

namespace pallax {
namespace {

/// Eight measured neighbours and eight detected cells.
Record connectedMode() {
    return Record(0xB179).padTo(29 + 8 * 6 + 8 * 2).at(27, 8).at(28, 8);
}

/// Eight neighbours.
Record idleNeighbours() {
    constexpr unsigned kCount = 8;
    constexpr unsigned kCountField = (kCount - 1) << 6U;
    return Record(0xB180).padTo(19).u16(kCountField).padTo(21 + kCount * 20);
}

/// Eight LTE candidates.
Record candidates() {
    return Record(0xB186).padTo(21 + 8 * 4 + 4).at(19, 8);
}

/// A serving cell with all numbers that are read.
Record lteCellMonitor() {
    Dictionary cell;
    cell.setFixed(kHXCellMonitorCellRadioAccessTechnology,
                  Text::fixed(kHXCellMonitorRadioAccessTechnologyLTE));
    cell.setFixed(kHXCellMonitorCellType, Text::fixed(kHXCellMonitorCellTypeServing));
    for (const std::string_view key : {kHXCellMonitorTAC, kHXCellMonitorCellId, kHXCellMonitorPID,
                                       kHXCellMonitorBandInfo, kHXCellMonitorUARFCN}) {
        cell.setFixed(key, PropertyList::integer(42));
    }
    const auto bytes = serializeBinary(Array{cell});
    return Record(0xFF0001).append(Bytes(*bytes));
}

// One line for each record class and kind of packet.
BENCHMARK_TEMPLATE(measure, LTEServingCellInfo, zeros<0xB0C2, 38>);
BENCHMARK_TEMPLATE(measure, LTEServingCellInfo, zeros<0xB0C1, 22>);
BENCHMARK_TEMPLATE(measure, LTEServingCellInfo, lteCellMonitor);
BENCHMARK_TEMPLATE(measure, ServingCellMeasurement, zeros<0xB17F, 33>);
BENCHMARK_TEMPLATE(measure, ConnectedModeMeasurementMisc, connectedMode);
BENCHMARK_TEMPLATE(measure, MeasuredNeighborCells, connectedMode);
BENCHMARK_TEMPLATE(measure, DetectedCells, connectedMode);
BENCHMARK_TEMPLATE(measure, NeighborMeasurementMisc, idleNeighbours);
BENCHMARK_TEMPLATE(measure, NeighborCellsList, idleNeighbours);
BENCHMARK_TEMPLATE(measure, ReselectionCandidatesMisc, candidates);
BENCHMARK_TEMPLATE(measure, ReselectionCandidatesList, candidates);

} // namespace
} // namespace pallax
