#pragma once

#include "platform/TelephonyConstants.h"
#include "plist/PropertyList.h"
#include "simulator/RadioLayer.h"

#include <cstdint>
#include <initializer_list>
#include <string_view>
#include <utility>

namespace pallax {

enum class CellRole { Serving, Neighbour };

/// One cell of the cell-monitor list: its technology, whether it serves, and numbers by the
/// service's keys.
PropertyList
cellMonitorEntry(std::string_view technology, CellRole role,
                 std::initializer_list<std::pair<std::string_view, std::int64_t>> numbers);

/// A GSM neighbour with its level.
PropertyList gsmNeighbourEntry(const Cell& cell, double level_dbm);

} // namespace pallax
