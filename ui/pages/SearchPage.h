#pragma once

#include "ui/pages/PageTable.h"
#include "ui/pages/TextFinder.h"

#include <chrono>
#include <cstdint>
#include <functional>
#include <string>
#include <vector>

namespace pallax::terminal {

/// Where a search looks.
enum class SearchScope { Frame, Recording };

/// A text that is typed in the last row, and everything that contains it, as a table.
class SearchPage {
public:
    struct Surroundings {
        TextFinder& finder; ///< must outlive the page
        std::function<void(const std::string& text, const FoundRow& row)> goToRow;
        std::function<void(const std::string& text, std::uint64_t packet)> goToPacket;
        std::function<std::chrono::seconds()> ahead; ///< local time minus UTC
        const Marks& marks;
        PageTable::Copy copy;
    };

    explicit SearchPage(Surroundings surroundings)
        : _surroundings(std::move(surroundings)), _table(_surroundings.copy) {}

    PageAnswer handle(const KeyEvent& event);
    void draw(const PageScreen& screen, const PageSurroundings& around);

private:
    PageAnswer goThere();
    void search();
    void findRows();
    void findInstants();
    std::string_view wordsWithoutRows() const;

    Surroundings _surroundings;
    PageTable _table;
    LineEditor _line;
    SearchScope _scope = SearchScope::Frame;
    NodeRef _root; ///< of the frame that was searched
    std::vector<FoundRow> _rows;
    TextFinder::Instants _instants;
    bool _isCut = false; ///< there are more hits than are shown
    bool _isSearching = false;
};

} // namespace pallax::terminal
