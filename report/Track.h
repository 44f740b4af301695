#pragma once

#include "text/Bytes.h"
#include "text/Date.h"
#include "text/Result.h"

#include <cstddef>
#include <string>
#include <vector>

namespace pallax {

/// Where somebody was, and when.
struct TrackPoint {
    Time time;
    double latitude = 0; ///< degrees, north is positive
    double longitude = 0;
};
using Track = std::vector<TrackPoint>;

inline constexpr std::size_t kLargestTrack = std::size_t{1} << 26U;
/// Of more points, every n-th is kept.
inline constexpr std::size_t kMostTrackPoints = 20000;

/// The points of a GPX file that have a time, in its order. An error is the reason, without a full
/// stop.
Result<Track, std::string> parseTrack(Bytes content);

/// The page's element `track`: deflated JSON, [[seconds, latitude, longitude] …], by time.
std::string pageTrack(const Track& track);

} // namespace pallax
