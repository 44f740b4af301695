#include "tests/ui/terminal/StageFixture.h"

#include <gtest/gtest.h>

#include <string>

namespace pallax::terminal {
namespace {

/// The help over the first pane.
std::string screenOf(int columns, int rows, const Marks& marks = kUtf8Marks) {
    TerminalStage stage(marks);
    stage.tick(display());
    stage.frontEnd.setOrigin({"Zorell_LTE", "drive.pcap"});
    stage.type("?");
    const std::string screen = stage.screen(columns, rows);
    EXPECT_EQ(faultOf(stage.frontEnd.draw()), "");
    return screen;
}

TEST(HelpScreens, FillsTheComfortableScreen) {
    EXPECT_EQ(screenOf(80, 24), R"(
 Pallax       ┌ Keys ────────────────────────────────────────────┐ · drive.pcap
 ─────────────│ Up Down  k j      one row up or down             │─────────────
▌Serving Cell │ PgUp PgDn         one page up or down            │             ›
 Measured Neig│ Home End  g G     first or last row              │           3 ›
 Empty List   │ Enter Right l     open the row                   │             ›
 SIM Info     │ Right Left  l h   scroll a long row              │             ›
 Operator     │ Left h Backspace  back                           │     Example
              │ Esc               clear the filter, or back      │
              │ /                 filter rows by name or value   │
              │ f                 find a text in all values      │
              │ t                 a list as a table or as rows   │
              │ < > r  x X        sort a table; hide columns     │
              │ o                 overview of the radio          │
              │ e ;               events; ask in SQL             │
              │ i Enter           all about the value            │
              │ v V               put it in the graph; open it   │
              │ Space             hold time; play on from there  │
              │ , .               one tick back or forward       │
              │ [ ]               to the event before or after   │
              │ { }               one minute back or forward     │
              │ ^ $               to the start; present or end   │
              │ :                 go to a time or a condition    │
 ─────────────│ n N               next or previous place found   │─────────────
 Updated 2023-└─────────────────────────────────────────── ↓ 12 ─┘ Save  ? help
)");
}

TEST(HelpScreens, FitsANarrowScreen) {
    EXPECT_EQ(screenOf(40, 20), R"(
 P┌ Keys ───────────────────────────┐ap
 ─│ Up Down  k j                    │──
▌S│  one row up or down             │  ›
 M│ PgUp PgDn                       │3 ›
 E│  one page up or down            │  ›
 S│ Home End  g G                   │  ›
 O│  first or last row              │e
  │ Enter Right l                   │
  │  open the row                   │
  │ Right Left  l h                 │
  │  scroll a long row              │
  │ Left h Backspace                │
  │  back                           │
  │ Esc                             │
  │  clear the filter, or back      │
  │ /                               │
  │  filter rows by name or value   │
  │ f                               │
 ─│  find a text in all values      │──
 U└────────────────────────── ↓ 50 ─┘lp
)");
}

TEST(HelpScreens, UsesAWideScreen) {
    EXPECT_EQ(screenOf(200, 60), R"(
 Pallax                                                                                                                                                                         Zorell_LTE · drive.pcap
 ──────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────
▌Serving Cell Measurements                                                                                                                                                                             ›
 Measured Neighbor Cells                                                                                                                                                                             3 ›
 Empty List                                                                                                                                                                                            ›
 SIM Info                                                                                                                                                                                              ›
 Operator                                                                                                                                                                                      Example





                                                                          ┌ Keys ────────────────────────────────────────────┐
                                                                          │ Up Down  k j      one row up or down             │
                                                                          │ PgUp PgDn         one page up or down            │
                                                                          │ Home End  g G     first or last row              │
                                                                          │ Enter Right l     open the row                   │
                                                                          │ Right Left  l h   scroll a long row              │
                                                                          │ Left h Backspace  back                           │
                                                                          │ Esc               clear the filter, or back      │
                                                                          │ /                 filter rows by name or value   │
                                                                          │ f                 find a text in all values      │
                                                                          │ t                 a list as a table or as rows   │
                                                                          │ < > r  x X        sort a table; hide columns     │
                                                                          │ o                 overview of the radio          │
                                                                          │ e ;               events; ask in SQL             │
                                                                          │ i Enter           all about the value            │
                                                                          │ v V               put it in the graph; open it   │
                                                                          │ Space             hold time; play on from there  │
                                                                          │ , .               one tick back or forward       │
                                                                          │ [ ]               to the event before or after   │
                                                                          │ { }               one minute back or forward     │
                                                                          │ ^ $               to the start; present or end   │
                                                                          │ :                 go to a time or a condition    │
                                                                          │ n N               next or previous place found   │
                                                                          │ m d               mark; changes since the mark   │
                                                                          │ ( )               play slower or faster          │
                                                                          │ s                 save a snapshot                │
                                                                          │ y                 copy the value                 │
                                                                          │ x                 safe: hide identities, or back │
                                                                          │ R                 reconnect, drop old values     │
                                                                          │ Click, wheel      open; scroll; drag time bar    │
                                                                          │ Ctrl-L            redraw the screen              │
                                                                          │ Ctrl-Z            suspend; fg resumes            │
                                                                          │ ?                 all keys                       │
                                                                          │ q                 back; at the first pane, quit  │
                                                                          │ Ctrl-C            quit                           │
                                                                          └──────────────────────────────────────────────────┘










 ──────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────────
 Updated 2023-11-14 at 22:13:20                                                                                                                                                / filter  s Save  ? help
)");
}

TEST(HelpScreens, NeedsOnlyAscii) {
    EXPECT_EQ(screenOf(80, 24, kAsciiMarks), R"(
 Pallax       + Keys --------------------------------------------+E, drive.pcap
 -------------| Up Down  k j      one row up or down             |-------------
>Serving Cell | PgUp PgDn         one page up or down            |             >
 Measured Neig| Home End  g G     first or last row              |           3 >
 Empty List   | Enter Right l     open the row                   |             >
 SIM Info     | Right Left  l h   scroll a long row              |             >
 Operator     | Left h Backspace  back                           |     Example
              | Esc               clear the filter, or back      |
              | /                 filter rows by name or value   |
              | f                 find a text in all values      |
              | t                 a list as a table or as rows   |
              | < > r  x X        sort a table; hide columns     |
              | o                 overview of the radio          |
              | e ;               events; ask in SQL             |
              | i Enter           all about the value            |
              | v V               put it in the graph; open it   |
              | Space             hold time; play on from there  |
              | , .               one tick back or forward       |
              | [ ]               to the event before or after   |
              | { }               one minute back or forward     |
              | ^ $               to the start; present or end   |
              | :                 go to a time or a condition    |
 -------------| n N               next or previous place found   |-------------
 Updated 2023-+------------------------------------------- v 12 -+ Save  ? help
)");
}

} // namespace
} // namespace pallax::terminal
