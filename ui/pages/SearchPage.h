#pragma once

#include "ui/contents/SearchContent.h"
#include "ui/pages/PageTable.h"

#include <string_view>
#include <utility>

namespace pallax::terminal {

/// A text that is typed in the last row, and everything that contains it, as a table.
class SearchPage {
public:
    SearchPage(SearchContent::Surroundings surroundings, PageTable::Copy copy)
        : _content(std::move(surroundings)), _table(std::move(copy)) {}

    PageAnswer handle(const KeyEvent& event);
    void draw(const PageScreen& screen, const PageSurroundings& around);

private:
    /// The content's scope is that of the latest search.
    void search(SearchScope scope) { _content.search(_table.model(), _line.text(), scope); }
    std::string_view wordsWithoutRows() const;

    SearchContent _content;
    PageTable _table;
    LineEditor _line;
};

} // namespace pallax::terminal
