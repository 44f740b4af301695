#pragma once

#include "tests/ui/pages/SampleDisplay.h"

#include <string>

namespace pallax::terminal {

/// What is known at the end of a sample ("lte-drive"), or `later` than that.
inline Overview overviewOf(const std::string& sample, std::chrono::seconds later = {}) {
    const SampleDisplay shown(sample);
    return shown.watch.overview(shown.end + later, NetworkNames(),
                                *builtInProfile(kDefaultProfile));
}

} // namespace pallax::terminal
