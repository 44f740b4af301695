#pragma once

#include "app/tree/PallaxModelNode.h"

#include <initializer_list>
#include <memory>
#include <string>
#include <utility>
#include <vector>

namespace pallax::doubles {

inline NodeRef leafNode(std::string name, PropertyList value) {
    return std::make_shared<PallaxModelLeafNode>(std::move(name), std::move(value));
}
inline NodeRef treeNode(std::string name, std::vector<NodeRef> children) {
    return std::make_shared<PallaxModelTreeNode>(std::move(name), std::move(children));
}

/// A section of leaves with these names and the value "-".
inline NodeRef sectionOf(std::initializer_list<const char*> names) {
    std::vector<NodeRef> leaves;
    for (const char* name : names) {
        leaves.push_back(leafNode(name, "-"));
    }
    return treeNode("Section", std::move(leaves));
}

inline DisplayNumber dbm(std::int64_t power) {
    static constexpr NumberFormat kDbm{"%d dBm"};
    return {power, kDbm};
}

} // namespace pallax::doubles
