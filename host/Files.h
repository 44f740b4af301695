#pragma once

#include "platform/Bytes.h"

#include <optional>
#include <string>
#include <string_view>

namespace pallax {

/// The content of a file of at most `largest` bytes; nothing when it cannot be read whole.
std::optional<ByteBuffer> readFile(const std::string& path, std::size_t largest);

/// Writes straight to the path; false when that failed.
bool writeFile(const std::string& path, std::string_view content);

/// Replaces the file in one step: whoever reads it sees the old content or the new one, also
/// after a crash. False, with the old content in place, when that failed.
bool replaceFile(const std::string& path, std::string_view content);

} // namespace pallax
