#pragma once

#include "platform/PropertyList.h"

#include <memory>
#include <string>
#include <string_view>
#include <unordered_map>
#include <vector>

namespace pallax {

class PallaxModelNode;
using NodeRef = std::shared_ptr<const PallaxModelNode>;

/// Path ("/Serving Cell/ARFCN") to node.
using PathDictionary = std::unordered_map<std::string, NodeRef>;

/// A named node of the display tree; created once, never changed. Whether it is a branch is told
/// by `childNodes` being non-null, never by its class.
class PallaxModelNode {
public:
    explicit PallaxModelNode(std::string name) : _name(std::move(name)) {}
    virtual ~PallaxModelNode() = default;
    PallaxModelNode(const PallaxModelNode&) = delete;
    PallaxModelNode& operator=(const PallaxModelNode&) = delete;

    const std::string& displayName() const { return _name; }
    /// The children in display order; null for a leaf. Valid as long as the node.
    virtual const std::vector<NodeRef>* childNodes() const { return nullptr; }
    /// The value of a leaf: a string or display number (which knows its number and unit); null
    /// for a branch. Valid as long as the node.
    virtual const PropertyList* value() const { return nullptr; }

    /// Builds the tree of a display object; its root is named "Pallax" and has the path "/".
    /// Fills `pathDictionary` (empty before) with every node; of two nodes with one path it keeps
    /// the later. A null object has no tree: null is returned and nothing is stored.
    static NodeRef makeTreeFromObject(const PropertyList& object, PathDictionary& pathDictionary);

private:
    std::string _name;
};

/// A key/value row.
class PallaxModelLeafNode final : public PallaxModelNode {
public:
    PallaxModelLeafNode(std::string name, PropertyList value)
        : PallaxModelNode(std::move(name)), _string(std::move(value)) {}
    const PropertyList* value() const override { return &_string; }

private:
    PropertyList _string;
};

/// A row that opens a further pane; an empty one is a branch too.
class PallaxModelTreeNode final : public PallaxModelNode {
public:
    PallaxModelTreeNode(std::string name, std::vector<NodeRef> children)
        : PallaxModelNode(std::move(name)), _childNodes(std::move(children)) {}
    const std::vector<NodeRef>* childNodes() const override { return &_childNodes; }

private:
    std::vector<NodeRef> _childNodes;
};

/// The path of the child `name` below `parent`, joined by exactly one slash: "/" + "A" is "/A",
/// "/A" + "B" and "/A" + "/B" are "/A/B".
std::string childPath(std::string_view parent, std::string_view name);

} // namespace pallax
