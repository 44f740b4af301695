#pragma once

#include "app/PallaxCell.h"
#include "app/pane/PaneModel.h"
#include "tests/app/pane/PaneNodes.h"
#include "ui/terminal/TerminalMetrics.h"
#include "ui/terminal/TerminalTable.h"

#include <initializer_list>
#include <memory>
#include <optional>
#include <string>
#include <utility>
#include <vector>

namespace pallax::terminal {

/// Rows of text as a table's source, in the application's layout.
class TextRows final : public ui::TableSource, public PaneOwner {
public:
    /// Leaves of these names, each with the value "-".
    TextRows(std::initializer_list<const char*> names) : _pane(doubles::sectionOf(names), "/") {}

    void show(std::vector<NodeRef> rows) { _pane.show(doubles::treeNode("Rows", std::move(rows))); }

    ui::Rect bounds; ///< given to each cell

    PaneModel& pane() override { return _pane; }
    std::size_t numberOfRows() const override { return _pane.totalRows(); }
    std::shared_ptr<ui::TableCell> cellForRow(std::size_t row) override {
        const PaneRow text = _pane.row(row);
        auto cell = std::make_shared<PallaxCell>(
            text.isBranch ? PallaxCell::Kind::Branch : PallaxCell::Kind::Leaf, "Row", _metrics);
        cell->setContentBounds(bounds);
        cell->key()->text = text.name;
        if (text.isBranch) {
            cell->setAccessory(ui::CellAccessory::DisclosureIndicator);
            cell->setLayoutKey();
        } else {
            cell->value()->text = text.text.value_or("");
            cell->setLayout();
        }
        return cell;
    }
    void didSelectRow(std::optional<std::size_t> /*row*/) override {}

private:
    PaneModel _pane;
    TerminalMetrics _metrics;
};

} // namespace pallax::terminal
