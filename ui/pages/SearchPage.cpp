#include "ui/pages/SearchPage.h"

#include <string>

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
        return _content.goThere(_table.model()) ? PageAnswer::Closes : PageAnswer::Handled;
    }
    if (event.key == Key::Tab) {
        search(_content.scope() == SearchScope::Frame ? SearchScope::Recording
                                                      : SearchScope::Frame);
        return PageAnswer::Handled;
    }
    const std::string before = _line.text();
    if (!_line.handle(event)) {
        (void)_table.table().handle(event); // moves the cursor
    } else if (_line.text() != before) {
        search(_content.scope());
    }
    return PageAnswer::Handled;
}

std::string_view SearchPage::wordsWithoutRows() const {
    switch (_content.state()) {
    case SearchState::NothingTyped:
        return kTypeSomething;
    case SearchState::NotInFrame:
        return kNotInFrame;
    case SearchState::NotInRecording:
        return kNotInRecording;
    case SearchState::NothingToSearch:
        return kNothingToSearch;
    case SearchState::Searching:
        return kSearching;
    case SearchState::Stopped:
        return kSearchStopped;
    case SearchState::Found:
        break;
    }
    return "";
}

void SearchPage::draw(const PageScreen& screen, const PageSurroundings& around) {
    _content.refresh(_table.model());
    const bool isFrame = _content.scope() == SearchScope::Frame;
    std::string title = isFrame ? "Find in this frame" : "Find in the whole recording";
    if (_content.isStopped() && !_content.isSearching()) {
        title += " (stopped)";
    } else if (_content.isFull()) {
        title += " (not all values)";
    }
    if (_content.isCut() && !_content.isSearching()) {
        title += " (first 1,000 hits)";
    }
    PageTable::Words words{.title = title, .empty = wordsWithoutRows()};
    if (_content.isSearching()) {
        words.message = kSearching;
    } else {
        words.prompt = {"find:",
                        &_line,
                        {isFrame ? "Tab whole recording" : "Tab this frame", {.key = Key::Tab}}};
    }
    _table.draw(screen, around, words);
}

} // namespace pallax::terminal
