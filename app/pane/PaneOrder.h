#pragma once

#include "app/tree/PallaxModelNode.h"

#include <cstddef>
#include <vector>

namespace pallax {

/// How the rows of a pane are put in order.
struct PaneOrder {
    enum class By {
        Display, ///< as the display has them
        Name,    ///< by the bytes of the name
        Value,   ///< numbers by their size, then other texts by their bytes, then branches
    };

    By by = By::Display;
    /// The greatest first; texts still follow numbers, and branches both. Rows that are equal keep
    /// the display's order.
    bool isDescending = false;

    bool operator==(const PaneOrder&) const = default;
};

/// Puts rows, given as places among `children`, in that order; they are in the display's before.
void putInOrder(std::vector<std::size_t>& rows, const std::vector<NodeRef>& children,
                const PaneOrder& order);

} // namespace pallax
