#pragma once

#include "app/tree/PallaxModelNode.h"
#include "text/Date.h"

#include <chrono>
#include <cstddef>
#include <optional>
#include <string>
#include <string_view>

namespace pallax {

/// A row of a pane: a leaf, with a value, or a branch, which opens a pane of its own.
struct PaneRow {
    std::string name;
    std::optional<std::string> text; ///< the value of a leaf
    /// The number that the text shows, in `unit`; integers beyond 2^53 are rounded. Nothing if the
    /// value is not a number.
    std::optional<double> number;
    std::string_view unit;               ///< "dBm", or empty. Lives as long as the program
    std::optional<std::size_t> elements; ///< as `elementsOf`
    bool isBranch = false;
    /// Whether a leaf's value differs from the pane's previous data.
    bool hasChanged = false;
    /// The time of the data in which a leaf got its current value. Nothing if the pane does not
    /// know it: the value was in the pane's first data, the data had no time, or the row was not
    /// requested after each change of the data.
    std::optional<Time> changedAt;
    /// As PallaxModelNode::readAt.
    std::optional<Time> readAt;
    /// How long ago the row was read, if that is longer than usual.
    std::optional<std::chrono::nanoseconds> overdue;
};

/// The value of a leaf as text; nothing for a branch.
std::optional<std::string> textOf(const PallaxModelNode& node);

/// The number that a leaf's text shows; nothing for a branch or any other text.
std::optional<double> numberOf(const PallaxModelNode& node);

/// The number of elements if the branch is a list. A branch counts as a list when it has children,
/// named "0", "1", ... in order: the tree gives these names to the elements of an array, and does
/// not mark arrays in another way.
std::optional<std::size_t> elementsOf(const PallaxModelNode& node);

} // namespace pallax
