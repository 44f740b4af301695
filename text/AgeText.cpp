#include "text/AgeText.h"

#include "text/Format.h"

namespace pallax {

std::string ageText(std::chrono::nanoseconds age) {
    using namespace std::chrono;
    const auto rounded = round<seconds>(age);
    if (rounded < minutes(2)) {
        return formatText("%lld s", {rounded.count()});
    }
    if (rounded < hours(2)) {
        return formatText("%lld min", {floor<minutes>(rounded).count()});
    }
    return rounded < days(2) ? formatText("%lld h", {floor<hours>(rounded).count()})
                             : formatText("%lld days", {floor<days>(rounded).count()});
}

} // namespace pallax
