#pragma once

#include "text/Bytes.h"

#include <optional>
#include <string>
#include <string_view>

namespace pallax {

/// Base64 in one line, padded.
std::string base64Text(Bytes bytes);

/// The bytes behind a base64 text, in which white space may stand anywhere. Nothing when the
/// text is anything else: other characters, padding missing or inside, bits left over.
std::optional<ByteBuffer> parseBase64(std::string_view text);

} // namespace pallax
