#include "ui/pages/SearchPage.h"

#include "ui/pages/EventText.h"

#include <algorithm>
#include <utility>

namespace pallax::terminal {

namespace {

constexpr std::string_view kTypeSomething = "Type a part of a name or a value.";
constexpr std::string_view kNotInFrame =
    "Nothing in this frame contains this text. Tab searches the whole recording.";
constexpr std::string_view kNotInRecording =
    "No event, name or value of the recording contains it.";
constexpr std::string_view kNothingToSearch = "There is nothing to search yet: no packet has come.";
constexpr std::string_view kSearching = "The recording is being searched.";
constexpr std::string_view kSearchStopped = "The search was stopped.";

} // namespace

PageAnswer SearchPage::handle(const KeyEvent& event) {
    const bool erasesNothing = event.key == Key::Backspace && _line.text().empty();
    if (event.key == Key::Escape || erasesNothing) {
        return PageAnswer::Closes;
    }
    if (event.key == Key::Enter) {
        return goThere();
    }
    if (event.key == Key::Tab) {
        _scope = _scope == SearchScope::Frame ? SearchScope::Recording : SearchScope::Frame;
        search();
        return PageAnswer::Handled;
    }
    const std::string before = _line.text();
    if (!_line.handle(event)) {
        (void)_table.table().handle(event); // moves the cursor
    } else if (_line.text() != before) {
        search();
    }
    return PageAnswer::Handled;
}

void SearchPage::search() {
    if (_scope == SearchScope::Frame) {
        findRows();
        _table.model().moveCursorTo(0);
    } else {
        findInstants();
    }
}

/// A row's key is its place, so that the cursor stays on it at the next tick.
void SearchPage::findRows() {
    _root = _surroundings.finder.root();
    _rows = _surroundings.finder.rows(_line.text());
    _isCut = _rows.size() > TextFinder::kMostHits;
    _rows.resize(std::min(_rows.size(), TextFinder::kMostHits));
    TableContent table{{{"Name", {}, true}, {"Value"}, {"Where"}}, {}, "hit", "hits"};
    for (const FoundRow& row : _rows) {
        std::string key;
        for (const std::size_t place : row.place) {
            key.append(std::to_string(place)).append(1, ' ');
        }
        table.rows.push_back({std::move(key), {{row.name}, {row.value}, {row.where}}});
    }
    _table.model().update(std::move(table), TableModel::Changes::Ignore);
}

/// The first time, it reads the whole recording, which may draw the screen.
void SearchPage::findInstants() {
    _isSearching = true;
    _instants = _surroundings.finder.instants(_line.text());
    _isSearching = false;
    const std::chrono::seconds ahead = _surroundings.ahead();
    TableContent table{{{"Time", {}, true}, {"Name"}, {"Value"}, {"Where"}}, {}, "hit", "hits"};
    _isCut = _instants.hits.size() > TextFinder::kMostHits;
    const std::size_t count = std::min(_instants.hits.size(), TextFinder::kMostHits);
    for (std::size_t index = 0; index < count; ++index) {
        const Appearances::Hit& hit = _instants.hits[index];
        const bool isEvent = hit.where.empty();
        std::string value = isEvent ? eventWords(hit.value, _surroundings.marks) : hit.value;
        table.rows.push_back(
            {std::to_string(index),
             {{eventTime(hit.time, ahead)}, {hit.name}, {std::move(value)}, {hit.where}}});
    }
    _table.model().show(std::move(table));
}

PageAnswer SearchPage::goThere() {
    if (_scope == SearchScope::Frame && _root != _surroundings.finder.root()) {
        findRows();
    }
    const auto row = _table.model().cursorRow();
    if (!row) {
        return PageAnswer::Handled;
    }
    if (_scope == SearchScope::Frame) {
        _surroundings.goToRow(_line.text(), _rows[*row]);
    } else {
        _surroundings.goToPacket(_line.text(), _instants.hits[*row].packet);
    }
    return PageAnswer::Closes;
}

std::string_view SearchPage::wordsWithoutRows() const {
    if (_isSearching) {
        return kSearching;
    }
    if (_line.text().empty()) {
        return kTypeSomething;
    }
    if (_scope == SearchScope::Frame) {
        return kNotInFrame;
    }
    if (_instants.isStopped) {
        return kSearchStopped;
    }
    return _surroundings.finder.moment().timeline == nullptr ? kNothingToSearch : kNotInRecording;
}

void SearchPage::draw(const PageScreen& screen, const PageSurroundings& around) {
    const bool isFrame = _scope == SearchScope::Frame;
    if (isFrame && _root != _surroundings.finder.root()) {
        findRows();
    }
    std::string title = isFrame ? "Find in this frame" : "Find in the whole recording";
    if (!isFrame && !_isSearching && _instants.isStopped) {
        title += " (stopped)";
    } else if (!isFrame && _instants.isFull) {
        title += " (not all values)";
    }
    if (_isCut && !_isSearching) {
        title += " (first 1,000 hits)";
    }
    PageTable::Words words{.title = title, .empty = wordsWithoutRows()};
    if (_isSearching) {
        words.message = kSearching;
    } else {
        words.prompt = {"find:",
                        &_line,
                        {isFrame ? "Tab whole recording" : "Tab this frame", {.key = Key::Tab}}};
    }
    _table.draw(screen, around, words);
}

} // namespace pallax::terminal
