#pragma once

#include "fleet/RowBinary.h"
#include "store/IntervalBatch.h"
#include "store/MeasurementStore.h"

#include <cstddef>
#include <cstdint>
#include <string>
#include <string_view>

namespace pallax {

/// The columns of `intervals` in the order of appendInterval().
inline constexpr std::string_view kIntervalColumns =
    "device, load, month, field, entry, system, cell, day, minute, second, ms, hold_minutes, "
    "hold_seconds, hold_ms, part, whole_minutes, whole_seconds, whole_ms, known, steps, step, "
    "rest, decimals, suffix, text, raw, reason, unit, packet_high, "
    "packet_middle, packet_low, recording, technology, decoder";

/// 202611, in UTC.
std::uint32_t monthOf(std::int64_t milliseconds);

/// A number as text with `decimals`, and what follows it.
struct DecimalText {
    std::int8_t decimals = -1; ///< -1: the text is not made of the number
    std::string_view suffix = {};
};

/// "-92.25": the number with up to four decimals.
std::string decimalText(double number, std::size_t decimals);

/// How the text of a number can be made of it again, exactly, by decimalText().
DecimalText decimalTextOf(double number, std::string_view text);

/// Appends an interval of a batch as a row of a recording, whose `id` is the number of the load.
void appendInterval(RowBinary& rows, const IntervalBatch::Row& row, IntervalBatch& batch,
                    const LoadedRecording& recording);

} // namespace pallax
