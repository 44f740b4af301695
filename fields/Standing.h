#pragma once

#include "fields/FieldRegistry.h"

#include <cstdint>
#include <optional>
#include <string_view>

namespace pallax {

/// Whether what is shown for a field is a value of it.
enum class Standing {
    Value,
    /// The record says that there is none, with a number of its own ("Not Present") or with a state
    /// in which the field means nothing ("N/A").
    NotApplicable,
    /// The number is outside the field's range, or none of those that have a label.
    OutOfRange,
};

/// `text` is what is shown, `number` its number (NaN: none), `raw` the number in the record.
Standing standingOf(const FieldInfo& field, std::string_view text, double number,
                    std::optional<std::int64_t> raw);

/// "not applicable"; empty for a value.
std::string_view nameOf(Standing standing);

} // namespace pallax
