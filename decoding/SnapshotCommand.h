#pragma once

#include "console/ExitStatus.h"

#include <string>

namespace pallax {

/// `pallax snapshot`: a part of a saved snapshot, to a file.
struct SnapshotOptions {
    std::string file;
    std::string output = "-"; ///< "-" is standard output
    bool dlf = false;         ///< the DLF log, the only part so far
};

/// Reports on standard error; OutputClosed and OutputFailure leave.
ExitStatus runSnapshot(const SnapshotOptions& options);

} // namespace pallax
