#include "fleet/IntervalRows.h"

#include "fields/Standing.h"
#include "query/CellFinder.h"
#include "text/NumberFormat.h"

#include <algorithm>
#include <array>
#include <chrono>
#include <cmath>
#include <limits>

namespace pallax {

namespace {

constexpr std::int64_t kMinute = 60'000; ///< milliseconds
constexpr std::int64_t kMinutesOfDay = std::int64_t{24} * 60;
constexpr double kStepsOfReal = 16; ///< levels come in halves, quarters or sixteenths of a decibel
constexpr std::array<std::int64_t, 5> kScales{1, 10, 100, 1000, 10000};
constexpr double kExact = 9e15; ///< whole numbers up to it are numbers of a double

struct Divided {
    std::int64_t quotient;
    std::int64_t rest; ///< not negative
};

Divided divided(std::int64_t number, std::int64_t by) {
    const std::int64_t rest = (number % by + by) % by;
    return {(number - rest) / by, rest};
}

/// known, steps, step, rest
void appendNumber(RowBinary& rows, const FieldValue& value) {
    if (std::isnan(value.number)) {
        rows.add(std::uint8_t{0}).add(std::int16_t{0}).add(0.0).add(0.0);
        return;
    }
    const DisplayNumber* shown = value.shown.displayNumber();
    const double step = shown != nullptr && !shown->isReal() ? 1 : 1 / kStepsOfReal;
    const double steps = value.number / step;
    rows.add(std::uint8_t{1});
    if (steps == std::floor(steps) && std::abs(steps) <= std::numeric_limits<std::int16_t>::max()) {
        rows.add(static_cast<std::int16_t>(steps)).add(step).add(0.0);
    } else {
        rows.add(std::int16_t{0}).add(step).add(value.number);
    }
}

/// decimals, suffix, text, raw, reason
void appendText(RowBinary& rows, const FieldInfo& field, const FieldValue& value) {
    const std::string text = value.text();
    const bool isNumber = value.shown.displayNumber() != nullptr;
    const Standing standing = standingOf(field, text, value.number, value.raw);
    const DecimalText made = isNumber ? decimalTextOf(value.number, text) : DecimalText();
    rows.add(made.decimals).add(made.suffix);
    rows.add(made.decimals < 0 ? std::string_view(text) : std::string_view());
    rows.add(isNumber ? std::nullopt : value.raw).add(nameOf(standing));
}

void appendSeconds(RowBinary& rows, std::int64_t millisecondsOfMinute) {
    constexpr std::int64_t kSecond = 1000;
    rows.add(static_cast<std::uint8_t>(millisecondsOfMinute / kSecond));
    rows.add(static_cast<std::uint16_t>(millisecondsOfMinute % kSecond));
}

void appendDuration(RowBinary& rows, std::int64_t milliseconds) {
    const Divided minutes = divided(milliseconds, kMinute);
    rows.add(static_cast<std::uint32_t>(minutes.quotient));
    appendSeconds(rows, minutes.rest);
}

} // namespace

std::uint32_t monthOf(std::int64_t milliseconds) {
    constexpr unsigned kYear = 100;
    using std::chrono::floor;
    const std::chrono::sys_time<std::chrono::milliseconds> time{
        std::chrono::milliseconds(milliseconds)};
    const std::chrono::year_month_day date(floor<std::chrono::days>(time));
    return static_cast<unsigned>(static_cast<int>(date.year())) * kYear +
           static_cast<unsigned>(date.month());
}

/// As the view `measurement` makes it.
std::string decimalText(double number, std::size_t decimals) {
    const std::int64_t scale = kScales.at(std::min(decimals, kScales.size() - 1));
    const double scaled = std::round(std::abs(number) * static_cast<double>(scale));
    const auto digits = static_cast<std::int64_t>(std::min(scaled, kExact));
    std::string text = (number < 0 ? "-" : "") + std::to_string(digits / scale);
    if (decimals > 0) {
        text += "." + std::to_string(scale + digits % scale).substr(1);
    }
    return text;
}

DecimalText decimalTextOf(double number, std::string_view text) {
    const std::size_t start = text.starts_with('-') ? 1 : 0;
    const std::size_t end = std::min(text.find_first_not_of("0123456789.", start), text.size());
    const std::size_t point = text.substr(0, end).find('.');
    const std::size_t decimals = point == std::string_view::npos ? 0 : end - point - 1;
    if (decimals >= kScales.size()) {
        return {};
    }
    const double scaled = std::abs(number) * static_cast<double>(kScales.at(decimals));
    if (scaled != std::floor(scaled) || scaled > kExact ||
        decimalText(number, decimals) != text.substr(0, end)) {
        return {};
    }
    return {static_cast<std::int8_t>(decimals), text.substr(end)};
}

void appendInterval(RowBinary& rows, const IntervalBatch::Row& row, IntervalBatch& batch,
                    const LoadedRecording& recording) {
    constexpr unsigned kBits = 8;
    const RecordingMeasurements& measurements = batch.measurements();
    const IntervalBatch::Series& series = batch.series(row);
    const FieldInfo& field = measurements.fields()[series.field];
    rows.add(recording.device).add(recording.id).add(monthOf(recording.first)).add(field.name);
    rows.add(series.entry != kNoEntry ? std::string_view(measurements.entries().words(series.entry))
                                      : std::string_view());
    if (series.cell) {
        const FoundCell& cell = measurements.cells()[*series.cell];
        rows.add(nameOf(cell.system)).add(cell.identity);
    } else {
        rows.add("").add("");
    }
    const Divided time = divided(batch.first().count() + row.time, kMinute);
    const Divided minute = divided(time.quotient, kMinutesOfDay);
    rows.add(static_cast<std::int32_t>(minute.quotient));
    rows.add(static_cast<std::uint16_t>(minute.rest));
    appendSeconds(rows, time.rest);
    appendDuration(rows, row.hold);
    rows.add(static_cast<std::uint8_t>(row.part));
    appendDuration(rows, row.part == Interval::Part::First ? row.whole : 0);
    appendNumber(rows, row.value);
    appendText(rows, field, row.value);
    rows.add(field.unit);
    rows.add(static_cast<std::uint16_t>(row.packet >> 2 * kBits));
    rows.add(static_cast<std::uint8_t>(row.packet >> kBits));
    rows.add(static_cast<std::uint8_t>(row.packet));
    rows.add(recording.name).add(recording.technology).add(recording.decoder);
}

} // namespace pallax
