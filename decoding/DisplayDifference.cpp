#include "decoding/DisplayDifference.h"

#include "app/tree/PallaxModelNode.h"
#include "app/tree/ShownEntries.h"

namespace pallax {

namespace {

/// Compares without formatting the texts: false does not mean that they differ.
bool isSameText(const PropertyList& a, const PropertyList& b) {
    const DisplayNumber* number = a.displayNumber();
    const DisplayNumber* otherNumber = b.displayNumber();
    if (number != nullptr && otherNumber != nullptr) {
        return number->sameNumberAndFormat(*otherNumber);
    }
    return a.text() != nullptr && b.text() != nullptr && *a.text() == *b.text();
}

} // namespace

void DisplayDifference::clear() {
    _before.clear();
    _order.clear();
    _leaves.clear();
}

void DisplayDifference::compare(const PropertyList& display, Listener& listener) {
    ++_display;
    _before.swap(_order);
    _order.clear();
    _path.assign(1, '/');
    visit(display, listener);
    for (auto at = _leaves.begin(); at != _leaves.end();) {
        if (at->second.display == _display) {
            ++at;
            continue;
        }
        listener.removed(at->first.first, at->second);
        at = _leaves.erase(at);
    }
}

/// Visits the values in the order of the display tree, which keeps only texts.
void DisplayDifference::visit(const PropertyList& value, Listener& listener) {
    if (const DictionaryRef dictionary = value.dictionary()) {
        for (const ShownEntry& entry : shownEntries(*dictionary)) {
            visitChild(entry.name, *entry.value, listener);
        }
    } else if (const ArrayRef array = value.array()) {
        int number = 0;
        for (const PropertyList& element : *array) {
            if (!element.isNull()) {
                visitChild(std::to_string(number++), element, listener);
            }
        }
    } else if (!value.isNull()) {
        visitLeaf(value, listener);
    }
}

void DisplayDifference::visitChild(std::string_view name, const PropertyList& value,
                                   Listener& listener) {
    const std::size_t length = _path.size();
    const std::size_t lengthWithoutSlashes = _path.find_last_not_of('/') + 1;
    makeChildPath(_path, name);
    visit(value, listener);
    _path.resize(lengthWithoutSlashes);
    _path.resize(length, '/');
}

void DisplayDifference::visitLeaf(const PropertyList& value, Listener& listener) {
    const auto found = leafOfPath();
    _order.push_back(found);
    Leaf& leaf = found->second;
    const bool isNew = leaf.display == 0;
    leaf.display = _display;
    if (isNew || !isSameText(leaf.value, value)) {
        listener.changed(_path, leaf, value);
        leaf.value = value;
    }
}

/// The next node at the path; a new one has no display yet.
DisplayDifference::Leaves::iterator DisplayDifference::leafOfPath() {
    if (_order.size() < _before.size()) {
        const auto next = _before[_order.size()];
        if (next->first.second == 0 && next->first.first == _path &&
            next->second.display != _display) {
            return next;
        }
    }
    std::pair<std::string, int> key(_path, 0);
    auto leaf = _leaves.try_emplace(key).first;
    while (leaf->second.display == _display) {
        ++key.second;
        leaf = _leaves.try_emplace(key).first;
    }
    return leaf;
}

} // namespace pallax
