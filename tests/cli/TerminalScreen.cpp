#include "tests/cli/TerminalScreen.h"

#include "text/Format.h"

#include <vector>

namespace pallax::doubles {

namespace {

/// Saves and restores the window's title, which the emulator does not keep.
constexpr char kTitleStack = 't';

std::string& unknownOf(void* unknown) {
    return *static_cast<std::string*>(unknown);
}

std::string nameOf(const VTermColor& color) {
    if (VTERM_COLOR_IS_DEFAULT_FG(&color)) {
        return "default";
    }
    if (VTERM_COLOR_IS_INDEXED(&color)) {
        return std::to_string(color.indexed.idx);
    }
    return formatText("#%06x", {color.rgb.red << 16 | color.rgb.green << 8 | color.rgb.blue});
}

int switchScreen(VTermProp property, VTermValue* value, void* isOnOtherScreen) {
    if (property == VTERM_PROP_ALTSCREEN) {
        *static_cast<bool*>(isOnOtherScreen) = value->boolean != 0;
    }
    return 1;
}

int noteControl(unsigned char control, void* unknown) {
    unknownOf(unknown) += static_cast<char>(control);
    return 1;
}

int noteSequence(const char* /*leader*/, const long /*arguments*/[], int /*count*/,
                 const char* /*intermediate*/, char command, void* unknown) {
    if (command != kTitleStack) {
        unknownOf(unknown) += command;
    }
    return 1;
}

int noteString(const char* text, std::size_t length, void* unknown) {
    unknownOf(unknown).append(text, length);
    return 1;
}

int noteEscape(const char* letters, std::size_t length, void* unknown) {
    constexpr std::string_view kKnown = "()78=>"; // character sets, cursor, key pad
    if (kKnown.find(letters[0]) == std::string_view::npos) {
        unknownOf(unknown).append(letters, length);
    }
    return 1;
}

constexpr VTermScreenCallbacks kScreen = [] {
    VTermScreenCallbacks callbacks{};
    callbacks.settermprop = switchScreen;
    return callbacks;
}();
constexpr VTermParserCallbacks kNotUnderstood = [] {
    VTermParserCallbacks callbacks{};
    callbacks.control = noteControl;
    callbacks.csi = noteSequence;
    callbacks.osc = noteString;
    callbacks.dcs = noteString;
    return callbacks;
}();
constexpr VTermParserCallbacks kEscapes = [] {
    VTermParserCallbacks callbacks{};
    callbacks.escape = noteEscape;
    return callbacks;
}();

} // namespace

TerminalScreen::TerminalScreen(int columns, int rows)
    : _terminal(vterm_new(rows, columns)), _escapes(vterm_new(rows, columns)),
      _screen(vterm_obtain_screen(_terminal.get())) {
    vterm_set_utf8(_terminal.get(), 1);
    vterm_screen_enable_altscreen(_screen, 1);
    vterm_screen_set_callbacks(_screen, &kScreen, &_isOnOtherScreen);
    vterm_screen_set_unrecognised_fallbacks(_screen, &kNotUnderstood, &_unknown);
    vterm_screen_reset(_screen, 1);
    vterm_set_utf8(_escapes.get(), 1);
    vterm_parser_set_callbacks(_escapes.get(), &kEscapes, &_unknown);
}

void TerminalScreen::write(std::string_view bytes) {
    vterm_input_write(_terminal.get(), bytes.data(), bytes.size());
    vterm_input_write(_escapes.get(), bytes.data(), bytes.size());
}

std::string TerminalScreen::text() const {
    constexpr std::size_t kMostBytes = 4 * VTERM_MAX_CHARS_PER_CELL;
    int rows = 0;
    int columns = 0;
    vterm_get_size(_terminal.get(), &rows, &columns);
    std::string text;
    for (int row = 0; row < rows; ++row) {
        std::string line(kMostBytes * static_cast<std::size_t>(columns), '\0');
        line.resize(
            vterm_screen_get_text(_screen, line.data(), line.size(), {row, row + 1, 0, columns}));
        line.erase(line.find_last_not_of(' ') + 1);
        text += line + "\n";
    }
    return text;
}

std::string TerminalScreen::colorOf(const std::string& text) const {
    int rows = 0;
    int columns = 0;
    vterm_get_size(_terminal.get(), &rows, &columns);
    for (int row = 0; row < rows; ++row) {
        std::string line;
        std::vector<VTermColor> colors;
        for (int column = 0; column < columns; ++column) {
            VTermScreenCell cell{};
            (void)vterm_screen_get_cell(_screen, {row, column}, &cell);
            line += cell.chars[0] < 0x80 ? static_cast<char>(cell.chars[0]) : '?';
            colors.push_back(cell.fg);
        }
        const std::size_t at = line.find(text);
        if (at != std::string::npos) {
            return nameOf(colors[at]);
        }
    }
    return "";
}

void TerminalScreen::resize(int columns, int rows) {
    vterm_set_size(_terminal.get(), rows, columns);
}

} // namespace pallax::doubles
