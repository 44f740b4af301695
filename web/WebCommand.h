#pragma once

#include "console/ExitStatus.h"

namespace pallax {

struct WebOptions;

/// `pallax web`: serves the live page until a signal. Prints its link, and reports on standard
/// error; OutputClosed, OutputFailure and TemplateFailure leave.
ExitStatus runWeb(const WebOptions& options);

} // namespace pallax
