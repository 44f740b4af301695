#pragma once

#include "text/NumberFormat.h"

#include <cstdint>
#include <optional>
#include <span>
#include <string_view>

namespace pallax {

/// How a raw number is shown, told as data for whoever explains a field or shows it elsewhere. The
/// rules are those of `Conversion`.
struct ShownAs {
    /// Of a number: raw x factor + offset. Null for a label.
    const NumberFormat* format = nullptr;
    double factor = 1.0;
    double offset = 0.0;

    /// By raw + shift; with a shift other than 0 the index is cut to 8 bits.
    std::span<const std::string_view> labels;
    std::uint8_t shift = 0;
    /// Where there is no label: the raw number under `beyondFormat`, or `beyond` where that is
    /// null.
    std::string_view beyond;
    const NumberFormat* beyondFormat = nullptr;

    /// The one raw number that shows `exceptionalText` whatever the rest says.
    std::optional<std::int64_t> exceptional;
    std::string_view exceptionalText;
};

} // namespace pallax
