#include "ui/pages/QueryPage.h"

#include "ui/drawing/Prompt.h"

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

QueryPage::QueryPage(QueryContent::Surroundings surroundings, PageTable::Copy copy)
    : _content(std::move(surroundings)), _table(std::move(copy)) {
    startTyping();
}

void QueryPage::startTyping() {
    _line.emplace();
    _content.startTyping();
}

PageAnswer QueryPage::handle(const KeyEvent& event) {
    _note = {};
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
        return _content.hasAnswer() ? PageAnswer::Handled : PageAnswer::Closes;
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
    if (const auto query = _content.recall(isEarlier, _line->text())) {
        _line->setText(*query);
    }
}

/// After a failure the line stays, so that it can be corrected.
void QueryPage::run(const std::string& query) {
    _content.run(query, _table.model());
    if (_content.hasAnswer()) {
        _line.reset();
    }
}

PageAnswer QueryPage::goToRow() {
    const QueryContent::Went went = _content.goThere(_table.model());
    if (went == QueryContent::Went::NoInstant) {
        _note = kNoInstant;
    }
    return went == QueryContent::Went::There ? PageAnswer::Closes : PageAnswer::Handled;
}

/// About the latest query.
std::string_view QueryPage::words() const {
    switch (_content.state()) {
    case QueryState::NotAsked:
        return kExample;
    case QueryState::NothingToAsk:
        return kNothingToAsk;
    case QueryState::Running:
        return kRunning;
    case QueryState::NoRows:
        return kNoRows;
    case QueryState::Failed:
    case QueryState::Answered:
        break;
    }
    return _content.sentence();
}

void QueryPage::draw(const PageScreen& screen, const PageSurroundings& around) {
    const bool isRunning = _content.state() == QueryState::Running;
    PageTable::Words words{.title = "Query", .empty = this->words()};
    if (isRunning) {
        words.message = kRunning;
    } else if (_table.model().cursorRow()) {
        words.message = _note.empty() ? this->words() : _note;
        words.hints = {{"; query", typed(U';')}, {"Enter go there", {.key = Key::Enter}}};
    } else {
        words.hints = {{"; query", typed(U';')}};
    }
    if (_line && !isRunning) {
        words.prompt = {";", &*_line, {"Esc close", {.key = Key::Escape}}};
    }
    _table.draw(screen, around, words);
}

} // namespace pallax::terminal
