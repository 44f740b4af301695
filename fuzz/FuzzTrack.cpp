#include "report/Track.h"

#include <cstddef>
#include <cstdint>
#include <cstdlib>

using namespace pallax;

/// Any bytes as a GPX file: what is read out of it lies on the earth, in the order of its times.
extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    const auto track = parseTrack({data, size});
    if (!track) {
        return 0;
    }
    constexpr double kMostLatitude = 90;
    constexpr double kMostLongitude = 180;
    Time before = kEarliestTime;
    for (const TrackPoint& point : *track) {
        const bool isRight = point.time >= before && point.time <= kLatestTime &&
                             point.latitude >= -kMostLatitude && point.latitude <= kMostLatitude &&
                             point.longitude >= -kMostLongitude &&
                             point.longitude <= kMostLongitude;
        if (!isRight) {
            std::abort();
        }
        before = point.time;
    }
    return pageTrack(*track).empty() ? 1 : 0;
}
