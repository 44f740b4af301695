#include "app/tree/PallaxModelNode.h"

#include "LogGenerator/Records/ArrayLock.h"
#include "app/tree/ShownEntries.h"

#include <algorithm>
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

/// How many nodes the object's tree has at most.
std::size_t nodesIn(const PropertyList& object) {
    std::size_t nodes = 1;
    if (const DictionaryRef dictionary = object.dictionary()) {
        for (const Dictionary::Entry& entry : *dictionary) {
            nodes += nodesIn(entry.value);
        }
    }
    return nodes;
}

class TreeBuilder {
public:
    explicit TreeBuilder(PathDictionary& paths) : _paths(paths) {}

    /// Null for a null object: where there is no value there is no row.
    NodeRef node(std::string_view name, const PropertyList& object, std::string path) {
        if (object.isNull()) {
            return nullptr;
        }
        NodeRef made = make(std::string(name), object, path);
        _paths.insert_or_assign(std::move(path), made);
        return made;
    }

private:
    NodeRef make(std::string name, const PropertyList& object, const std::string& path) {
        if (object.isString()) {
            return std::make_shared<PallaxModelLeafNode>(std::move(name), object);
        }
        if (const DictionaryRef dictionary = object.dictionary()) {
            return std::make_shared<PallaxModelTreeNode>(std::move(name),
                                                         childrenOf(*dictionary, path));
        }
        if (const ArrayRef array = object.array()) {
            return std::make_shared<PallaxModelTreeNode>(std::move(name), childrenOf(*array, path));
        }
        return std::make_shared<PallaxModelLeafNode>(std::move(name), Text::fixed(kUnknown));
    }

    std::vector<NodeRef> childrenOf(const Dictionary& dictionary, const std::string& path) {
        const std::vector<ShownEntry> shown = shownEntries(dictionary);
        std::vector<NodeRef> children;
        children.reserve(shown.size());
        for (const ShownEntry& entry : shown) {
            append(children, entry.name, *entry.value, path);
        }
        return children;
    }

    std::vector<NodeRef> childrenOf(const Array& array, const std::string& path) {
        const HeldArrayLock lock; // records may be replacing the elements
        std::vector<NodeRef> children;
        children.reserve(array.size());
        for (const PropertyList& element : array) {
            append(children, std::to_string(children.size()), element, path);
        }
        return children;
    }

    void append(std::vector<NodeRef>& children, std::string_view name, const PropertyList& object,
                const std::string& parentPath) {
        if (NodeRef child = node(name, object, childPath(parentPath, name))) {
            children.push_back(std::move(child));
        }
    }

    PathDictionary& _paths;
};

} // namespace

NodeRef PallaxModelNode::makeTreeFromObject(const PropertyList& object,
                                            PathDictionary& pathDictionary) {
    // Growing step by step costs a tree of 50,000 leaves a sixth of its tick (bench/ScreenBench).
    pathDictionary.reserve(nodesIn(object));
    return TreeBuilder(pathDictionary).node(kTitle, object, "/");
}

std::string childPath(std::string_view parent, std::string_view name) {
    const std::size_t parentEnd = parent.find_last_not_of('/') + 1; // 0 where there is none
    const std::size_t nameStart = std::min(name.find_first_not_of('/'), name.size());
    std::string path;
    path.reserve(parentEnd + 1 + name.size() - nameStart);
    path += parent.substr(0, parentEnd);
    path += '/';
    path += name.substr(nameStart);
    return path;
}

} // namespace pallax
