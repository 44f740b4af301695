#include "app/tree/PallaxModelNode.h"

#include "LogGenerator/Records/ArrayLock.h"
#include "app/tree/ShownEntries.h"

#include <algorithm>
#include <deque>
#include <utility>

namespace pallax {

namespace {

constexpr std::string_view kTitle = "Pallax";
constexpr std::string_view kUnknown = "(unknown)";

/// The array lock, held for a scope.
class HeldArrayLock {
public:
    HeldArrayLock() { ArrayLock::lockArray(); }
    ~HeldArrayLock() { ArrayLock::unlockArray(); }
    HeldArrayLock(const HeldArrayLock&) = delete;
    HeldArrayLock& operator=(const HeldArrayLock&) = delete;
};

/// The maximum number of nodes in the object's tree.
std::size_t nodesIn(const PropertyList& object) {
    std::size_t nodes = 1;
    if (const DictionaryRef dictionary = object.dictionary()) {
        for (const Dictionary::Entry& entry : *dictionary) {
            nodes += nodesIn(entry.value);
        }
    }
    return nodes;
}

using SharedName = PallaxModelNode::SharedName;

class TreeBuilder {
public:
    explicit TreeBuilder(PathDictionary& paths) : _paths(paths) {}

    NodeRef root(const PropertyList& object) {
        if (object.isNull()) {
            return nullptr;
        }
        Leaves leaves;
        return node(std::make_shared<const std::string>(kTitle), object, "/", leaves);
    }

private:
    /// The leaves of one branch are contiguous and live as long as any of them is in use. Separate
    /// allocations took a fifth of a tick of 50,000 leaves (bench/ScreenBench).
    using Leaves = std::shared_ptr<std::deque<PallaxModelLeafNode>>;

    /// `object` must not be null: a null has no row.
    NodeRef node(SharedName name, const PropertyList& object, std::string path, Leaves& leaves) {
        NodeRef made = make(std::move(name), object, path, leaves);
        _paths.insert_or_assign(std::move(path), made);
        return made;
    }

    NodeRef make(SharedName name, const PropertyList& object, const std::string& path,
                 Leaves& leaves) {
        if (object.isString()) {
            return leaf(std::move(name), object, leaves);
        }
        if (const DictionaryRef dictionary = object.dictionary()) {
            return std::make_shared<PallaxModelTreeNode>(std::move(name),
                                                         childrenOf(*dictionary, path));
        }
        if (const ArrayRef array = object.array()) {
            return std::make_shared<PallaxModelTreeNode>(std::move(name), childrenOf(*array, path));
        }
        return leaf(std::move(name), Text::fixed(kUnknown), leaves);
    }

    static NodeRef leaf(SharedName name, PropertyList value, Leaves& leaves) {
        if (!leaves) {
            leaves = std::make_shared<Leaves::element_type>();
        }
        return {leaves, &leaves->emplace_back(std::move(name), std::move(value))};
    }

    std::vector<NodeRef> childrenOf(const Dictionary& dictionary, const std::string& path) {
        const std::vector<ShownEntry> shown = shownEntries(dictionary);
        Leaves leaves;
        std::vector<NodeRef> children;
        children.reserve(shown.size());
        for (const ShownEntry& entry : shown) {
            children.push_back(
                node(entry.sharedName(), *entry.value, childPath(path, entry.name), leaves));
        }
        return children;
    }

    std::vector<NodeRef> childrenOf(const Array& array, const std::string& path) {
        const HeldArrayLock lock; // records may be replacing elements
        Leaves leaves;
        std::vector<NodeRef> children;
        children.reserve(array.size());
        for (const PropertyList& element : array) {
            if (element.isNull()) { // a null has no row and no number
                continue;
            }
            auto name = std::make_shared<const std::string>(std::to_string(children.size()));
            std::string childsPath = childPath(path, *name);
            children.push_back(node(std::move(name), element, std::move(childsPath), leaves));
        }
        return children;
    }

    PathDictionary& _paths;
};

} // namespace

NodeRef PallaxModelNode::makeTreeFromObject(const PropertyList& object,
                                            PathDictionary& pathDictionary) {
    // Growing stepwise took a sixth of a tick of 50,000 leaves (bench/ScreenBench).
    pathDictionary.reserve(nodesIn(object));
    return TreeBuilder(pathDictionary).root(object);
}

void makeChildPath(std::string& path, std::string_view name) {
    const std::size_t nameStart = std::min(name.find_first_not_of('/'), name.size());
    path.resize(path.find_last_not_of('/') + 1); // clears it if there is none
    path += '/';
    path += name.substr(nameStart);
}

std::string childPath(std::string_view parent, std::string_view name) {
    std::string path;
    path.reserve(parent.size() + 1 + name.size());
    path = parent;
    makeChildPath(path, name);
    return path;
}

} // namespace pallax
