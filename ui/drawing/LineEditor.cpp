#include "ui/drawing/LineEditor.h"

#include "text/Utf8.h"
#include "ui/drawing/TextWidth.h"

#include <utility>

namespace pallax::terminal {

void LineEditor::setText(std::string text) {
    _text = std::move(text);
    _cursor = _text.size();
}

bool LineEditor::handle(const KeyEvent& event) {
    switch (event.key) {
    case Key::Character:
        return event.character < U' ' ? handleControl(event.character) : insert(event.character);
    case Key::Left:
        _cursor = before();
        return true;
    case Key::Right:
        _cursor = after();
        return true;
    case Key::Home:
        _cursor = 0;
        return true;
    case Key::End:
        _cursor = _text.size();
        return true;
    case Key::Backspace:
        erase(before(), _cursor);
        return true;
    case Key::Delete:
        erase(_cursor, after());
        return true;
    default:
        return false;
    }
}

bool LineEditor::handleControl(char32_t character) {
    switch (character) {
    case controlKey('a'):
        _cursor = 0;
        return true;
    case controlKey('e'):
        _cursor = _text.size();
        return true;
    case controlKey('b'):
        _cursor = before();
        return true;
    case controlKey('f'):
        _cursor = after();
        return true;
    case controlKey('d'):
        erase(_cursor, after());
        return true;
    case controlKey('h'):
        erase(before(), _cursor);
        return true;
    case controlKey('k'):
        erase(_cursor, _text.size());
        return true;
    case controlKey('u'):
        erase(0, _cursor);
        return true;
    case controlKey('w'):
        erase(wordStart(), _cursor);
        return true;
    default:
        return false;
    }
}

bool LineEditor::insert(char32_t character) {
    constexpr char32_t kDelete = 0x7F; // the first control character after ASCII
    constexpr char32_t kNoBreakSpace = 0xA0;
    if ((character >= kDelete && character < kNoBreakSpace) || character > kLastCodePoint ||
        isSurrogate(character)) {
        return false;
    }
    std::string bytes;
    appendUtf8(bytes, character);
    if (_text.size() + bytes.size() <= kMaximumBytes) {
        _text.insert(_cursor, bytes);
        _cursor = boundaryFrom(_cursor + bytes.size());
    }
    return true;
}

void LineEditor::erase(std::size_t from, std::size_t to) {
    _text.erase(from, to - from);
    _cursor = from;
}

std::size_t LineEditor::before() const {
    std::size_t start = 0;
    for (const Cluster& cluster : clustersOf(std::string_view(_text).substr(0, _cursor))) {
        start = cluster.offset;
    }
    return start;
}

std::size_t LineEditor::after() const {
    const auto clusters = clustersOf(std::string_view(_text).substr(_cursor));
    return clusters.empty() ? _cursor : _cursor + clusters.front().bytes;
}

/// A lone combining character joins the character typed before it.
std::size_t LineEditor::boundaryFrom(std::size_t offset) const {
    for (const Cluster& cluster : clustersOf(_text)) {
        const std::size_t end = cluster.offset + cluster.bytes;
        if (end >= offset) {
            return end;
        }
    }
    return _text.size();
}

std::size_t LineEditor::wordStart() const {
    const std::string_view left = std::string_view(_text).substr(0, _cursor);
    const std::size_t lastOfWord = left.find_last_not_of(' ');
    if (lastOfWord == std::string_view::npos) {
        return 0;
    }
    return left.find_last_of(' ', lastOfWord) + 1; // npos + 1 is 0
}

} // namespace pallax::terminal
