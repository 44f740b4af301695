#pragma once

#include "console/ExitStatus.h"

namespace pallax {

struct DecodeOptions;

/// `pallax decode`, wired to this machine. It reports on standard error; OutputClosed,
/// OutputFailure and FatalRecord leave.
ExitStatus runDecode(const DecodeOptions& options);

} // namespace pallax
