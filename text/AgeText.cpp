#include "text/AgeText.h"

#include "text/Format.h"

namespace pallax {

std::string ageText(std::chrono::nanoseconds age) {
    using namespace std::chrono;
    if (age < minutes(2)) {
        return formatText("%lld s", {round<seconds>(age).count()});
    }
    if (age < hours(2)) {
        return formatText("%lld min", {floor<minutes>(age).count()});
    }
    return age < days(2) ? formatText("%lld h", {floor<hours>(age).count()})
                         : formatText("%lld days", {floor<days>(age).count()});
}

} // namespace pallax
