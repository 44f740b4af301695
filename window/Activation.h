#pragma once

#include "console/ExitStatus.h"

namespace pallax {

/// The argument with which the session's bus starts the program.
inline constexpr const char* kActivationArgument = "--gapplication-service";

/// The application as the session's bus starts it when there is no window: opens what is asked for,
/// each in a process of its own, until these have ended and nothing is asked for any more. What
/// cannot be opened is told in a dialog, because nobody sees standard error.
ExitStatus runActivated();

} // namespace pallax
