#pragma once

#include "platform/ui/TableView.h"

#include <memory>
#include <string>
#include <string_view>

namespace pallax {

namespace ui {
class TextMetrics;
}

/// A row of a pane. Both kinds share one reuse identifier, so a cell may have to show a node of the
/// other kind: a branch cell has no value label, and a leaf cell that shows a branch keeps the last
/// layout of its scroll container.
class PallaxCell final : public ui::TableCell {
public:
    /// The kind of row that a cell was created for.
    enum class Kind {
        /// The key label directly in the content area.
        Branch,
        /// A sideways-scrolling container with the key label, then the value label.
        Leaf,
    };

    /// `metrics` must outlive the cell.
    PallaxCell(Kind kind, std::string reuseIdentifier, const ui::TextMetrics& metrics);

    const std::shared_ptr<ui::Label>& key() const { return _key; }
    void setKey(std::shared_ptr<ui::Label> key) { _key = std::move(key); }
    /// Null in a branch cell.
    const std::shared_ptr<ui::Label>& value() const { return _value; }
    void setValue(std::shared_ptr<ui::Label> value) { _value = std::move(value); }
    /// The container of both labels, whose frames are relative to its content; null in a branch
    /// cell.
    const std::shared_ptr<ui::ScrollContainer>& view() const { return _view; }

    /// The cell's labels; in a container, their frames are relative to its content.
    ui::CellContents contents() const override;

    /// Lays out a branch row: only the key, even if the cell has more.
    void setLayoutKey();
    /// Lays out a leaf row: the value is flush right, or follows the key in a row that scrolls.
    void setLayout();

private:
    /// The extent of a label's text; zero if there is no label.
    ui::Size measured(const std::shared_ptr<ui::Label>& label) const;
    void placeKey(const ui::Size& extent);

    const ui::TextMetrics& _metrics;
    std::shared_ptr<ui::Label> _key;
    std::shared_ptr<ui::Label> _value;
    std::shared_ptr<ui::ScrollContainer> _view;
};

} // namespace pallax
