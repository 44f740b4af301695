#include "ui/contents/Graph.h"

#include "text/Format.h"

#include <algorithm>

namespace pallax {

bool Graph::contains(const LeafName& leaf) const {
    return std::find(_leaves.begin(), _leaves.end(), leaf) != _leaves.end();
}

std::string Graph::toggle(const LeafName& leaf) {
    const auto found = std::find(_leaves.begin(), _leaves.end(), leaf);
    if (found != _leaves.end()) {
        _leaves.erase(found);
        return "No longer in the graph.";
    }
    if (_leaves.size() == kMost) {
        return formatText("The graph has %u values already: v takes one away.", {kMost});
    }
    _leaves.push_back(leaf);
    return formatText("In the graph (%u of %u): V opens it.", {_leaves.size(), kMost});
}

} // namespace pallax
