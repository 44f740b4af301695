#pragma once

#include "app/tree/PallaxModelNode.h"

#include <cstddef>
#include <vector>

namespace pallax {

/// How the rows of a pane are sorted.
struct PaneOrder {
    enum class By {
        Display, ///< in the display's order
        Name,    ///< by the bytes of the name
        Value,   ///< numbers, then other texts by their bytes, then branches
    };

    By by = By::Display;
    /// Greatest first, but numbers still come before texts and texts before branches. Equal rows
    /// keep the display's order.
    bool isDescending = false;

    bool operator==(const PaneOrder&) const = default;
};

/// Sorts rows, which are indices into `children` in the display's order.
void putInOrder(std::vector<std::size_t>& rows, const std::vector<NodeRef>& children,
                const PaneOrder& order);

} // namespace pallax
