#pragma once

#include "timeline/LeafField.h"

#include <cstddef>
#include <string>
#include <vector>

namespace pallax {

/// The values whose curves the graph page shows.
class Graph {
public:
    static constexpr std::size_t kMost = 6;

    /// Adds a value or, if it is there, takes it away. Returns a sentence about it.
    std::string toggle(const LeafName& leaf);
    bool contains(const LeafName& leaf) const;
    const std::vector<LeafName>& leaves() const { return _leaves; }

private:
    std::vector<LeafName> _leaves;
};

} // namespace pallax
