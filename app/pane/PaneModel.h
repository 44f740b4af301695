#pragma once

#include "app/pane/PaneChanges.h"
#include "app/pane/PaneOrder.h"
#include "app/pane/PaneRow.h"
#include "app/pane/ReadingAge.h"

#include <cstddef>
#include <optional>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

namespace pallax {

/// A pane of the display without a toolkit. Its rows are the children of one node of the display
/// tree. It has a filter, an order, and a cursor, which stays on its row, by name, when the rows
/// change. The content of a row is computed when it is requested.
///
/// Row numbers follow the display's order. Only numbers called `shown` count the rows that pass the
/// filter, in the pane's order.
class PaneModel {
public:
    /// `node` may be null: no data yet.
    PaneModel(NodeRef node, std::string path);

    /// The node whose children are the rows; may be null.
    const NodeRef& node() const { return _node; }
    /// The node's name, or "Pallax" without a node.
    std::string title() const;
    /// The node's path in the display tree; "/" for the root.
    const std::string& path() const { return _path; }

    /// The state of the connection: a text, and whether something is in progress.
    const std::string& status() const { return _status; }
    bool isLoading() const { return _isLoading; }
    void setStatus(std::string text, bool isLoading);

    /// Shows a new node at the path, or null. `time` is the time of its data. The previous node is
    /// kept to tell what has changed. Showing the same node again does not count as new data.
    void show(NodeRef node, std::optional<Time> time = {});

    /// Where the ages of the rows come from.
    void setAges(ReadingAges ages) { _ages = std::move(ages); }
    /// Why a pane without rows has none, in words; empty if it has rows or the ages are unknown.
    std::string emptyWords() const;
    /// The names of the values that the previous data had and the current data has not, in their
    /// order. The elements of a list have no names.
    std::vector<std::string> gone() const;

    std::size_t totalRows() const;
    /// The node of a row; null beyond the last row.
    NodeRef nodeAt(std::size_t row) const;
    /// The texts and numbers of a row; empty beyond the last row.
    PaneRow row(std::size_t row) const;

    /// Shows only rows whose name or value contains this text, ignoring the case of ASCII letters.
    /// The empty text shows all rows.
    void setFilter(std::string text);
    const std::string& filter() const { return _filter; }
    void setOrder(PaneOrder order);
    const PaneOrder& order() const { return _order; }

    std::size_t shownRows() const;
    /// The row of a shown row; `shown` must be below shownRows().
    std::size_t rowAt(std::size_t shown) const;

    /// The cursor's shown row; below shownRows() unless there are none.
    std::size_t cursor() const { return _cursor; }
    std::optional<std::size_t> cursorRow() const;
    /// Numbers beyond the last row mean the last row.
    void moveCursorTo(std::size_t shown);

    /// The text to copy from the row under the cursor: its value, or a branch's name. Nothing if
    /// there is no row.
    std::optional<std::string> copied() const;

private:
    const std::vector<NodeRef>& children() const;
    bool showsAllInDisplayOrder() const { return _filter.empty() && _order == PaneOrder{}; }
    bool passes(const PallaxModelNode& node) const;
    /// Selects and orders the shown rows, then finds the cursor's row.
    void arrange();
    void rememberCursor();
    void findCursor();

    NodeRef _node;
    std::string _path;
    std::string _status;
    bool _isLoading = true;
    PaneChanges _changes;
    ReadingAges _ages;
    std::string _filter;
    PaneOrder _order;
    std::vector<std::size_t> _shown; ///< unused while all rows are shown in the display's order
    std::size_t _cursor = 0;
    std::optional<std::string> _cursorName; ///< of the row under the cursor, now or last
};

/// A screen or table source that owns a pane's model.
class PaneOwner {
public:
    virtual PaneModel& pane() = 0;

protected:
    ~PaneOwner() = default;
};

} // namespace pallax
