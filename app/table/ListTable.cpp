#include "app/table/ListTable.h"

#include "LogGenerator/Records/SampleValue.h"
#include "app/pane/PaneRow.h"
#include "text/AgeText.h"

#include <algorithm>
#include <utility>

namespace pallax {

namespace {

constexpr std::string_view kAnyEntry = "*";

/// The path of the fields of a list's entries, without their name: a number in the list's own path
/// is an entry of another list.
std::string entryPath(std::string_view list) {
    std::string path;
    for (std::size_t start = 1; start < list.size();) {
        const std::size_t end = std::min(list.find('/', start), list.size());
        const std::string_view part = list.substr(start, end - start);
        const bool isEntry = part.find_first_not_of("0123456789") == std::string_view::npos;
        path.append(1, '/').append(isEntry ? kAnyEntry : part);
        start = end + 1;
    }
    return path.append(1, '/').append(kAnyEntry);
}

/// A leaf with the unit that its text ends with.
struct LeafCell {
    TableCell cell;
    std::string unit;
};

LeafCell leafCell(const PallaxModelNode& leaf) {
    LeafCell made{{*textOf(leaf), numberOf(leaf), false}, {}};
    if (made.cell.number) {
        made.unit = leaf.value()->displayNumber()->unit();
    } else if (const auto number = numberTextIn(made.cell.text)) {
        made.cell.number = number->number;
        made.unit = number->unit;
    }
    return made;
}

TableCell branchCell(const PallaxModelNode& branch) {
    return {std::to_string(branch.childNodes()->size()), std::nullopt, true};
}

std::string withoutUnit(std::string text, std::string_view unit) {
    if (text.ends_with(unit)) {
        text.resize(text.size() - unit.size());
        text.resize(text.find_last_not_of(' ') + 1);
    }
    return text;
}

class ListReader {
public:
    ListReader(const std::string& path, const EntryPartAt& partAt)
        : _path(entryPath(path)), _partAt(partAt) {}

    TableContent read(const std::vector<NodeRef>& entries) {
        for (const NodeRef& entry : entries) {
            addColumns(*entry);
        }
        std::stable_partition(_columns.begin(), _columns.end(),
                              [](const Column& each) { return each.part != EntryPart::None; });
        TableContent table;
        const bool areCells = std::any_of(_columns.begin(), _columns.end(), [](const Column& each) {
            return each.part == EntryPart::Cell;
        });
        table.one = areCells ? "cell" : "entry";
        table.many = areCells ? "cells" : "entries";
        for (const Column& column : _columns) {
            table.columns.push_back({column.name, {}, column.part != EntryPart::None});
        }
        for (const NodeRef& entry : entries) {
            table.rows.push_back(rowOf(*entry));
        }
        for (std::size_t column = 0; column < _columns.size(); ++column) {
            moveUnit(table, column);
        }
        return table;
    }

private:
    struct Column {
        std::string name;
        EntryPart part = EntryPart::None;
        std::vector<std::string> units; ///< of its numbers, each once
    };

    /// A field that the entries before do not have comes after the one that it follows here.
    void addColumns(const PallaxModelNode& entry) {
        std::size_t place = 0;
        for (const NodeRef& child : *entry.childNodes()) {
            const std::size_t found = columnOf(child->displayName());
            if (found == _columns.size()) {
                _columns.insert(_columns.begin() + static_cast<std::ptrdiff_t>(place),
                                {child->displayName(), partOf(*child), {}});
            } else {
                place = found;
            }
            ++place;
        }
    }

    EntryPart partOf(const PallaxModelNode& child) const {
        return child.childNodes() == nullptr ? _partAt(childPath(_path, child.displayName()))
                                             : EntryPart::None;
    }

    std::size_t columnOf(std::string_view name) const {
        const auto found = std::find_if(_columns.begin(), _columns.end(),
                                        [name](const Column& each) { return each.name == name; });
        return static_cast<std::size_t>(found - _columns.begin());
    }

    /// Without identity columns, the place of an entry is its identity.
    TableRow rowOf(const PallaxModelNode& entry) {
        TableRow row{{}, std::vector<TableCell>(_columns.size())};
        for (const NodeRef& child : *entry.childNodes()) {
            const std::size_t column = columnOf(child->displayName());
            if (child->childNodes() != nullptr) {
                row.cells[column] = branchCell(*child);
                continue;
            }
            LeafCell leaf = leafCell(*child);
            std::vector<std::string>& units = _columns[column].units;
            if (leaf.cell.number &&
                std::find(units.begin(), units.end(), leaf.unit) == units.end()) {
                units.push_back(leaf.unit);
            }
            row.cells[column] = std::move(leaf.cell);
        }
        for (std::size_t column = 0; column < _columns.size(); ++column) {
            if (_columns[column].part != EntryPart::None) {
                row.key.append(row.cells[column].text).append(1, '\n');
            }
        }
        row.key = row.key.empty() ? entry.displayName() : row.key;
        return row;
    }

    /// The unit of all numbers of a column goes from the cells to the column.
    void moveUnit(TableContent& table, std::size_t column) const {
        const std::vector<std::string>& units = _columns[column].units;
        if (units.size() != 1 || units.front().empty()) {
            return;
        }
        table.columns[column].unit = units.front();
        for (TableRow& row : table.rows) {
            TableCell& cell = row.cells[column];
            if (cell.number) {
                cell.text = withoutUnit(std::move(cell.text), units.front());
            }
        }
    }

    std::string _path;
    const EntryPartAt& _partAt;
    std::vector<Column> _columns;
};

} // namespace

bool isTable(const PallaxModelNode& node) {
    if (!elementsOf(node)) {
        return false;
    }
    const std::vector<NodeRef>& entries = *node.childNodes();
    return std::all_of(entries.begin(), entries.end(), [](const NodeRef& entry) {
        return entry->childNodes() != nullptr && !entry->childNodes()->empty();
    });
}

TableContent tableOf(const PallaxModelNode& list, const std::string& path,
                     const EntryPartAt& partAt) {
    return ListReader(path, partAt).read(*list.childNodes());
}

std::vector<TableCell> agesOf(const PallaxModelNode& list, const std::string& path,
                              const LeafAgeAt& ageAt) {
    std::vector<TableCell> ages;
    for (const NodeRef& entry : *list.childNodes()) {
        const std::string place = childPath(path, entry->displayName());
        std::optional<std::chrono::nanoseconds> latest;
        for (const NodeRef& leaf : *entry->childNodes()) {
            const auto age = ageAt(childPath(place, leaf->displayName()));
            latest = age && (!latest || *age < *latest) ? age : latest;
        }
        ages.push_back(latest ? TableCell{ageText(*latest), static_cast<double>(latest->count())}
                              : TableCell());
    }
    return ages;
}

void addAges(TableContent& table, const std::vector<TableCell>& ages) {
    const bool isKnown = std::any_of(ages.begin(), ages.end(),
                                     [](const TableCell& age) { return age.number.has_value(); });
    if (!isKnown) {
        return;
    }
    table.columns.push_back({"age", {}, false, true});
    for (std::size_t row = 0; row < ages.size(); ++row) {
        table.rows[row].cells.push_back(ages[row]);
    }
}

} // namespace pallax
