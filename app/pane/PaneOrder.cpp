#include "app/pane/PaneOrder.h"

#include "app/pane/PaneRow.h"

#include <algorithm>
#include <cmath>
#include <string>
#include <utility>

namespace pallax {

namespace {

/// The properties by which rows are compared.
struct OrderKey {
    enum class Kind { Number, Text, None };

    Kind kind = Kind::None;
    double number = 0;
    std::string text;
    std::size_t row = 0;
};

OrderKey keyOf(const PallaxModelNode& node, std::size_t row, PaneOrder::By by) {
    using Kind = OrderKey::Kind;
    if (by == PaneOrder::By::Display) {
        return {Kind::Number, static_cast<double>(row), {}, row};
    }
    if (by == PaneOrder::By::Name) {
        return {Kind::Text, 0, node.displayName(), row};
    }
    const std::optional<double> number = numberOf(node);
    if (number && !std::isnan(*number)) {
        return {Kind::Number, *number, {}, row};
    }
    std::optional<std::string> text = textOf(node);
    return text ? OrderKey{Kind::Text, 0, std::move(*text), row} : OrderKey{Kind::None, 0, {}, row};
}

bool isLess(const OrderKey& left, const OrderKey& right) {
    return left.number != right.number ? left.number < right.number : left.text < right.text;
}

} // namespace

void putInOrder(std::vector<std::size_t>& rows, const std::vector<NodeRef>& children,
                const PaneOrder& order) {
    if (order == PaneOrder{}) {
        return;
    }
    std::vector<OrderKey> keys;
    keys.reserve(rows.size());
    for (const std::size_t row : rows) {
        keys.push_back(keyOf(*children[row], row, order.by));
    }
    std::stable_sort(keys.begin(), keys.end(), [&](const OrderKey& left, const OrderKey& right) {
        if (left.kind != right.kind) {
            return left.kind < right.kind;
        }
        return order.isDescending ? isLess(right, left) : isLess(left, right);
    });
    std::transform(keys.begin(), keys.end(), rows.begin(),
                   [](const OrderKey& key) { return key.row; });
}

} // namespace pallax
