#pragma once

#include "LogGenerator/Records/Layout.h"
#include "LogGenerator/Records/LogRecord.h"
#include "plist/PropertyList.h"

#include <cstdint>
#include <optional>
#include <span>
#include <string_view>

/// The cell-monitor array: the payload of the extended record 0xFF0001 is a serialized property
/// list, an array with one dictionary for each cell that the telephony service knows. The keys are
/// the service's `kHXCellMonitor…` constants.
namespace pallax {

inline constexpr std::string_view kCellMonitorName = "Cell monitor";
/// For layouts with levels.
inline constexpr std::string_view kLevelsNote =
    "Of a level only the low 16 bits count, as a signed number.";

/// The array. Logs two lines and returns nothing when the payload is not a property list.
std::optional<PropertyList> parseCellMonitorArray(const LogRecord& record);
/// The same, but logs only the first of the two lines.
std::optional<PropertyList> parseCellMonitorArrayQuietly(const LogRecord& record);

/// A key that shows a cell's number as decimal text. `failure` is logged if the cell has none.
constexpr Field cellNumber(std::string_view key, std::string_view cellKey, std::string_view failure,
                           std::string_view meaning = {}) {
    Field field{key, std::nullopt, Conversion::number(), meaning};
    field.listKey = cellKey;
    field.failure = failure;
    return field;
}

/// A key that shows a cell's number as a level: the low 16 bits, signed, times `factor`, with
/// `format`. 32767 means "not measured" and is shown as the empty string.
constexpr Field cellLevel(std::string_view key, std::string_view cellKey, std::string_view failure,
                          const NumberFormat& format, double factor = 1.0,
                          std::string_view meaning = {}) {
    constexpr std::int64_t kNotMeasured = 32767;
    Field field = cellNumber(key, cellKey, failure, meaning);
    field.conversion = Conversion::number(format, factor).except(kNotMeasured, "");
    field.listBits = 16;
    return field;
}

} // namespace pallax
