#pragma once

#include "platform/ui/Screen.h"
#include "platform/ui/TableView.h"
#include "platform/ui/Toolkit.h"

#include <memory>

namespace pallax::ui {

/// A screen that is one table and its source.
class TableScreen : public Screen, public TableSource {
public:
    explicit TableScreen(Toolkit& toolkit)
        : Screen(toolkit.makeScreenView()), _table(toolkit.makeTableView(*this)) {}

    TableView& table() { return *_table; }

private:
    std::unique_ptr<TableView> _table;
};

} // namespace pallax::ui
