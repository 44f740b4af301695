#include "app/table/PaneTable.h"

#include <utility>

namespace pallax {

bool showsTable(const PaneModel& pane) {
    return pane.node() != nullptr && isTable(*pane.node());
}

void PaneTable::refresh(TableModel& table, const PaneModel& pane, const ListLook& look) {
    const NodeRef& node = pane.node();
    if (node == _listed) {
        return;
    }
    const bool isFollowed = _listed != nullptr;
    TableContent content;
    if (showsTable(pane)) {
        content = tableOf(*node, pane.path(), look.partAt);
        addAges(content, agesOf(*node, pane.path(), look.ageAt));
    }
    table.update(std::move(content),
                 isFollowed ? TableModel::Changes::Mark : TableModel::Changes::Ignore);
    if (const auto row = pane.cursorRow(); row && !isFollowed) {
        table.select(*row);
    }
    _listed = node;
}

void PaneTable::refreshAges(TableModel& table, const PaneModel& pane, const ListLook& look) const {
    for (const std::size_t column : table.columns()) {
        if (table.content().columns[column].isExtra) {
            table.setCells(column, agesOf(*_listed, pane.path(), look.ageAt));
        }
    }
}

} // namespace pallax
