#pragma once

#include "plist/PropertyList.h"
#include "text/Date.h"

#include <cstddef>
#include <memory>
#include <memory_resource>
#include <optional>
#include <string>
#include <string_view>
#include <unordered_map>
#include <utility>
#include <vector>

namespace pallax {

class PallaxModelNode;
using NodeRef = std::shared_ptr<const PallaxModelNode>;

/// Maps paths ("/Serving Cell/ARFCN") to nodes. Its entries are in a few large blocks, freed
/// together: individual allocations took a third of a tick of 50,000 leaves (bench/ScreenBench).
class PathDictionary {
    using Nodes = std::pmr::unordered_map<std::string, NodeRef>;

public:
    PathDictionary() = default;
    ~PathDictionary() = default;
    PathDictionary(const PathDictionary&) = delete;
    PathDictionary& operator=(const PathDictionary&) = delete;

    /// Reserves room for this many entries.
    void reserve(std::size_t count) { _nodes.reserve(count); }
    void insert_or_assign(std::string path, NodeRef node) {
        _nodes.insert_or_assign(std::move(path), std::move(node));
    }
    void clear() { _nodes.clear(); }

    /// The node at a path; throws std::out_of_range if there is none.
    const NodeRef& at(const std::string& path) const { return _nodes.at(path); }
    Nodes::const_iterator find(const std::string& path) const { return _nodes.find(path); }
    bool contains(const std::string& path) const { return _nodes.contains(path); }
    std::size_t size() const { return _nodes.size(); }
    bool empty() const { return _nodes.empty(); }
    Nodes::const_iterator begin() const { return _nodes.begin(); }
    Nodes::const_iterator end() const { return _nodes.end(); }

    friend bool operator==(const PathDictionary& a, const PathDictionary& b) {
        return a._nodes == b._nodes;
    }

private:
    std::pmr::monotonic_buffer_resource _storage; // keeps its blocks until it is destroyed
    Nodes _nodes{&_storage};
};

/// A named node of the display tree; immutable. A node of any class is a branch if `childNodes`
/// is not null.
class PallaxModelNode {
public:
    /// A name that may be shared, usually with the key in the display. Never null.
    using SharedName = std::shared_ptr<const std::string>;

    explicit PallaxModelNode(SharedName name) : _name(std::move(name)) {}
    explicit PallaxModelNode(std::string name)
        : _name(std::make_shared<const std::string>(std::move(name))) {}
    virtual ~PallaxModelNode() = default;
    PallaxModelNode(const PallaxModelNode&) = delete;
    PallaxModelNode& operator=(const PallaxModelNode&) = delete;

    const std::string& displayName() const { return *_name; }
    /// The children in display order; null for a leaf. Valid as long as the node.
    virtual const std::vector<NodeRef>* childNodes() const { return nullptr; }
    /// The value of a leaf: a string or display number (which knows its number and unit); null for
    /// a branch. Valid as long as the node.
    virtual const PropertyList* value() const { return nullptr; }
    /// When the value of a leaf was last read from a packet, changed or not. Nothing for a branch,
    /// and if the display does not keep it.
    virtual std::optional<Time> readAt() const { return std::nullopt; }

    /// Builds the tree of a display object; its root is named "Pallax" and has the path "/". Fills
    /// `pathDictionary` (empty before) with every node; of two nodes with the same path it keeps
    /// the later. For a null object it returns null and stores nothing.
    static NodeRef makeTreeFromObject(const PropertyList& object, PathDictionary& pathDictionary);

private:
    SharedName _name;
};

/// A key/value row.
class PallaxModelLeafNode final : public PallaxModelNode {
public:
    PallaxModelLeafNode(SharedName name, PropertyList value)
        : PallaxModelNode(std::move(name)), _string(std::move(value)) {}
    PallaxModelLeafNode(std::string name, PropertyList value)
        : PallaxModelNode(std::move(name)), _string(std::move(value)) {}
    const PropertyList* value() const override { return &_string; }

private:
    PropertyList _string;
};

/// A row that opens another pane; an empty one is also a branch.
class PallaxModelTreeNode final : public PallaxModelNode {
public:
    PallaxModelTreeNode(SharedName name, std::vector<NodeRef> children)
        : PallaxModelNode(std::move(name)), _childNodes(std::move(children)) {}
    PallaxModelTreeNode(std::string name, std::vector<NodeRef> children)
        : PallaxModelNode(std::move(name)), _childNodes(std::move(children)) {}
    const std::vector<NodeRef>* childNodes() const override { return &_childNodes; }

private:
    std::vector<NodeRef> _childNodes;
};

/// The path of the child `name` of `parent`, joined by exactly one slash: "/" + "A" is "/A", "/A" +
/// "B" and "/A" + "/B" are "/A/B".
std::string childPath(std::string_view parent, std::string_view name);
/// The same, replacing the parent's path.
void makeChildPath(std::string& path, std::string_view name);

} // namespace pallax
