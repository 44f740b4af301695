#pragma once

#include "text/Bytes.h"
#include "text/Result.h"

#include <optional>
#include <string>
#include <string_view>

namespace pallax {

/// Why a file could not be read.
struct ReadFailure {
    bool isMissing = false; ///< there is no such file, rather than one that cannot be looked at
    std::string reason;     ///< "it is a folder", without a full stop
};

/// The content of a regular file of at most `largest` bytes. Anything else, such as a named pipe,
/// is refused without waiting for it.
Result<ByteBuffer, ReadFailure> readRegularFile(const std::string& path, std::size_t largest);
/// The same where nobody asks why.
std::optional<ByteBuffer> readFile(const std::string& path, std::size_t largest);

/// Writes straight to the path, a file that only its user may read; false when that failed. What
/// stands there is replaced if it is a file; a symbolic link, a file of several names, a pipe or a
/// device is refused. A file that cannot be written whole is removed.
bool writePrivateFile(const std::string& path, std::string_view content);

/// Replaces the file in one step: whoever reads it sees the old content or the new one, also
/// after a crash. False, with the old content in place, when that failed.
bool replaceFile(const std::string& path, std::string_view content);

} // namespace pallax
