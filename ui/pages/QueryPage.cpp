#include "ui/pages/QueryPage.h"

#include "ui/drawing/Prompt.h"
#include "ui/pages/EventText.h"

#include <utility>

namespace pallax::terminal {

namespace {

constexpr std::string_view kExample =
    "Ask in SQL, for example: select kind, count(*) from event group by kind. The table \"tables\" "
    "lists all tables.";
constexpr std::string_view kNothingToAsk = "There is nothing to ask yet: no packet has come.";
constexpr std::string_view kNoInstant = "The row has no packet and no time to go to.";
constexpr std::string_view kRunning = "The query is running.";
constexpr std::string_view kNoRows = "The query gave no rows.";

} // namespace

QueryPage::QueryPage(Surroundings surroundings)
    : _surroundings(std::move(surroundings)), _table(_surroundings.copy),
      _earlier(_surroundings.seams.earlier()), _sentence(kExample) {
    startTyping();
}

void QueryPage::startTyping() {
    _line.emplace();
    _recalled = _earlier.size();
}

PageAnswer QueryPage::handle(const KeyEvent& event) {
    _note.clear();
    if (_line) {
        return handleLine(event);
    }
    if (!_table.isTyping()) {
        if (event.key == Key::Enter) {
            return goToRow();
        }
        if (event.key == Key::Character && event.character == U';') {
            startTyping();
            return PageAnswer::Handled;
        }
    }
    return _table.handle(event);
}

PageAnswer QueryPage::handleLine(const KeyEvent& event) {
    const bool erasesNothing = event.key == Key::Backspace && _line->text().empty();
    if (event.key == Key::Escape || erasesNothing) {
        _line.reset();
        return _hasAnswer ? PageAnswer::Handled : PageAnswer::Closes;
    }
    switch (event.key) {
    case Key::Enter:
        if (_line->text().find_first_not_of(' ') != std::string::npos) {
            run(std::string(_line->text()));
        }
        break;
    case Key::Up:
    case Key::Down:
        recall(event.key == Key::Up);
        break;
    default:
        (void)_line->handle(event);
        break;
    }
    return PageAnswer::Handled;
}

void QueryPage::recall(bool isEarlier) {
    if (isEarlier ? _recalled == 0 : _recalled == _earlier.size()) {
        return;
    }
    if (_recalled == _earlier.size()) {
        _typed = _line->text();
    }
    _recalled = isEarlier ? _recalled - 1 : _recalled + 1;
    _line->setText(_recalled == _earlier.size() ? _typed : _earlier[_recalled]);
}

/// After a failure the line stays, so that it can be corrected.
void QueryPage::run(const std::string& query) {
    if (_earlier.empty() || _earlier.back() != query) {
        _earlier.push_back(query);
        _surroundings.seams.remember(query);
    }
    _recalled = _earlier.size();
    const Moment moment = _surroundings.moment();
    QueryAnswer answer{{}, std::string(kNothingToAsk), true};
    if (moment.timeline != nullptr) {
        _isRunning = true;
        answer = answerQuery(*moment.timeline, query, _surroundings.mayGoOn,
                             _surroundings.seams.addFunctions);
        _isRunning = false;
        addTimeOfDay(answer.table, _surroundings.ahead());
        for (TableRow& row : answer.table.rows) {
            for (TableCell& cell : row.cells) { // the words of events have an arrow
                cell.text = eventWords(std::move(cell.text), _surroundings.marks);
            }
        }
    }
    _sentence = std::move(answer.sentence);
    _hasAnswer = !answer.hasFailed;
    if (_hasAnswer && answer.table.rows.empty()) {
        _sentence = kNoRows;
    }
    _table.model().show(_hasAnswer ? std::move(answer.table) : TableContent());
    if (_hasAnswer) {
        _line.reset();
    }
}

PageAnswer QueryPage::goToRow() {
    const auto row = _table.model().cursorRow();
    const Moment moment = _surroundings.moment();
    if (!row || moment.timeline == nullptr) {
        return PageAnswer::Handled;
    }
    const auto packet = packetOf(_table.model().content(), *row, *moment.timeline);
    if (!packet) {
        _note = kNoInstant;
        return PageAnswer::Handled;
    }
    _surroundings.goTo(*packet);
    return PageAnswer::Closes;
}

void QueryPage::draw(const PageScreen& screen, const PageSurroundings& around) {
    PageTable::Words words{.title = "Query", .empty = _sentence};
    if (_isRunning) {
        words.empty = kRunning;
        words.message = kRunning;
    } else if (_table.model().cursorRow()) {
        words.message = _note.empty() ? _sentence : _note;
        words.hints = {{"; query", typed(U';')}, {"Enter go there", {.key = Key::Enter}}};
    } else {
        words.hints = {{"; query", typed(U';')}};
    }
    if (_line && !_isRunning) {
        words.prompt = {";", &*_line, {"Esc close", {.key = Key::Escape}}};
    }
    _table.draw(screen, around, words);
}

} // namespace pallax::terminal
