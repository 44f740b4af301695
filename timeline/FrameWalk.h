#pragma once

#include "timeline/Instants.h"

#include <cstdint>
#include <optional>
#include <vector>

namespace pallax {

/// An instant's display, made again.
struct InstantFrame {
    FrameRef frame;
    FrameRef before; ///< of the latest tick before the instant; null if there is none
};

/// Makes the frames of instants that are often close to each other. Between two key frames of the
/// timeline, which may be thousands of packets apart, it keeps some more on the way to an instant,
/// so that a step back costs about as much as a step forward.
class FrameWalk {
public:
    /// The timeline must outlive the walk.
    explicit FrameWalk(Timeline& timeline) : _timeline(timeline) {}

    /// The display at an instant, between the earliest and the latest, with the ages at its time.
    /// Nothing before the first packet, and if the journal does not have the packet.
    std::optional<InstantFrame> at(std::uint64_t instant);

private:
    /// The state of decoding after a packet.
    struct Place {
        std::uint64_t packet;
        KeyFrame decoder;
    };
    static constexpr std::uint64_t kPlaces = 16;        ///< between two key frames, about
    static constexpr std::uint64_t kLeastDistance = 64; ///< packets between two of them

    std::unique_ptr<Replay> replayAt(std::uint64_t instant);

    Timeline& _timeline;
    std::uint64_t _from = 0;    ///< the packet of the key frame before the places
    std::vector<Place> _places; ///< by their packets
};

} // namespace pallax
