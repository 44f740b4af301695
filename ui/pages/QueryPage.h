#pragma once

#include "timeline/Moment.h"
#include "ui/pages/PageTable.h"
#include "ui/pages/QueryAnswer.h"

#include <chrono>
#include <cstddef>
#include <cstdint>
#include <functional>
#include <optional>
#include <string>
#include <vector>

namespace pallax::terminal {

/// What queries need beside a timeline.
struct QuerySeams {
    /// The queries of earlier sessions, the oldest first.
    std::function<std::vector<std::string>()> earlier = [] { return std::vector<std::string>(); };
    std::function<void(const std::string&)> remember = [](const std::string& /*query*/) {};
    std::function<void(Database&, Timeline&)> addFunctions = [](Database& /*database*/,
                                                                Timeline& /*timeline*/) {};
};

/// Asks the timeline in SQL: a line that is typed in the last row, and the answer as a table.
class QueryPage {
public:
    struct Surroundings {
        std::function<Moment()> moment;
        std::function<void(std::uint64_t packet)> goTo;
        /// Asked often during a query; false stops it.
        std::function<bool()> mayGoOn;
        QuerySeams seams;
        std::function<std::chrono::seconds()> ahead; ///< local time minus UTC
        const Marks& marks;
        PageTable::Copy copy;
    };

    explicit QueryPage(Surroundings surroundings);

    PageAnswer handle(const KeyEvent& event);
    void draw(const PageScreen& screen, const PageSurroundings& around);

private:
    PageAnswer handleLine(const KeyEvent& event);
    void startTyping();
    /// Replaces the line by an earlier one, or a later one.
    void recall(bool isEarlier);
    void run(const std::string& query);
    PageAnswer goToRow();

    Surroundings _surroundings;
    PageTable _table;
    std::optional<LineEditor> _line; ///< while a query is being typed
    std::vector<std::string> _earlier;
    std::size_t _recalled = 0; ///< which of them is in the line; their number: the typed one
    std::string _typed;        ///< the line before others were recalled
    bool _hasAnswer = false;
    bool _isRunning = false;
    std::string _sentence; ///< about the latest query
    std::string _note;     ///< about the latest key
};

} // namespace pallax::terminal
