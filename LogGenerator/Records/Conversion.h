#pragma once

#include "LogGenerator/Records/Formats.h"
#include "LogGenerator/Records/SampleValue.h"

#include <cstdint>
#include <optional>
#include <span>
#include <string_view>

namespace pallax {

/// How a raw number becomes a display value: a label, or a number with its format. Formats and
/// tables live as long as the program.
struct Conversion {
    /// For a number: raw × factor / divisor + offset, computed in double precision, truncated
    /// toward zero if the format is for integers. Null for a label.
    const NumberFormat* format = nullptr;
    double factor = 1.0;
    double divisor = 1.0; ///< for decimal fractions, which a factor cannot hold exactly
    double offset = 0.0;
    bool isScaled = false; ///< by any of the three: said once, for it is asked of each number

    /// labels[raw + shift]. If the shift is not 0, the index is cut to 8 bits, so that with a
    /// shift of 1 the byte 255 selects the first entry.
    std::span<const std::string_view> labels = {};
    std::uint8_t shift = 0;
    /// Shown for numbers outside the table, unless `beyondFormat` is set, which then formats the
    /// low 32 bits of the raw number.
    std::string_view beyond = {};
    const NumberFormat* beyondFormat = nullptr;

    /// The raw number that is shown as `exceptionalText`.
    std::optional<std::int64_t> exceptional = std::nullopt;
    std::string_view exceptionalText = {};

    static constexpr Conversion number(const NumberFormat& format = kDecimal, double factor = 1.0,
                                       double offset = 0.0) {
        Conversion result;
        result.format = &format;
        result.factor = factor;
        result.offset = offset;
        result.isScaled = factor != 1.0 || offset != 0.0;
        return result;
    }
    static Conversion number(const NumberFormat&& format, double = 1.0, double = 0.0) = delete;

    static constexpr Conversion label(std::span<const std::string_view> labels,
                                      std::string_view beyond = "Unknown", std::uint8_t shift = 0) {
        Conversion result;
        result.labels = labels;
        result.beyond = beyond;
        result.shift = shift;
        return result;
    }
    static constexpr Conversion label(std::span<const std::string_view> labels,
                                      const NumberFormat& beyond) {
        Conversion result;
        result.labels = labels;
        result.beyondFormat = &beyond;
        return result;
    }
    static Conversion label(std::span<const std::string_view> labels,
                            const NumberFormat&& beyond) = delete;

    /// Shows `clear` for 0, and `set` for every other raw number.
    static constexpr Conversion flag(std::string_view set, std::string_view clear) {
        Conversion result;
        result.beyond = set;
        result.exceptional = 0;
        result.exceptionalText = clear;
        return result;
    }

    /// This conversion with the divisor `by`.
    constexpr Conversion dividedBy(double by) const {
        Conversion result = *this;
        result.divisor = by;
        result.isScaled = result.isScaled || by != 1.0;
        return result;
    }

    /// This conversion, except that `raw` is shown as `text` ("Not Present").
    constexpr Conversion except(std::int64_t raw, std::string_view text) const {
        Conversion result = *this;
        result.exceptional = raw;
        result.exceptionalText = text;
        return result;
    }

    SampleValue valueOf(std::int64_t raw) const;
    /// What a raw number is multiplied by, for documents.
    constexpr double scale() const { return factor / divisor; }
};

inline SampleValue Conversion::valueOf(std::int64_t raw) const {
    if (exceptional && raw == *exceptional) {
        return SampleValue::label(exceptionalText);
    }
    if (format != nullptr) {
        if (!isScaled) {
            return DisplayNumber(raw, *format);
        }
        const double scaled = static_cast<double>(raw) * factor;
        return DisplayNumber((divisor == 1.0 ? scaled : scaled / divisor) + offset, *format);
    }
    const auto index = static_cast<std::uint64_t>(raw) + shift;
    const std::size_t entry = shift == 0 ? index : static_cast<std::uint8_t>(index);
    if (entry < labels.size()) {
        return SampleValue::label(labels[entry]);
    }
    if (beyondFormat != nullptr) {
        return DisplayNumber(std::int64_t{static_cast<std::int32_t>(raw)}, *beyondFormat);
    }
    return SampleValue::label(beyond);
}

} // namespace pallax
