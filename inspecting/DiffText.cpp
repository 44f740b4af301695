#include "inspecting/DiffText.h"

#include "decoding/DisplayJson.h"

#include <cmath>

namespace pallax {

namespace {

PropertyList numberOrNull(double number) {
    return std::isfinite(number) ? PropertyList::real(number) : PropertyList();
}

PropertyList textOrNone(const FieldValue& value) {
    return value.isEmpty() ? PropertyList() : PropertyList(value.text());
}

} // namespace

void appendDifferencesJson(std::string& out, const std::vector<Difference>& differences) {
    const char* kinds[] = {"changed", "gone", "new"};
    for (const Difference& difference : differences) {
        appendJson(out,
                   Dictionary{
                       {"field", difference.field->name},
                       {"entry",
                        difference.entry.empty() ? PropertyList() : PropertyList(difference.entry)},
                       {"change", kinds[static_cast<std::size_t>(difference.kind)]},
                       {"before", textOrNone(difference.before)},
                       {"after", textOrNone(difference.after)},
                       {"before_number", numberOrNull(difference.before.number)},
                       {"after_number", numberOrNull(difference.after.number)},
                       {"difference",
                        numberOrNull(difference.amount ? difference.amount->number : std::nan(""))},
                       {"unit",
                        difference.amount ? PropertyList(difference.amount->unit) : PropertyList()},
                   });
        out += '\n';
    }
}

} // namespace pallax
