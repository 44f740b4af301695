#pragma once

#include "console/ExitStatus.h"

namespace pallax {

struct RecordOptions;

/// `pallax record`, wired to this machine. It reports on standard error; OutputClosed and
/// OutputFailure leave.
ExitStatus runRecord(const RecordOptions& options);

} // namespace pallax
