#pragma once

#include "tests/doubles/PropertyListRecord.h"

#include <initializer_list>
#include <string>
#include <utility>

namespace pallax::doubles {

/// A cell of the cell-monitor array: cell("GSM", "Serving", {{"MCC", 310}}).
inline PropertyList cell(const std::string& technology, const std::string& type,
                         std::initializer_list<std::pair<const char*, std::int64_t>> numbers = {}) {
    Dictionary cell{
        {"kHXCellMonitorCellRadioAccessTechnology",
         "kHXCellMonitorRadioAccessTechnology" + technology},
        {"kHXCellMonitorCellType", "kHXCellMonitorCellType" + type},
    };
    for (const auto& [name, number] : numbers) {
        cell.set(std::string("kHXCellMonitor") + name, PropertyList::integer(number));
    }
    return cell;
}

/// The record that carries the cell-monitor array.
inline Record cellsRecord(const Array& cells) {
    return propertyListRecord(kCellMonitorLogCode, cells);
}

} // namespace pallax::doubles
