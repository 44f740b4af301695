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

/// An immutable picture of the display at one tick: the tree, what has changed in it since the
/// frame before, and the age of each value.
///
/// A frame holds texts and numbers of its own and nothing of the live display, so that any thread
/// may keep it and read it, without a lock, while the next packets change the display.
class Frame {
public:
    struct Picture {
        NodeRef root; ///< null where nothing is shown
        /// Of the root's tree; null where nothing is shown.
        std::shared_ptr<const PathDictionary> paths;
        Time time; ///< of the display's clock
    };

    struct Stamp {
        /// When the first frame was made that shows this value; of a branch, when anything below it
        /// last changed. No later than the first frame of all.
        Time since;
        /// When it was last read, changed or not; of a branch without an answer of its own the
        /// latest below it. Nothing where that is not known.
        std::optional<Time> read;
        /// Whether it is new, or another than in the frame before. False in the first frame.
        bool isChanged = false;
    };

    /// The frame that follows `before`, which is null for the first one. `ages`, which may be null,
    /// are asked now and never again.
    Frame(Picture picture, const Frame* before, const SectionAges* ages);
    Frame(const Frame&) = delete;
    Frame& operator=(const Frame&) = delete;

    /// From 1.
    std::uint64_t number() const { return _number; }
    Time time() const { return _picture.time; }
    const NodeRef& root() const { return _picture.root; }
    /// The node that stands at `path` ("/", "/Serving Cell"), or null.
    NodeRef nodeAtPath(std::string_view path) const;

    /// Of a node of this frame; throws std::out_of_range for any other.
    const Stamp& stamp(const PallaxModelNode& node) const { return _stamps.at(&node); }
    /// How long ago a node of this frame was last read or, where that is not known, changed.
    std::chrono::nanoseconds age(const PallaxModelNode& node) const;

    /// The paths of the leaves that have changed, in display order.
    const std::vector<std::string>& changed() const { return _changed; }
    /// The paths of the nodes of the frame before that stand here no longer, without those below
    /// them.
    const std::vector<std::string>& gone() const { return _gone; }

private:
    class Comparison;

    Picture _picture;
    std::uint64_t _number;
    std::pmr::monotonic_buffer_resource _storage; // of the stamps, which are as many as the nodes
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
