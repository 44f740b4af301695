#pragma once

#include "tests/doubles/WholeGsm.h"
#include "tests/doubles/WholeLte.h"
#include "tests/doubles/WholeUtran.h"

#include <string_view>

namespace pallax::doubles {

/// The technology of that name on the command line; an empty one for technologies without records.
inline const WholeTechnology& wholeTechnology(std::string_view commandName) {
    static const WholeTechnology kNone;
    return commandName == "gsm"     ? kWholeGsm
           : commandName == "lte"   ? kWholeLte
           : commandName == "utran" ? kWholeUtran
                                    : kNone;
}

} // namespace pallax::doubles
