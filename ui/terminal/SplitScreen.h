#pragma once

#include "ui/drawing/Grid.h"
#include "ui/drawing/HitMap.h"
#include "ui/drawing/Keys.h"
#include "ui/drawing/Marks.h"

#include <cstddef>
#include <functional>
#include <string>
#include <vector>

namespace pallax::terminal {

class FrontEnd;

/// The front ends of several modems on one screen: side by side where each has room, otherwise as
/// many as have room. One of them has the keyboard, and is always visible; a row above all of them
/// lists their numbers and names. A single front end has the whole screen to itself.
class SplitScreen {
public:
    struct Modem {
        std::string name;
        FrontEnd& frontEnd;
    };

    /// Two modems and the line between them fit into 160 columns.
    static constexpr int kLeastColumns = 79;

    /// There is at least one modem, and the first has the keyboard. `needsDisplay` requests a
    /// `draw` soon. The front ends must outlive the screen.
    SplitScreen(std::vector<Modem> modems, const Marks& marks, std::function<void()> needsDisplay);

    void resize(int columns, int rows);
    /// A key goes to the front end with the keyboard, except the one that moves the keyboard to the
    /// next modem (Ctrl-N). A click moves the keyboard to the modem at its place.
    void handle(const KeyEvent& event);
    Grid draw();

    /// Gives the keyboard to the modem with this number, from 1; nothing happens if there is none.
    void choose(std::size_t number);

    bool isAnimated() const;
    void turn();

private:
    /// Where a visible modem is.
    struct Side {
        std::size_t modem;
        int left;
        int columns;
    };

    FrontEnd& current() const { return _modems[_current].frontEnd; }
    void layOut();
    void drawList(Grid& grid);
    void drawSides(Grid& grid);
    void handleMouse(const KeyEvent& event);
    std::string label(std::size_t modem, bool withName) const;
    bool namesFit() const;

    std::vector<Modem> _modems;
    const Marks& _marks;
    std::function<void()> _needsDisplay;
    std::size_t _current = 0; ///< the modem with the keyboard
    std::size_t _first = 0;   ///< the leftmost visible modem
    std::vector<Side> _sides;
    HitMap _hits; ///< in the list
    int _columns = 80;
    int _rows = 24;
};

} // namespace pallax::terminal
