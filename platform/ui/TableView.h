#pragma once

#include "platform/ui/Geometry.h"
#include "platform/ui/Views.h"

#include <cstddef>
#include <memory>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace pallax::ui {

enum class CellStyle {
    Plain = 0,
    /// A title on the left and a detail on the right.
    TitleAndDetail = 1,
};

enum class CellAccessory { None, DisclosureIndicator, Checkmark };

/// What a cell draws in its content area. The labels' frames are relative to the content area or,
/// with a scroll container, to its content.
struct CellContents {
    std::vector<const Label*> labels;
    const ScrollContainer* container = nullptr;
};

/// A row as it is shown. Derived classes may add labels and lay them out.
class TableCell {
public:
    TableCell(CellStyle style, std::string reuseIdentifier)
        : _style(style), _reuseIdentifier(std::move(reuseIdentifier)) {}
    virtual ~TableCell() = default;
    TableCell(const TableCell&) = delete;
    TableCell& operator=(const TableCell&) = delete;

    CellStyle style() const { return _style; }
    const std::string& reuseIdentifier() const { return _reuseIdentifier; }

    CellAccessory accessory() const { return _accessory; }
    void setAccessory(CellAccessory accessory) { _accessory = accessory; }

    /// The cell's own label, shown by plain cells.
    Label& textLabel() { return _textLabel; }
    const Label& textLabel() const { return _textLabel; }

    /// The content area, which a cell is laid out in: the table's when the cell was made. A front
    /// end that hands out a spare cell sets it first.
    const Rect& contentBounds() const { return _contentBounds; }
    void setContentBounds(const Rect& bounds) { _contentBounds = bounds; }

    /// Valid as long as the cell.
    virtual CellContents contents() const { return {{&_textLabel}, nullptr}; }

    /// The toolkit's default layout: the label fills the content area.
    virtual void layoutSubviews() { _textLabel.frame = _contentBounds; }

private:
    CellStyle _style;
    std::string _reuseIdentifier;
    CellAccessory _accessory = CellAccessory::None;
    Label _textLabel;
    Rect _contentBounds;
};

/// What a table shows: one section of rows. The table asks only for the rows it needs.
class TableSource {
public:
    virtual ~TableSource() = default;
    virtual std::size_t numberOfRows() const = 0;
    /// `row` is below numberOfRows().
    virtual std::shared_ptr<TableCell> cellForRow(std::size_t row) = 0;
    virtual void didSelectRow(std::optional<std::size_t> row) = 0;
};

/// A table on the screen. Its source outlives it.
class TableView {
public:
    virtual ~TableView() = default;
    /// A cell with this identifier that has left the screen, or null. The source fills it and lays
    /// it out in the content area that it has.
    virtual std::shared_ptr<TableCell> dequeueReusableCell(std::string_view identifier) = 0;
    /// The content area a new cell gets. It is the same for every accessory, which is drawn outside
    /// it. When the width changes, a front end asks the source for the cells again: a cell that it
    /// has is not laid out anew.
    virtual Rect contentBounds() const = 0;
    virtual void reloadData() = 0;
    virtual void deselectRow(std::size_t row, bool animated) = 0;
    virtual void sizeToFit() = 0;
};

} // namespace pallax::ui
