#pragma once

#include "LogGenerator/Records/Formats.h"
#include "LogGenerator/Records/LogRecord.h"
#include "LogGenerator/Records/ShownAs.h"
#include "plist/PropertyList.h"

#include <cstdint>
#include <span>
#include <string_view>

namespace pallax {

/// How a raw number becomes a display value: a label, or a number with its format.
class Conversion {
public:
    /// raw × factor + offset under `format`; the result is cut toward zero where the format is an
    /// integer's. Computed in double precision.
    static constexpr Conversion number(const NumberFormat& format = kDecimal, double factor = 1.0,
                                       double offset = 0.0) {
        Conversion result;
        result._format = &format;
        result._factor = factor;
        result._offset = offset;
        return result;
    }
    static Conversion number(const NumberFormat&& format, double = 1.0, double = 0.0) = delete;

    /// labels[raw + shift], or `beyond` where the table has no such entry; with a shift other than
    /// 0 the index is cut to 8 bits, so that the byte 255 finds the first entry at a shift of 1.
    /// The table must live as long as the program.
    static constexpr Conversion label(std::span<const std::string_view> labels,
                                      std::string_view beyond = "Unknown", std::uint8_t shift = 0) {
        Conversion result;
        result._labels = labels;
        result._beyond = beyond;
        result._shift = shift;
        return result;
    }

    /// `set` for every raw value but 0, which shows `clear`.
    static constexpr Conversion flag(std::string_view set, std::string_view clear) {
        Conversion result;
        result._beyond = set;
        result._exceptional = 0;
        result._exceptionalText = clear;
        return result;
    }

    /// This conversion for every raw value but `exceptional`, which shows `text` ("Not Present").
    constexpr Conversion except(std::int64_t exceptional, std::string_view text) const {
        Conversion result = *this;
        result._exceptional = exceptional;
        result._exceptionalText = text;
        return result;
    }

    PropertyList valueOf(std::int64_t raw) const;
    /// The same in place of what `value` was before.
    void showIn(PropertyList& value, std::int64_t raw) const;

    /// The conversion as data.
    ShownAs shownAs() const;

private:
    static constexpr std::int64_t kNone = INT64_MIN;

    const NumberFormat* _format = nullptr; ///< null: a label
    double _factor = 1.0;
    double _offset = 0.0;
    std::span<const std::string_view> _labels;
    std::string_view _beyond;
    std::uint8_t _shift = 0;
    std::int64_t _exceptional = kNone;
    std::string_view _exceptionalText;
};

/// One display key of a record: where its number stands and how it is shown.
struct Field {
    std::string_view key;
    Position position;
    Conversion conversion;
};

/// Sets the key of every field, in order, from `record`.
void showFields(Dictionary& target, std::span<const Field> fields, const LogRecord& record);

/// A dictionary of the fields: one entry of a list.
Dictionary entryOf(std::span<const Field> fields, const LogRecord& record);

/// The same in place of what `entry` held before, mostly values under the same keys.
void fillEntry(Dictionary& entry, std::span<const Field> fields, const LogRecord& record);

} // namespace pallax
