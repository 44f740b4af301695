#pragma once

#include "ui/drawing/Keys.h"

#include <cstddef>
#include <string>
#include <string_view>

namespace pallax::terminal {

/// An editor for one line of UTF-8 text, with a cursor between characters. A character and the
/// combining characters after it are moved over and deleted as one.
class LineEditor {
public:
    /// Text typed beyond this length is ignored.
    static constexpr std::size_t kMaximumBytes = 4096;

    const std::string& text() const { return _text; }
    /// The cursor's offset in bytes.
    std::size_t cursor() const { return _cursor; }
    /// Replaces the text and moves the cursor to its end.
    void setText(std::string text);

    /// Handles an editing key; false for other keys. Besides the arrows, Home, End, Backspace and
    /// Delete, these are Ctrl-A, -E, -B, -F, -D, -H, -K, -U and -W, as in a shell.
    bool handle(const KeyEvent& event);

private:
    bool handleControl(char32_t character);
    bool insert(char32_t character);
    void erase(std::size_t from, std::size_t to);
    std::size_t before() const;
    std::size_t after() const;
    /// The first boundary between characters at or after `offset`.
    std::size_t boundaryFrom(std::size_t offset) const;
    std::size_t wordStart() const;

    std::string _text;
    std::size_t _cursor = 0;
};

} // namespace pallax::terminal
