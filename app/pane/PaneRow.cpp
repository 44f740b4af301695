#include "app/pane/PaneRow.h"

#include <algorithm>

namespace pallax {

std::optional<std::string> textOf(const PallaxModelNode& node) {
    const PropertyList* value = node.value();
    if (value == nullptr) {
        return std::nullopt;
    }
    std::string text;
    (void)value->appendString(text);
    return text;
}

std::optional<double> numberOf(const PallaxModelNode& node) {
    const PropertyList* value = node.value();
    const DisplayNumber* number = value != nullptr ? value->displayNumber() : nullptr;
    if (number == nullptr) {
        return std::nullopt;
    }
    return number->isReal() ? number->real() : static_cast<double>(number->integer());
}

std::optional<std::size_t> elementsOf(const PallaxModelNode& node) {
    const std::vector<NodeRef>* children = node.childNodes();
    if (children == nullptr || children->empty()) {
        return std::nullopt;
    }
    std::size_t expected = 0;
    const bool areNumbered =
        std::all_of(children->begin(), children->end(), [&expected](const NodeRef& child) {
            return child->displayName() == std::to_string(expected++);
        });
    return areNumbered ? std::optional(children->size()) : std::nullopt;
}

} // namespace pallax
