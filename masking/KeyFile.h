#pragma once

#include "host/HostError.h"
#include "text/Bytes.h"
#include "text/Result.h"

#include <string>

namespace pallax {

/// The key of pseudonyms: the content of a file that only its user may read, at least 16 bytes.
Result<ByteBuffer, HostError> readKeyFile(const std::string& path);

/// A key that is forgotten at the end of the program.
Result<ByteBuffer, HostError> randomKey();

} // namespace pallax
