#pragma once

#include "app/pane/PaneChanges.h"
#include "app/pane/PaneOrder.h"
#include "app/pane/PaneRow.h"

#include <cstddef>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace pallax {

/// A pane of the display without a toolkit: the children of one node of the display tree as rows,
/// the rows that a filter lets through in an order, and a cursor on one of them, which keeps to its
/// row, by name, when the rows change. What a row says is worked out when it is asked for.
///
/// Row numbers are the display's, but for `shown…`: those count the rows that pass the filter, in
/// the pane's order.
class PaneModel {
public:
    /// `node` may be null: no data yet.
    PaneModel(NodeRef node, std::string path);

    /// The node's name, or "Pallax" without a node.
    std::string title() const;
    /// The node's path in the display tree; "/" for the root.
    const std::string& path() const { return _path; }

    /// The state of the connection: its text, and whether something is under way.
    const std::string& status() const { return _status; }
    bool isLoading() const { return _isLoading; }
    void setStatus(std::string text, bool isLoading);

    /// Shows the node that now stands at the path, or null. `time` is that of the data. The node
    /// shown before is kept to tell what has changed; the same node again is no new data.
    void show(NodeRef node, std::optional<Time> time = {});

    std::size_t totalRows() const;
    /// The node of a row; null where there is no such row.
    NodeRef nodeAt(std::size_t row) const;
    /// A row in words and numbers; an empty one where there is no such row.
    PaneRow row(std::size_t row) const;

    /// Rows whose name or value holds this text stay, ignoring the case of ASCII letters; the empty
    /// text lets all stay.
    void setFilter(std::string text);
    const std::string& filter() const { return _filter; }
    void setOrder(PaneOrder order);
    const PaneOrder& order() const { return _order; }

    std::size_t shownRows() const;
    /// Which row a shown one is; `shown` is below shownRows().
    std::size_t rowAt(std::size_t shown) const;

    /// The shown row on which the cursor stands; below shownRows() unless there are none.
    std::size_t cursor() const { return _cursor; }
    std::optional<std::size_t> cursorRow() const;
    /// Beyond the last row, to the last row.
    void moveCursorTo(std::size_t shown);

    /// What is copied of the row under the cursor: its value, or the name of a branch. Nothing
    /// where there is no row.
    std::optional<std::string> copied() const;

private:
    const std::vector<NodeRef>& children() const;
    bool showsAllInDisplayOrder() const { return _filter.empty() && _order == PaneOrder{}; }
    bool passes(const PallaxModelNode& node) const;
    /// Chooses the shown rows anew and finds the cursor's among them.
    void arrange();
    void rememberCursor();
    void findCursor();

    NodeRef _node;
    std::string _path;
    std::string _status;
    bool _isLoading = true;
    PaneChanges _changes;
    std::string _filter;
    PaneOrder _order;
    std::vector<std::size_t> _shown; ///< while not all are shown in the display's order
    std::size_t _cursor = 0;
    std::optional<std::string> _cursorName; ///< of the row under the cursor, or the last one there
};

/// What has a pane's model: a screen, or the source of a table.
class PaneOwner {
public:
    virtual PaneModel& pane() = 0;

protected:
    ~PaneOwner() = default;
};

} // namespace pallax
