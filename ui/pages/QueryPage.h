#pragma once

#include "ui/contents/QueryContent.h"
#include "ui/pages/PageTable.h"

#include <optional>
#include <string>
#include <string_view>

namespace pallax::terminal {

/// Asks the timeline in SQL: a line that is typed in the last row, and the answer as a table.
class QueryPage {
public:
    QueryPage(QueryContent::Surroundings surroundings, PageTable::Copy copy);

    PageAnswer handle(const KeyEvent& event);
    void draw(const PageScreen& screen, const PageSurroundings& around);

private:
    PageAnswer handleLine(const KeyEvent& event);
    void startTyping();
    /// Replaces the line by an earlier query, or a later one.
    void recall(bool isEarlier);
    void run(const std::string& query);
    PageAnswer goToRow();
    std::string_view words() const;

    QueryContent _content;
    PageTable _table;
    std::optional<LineEditor> _line; ///< while a query is being typed
    std::string_view _note;          ///< about the latest key
};

} // namespace pallax::terminal
