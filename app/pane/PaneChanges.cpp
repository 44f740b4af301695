#include "app/pane/PaneChanges.h"

#include "app/pane/PaneRow.h"

#include <unordered_set>
#include <utility>

namespace pallax {

namespace {

bool haveSameValue(const PallaxModelNode* before, const PallaxModelNode& now) {
    const PropertyList* valueBefore = before != nullptr ? before->value() : nullptr;
    const PropertyList* value = now.value();
    return valueBefore != nullptr && value != nullptr && *valueBefore == *value;
}

} // namespace

void PaneChanges::replaced(NodeRef before, std::optional<Time> time) {
    _before = std::move(before);
    _time = time;
    _namesBefore.clear();
    _changedBefore = std::exchange(_changed, {});
}

PaneChanges::Change PaneChanges::changeOf(const PallaxModelNode& leaf, std::size_t row) const {
    Change change;
    if (!_before) {
        return change;
    }
    const PallaxModelNode* before = namedBefore(leaf.displayName(), row);
    change.hasChanged = !haveSameValue(before, leaf);
    if (change.hasChanged) {
        change.at = _time;
    } else if (const auto found = _changedBefore.find(before); found != _changedBefore.end()) {
        change.at = found->second;
    }
    if (change.at) {
        _changed.insert_or_assign(&leaf, *change.at);
    }
    return change;
}

std::vector<std::string> PaneChanges::gone(const PallaxModelNode& now) const {
    std::vector<std::string> names;
    if (!_before || _before->childNodes() == nullptr || elementsOf(*_before)) {
        return names;
    }
    std::unordered_set<std::string_view> present;
    if (const std::vector<NodeRef>* children = now.childNodes()) {
        for (const NodeRef& child : *children) {
            present.insert(child->displayName());
        }
    }
    for (const NodeRef& child : *_before->childNodes()) {
        if (!present.contains(child->displayName())) {
            names.push_back(child->displayName());
        }
    }
    return names;
}

const PallaxModelNode* PaneChanges::namedBefore(std::string_view name, std::size_t row) const {
    const std::vector<NodeRef>* children = _before->childNodes();
    if (children == nullptr) {
        return nullptr;
    }
    if (row < children->size() && (*children)[row]->displayName() == name) {
        return (*children)[row].get();
    }
    if (_namesBefore.empty()) {
        _namesBefore.reserve(children->size());
        for (const NodeRef& child : *children) {
            _namesBefore.insert_or_assign(child->displayName(), child.get());
        }
    }
    const auto found = _namesBefore.find(name);
    return found != _namesBefore.end() ? found->second : nullptr;
}

} // namespace pallax
