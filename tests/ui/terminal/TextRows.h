#pragma once

#include "app/PallaxCell.h"
#include "ui/terminal/TerminalMetrics.h"
#include "ui/terminal/TerminalTable.h"

#include <initializer_list>
#include <memory>
#include <optional>
#include <string>
#include <utility>
#include <vector>

namespace pallax::terminal {

inline ui::RowText leafRow(std::string name, std::string value) {
    ui::RowText row;
    row.name = std::move(name);
    row.value = std::move(value);
    return row;
}

inline ui::RowText branchRow(std::string name, std::optional<std::size_t> elements = {}) {
    ui::RowText row;
    row.name = std::move(name);
    row.elements = elements;
    row.isBranch = true;
    return row;
}

/// Rows of text as a table's source, laid out as the application lays out its own.
class TextRows final : public ui::TableSource {
public:
    TextRows() = default;
    /// Leaves of these names, each with the value "-".
    TextRows(std::initializer_list<const char*> names) { set(names); }

    void set(std::initializer_list<const char*> names) {
        rows.clear();
        for (const char* name : names) {
            rows.push_back(leafRow(name, "-"));
        }
    }

    std::vector<ui::RowText> rows;
    ui::Rect bounds; ///< that a cell gets
    std::vector<std::optional<std::size_t>> selected;

    std::size_t numberOfRows() const override { return rows.size(); }
    std::shared_ptr<ui::TableCell> cellForRow(std::size_t row) override {
        const ui::RowText& text = rows.at(row);
        auto cell = std::make_shared<PallaxCell>(
            text.isBranch ? PallaxCell::Kind::Branch : PallaxCell::Kind::Leaf, "Row", _metrics);
        cell->setContentBounds(bounds);
        cell->key()->text = text.name;
        if (text.isBranch) {
            cell->setAccessory(ui::CellAccessory::DisclosureIndicator);
            cell->setLayoutKey();
        } else {
            cell->value()->text = text.value.value_or("");
            cell->setLayout();
        }
        return cell;
    }
    ui::RowText textOfRow(std::size_t row) const override { return rows.at(row); }
    void didSelectRow(std::optional<std::size_t> row) override { selected.push_back(row); }

private:
    TerminalMetrics _metrics;
};

} // namespace pallax::terminal
