#pragma once

#include "plist/PropertyList.h"

#include <cstdint>
#include <map>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

namespace pallax {

/// Compares each display with the one before, leaf by leaf, in display order.
class DisplayDifference {
public:
    /// A leaf of the display tree. The listener owns `written`, which is kept from display to
    /// display.
    struct Leaf {
        PropertyList value;
        std::string written;
        std::uint64_t display = 0; ///< in which it was seen last
    };

    class Listener {
    public:
        virtual ~Listener() = default;
        /// A leaf that is new, or whose text may differ from the one before (`leaf.value` is still
        /// the former value).
        virtual void changed(std::string_view path, Leaf& leaf, const PropertyList& value) = 0;
        /// A leaf of the display before, after all of this one, by path.
        virtual void removed(std::string_view path, Leaf& leaf) = 0;
    };

    /// The next display is compared with none.
    void clear();
    void compare(const PropertyList& display, Listener& listener);

private:
    /// By path and count of earlier nodes with the same path in the display.
    using Leaves = std::map<std::pair<std::string, int>, Leaf>;

    /// The value at `_path`.
    void visit(const PropertyList& value, Listener& listener);
    void visitChild(std::string_view name, const PropertyList& value, Listener& listener);
    void visitLeaf(const PropertyList& value, Listener& listener);
    Leaves::iterator leafOfPath();

    Leaves _leaves;
    /// The leaves of the previous display and of this one in order: the next leaf is usually the
    /// one that came next before, so no search is needed.
    std::vector<Leaves::iterator> _before;
    std::vector<Leaves::iterator> _order;
    std::uint64_t _display = 0;
    std::string _path; ///< of the current value
};

} // namespace pallax
