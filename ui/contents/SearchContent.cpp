#include "ui/contents/SearchContent.h"

#include <algorithm>
#include <utility>

namespace pallax {

void SearchContent::search(TableModel& table, const std::string& text, SearchScope scope) {
    _text = text;
    _scope = scope;
    if (_scope == SearchScope::Frame) {
        findRows(table);
        table.moveCursorTo(0);
    } else {
        findInstants(table);
    }
}

void SearchContent::refresh(TableModel& table) {
    if (_scope == SearchScope::Frame && _root != _surroundings.finder.root()) {
        findRows(table);
    }
}

/// A row's key is its place, so that the cursor stays on it at the next tick.
void SearchContent::findRows(TableModel& table) {
    _root = _surroundings.finder.root();
    _rows = _surroundings.finder.rows(_text);
    _isCut = _rows.size() > TextFinder::kMostHits;
    _rows.resize(std::min(_rows.size(), TextFinder::kMostHits));
    TableContent content{{{"Name", {}, true}, {"Value"}, {"Where"}}, {}, "hit", "hits"};
    for (const FoundRow& row : _rows) {
        std::string key;
        for (const std::size_t place : row.place) {
            key.append(std::to_string(place)).append(1, ' ');
        }
        content.rows.push_back({std::move(key), {{row.name}, {row.value}, {row.where}}});
    }
    table.update(std::move(content), TableModel::Changes::Ignore);
}

void SearchContent::findInstants(TableModel& table) {
    _isSearching = true;
    _instants = _surroundings.finder.instants(_text);
    _isSearching = false;
    const std::chrono::seconds ahead = _surroundings.ahead();
    TableContent content{{{"Time", {}, true}, {"Name"}, {"Value"}, {"Where"}}, {}, "hit", "hits"};
    _isCut = _instants.hits.size() > TextFinder::kMostHits;
    const std::size_t count = std::min(_instants.hits.size(), TextFinder::kMostHits);
    for (std::size_t index = 0; index < count; ++index) {
        const Appearances::Hit& hit = _instants.hits[index];
        const bool isEvent = hit.where.empty();
        std::string value = isEvent ? _surroundings.wording(hit.value) : hit.value;
        content.rows.push_back(
            {std::to_string(index),
             {{timeOfDay(hit.time, ahead)}, {hit.name}, {std::move(value)}, {hit.where}}});
    }
    table.show(std::move(content));
}

bool SearchContent::goThere(TableModel& table) {
    refresh(table);
    const auto row = table.cursorRow();
    if (!row) {
        return false;
    }
    if (_scope == SearchScope::Frame) {
        _surroundings.goToRow(_text, _rows[*row]);
    } else {
        _surroundings.goToPacket(_text, _instants.hits[*row].packet);
    }
    return true;
}

SearchState SearchContent::state() const {
    if (_isSearching) {
        return SearchState::Searching;
    }
    if (_text.empty()) {
        return SearchState::NothingTyped;
    }
    if (_scope == SearchScope::Frame) {
        return _rows.empty() ? SearchState::NotInFrame : SearchState::Found;
    }
    if (!_instants.hits.empty()) {
        return SearchState::Found;
    }
    if (_instants.isStopped) {
        return SearchState::Stopped;
    }
    return _surroundings.finder.moment().timeline == nullptr ? SearchState::NothingToSearch
                                                             : SearchState::NotInRecording;
}

} // namespace pallax
