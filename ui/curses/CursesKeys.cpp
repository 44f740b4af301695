#include "ui/curses/CursesKeys.h"

#include "ui/curses/Curses.h"

#include <algorithm>
#include <array>

namespace pallax::terminal {

namespace {

struct Code {
    unsigned code;
    Key key;
};

constexpr auto kCodes = std::to_array<Code>({
    {KEY_UP, Key::Up},
    {KEY_DOWN, Key::Down},
    {KEY_LEFT, Key::Left},
    {KEY_RIGHT, Key::Right},
    {KEY_PPAGE, Key::PageUp},
    {KEY_NPAGE, Key::PageDown},
    {KEY_HOME, Key::Home},
    {KEY_END, Key::End},
    {KEY_ENTER, Key::Enter},
    {KEY_BACKSPACE, Key::Backspace},
    {KEY_DC, Key::Delete},
    {KEY_BTAB, Key::BackTab},
});

struct Sequence {
    std::string_view parameters;
    char32_t final;
    Key key;
};

/// The sequences of xterm, the console, rxvt and terminals compatible with them.
constexpr auto kSequences = std::to_array<Sequence>({
    {"", U'A', Key::Up},
    {"", U'B', Key::Down},
    {"", U'C', Key::Right},
    {"", U'D', Key::Left},
    {"", U'H', Key::Home},
    {"", U'F', Key::End},
    {"", U'Z', Key::BackTab},
    {"", U'M', Key::Enter},
    {"1", U'~', Key::Home},
    {"7", U'~', Key::Home},
    {"4", U'~', Key::End},
    {"8", U'~', Key::End},
    {"3", U'~', Key::Delete},
    {"5", U'~', Key::PageUp},
    {"6", U'~', Key::PageDown},
});

} // namespace

std::optional<KeyEvent> keyOfCode(unsigned code) {
    const auto* found = std::find_if(kCodes.begin(), kCodes.end(),
                                     [code](const Code& known) { return known.code == code; });
    if (found == kCodes.end()) {
        return std::nullopt;
    }
    return KeyEvent{.key = found->key};
}

std::optional<KeyEvent> keyOfSequence(std::string_view parameters, char32_t final) {
    const auto* found =
        std::find_if(kSequences.begin(), kSequences.end(), [&](const Sequence& known) {
            return known.parameters == parameters && known.final == final;
        });
    if (found == kSequences.end()) {
        return std::nullopt;
    }
    return KeyEvent{.key = found->key};
}

KeyEvent keyOfCharacter(char32_t character) {
    constexpr char32_t kEscape = 0x1B;
    constexpr char32_t kDelete = 0x7F; // sent by most terminals for the backspace key
    switch (character) {
    case U'\r':
    case U'\n':
        return {.key = Key::Enter};
    case U'\t':
        return {.key = Key::Tab};
    case U'\b':
    case kDelete:
        return {.key = Key::Backspace};
    case kEscape:
        return {.key = Key::Escape};
    default:
        return {.key = Key::Character, .character = character};
    }
}

} // namespace pallax::terminal
