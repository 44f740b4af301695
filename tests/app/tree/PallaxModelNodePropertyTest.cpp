#include "app/tree/PallaxModelNode.h"
#include "tests/doubles/Property.h"

#include <gtest/gtest.h>

#include <unordered_set>

namespace pallax {
namespace {

namespace any = doubles::any;

constexpr int kDeepest = 4;
constexpr int kWidest = 6;

/// A display object of strings, dictionaries and arrays. Some dictionaries are sorted, and names
/// contain separators, slashes and repetitions.
PropertyList randomObject(int depth) {
    const int kind = any::between(0, depth > 0 ? 3 : 1);
    if (kind == 0) {
        return any::text();
    }
    const int count = any::between(0, kWidest);
    if (kind == 1) {
        Array array;
        for (int at = 0; at < count; ++at) {
            array.push_back(randomObject(depth - 1));
        }
        return array;
    }
    Dictionary dictionary;
    if (any::boolean()) {
        dictionary.set("_sorted", "1");
    }
    for (int at = 0; at < count; ++at) {
        const std::string key = any::textOf("aB1;/");
        dictionary.set(key, randomObject(depth - 1));
    }
    return dictionary;
}

struct Count {
    int leaves = 0;
    int branches = 0;
    friend bool operator==(const Count&, const Count&) = default;
};

/// Counts the object's content without the reserved keys.
void count(const PropertyList& object, Count& total) {
    if (const auto dictionary = object.dictionary()) {
        ++total.branches;
        for (const auto& entry : *dictionary) {
            if (entry.key.view() != "_sorted") {
                count(entry.value, total);
            }
        }
    } else if (const auto array = object.array()) {
        ++total.branches;
        for (const PropertyList& element : *array) {
            count(element, total);
        }
    } else {
        ++total.leaves;
    }
}

/// Visits every node with its path, parents before children.
template <class Visit>
void walk(const NodeRef& node, const std::string& path, const Visit& visit) {
    if (const auto* children = node->childNodes()) {
        for (const NodeRef& child : *children) {
            walk(child, childPath(path, child->displayName()), visit);
        }
    }
    visit(node, path);
}

TEST(PallaxModelNodeProperty, EveryPathLeadsToTheLastNodeThatStandsThere) {
    EXPECT_TRUE(doubles::holds([] {
        PathDictionary paths;
        const NodeRef root = PallaxModelNode::makeTreeFromObject(randomObject(kDeepest), paths);
        PathDictionary expected;
        walk(root, "/", [&](const NodeRef& node, const std::string& path) {
            expected.insert_or_assign(path, node);
        });
        RC_ASSERT(paths == expected);
        RC_ASSERT(paths.at("/") == root);
    }));
}

TEST(PallaxModelNodeProperty, EveryValueHasExactlyOneNodeOfItsKind) {
    EXPECT_TRUE(doubles::holds([] {
        const PropertyList object = randomObject(kDeepest);
        PathDictionary paths;
        const NodeRef root = PallaxModelNode::makeTreeFromObject(object, paths);
        Count expected;
        count(object, expected);
        Count found;
        std::unordered_set<const PallaxModelNode*> seen;
        walk(root, "/", [&](const NodeRef& node, const std::string& path) {
            ++(node->childNodes() != nullptr ? found.branches : found.leaves);
            RC_ASSERT((node->childNodes() == nullptr) == (node->value() != nullptr));
            RC_ASSERT(seen.insert(node.get()).second);
            RC_ASSERT(path.front() == '/');
        });
        RC_ASSERT(found == expected);
    }));
}

TEST(PallaxModelNodeProperty, SortedRowsAreInAscendingOrderOfTheirKeys) {
    EXPECT_TRUE(doubles::holds([] {
        const std::vector<std::string> keys = any::texts();
        Dictionary object{{"_sorted", "1"}};
        for (const std::string& key : keys) {
            object.set(key, key); // the value names its key
        }
        object.set("_sorted", "1");
        PathDictionary paths;
        const NodeRef root = PallaxModelNode::makeTreeFromObject(object, paths);
        std::string previous;
        for (const NodeRef& child : *root->childNodes()) {
            const std::string key = child->value()->string().value();
            RC_ASSERT(previous <= key);
            RC_ASSERT(key.ends_with(child->displayName()));
            previous = key;
        }
        RC_ASSERT(root->childNodes()->size() == object.size() - 1);
    }));
}

} // namespace
} // namespace pallax
