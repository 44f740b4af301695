#pragma once

#include "ui/drawing/ColumnTable.h"
#include "ui/drawing/LineEditor.h"
#include "ui/pages/Page.h"

#include <functional>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace pallax::terminal {

/// A table as the content of a page, with its filter, which is typed in the last row.
class PageTable {
public:
    using Copy = std::function<void(const std::string&)>;

    /// A line that is being typed in the last row.
    struct Prompt {
        std::string_view mark;
        const LineEditor* line = nullptr; ///< null: none
        Hint hint = {};
    };

    /// The words around a table.
    struct Words {
        std::string_view title;        ///< of the page
        std::string_view empty;        ///< instead of a table without rows
        std::vector<Hint> hints = {};  ///< before those of every table
        std::string_view message = {}; ///< instead of the status, if not empty
        Prompt prompt = {};
    };

    /// Copies values to the clipboard by this function.
    explicit PageTable(Copy copy) : _copy(std::move(copy)) {}

    ColumnTable& table() { return _table; }
    TableModel& model() { return _table.model(); }
    const TableModel& model() const { return _table.model(); }
    /// Whether keys are text.
    bool isTyping() const { return _filterEditor.has_value(); }

    /// Takes keys of the table and its filter. Closes the page by a key that goes back when the
    /// table is neither filtered nor scrolled sideways.
    PageAnswer handle(const KeyEvent& event);
    /// A click on a row is the Enter key.
    void draw(const PageScreen& screen, const PageSurroundings& around, const Words& words);

private:
    PageAnswer handleFilter(const KeyEvent& event);
    PageAnswer goBack(const KeyEvent& event);
    void drawTitle(const PageScreen& screen, Bars& bars, std::string_view root,
                   std::string_view title) const;
    void drawLastRow(const PageScreen& screen, const PageSurroundings& around, Bars& bars,
                     const Words& words, int ruleRight);

    Copy _copy;
    ColumnTable _table;
    std::optional<LineEditor> _filterEditor; ///< while a filter is being typed
};

} // namespace pallax::terminal
