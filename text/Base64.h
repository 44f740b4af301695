#pragma once

#include "text/Bytes.h"

#include <optional>
#include <string>
#include <string_view>

namespace pallax {

/// Base64 in one line, padded.
std::string base64Text(Bytes bytes);

/// Decodes a base64 text, which may contain white space anywhere. Nothing for invalid texts: other
/// characters, missing or misplaced padding, extra bits.
std::optional<ByteBuffer> parseBase64(std::string_view text);

} // namespace pallax
