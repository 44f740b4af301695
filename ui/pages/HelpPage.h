#pragma once

#include "ui/drawing/Grid.h"
#include "ui/drawing/Keys.h"
#include "ui/drawing/Marks.h"
#include "ui/drawing/Scrolling.h"
#include "ui/pages/KeyHelp.h"

#include <optional>

namespace pallax::terminal {

/// The open help page and its scroll position.
class HelpPage {
public:
    bool isOpen() const { return _isOpen; }
    /// Lists the keys that work in this place.
    void open(HelpPlace place);
    /// The key of the page lists all keys. Arrows scroll if the page does not fit; any other key
    /// closes the page.
    void handle(const KeyEvent& event);
    void draw(Grid& grid, const Marks& marks);

private:
    bool _isOpen = false;
    std::optional<HelpPlace> _place; ///< nothing: all keys are listed
    Scrolling _scrolling;
};

} // namespace pallax::terminal
