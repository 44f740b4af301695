#pragma once

#include "plist/PropertyList.h"

#include <optional>
#include <string_view>

namespace pallax {

/// The frame error rate of the 1x traffic channel, an exponential average between 0 and 1 that
/// lives in the state under "TrafficFER" for as long as a call. Single precision throughout.

/// The lookup name under which it is shown, and how: in per cent.
inline constexpr std::string_view kTrafficFERName = "k1xTrafficFER";
inline constexpr NumberFormat kTrafficFERFormat{"%.02f%%"};
inline constexpr NumberFormat kOldTrafficFERFormat{"%.02f%% (old)", "%"};

/// The rate so far; nothing when no call has reported a frame yet.
std::optional<float> trafficFER(const Dictionary& state);

/// Adds a frame with the weight 1/64 and gives the new rate, which is kept.
float addTrafficFrame(bool inError, Dictionary& state);

/// Forgets the rate, so that the next call starts anew.
void endTrafficFER(Dictionary& state);

/// A rate as shown.
PropertyList shownTrafficFER(float rate);
/// The same, of a call that is over.
PropertyList shownOldTrafficFER(float rate);

} // namespace pallax
