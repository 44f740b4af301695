#include "fields/Standing.h"

#include <algorithm>
#include <cmath>

namespace pallax {

namespace {

bool isBeyond(const Conversion& conversion, std::string_view text) {
    const auto& labels = conversion.labels;
    return !labels.empty() && text == conversion.beyond &&
           std::find(labels.begin(), labels.end(), text) == labels.end();
}

Standing standingOfLabel(const Conversion& conversion, std::string_view text, std::int64_t raw) {
    const SampleValue value = conversion.valueOf(raw);
    if (value.number() != nullptr || value.words() != text) {
        return Standing::Value; // another row has read it
    }
    if (conversion.format != nullptr) { // the one number that is shown as a text
        return Standing::NotApplicable;
    }
    return isBeyond(conversion, text) ? Standing::OutOfRange : Standing::Value;
}

} // namespace

Standing standingOf(const FieldInfo& field, std::string_view text, double number,
                    std::optional<std::int64_t> raw) {
    if (std::isfinite(number)) {
        const bool isInside =
            number >= field.least.value_or(number) && number <= field.most.value_or(number);
        return isInside ? Standing::Value : Standing::OutOfRange;
    }
    const auto& otherwise = field.otherwise;
    if (!raw) {
        const bool isOtherwise =
            std::find(otherwise.begin(), otherwise.end(), text) != otherwise.end();
        return isOtherwise ? Standing::NotApplicable : Standing::Value;
    }
    for (const Conversion& conversion : field.labelled) {
        const Standing standing = standingOfLabel(conversion, text, *raw);
        if (standing != Standing::Value) {
            return standing;
        }
    }
    return Standing::Value;
}

std::string_view nameOf(Standing standing) {
    switch (standing) {
    case Standing::NotApplicable:
        return "not applicable";
    case Standing::OutOfRange:
        return "out of range";
    default:
        return "";
    }
}

} // namespace pallax
