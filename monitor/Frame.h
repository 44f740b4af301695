#pragma once

#include "app/tree/PallaxModelNode.h"
#include "text/Date.h"

#include <chrono>
#include <cstdint>
#include <memory>
#include <memory_resource>
#include <optional>
#include <string>
#include <string_view>
#include <unordered_map>
#include <vector>

namespace pallax {

class SectionAges;

/// An immutable picture of the display at one tick: the tree, the changes since the previous frame,
/// and the age of each value.
///
/// A frame owns its texts and numbers and shares nothing with the live display, so any thread may
/// keep it and read it without a lock while the next packets change the display.
class Frame {
public:
    struct Picture {
        NodeRef root; ///< null if nothing is shown
        /// The paths of the root's tree; null if nothing is shown.
        std::shared_ptr<const PathDictionary> paths;
        Time time; ///< by the display's clock
    };

    struct Stamp {
        /// The time of the first frame that shows this value. For a branch: the last change of a
        /// node below it.
        Time since;
        /// When the value was last read, changed or not; nothing if unknown. For a branch without
        /// a time of its own: the latest time below it.
        std::optional<Time> read;
        /// Whether the node is new or differs from the previous frame. False in the first frame.
        bool isChanged = false;
    };

    /// The frame after `before`, which is null for the first frame. `ages` may be null and is used
    /// only during this call.
    Frame(Picture picture, const Frame* before, const SectionAges* ages);
    Frame(const Frame&) = delete;
    Frame& operator=(const Frame&) = delete;

    /// Counts from 1.
    std::uint64_t number() const { return _number; }
    Time time() const { return _picture.time; }
    const NodeRef& root() const { return _picture.root; }
    /// The node at `path` ("/", "/Serving Cell"), or null.
    NodeRef nodeAtPath(std::string_view path) const;

    /// The stamp of a node of this frame. Throws std::out_of_range for other nodes.
    const Stamp& stamp(const PallaxModelNode& node) const { return _stamps.at(&node); }
    /// How long ago a node of this frame was last read or, if that is unknown, changed.
    std::chrono::nanoseconds age(const PallaxModelNode& node) const;

    /// The paths of the leaves that have changed, in display order.
    const std::vector<std::string>& changed() const { return _changed; }
    /// The paths of the nodes that the previous frame has and this one does not, without those
    /// below them.
    const std::vector<std::string>& gone() const { return _gone; }

private:
    class Comparison;

    Picture _picture;
    std::uint64_t _number;
    std::pmr::monotonic_buffer_resource _storage; // of the stamps, one for each node
    std::pmr::unordered_map<const PallaxModelNode*, Stamp> _stamps{&_storage};
    std::vector<std::string> _changed;
    std::vector<std::string> _gone;
};

using FrameRef = std::shared_ptr<const Frame>;

/// Gets the frames, on the main queue.
class FrameObserver {
public:
    virtual ~FrameObserver() = default;
    virtual void frameMade(const FrameRef& frame) = 0;
};

} // namespace pallax
