#pragma once

#include "cli/ExitStatus.h"
#include "cli/Options.h"

/// What the parsed command line runs: the parts of the system, wired to this machine. Each
/// reports on standard error; OutputClosed, OutputFailure and FatalRecord leave.
namespace pallax {

ExitStatus runDecode(const DecodeOptions& options);
ExitStatus runBrowse(const BrowseOptions& options);
ExitStatus runRecord(const RecordOptions& options);
ExitStatus runSimulate(const SimulateOptions& options);

} // namespace pallax
