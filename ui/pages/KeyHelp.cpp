#include "ui/pages/KeyHelp.h"

#include <array>

namespace pallax::terminal {

namespace {

constexpr auto kPanes = static_cast<unsigned>(HelpPlace::Panes);
constexpr auto kPages = static_cast<unsigned>(HelpPlace::Pages);
constexpr auto kModems = static_cast<unsigned>(HelpPlace::Modems);
constexpr auto kSave = static_cast<unsigned>(HelpPlace::Save);

constexpr auto kKeyHelp = std::to_array<KeyHelp>({
    {"Up Down  k j", "one row up or down", kPanes | kPages},
    {"PgUp PgDn", "one page up or down"},
    {"Home End  g G", "first or last row", kPanes | kPages},
    {"Enter Right l", "open the row", kPanes},
    {"Right Left  l h", "scroll a long row", kPanes},
    {"Left h Backspace", "back", kPanes | kPages},
    {"Esc", "clear the filter, or back"},
    {"/", "filter rows by name or value", kPanes},
    {"f", "find a text in all values", kPanes | kPages},
    {"t", "a list as a table or as rows", kPanes},
    {"< > r  x X", "sort a table; hide columns", kPanes},
    {"o", "overview of the radio", kPanes | kPages},
    {"e ;", "events; ask in SQL", kPanes | kPages},
    {"i Enter", "all about the value", kPanes},
    {"v V", "put it in the graph; open it", kPanes | kPages},
    {"+ -  Left Right", "zoom and read a curve", kPages},
    {"Space", "hold time; play on from there", kPanes | kPages},
    {", .", "one tick back or forward", kPanes | kPages},
    {"[ ]", "to the event before or after", kPanes | kPages},
    {"{ }", "one minute back or forward", kPanes | kPages},
    {"^ $", "to the start; present or end", kPanes | kPages},
    {":", "go to a time or a condition", kPanes | kPages},
    {"n N", "next or previous place found", kPanes | kPages},
    {"m d", "mark; changes since the mark", kPanes | kPages},
    {"( )", "play slower or faster", kPanes | kPages},
    {"s", "save a snapshot", kPanes | kPages},
    {"y", "copy the value", kPanes},
    {"x", "safe: hide identities, or back", kPanes | kPages},
    {"R", "reconnect, drop old values", kPanes | kPages},
    {"1-9", "one of several modems", kModems},
    {"Ctrl-N", "the next of several modems", kModems},
    {"Tab", "next field on the save screen", kSave},
    {"Click, wheel", "open; scroll; drag time bar"},
    {"Ctrl-L", "redraw the screen"},
    {"Ctrl-Z", "suspend; fg resumes"},
    {"?", "this help"},
    {"q", "back; at the first pane, quit", kPanes | kPages},
    {"Ctrl-C", "quit"},
});

} // namespace

std::span<const KeyHelp> keyHelp() {
    return kKeyHelp;
}

} // namespace pallax::terminal
