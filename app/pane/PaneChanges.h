#pragma once

#include "app/tree/PallaxModelNode.h"
#include "text/Date.h"

#include <cstddef>
#include <optional>
#include <string>
#include <string_view>
#include <unordered_map>
#include <vector>

namespace pallax {

/// Tells which leaves of a pane have changed, and when. Compares only the requested leaves.
class PaneChanges {
public:
    struct Change {
        bool hasChanged = false;
        std::optional<Time> at; ///< as PaneRow::changedAt
    };

    /// Notes that the pane's data `before` was replaced. `time` is the time of the new data.
    void replaced(NodeRef before, std::optional<Time> time);

    /// The change of a leaf that is now in that row. It has changed if the previous data had
    /// another value of that name, or none. Nothing has changed while there is no previous data.
    Change changeOf(const PallaxModelNode& leaf, std::size_t row) const;

    /// The names of the previous children that `now` has no longer; none of a list's elements.
    std::vector<std::string> gone(const PallaxModelNode& now) const;

private:
    using Times = std::unordered_map<const PallaxModelNode*, Time>;

    /// The child of that name in the previous data, searched in the same row, then by name.
    const PallaxModelNode* namedBefore(std::string_view name, std::size_t row) const;

    NodeRef _before;
    std::optional<Time> _time; ///< of the current data
    /// The previous children, filled when a row has moved. Of two with the same name it has the
    /// later, as PathDictionary does. The nodes own the names.
    mutable std::unordered_map<std::string_view, const PallaxModelNode*> _namesBefore;
    mutable Times _changed; ///< when the requested leaves changed, for the current data
    Times _changedBefore;   ///< the same for the previous data
};

} // namespace pallax
