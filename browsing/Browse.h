#pragma once

#include "console/ExitStatus.h"

namespace pallax {

struct BrowseOptions;

/// The viewer, wired to this machine. It reports on standard error; OutputClosed, OutputFailure
/// and FatalRecord leave.
ExitStatus runBrowse(const BrowseOptions& options);

} // namespace pallax
