#pragma once

#include "host/Recording.h"
#include "text/TimeText.h"

namespace pallax {

/// Reads the recording to its end: from its first stamp to its latest, and its stretches. Nothing
/// without packets.
std::optional<TimeSpan> spanOf(Recording& recording);

} // namespace pallax
