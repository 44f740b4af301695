#pragma once

#include "text/Bytes.h"
#include "text/Result.h"

#include <optional>
#include <string>
#include <string_view>

namespace pallax {

/// Why a file could not be read.
struct ReadFailure {
    bool isMissing = false; ///< the file does not exist (other failures: it is inaccessible)
    std::string reason;     ///< "it is a folder", without a full stop
};

/// The content of a regular file of at most `largest` bytes. Refuses anything else, such as a named
/// pipe, without waiting for it.
Result<ByteBuffer, ReadFailure> readRegularFile(const std::string& path, std::size_t largest);
/// The same without a reason.
std::optional<ByteBuffer> readFile(const std::string& path, std::size_t largest);

/// Writes directly to the path, creating a file that only its user may read; false on failure.
/// Replaces an existing file; refuses a symbolic link, a file with several names, a pipe or a
/// device. Removes a file that cannot be written completely.
bool writePrivateFile(const std::string& path, std::string_view content);

enum class FileMode {
    Private, ///< only its user may read it
    Usual    ///< as a program creates files: that of the file before or, if it is new, by the umask
};

/// Replaces the file atomically: readers see the old content or the new one, even after a crash.
/// False, with the old content in place, on failure.
bool replaceFile(const std::string& path, std::string_view content,
                 FileMode mode = FileMode::Private);

} // namespace pallax
