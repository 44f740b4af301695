#pragma once

#include "LogGenerator/KeyFrame.h"
#include "monitor/TickGrid.h"
#include "timeline/CurrentValues.h"

#include <array>
#include <cstddef>
#include <cstdint>
#include <memory>
#include <vector>

namespace pallax {

/// A display tick that has new data.
struct ShownTick {
    TickGrid::Tick tick{0, {}};
    std::uint64_t packet = 0; ///< the last packet before it
};

/// The state of decoding after a packet.
struct TimelineKeyFrame {
    std::uint64_t packet = 0; ///< 0: before the first packet
    KeyFrame decoder;
    CurrentValues values;
    TickGrid grid;
    std::vector<ShownTick> ticks; ///< the latest two
    Time latest{};                ///< the latest stamp of its stretch of time

    std::size_t bytes() const;
};

/// The key frames of a recording, at distances that grow with it.
class KeyFrames {
public:
    struct Limits {
        std::uint64_t distance = 8192;                           ///< packets, at first
        std::uint64_t distanceInBytes = std::uint64_t{1} << 19U; ///< of packets, at first
        std::size_t bytes = std::size_t{24} << 20U;              ///< of all key frames
        std::size_t count = 512;
    };

    explicit KeyFrames(const Limits& limits) : _limits(limits) {}

    /// Whether a key frame should be added after so many packets and bytes since the latest.
    bool isDue(std::uint64_t packets, std::uint64_t bytes) const {
        return packets >= _limits.distance || bytes >= _limits.distanceInBytes;
    }
    void add(TimelineKeyFrame keyFrame);
    /// Removes those from which decoding cannot go on without the packets before `packet`.
    void dropBefore(std::uint64_t packet);

    /// The latest key frame that contains no packet after `packet`, or null.
    const TimelineKeyFrame* atOrBefore(std::uint64_t packet) const;
    /// The earliest key frame after that of `packet`, or null.
    const TimelineKeyFrame* after(std::uint64_t packet) const;
    const std::vector<TimelineKeyFrame>& all() const { return _all; }

private:
    void thin();

    Limits _limits;
    std::vector<TimelineKeyFrame> _all;
    std::vector<std::size_t> _sizes;
    std::size_t _bytes = 0;
};

} // namespace pallax
