#include "report/DisplayColumns.h"

#include "app/tree/ShownEntries.h"
#include "text/Base64.h"

#include <algorithm>
#include <map>
#include <utility>

namespace pallax {

/// A place of the display. A branch has children, a leaf has a column.
struct DisplayColumns::Node {
    std::string key;
    Column column = {};
    std::uint32_t text = 0;                            ///< that is shown now
    bool isLeftOut = false;                            ///< its text, if it is a leaf
    bool isShown = false;                              ///< it, or something below it
    std::uint32_t seen = 0;                            ///< the latest tick that showed it, plus 1
    std::vector<std::unique_ptr<Node>> children = {};  ///< in the order of the display
    std::multimap<std::string_view, Node*> byKey = {}; ///< the children
};

namespace {

constexpr std::string_view kLeftOut = "left out";

PropertyList withLeftOutBelow(std::vector<std::string>& path, const PropertyList& value,
                              const IsLeftOut& isLeftOut) {
    const auto below = [&](std::string_view name, const PropertyList& each) {
        path.emplace_back(name);
        PropertyList shown = withLeftOutBelow(path, each, isLeftOut);
        path.pop_back();
        return shown;
    };
    if (const DictionaryRef dictionary = value.dictionary()) {
        Dictionary shown = *dictionary; // with its marks, which have no row
        for (const ShownEntry& entry : shownEntries(*dictionary)) {
            shown.set(*entry.key, below(entry.name, *entry.value));
        }
        return shown;
    }
    if (const ArrayRef array = value.array()) {
        Array shown;
        std::size_t place = 0;
        for (const PropertyList& each : *array) {
            shown.push_back(each.isNull() ? each : below(std::to_string(place++), each));
        }
        return shown;
    }
    return isLeftOut(path) ? PropertyList(std::string(kLeftOut)) : value;
}

std::string textOf(const PropertyList& leaf) {
    const SharedBytes data = leaf.data();
    return data ? base64Text(*data) : leaf.string().value_or(leaf.description());
}

} // namespace

PropertyList withLeftOut(const PropertyList& display, const IsLeftOut& isLeftOut) {
    std::vector<std::string> path;
    return withLeftOutBelow(path, display, isLeftOut);
}

DisplayColumns::DisplayColumns(IsLeftOut isLeftOut)
    : _isLeftOut(std::move(isLeftOut)), _root(std::make_unique<Node>()), _texts{{}} {}

DisplayColumns::~DisplayColumns() = default;

void DisplayColumns::add(std::uint32_t tick, const PropertyList& display) {
    _tick = tick;
    take(*_root, display);
}

void DisplayColumns::take(Node& node, const PropertyList& value) {
    node.seen = _tick + 1;
    node.isShown = true;
    std::size_t place = 0;
    const auto takeNext = [&](std::string_view key, const PropertyList& each) {
        if (Node* child = childOf(node, place, key)) {
            take(*child, each);
        }
        ++place;
    };
    if (const DictionaryRef dictionary = value.dictionary()) {
        for (const ShownEntry& entry : shownEntries(*dictionary)) {
            takeNext(entry.name, *entry.value);
        }
    } else if (const ArrayRef array = value.array()) {
        for (const PropertyList& element : *array) {
            if (!element.isNull()) {
                takeNext(std::to_string(place), element);
            }
        }
    }
    const bool isLeaf = !value.dictionary() && !value.array() && !value.isNull();
    change(node, isLeaf ? numberOf(node.isLeftOut ? std::string(kLeftOut) : textOf(value)) : 0);
    for (const auto& child : node.children) {
        if (child->isShown && child->seen != _tick + 1) {
            leave(*child);
        }
    }
}

/// The child that should stand there: it seldom moves. Null if there are too many.
DisplayColumns::Node* DisplayColumns::childOf(Node& node, std::size_t place, std::string_view key) {
    const auto isFree = [&](const Node& child) { // several rows can have the same name
        return child.key == key && child.seen != _tick + 1;
    };
    if (place < node.children.size() && isFree(*node.children[place])) {
        return node.children[place].get();
    }
    const auto [begin, end] = node.byKey.equal_range(key);
    const auto found =
        std::find_if(begin, end, [&](const auto& each) { return isFree(*each.second); });
    return found != end ? found->second : addChild(node, key);
}

/// Stands after the one that was shown before it.
DisplayColumns::Node* DisplayColumns::addChild(Node& node, std::string_view key) {
    if (_places >= kMostPlaces) {
        return nullptr;
    }
    ++_places;
    auto& children = node.children;
    const auto after = std::find_if(children.rbegin(), children.rend(),
                                    [this](const auto& child) { return child->seen == _tick + 1; });
    auto child = std::make_unique<Node>(Node{std::string(key)});
    child->column.path = node.column.path;
    child->column.path.emplace_back(key);
    child->isLeftOut = _isLeftOut && _isLeftOut(child->column.path);
    Node* const added = children.insert(after.base(), std::move(child))->get();
    node.byKey.emplace(added->key, added);
    return added;
}

void DisplayColumns::leave(Node& node) {
    node.isShown = false;
    change(node, 0);
    for (const auto& child : node.children) {
        if (child->isShown) {
            leave(*child);
        }
    }
}

void DisplayColumns::change(Node& node, std::uint32_t text) {
    if (node.text != text && _changes < kMostChanges) {
        node.text = text;
        node.column.changes.push_back({_tick, text});
        ++_changes;
    }
}

std::uint32_t DisplayColumns::numberOf(std::string text) {
    const auto number = static_cast<std::uint32_t>(_texts.size());
    const auto [place, isNew] = _numbers.emplace(std::move(text), number);
    if (isNew) {
        _texts.push_back(place->first);
    }
    return place->second;
}

void DisplayColumns::gather(const Node& node, std::vector<const Column*>& columns) {
    if (!node.column.changes.empty()) {
        columns.push_back(&node.column);
    }
    for (const auto& child : node.children) {
        gather(*child, columns);
    }
}

std::vector<const DisplayColumns::Column*> DisplayColumns::columns() const {
    std::vector<const Column*> columns;
    gather(*_root, columns);
    return columns;
}

} // namespace pallax
