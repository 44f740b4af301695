#include "simulator/common/CellMonitor.h"

#include "simulator/Measurement.h"

namespace pallax {

PropertyList
cellMonitorEntry(std::string_view technology, CellRole role,
                 std::initializer_list<std::pair<std::string_view, std::int64_t>> numbers) {
    Dictionary entry;
    entry.reserve(numbers.size() + 2);
    entry.setFixed(kHXCellMonitorCellRadioAccessTechnology, Text::fixed(technology));
    entry.setFixed(kHXCellMonitorCellType,
                   Text::fixed(role == CellRole::Serving ? kHXCellMonitorCellTypeServing
                                                         : kHXCellMonitorCellTypeNeighbor));
    for (const auto& [key, number] : numbers) {
        entry.setFixed(key, PropertyList::integer(number));
    }
    return entry;
}

PropertyList gsmNeighbourEntry(const Cell& cell, double level_dbm) {
    constexpr double kStepDb = 2; // of a cell-monitor level of GSM
    return cellMonitorEntry(
        kHXCellMonitorRadioAccessTechnologyGSM, CellRole::Neighbour,
        {{kHXCellMonitorARFCN, cell.channel}, {kHXCellMonitorRSSI, whole(level_dbm / kStepDb)}});
}

} // namespace pallax
