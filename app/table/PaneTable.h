#pragma once

#include "app/pane/PaneModel.h"
#include "app/table/ListTable.h"
#include "app/table/TableModel.h"

namespace pallax {

/// How panes show lists.
struct ListLook {
    bool asTables = false; ///< instead of rows that open
    EntryPartAt partAt = [](const std::string& /*path*/) { return EntryPart::None; };
    LeafAgeAt ageAt = [](const std::string& /*path*/) { return std::nullopt; };
};

/// Whether a pane shows a list that can be a table with columns.
bool showsTable(const PaneModel& pane);

/// Keeps a table of the list that a pane shows. Filter and cursor are the table's own.
class PaneTable {
public:
    /// Fills the table again if the pane has new data; changes are marked if this comes at each
    /// tick.
    void refresh(TableModel& table, const PaneModel& pane, const ListLook& look);
    /// Ages grow while nothing arrives. Comes after `refresh`.
    void refreshAges(TableModel& table, const PaneModel& pane, const ListLook& look) const;
    /// The table is not shown: its changes are not followed any more.
    void forget() { _listed = nullptr; }

private:
    NodeRef _listed; ///< the node in the table; null if it is out of date
};

} // namespace pallax
