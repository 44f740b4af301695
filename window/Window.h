#pragma once

#include "console/ExitStatus.h"

namespace pallax {

struct BrowseOptions;

/// The viewer in a window, until the user closes it. It reports on standard error. If a record ends
/// it, a page says so, and FatalRecord leaves when the window is closed, already reported.
ExitStatus runWindow(const BrowseOptions& options);

} // namespace pallax
