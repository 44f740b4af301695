#pragma once

#include "plist/PropertyList.h"

#include <optional>
#include <string_view>

namespace pallax {

/// The frame error rate of the 1x traffic channel: an exponential average between 0 and 1, kept in
/// the state under "TrafficFER" during a call. All in single precision.

/// Its lookup name; it is shown in per cent.
inline constexpr std::string_view kTrafficFERName = "k1xTrafficFER";
inline constexpr NumberFormat kTrafficFERFormat{"%.02f%%"};
inline constexpr NumberFormat kOldTrafficFERFormat{"%.02f%% (old)", "%"};

/// The current rate; nothing before the call's first frame.
std::optional<float> trafficFER(const Dictionary& state);

/// Adds a frame with the weight 1/64, stores the new rate and returns it.
float addTrafficFrame(bool inError, Dictionary& state);

/// Removes the rate, so that the next call starts without one.
void endTrafficFER(Dictionary& state);

/// The display value of a rate.
PropertyList shownTrafficFER(float rate);
/// The same for a call that has ended.
PropertyList shownOldTrafficFER(float rate);

} // namespace pallax
