#pragma once

#include "app/tree/PallaxModelNode.h"
#include "text/Date.h"

#include <cstddef>
#include <optional>
#include <string>
#include <string_view>

namespace pallax {

/// A row of a pane: a leaf, with a value, or a branch, which opens a pane of its own.
struct PaneRow {
    std::string name;
    std::optional<std::string> text; ///< the value of a leaf
    /// The number that the text shows, in `unit`; a whole one beyond 2^53 is rounded. Nothing where
    /// the value is a text of its own.
    std::optional<double> number;
    std::string_view unit;               ///< "dBm"; empty for none. Lives as long as the program
    std::optional<std::size_t> elements; ///< of a branch that is a list: how many
    bool isBranch = false;
    /// A leaf whose value is another than in the data that the pane showed before.
    bool hasChanged = false;
    /// The time of the data that brought a leaf's present value; the value's age counts from here.
    /// Nothing where the pane does not know it: the value was in the pane's first data, the data
    /// had no time, or the row was not asked for every time that new data had come.
    std::optional<Time> changedAt;
    /// As PallaxModelNode::readAt.
    std::optional<Time> readAt;
};

/// The value of a leaf as text; nothing for a branch.
std::optional<std::string> textOf(const PallaxModelNode& node);

/// The number that a leaf's text shows; nothing for a branch, and where it shows none.
std::optional<double> numberOf(const PallaxModelNode& node);

/// How many elements a branch has that is a list. It counts as one when its children are named "0",
/// "1", ... in order, at least one: the tree names the elements of an array so, and keeps no other
/// trace of it.
std::optional<std::size_t> elementsOf(const PallaxModelNode& node);

} // namespace pallax
