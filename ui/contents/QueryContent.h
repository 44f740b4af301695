#pragma once

#include "app/table/TableModel.h"
#include "timeline/Moment.h"
#include "ui/contents/QueryAnswer.h"
#include "ui/contents/TimeOfDay.h"

#include <chrono>
#include <cstddef>
#include <cstdint>
#include <functional>
#include <optional>
#include <string>
#include <vector>

namespace pallax {

/// What queries need beside a timeline.
struct QuerySeams {
    /// The queries of earlier sessions, the oldest first.
    std::function<std::vector<std::string>()> earlier = [] { return std::vector<std::string>(); };
    std::function<void(const std::string&)> remember = [](const std::string& /*query*/) {};
    std::function<void(Database&, Timeline&)> addFunctions = [](Database& /*database*/,
                                                                Timeline& /*timeline*/) {};
};

/// What has become of the latest query.
enum class QueryState {
    NotAsked,
    NothingToAsk, ///< no packet has come
    Running,
    Failed,
    NoRows,
    Answered,
};

/// Asks the timeline in SQL; the answer is a table.
class QueryContent {
public:
    struct Surroundings {
        std::function<Moment()> moment;
        std::function<void(std::uint64_t packet)> goTo;
        /// Asked often during a query; false stops it.
        std::function<bool()> mayGoOn;
        QuerySeams seams;
        std::function<std::chrono::seconds()> ahead; ///< local time minus UTC
        Wording wording = sameWords;
    };

    explicit QueryContent(Surroundings surroundings)
        : _surroundings(std::move(surroundings)), _earlier(_surroundings.seams.earlier()) {
        startTyping();
    }

    /// The query that will be typed is a new one.
    void startTyping() { _recalled = _earlier.size(); }
    /// The query before the one in the line, which is `typed`, or the one after; nothing if there
    /// is none. After the latest comes what was typed.
    std::optional<std::string> recall(bool isEarlier, const std::string& typed);

    /// Without an answer, the table is empty.
    void run(const std::string& query, TableModel& table);
    QueryState state() const { return _state; }
    /// Whether the latest query was answered, if only by no rows.
    bool hasAnswer() const {
        return _state == QueryState::NoRows || _state == QueryState::Answered;
    }
    /// Why the query failed or was stopped, or that there are more rows; may be empty.
    const std::string& sentence() const { return _sentence; }

    enum class Went { There, NoRow, NoInstant };
    /// Goes to the packet, or the time, of the row under the cursor.
    Went goThere(const TableModel& table) const;

private:
    Surroundings _surroundings;
    std::vector<std::string> _earlier;
    std::size_t _recalled = 0; ///< which of them is in the line; their number: the typed one
    std::string _typed;        ///< the line before others were recalled
    QueryState _state = QueryState::NotAsked;
    std::string _sentence;
};

} // namespace pallax
