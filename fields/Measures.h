#pragma once

#include "knowledge/Quality.h"

#include <optional>
#include <span>
#include <string_view>

namespace pallax {

/// A field whose values a quality profile can judge.
struct MeasuredField {
    std::string_view name; ///< as in the registry
    Measure measure;
};

std::span<const MeasuredField> measuredFields();

/// What the field measures, in the unit of its measure; nothing for a field that a profile cannot
/// judge, such as a level without a known unit.
std::optional<Measure> measureOf(std::string_view field);

/// The grade of a field's value; nothing if the profile does not judge the field.
std::optional<Grade> qualityOf(const QualityProfile& profile, std::string_view field, double value);

} // namespace pallax
