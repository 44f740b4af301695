#pragma once

namespace pallax {

/// The exit statuses of `pallax`; scripts rely on the numbers.
enum ExitStatus : int {
    kExitSuccess = 0,
    kExitFailure = 1,
    kExitWrongUsage = 2,
    kExitCouldNotTell = 3, ///< of a command that answers yes (0) or no (1)
    kExitFatalRecord = 70, ///< a record has thrown
};

} // namespace pallax
