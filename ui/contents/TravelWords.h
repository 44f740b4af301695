#pragma once

#include "travel/Travel.h"

#include <string>

namespace pallax {

inline constexpr const char* kNothingMarked = "Mark an instant first, with the key m.";

/// Marks the shown instant. Returns a sentence about it.
std::string markShown(Travel& travel);
/// A sentence about the speed, which has just been changed.
std::string speedWords(const Travel& travel);

} // namespace pallax
