#pragma once

#include "app/tree/PallaxModelNode.h"
#include "text/Date.h"

#include <cstddef>
#include <optional>
#include <string_view>
#include <unordered_map>

namespace pallax {

/// Which leaves of a pane have changed, and when. Nothing is compared but the leaves asked about.
class PaneChanges {
public:
    struct Change {
        bool hasChanged = false;
        std::optional<Time> at; ///< as PaneRow::changedAt
    };

    /// The pane shows other data than `before` from now on. `time` is that of the new data.
    void replaced(NodeRef before, std::optional<Time> time);

    /// Of a leaf that stands in that row now. It has changed when the data before had another value
    /// under its name, or none; as long as there were no data before, nothing has.
    Change changeOf(const PallaxModelNode& leaf, std::size_t row) const;

private:
    using Times = std::unordered_map<const PallaxModelNode*, Time>;

    /// The child of that name in the data before: looked for in the same row, then by name.
    const PallaxModelNode* namedBefore(std::string_view name, std::size_t row) const;

    NodeRef _before;
    std::optional<Time> _time; ///< of the data now
    /// The children before, made when a row has moved; of two with one name the later, as a path
    /// has it. The names belong to the nodes.
    mutable std::unordered_map<std::string_view, const PallaxModelNode*> _namesBefore;
    mutable Times _changed; ///< when the leaves asked about changed, of the data now
    Times _changedBefore;   ///< and of the data before
};

} // namespace pallax
