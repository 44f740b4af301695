#include "ui/terminal/ModalView.h"

#include "ui/drawing/TextWidth.h"
#include "ui/terminal/TerminalToolkit.h"

#include <algorithm>
#include <memory>
#include <string_view>

namespace pallax::terminal {

namespace {

constexpr std::string_view kTitle = "Save snapshot";
constexpr std::string_view kFieldName = "Description";
constexpr int kWidth = 76;
/// With fewer columns inside the frame, names and buttons are shortened.
constexpr int kNarrow = 28;
constexpr int kFieldAndButtons = 2;
constexpr int kBlankRows = 2; // above and below the field, if there is room

} // namespace

void ModalView::draw(ui::ModalScreen& screen, ModalFocus focus) {
    const int listRows = static_cast<int>(screen.numberOfRows());
    const Box box =
        centeredBox(_grid, kWidth, listRows + Box::kFrame + kFieldAndButtons + kBlankRows);
    drawBox(_grid, _marks, box, kTitle);
    _hits.clear(); // a modal screen covers all click areas
    _hits.add(0, 0, _grid.columns(), _grid.rows(), [&screen] { screen.backgroundTouched(); });
    const int inner = box.rows - Box::kFrame;
    const int shown = std::clamp(inner - kFieldAndButtons, 0, listRows);
    const bool hasBlanks = inner >= shown + kFieldAndButtons + kBlankRows;
    drawList(screen, box, shown);
    const int fieldRow = box.y + 1 + shown + (hasBlanks ? 1 : 0);
    drawField(screen, box, fieldRow);
    drawButtons(screen, box, fieldRow + (hasBlanks ? 2 : 1), focus);
}

void ModalView::drawList(ui::ModalScreen& screen, const Box& box, int rows) {
    TerminalTable& table = terminalTable(screen.list());
    table.setViewport(static_cast<std::size_t>(rows), rowContentBounds(box.columns - Box::kFrame));
    const Span inside = box.inside();
    for (int row = 0; row < rows; ++row) {
        const std::size_t index = table.firstShown() + static_cast<std::size_t>(row);
        if (index >= screen.numberOfRows()) {
            return;
        }
        const std::shared_ptr<ui::TableCell> cell = screen.cellForRow(index);
        const int y = box.y + 1 + row;
        if (cell->accessory() == ui::CellAccessory::Checkmark) {
            _grid.put(inside.left, y, _marks.check, {.bold = true}, inside);
        }
        for (const ui::Label* label : cell->contents().labels) {
            _grid.put(inside.left + 2, y, label->text, {}, inside);
        }
        _hits.add(box.x, y, box.columns, 1, [&screen, index] { screen.didSelectRow(index); });
    }
}

void ModalView::drawField(ui::ModalScreen& screen, const Box& box, int y) {
    TerminalTextField& field = terminalTextField(screen.field());
    const Span inside = box.inside();
    const bool isNarrow = inside.right - inside.left < kNarrow;
    Span room = inside;
    if (!isNarrow) {
        room.left = _grid.put(inside.left, y, kFieldName, {.bold = true}, inside) + 2;
    } else if (field.editor().text().empty()) {
        _grid.put(inside.left, y, kFieldName, {.dim = true}, inside);
    }
    const std::string& text = field.editor().text();
    const int cursor = columnsOf(std::string_view(text).substr(0, field.editor().cursor()));
    const int offset = std::max(room.left + cursor - (room.right - 1), 0);
    _grid.put(room.left - offset, y, text, {.underline = field.isEditing()}, room);
    if (field.isEditing()) {
        _grid.setCursor({room.left + cursor - offset, y});
    }
    _hits.add(box.x, y, box.columns, 1, [&field] { field.beginEditing(); });
}

void ModalView::drawButtons(ui::ModalScreen& screen, const Box& box, int y, ModalFocus focus) {
    const bool fieldHasKeys = terminalTextField(screen.field()).isEditing();
    const Span inside = box.inside();
    const bool isNarrow = inside.right - inside.left < kNarrow;
    const auto button = [&](int right, std::string_view text, ModalFocus own, auto press) {
        const bool hasFocus = !fieldHasKeys && focus == own;
        const int left = drawButton(_grid, right, y, buttonFace(text, isNarrow), hasFocus);
        _hits.add(left, y, right - left, 1, press);
        return left;
    };
    const int cancel =
        button(inside.right, "Cancel", ModalFocus::Cancel, [&screen] { screen.cancelPressed(); });
    button(cancel - 1, "Save", ModalFocus::Save, [&screen] { screen.savePressed(); });
}

} // namespace pallax::terminal
