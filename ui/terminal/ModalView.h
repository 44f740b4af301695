#pragma once

#include "platform/ui/ModalScreen.h"
#include "ui/drawing/Box.h"
#include "ui/drawing/HitMap.h"

namespace pallax::terminal {

/// The part of a modal screen that receives keys while its text field is not edited.
enum class ModalFocus { Save, Cancel };

/// Draws the modal screen over the pane: the list, the text field, and the two buttons.
class ModalView {
public:
    ModalView(Grid& grid, const Marks& marks, HitMap& hits)
        : _grid(grid), _marks(marks), _hits(hits) {}

    void draw(ui::ModalScreen& screen, ModalFocus focus);

private:
    void drawList(ui::ModalScreen& screen, const Box& box, int rows);
    void drawField(ui::ModalScreen& screen, const Box& box, int y);
    void drawButtons(ui::ModalScreen& screen, const Box& box, int y, ModalFocus focus);

    Grid& _grid;
    const Marks& _marks;
    HitMap& _hits;
};

} // namespace pallax::terminal
