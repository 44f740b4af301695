#include "ui/contents/QueryContent.h"

#include <utility>

namespace pallax {

std::optional<std::string> QueryContent::recall(bool isEarlier, const std::string& typed) {
    if (isEarlier ? _recalled == 0 : _recalled == _earlier.size()) {
        return std::nullopt;
    }
    if (_recalled == _earlier.size()) {
        _typed = typed;
    }
    _recalled = isEarlier ? _recalled - 1 : _recalled + 1;
    return _recalled == _earlier.size() ? _typed : _earlier[_recalled];
}

void QueryContent::run(const std::string& query, TableModel& table) {
    if (_earlier.empty() || _earlier.back() != query) {
        _earlier.push_back(query);
        _surroundings.seams.remember(query);
    }
    startTyping();
    const Moment moment = _surroundings.moment();
    if (moment.timeline == nullptr) {
        _state = QueryState::NothingToAsk;
        _sentence.clear();
        return table.show({});
    }
    _state = QueryState::Running;
    QueryAnswer answer = answerQuery(*moment.timeline, query, _surroundings.mayGoOn,
                                     _surroundings.seams.addFunctions);
    addTimeOfDay(answer.table, _surroundings.ahead());
    for (TableRow& row : answer.table.rows) {
        for (TableCell& cell : row.cells) {
            cell.text = _surroundings.wording(std::move(cell.text));
        }
    }
    _sentence = std::move(answer.sentence);
    _state = answer.hasFailed            ? QueryState::Failed
             : answer.table.rows.empty() ? QueryState::NoRows
                                         : QueryState::Answered;
    table.show(answer.hasFailed ? TableContent() : std::move(answer.table));
}

QueryContent::Went QueryContent::goThere(const TableModel& table) const {
    const auto row = table.cursorRow();
    const Moment moment = _surroundings.moment();
    if (!row || moment.timeline == nullptr) {
        return Went::NoRow;
    }
    const auto packet = packetOf(table.content(), *row, *moment.timeline);
    if (!packet) {
        return Went::NoInstant;
    }
    _surroundings.goTo(*packet);
    return Went::There;
}

} // namespace pallax
