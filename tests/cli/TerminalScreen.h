#pragma once

#include <memory>
#include <string>
#include <string_view>
#include <vterm.h>

namespace pallax::doubles {

/// The screen of an xterm after the bytes that were written to it.
class TerminalScreen {
public:
    TerminalScreen(int columns, int rows);
    TerminalScreen(const TerminalScreen&) = delete; // the emulator keeps a pointer to it
    TerminalScreen& operator=(const TerminalScreen&) = delete;

    void write(std::string_view bytes);
    /// The rows without trailing blanks, each with a line end.
    std::string text() const;
    /// The colour in which the first occurrence of a text begins: "default", the number of a
    /// palette's colour, or "#0087d7"; "" if the screen lacks the text. Of ASCII only.
    std::string colorOf(const std::string& text) const;
    bool isOnOtherScreen() const { return _isOnOtherScreen; }
    /// The escape and control sequences that the terminal did not understand.
    const std::string& unknown() const { return _unknown; }
    void resize(int columns, int rows);

private:
    struct Free {
        void operator()(VTerm* terminal) const { vterm_free(terminal); }
    };
    using Terminal = std::unique_ptr<VTerm, Free>;

    Terminal _terminal;
    /// A separate parser, because the terminal reports only unknown escapes of one letter.
    Terminal _escapes;
    VTermScreen* _screen;
    bool _isOnOtherScreen = false;
    std::string _unknown;
};

} // namespace pallax::doubles
