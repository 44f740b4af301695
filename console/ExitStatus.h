#pragma once

namespace pallax {

/// What `pallax` ends with; scripts rely on the numbers.
enum ExitStatus : int {
    kExitSuccess = 0,
    kExitFailure = 1,
    kExitWrongUsage = 2,
    kExitFatalRecord = 70, ///< a record's parser has thrown
};

} // namespace pallax
