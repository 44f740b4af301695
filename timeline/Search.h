#pragma once

#include "timeline/Timeline.h"

#include <cstdint>
#include <functional>
#include <optional>

namespace pallax {

/// Whether the current values after a packet are as they are looked for.
using ValueTest = std::function<bool(const CurrentValues& values, std::uint64_t packet)>;
/// Gets the share of the search that is done, from 0 to 1; false stops it.
using SearchProgress = std::function<bool(double share)>;

/// The first instant after `from` at which the test becomes true: it is not true after the packet
/// before. Nothing if there is none, or if it was stopped.
std::optional<std::uint64_t> nextInstant(Timeline& timeline, std::uint64_t from,
                                         const ValueTest& test,
                                         const SearchProgress& progress = {});
/// The last one before `from`. At the earliest instant nothing becomes true.
std::optional<std::uint64_t> previousInstant(Timeline& timeline, std::uint64_t from,
                                             const ValueTest& test,
                                             const SearchProgress& progress = {});

} // namespace pallax
