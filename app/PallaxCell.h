#pragma once

#include "platform/ui/TableView.h"

#include <memory>
#include <string>
#include <string_view>

namespace pallax {

namespace ui {
class TextMetrics;
}

/// A row of a pane. Two kinds share one reuse identifier, so a cell may have to show a node of
/// the other kind: a branch cell has no place for a value, and a leaf cell that shows a branch
/// keeps its scroll container as it was last laid out.
class PallaxCell final : public ui::TableCell {
public:
    /// What a cell was made for.
    enum class Kind {
        /// The key label directly in the content area.
        Branch,
        /// A sideways-scrolling container with the key label, then the value label.
        Leaf,
    };

    /// `metrics` outlives the cell.
    PallaxCell(Kind kind, std::string reuseIdentifier, const ui::TextMetrics& metrics);

    const std::shared_ptr<ui::Label>& key() const { return _key; }
    void setKey(std::shared_ptr<ui::Label> key) { _key = std::move(key); }
    /// Null in a branch cell.
    const std::shared_ptr<ui::Label>& value() const { return _value; }
    void setValue(std::shared_ptr<ui::Label> value) { _value = std::move(value); }
    /// The container that holds both labels, whose frames are places in its content; null in a
    /// branch cell.
    const std::shared_ptr<ui::ScrollContainer>& view() const { return _view; }

    /// The labels that it has; with a container, their places are in its content.
    ui::CellContents contents() const override;

    /// Lays out a branch row: the key alone, whatever else the cell has.
    void setLayoutKey();
    /// Lays out a leaf row: the value flush right, or behind the key in a row that scrolls.
    void setLayout();

private:
    /// The extent of a label's text; none for no label.
    ui::Size measured(const std::shared_ptr<ui::Label>& label) const;
    void placeKey(const ui::Size& extent);

    const ui::TextMetrics& _metrics;
    std::shared_ptr<ui::Label> _key;
    std::shared_ptr<ui::Label> _value;
    std::shared_ptr<ui::ScrollContainer> _view;
};

} // namespace pallax
