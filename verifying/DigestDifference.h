#pragma once

#include "verifying/RecordingDigest.h"

#include <string>
#include <vector>

namespace pallax {

/// What differs between a recording as it was and as it is, a sentence for each: the number of
/// packets, the blocks that have changed, and the fields that decode otherwise with the minutes in
/// which they do. Fields of a recording that has itself changed are not compared. Empty: nothing.
std::vector<std::string> differences(const RecordingDigest& before, const RecordingDigest& after);

} // namespace pallax
