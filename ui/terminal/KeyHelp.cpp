#include "ui/terminal/KeyHelp.h"

#include <array>

namespace pallax::terminal {

namespace {

constexpr auto kKeyHelp = std::to_array<KeyHelp>({
    {"Up Down  k j", "one row up or down"},
    {"PgUp PgDn", "one page up or down"},
    {"Home End  g G", "first or last row"},
    {"Enter Right l", "open the row"},
    {"Right Left  l h", "scroll a long row"},
    {"Left h Backspace", "back"},
    {"Esc", "clear the filter, or back"},
    {"/", "filter rows by name or value"},
    {"o", "overview of the radio"},
    {"i Enter", "all about the value"},
    {"v V", "put it in the graph; open it"},
    {"+ -  Left Right", "zoom and read a curve"},
    {"s", "save a snapshot"},
    {"y", "copy the value"},
    {"R", "reconnect, drop old values"},
    {"Tab", "next field on the save screen"},
    {"Click, wheel", "open the row; scroll"},
    {"Ctrl-L", "redraw the screen"},
    {"Ctrl-Z", "suspend; fg resumes"},
    {"?", "this help"},
    {"q", "back; at the first pane, quit"},
    {"Ctrl-C", "quit"},
});

} // namespace

std::span<const KeyHelp> keyHelp() {
    return kKeyHelp;
}

} // namespace pallax::terminal
