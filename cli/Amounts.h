#pragma once

#include "text/Result.h"
#include "text/SecondsText.h"

#include <cstdint>
#include <string>

/// How options write sizes and durations.
namespace pallax {

/// "4096", "64k", "100M", "2G": bytes, in powers of 1024. For anything else, and for 0, what is
/// wrong with it.
Result<std::uint64_t, std::string> parseSize(const std::string& text);

} // namespace pallax
