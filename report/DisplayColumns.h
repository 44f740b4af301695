#pragma once

#include "plist/PropertyList.h"

#include <cstddef>
#include <cstdint>
#include <functional>
#include <memory>
#include <string>
#include <string_view>
#include <unordered_map>
#include <vector>

namespace pallax {

/// Whether the value at a path of the display is masked, so that it is not shown as what is left.
using IsLeftOut = std::function<bool(const std::vector<std::string>& path)>;

/// A display with the words "left out" in place of each such value.
PropertyList withLeftOut(const PropertyList& display, const IsLeftOut& isLeftOut);

/// The display at every tick, as one column for each place in it, kept where it changes.
class DisplayColumns {
public:
    /// Further changes, and places beside these, are left out, so that records of any content need
    /// a bounded memory and time.
    static constexpr std::size_t kMostChanges = std::size_t{1} << 23U;
    static constexpr std::size_t kMostPlaces = std::size_t{1} << 14U;

    struct Change {
        std::uint32_t tick; ///< from 0
        std::uint32_t text; ///< its place in `texts`; 0: nothing is shown from here on
    };
    struct Column {
        std::vector<std::string> path; ///< names of rows; an entry of an array has its position
        std::vector<Change> changes;
    };

    explicit DisplayColumns(IsLeftOut isLeftOut = {});
    ~DisplayColumns();
    DisplayColumns(const DisplayColumns&) = delete;
    DisplayColumns& operator=(const DisplayColumns&) = delete;

    /// The display at a tick, which must be after the earlier ones.
    void add(std::uint32_t tick, const PropertyList& display);

    /// In the order of the display.
    std::vector<const Column*> columns() const;
    const std::vector<std::string_view>& texts() const { return _texts; }
    /// Whether something is left out.
    bool isFull() const { return _changes >= kMostChanges || _places >= kMostPlaces; }

private:
    struct Node;

    void take(Node& node, const PropertyList& value);
    Node* childOf(Node& node, std::size_t place, std::string_view key);
    Node* addChild(Node& node, std::string_view key);
    void leave(Node& node);
    void change(Node& node, std::uint32_t text);
    std::uint32_t numberOf(std::string text);
    static void gather(const Node& node, std::vector<const Column*>& columns);

    IsLeftOut _isLeftOut;
    std::unique_ptr<Node> _root;
    std::unordered_map<std::string, std::uint32_t> _numbers;
    std::vector<std::string_view> _texts;
    std::size_t _changes = 0;
    std::size_t _places = 0;
    std::uint32_t _tick = 0;
};

} // namespace pallax
