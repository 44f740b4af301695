#include "decoding/TableOutput.h"

#include "app/tree/ShownEntries.h"
#include "console/TextTable.h"
#include "fields/FieldRegistry.h"

#include <algorithm>

namespace pallax {

namespace {

struct Cell {
    std::string text;
    std::string number = {}; ///< without its unit; empty if the text is not a number
    std::string unit = {};
};

bool isContainer(const PropertyList& value) {
    return value.dictionary() != nullptr || value.array() != nullptr;
}

bool isNumber(std::string_view text) {
    return !text.empty() && text.find_first_not_of("+-.0123456789") == std::string_view::npos;
}

Cell cellOf(const PropertyList& value) {
    if (isContainer(value)) {
        const std::size_t entries = value.array() != nullptr
                                        ? value.array()->size()
                                        : shownEntries(*value.dictionary()).size();
        return {std::to_string(entries) + (entries == 1 ? " entry" : " entries")};
    }
    Cell cell{textOfValue(value)};
    if (const DisplayNumber* number = value.displayNumber()) {
        appendBareNumber(cell.number, *number);
        cell.unit = number->unit();
        return cell;
    }
    // A text of an object stream may be a number and a unit, too.
    const std::size_t blank = cell.text.find(' ');
    if (isNumber(std::string_view(cell.text).substr(0, blank))) {
        cell.number = cell.text.substr(0, blank);
        cell.unit = blank != std::string::npos ? cell.text.substr(blank + 1) : "";
    }
    return cell;
}

/// The columns of a table, which grow with its rows.
class Columns {
public:
    void beginRow() { ++_rows; }
    void add(std::string_view name, const PropertyList& value) { add(name, cellOf(value)); }
    void add(std::string_view name, Cell cell) {
        auto column = std::find_if(_columns.begin(), _columns.end(),
                                   [name](const Column& each) { return each.name == name; });
        if (column == _columns.end()) {
            column = _columns.insert(_columns.end(), Column{std::string(name), {}});
        }
        column->cells.resize(_rows);
        column->cells.back() = std::move(cell);
    }
    TextTable table() {
        std::vector<std::string> head;
        std::vector<std::vector<std::string>> rows(_rows);
        for (Column& column : _columns) {
            const std::string unit = column.unit();
            head.push_back(unit.empty() ? column.name : column.name + " (" + unit + ")");
            column.cells.resize(_rows);
            for (std::size_t row = 0; row < _rows; ++row) {
                const Cell& cell = column.cells[row];
                rows[row].push_back(unit.empty() || cell.number.empty() ? cell.text : cell.number);
            }
        }
        TextTable table;
        table.setHead(std::move(head));
        for (auto& row : rows) {
            table.add(std::move(row));
        }
        return table;
    }

private:
    struct Column {
        std::string name;
        std::vector<Cell> cells;

        /// The unit of all numbers; empty if they have none, or several.
        std::string unit() const {
            std::string unit;
            for (const Cell& cell : cells) {
                const bool isOther = !unit.empty() && cell.unit != unit;
                if (!cell.number.empty() && (isOther || cell.unit.empty())) {
                    return {};
                }
                unit = cell.unit.empty() ? unit : cell.unit;
            }
            return unit;
        }
    };

    std::vector<Column> _columns;
    std::size_t _rows = 0;
};

constexpr std::string_view kNameColumn = "Name";
constexpr std::string_view kValueColumn = "Value";

void addEntry(Columns& columns, const PropertyList& entry) {
    if (const DictionaryRef values = entry.dictionary()) {
        for (const ShownEntry& value : shownEntries(*values)) {
            columns.add(value.name, *value.value);
        }
    } else {
        columns.add(kValueColumn, entry);
    }
}

} // namespace

TableOutput::TableOutput(Output& output, std::string_view section, std::string_view technology)
    : _output(output), _section(fieldWord(section)) {
    const std::string prefix = std::string(technology) + "_";
    if (_section.starts_with(prefix) && section.size() > technology.size() &&
        section[technology.size()] == '.') {
        _section.erase(0, prefix.size());
    }
}

bool TableOutput::isAskedFor(std::string_view section) const {
    return fieldWord(section) == _section;
}

void TableOutput::show(const DisplayMoment& /*moment*/, const PropertyList& display) {
    visit(display, "");
}

void TableOutput::visit(const PropertyList& value, const std::string& name) {
    if (!name.empty()) {
        _sections.push_back(fieldWord(name));
        if (!_isWritten && isAskedFor(name)) {
            write(value);
        }
    }
    if (const DictionaryRef entries = value.dictionary()) {
        for (const ShownEntry& entry : shownEntries(*entries)) {
            if (isContainer(*entry.value)) {
                visit(*entry.value, name + (name.empty() ? "" : " ") + std::string(entry.name));
            }
        }
    }
}

void TableOutput::write(const PropertyList& section) {
    Columns columns;
    if (const ArrayRef elements = section.array()) {
        for (const PropertyList& element : *elements) {
            columns.beginRow();
            addEntry(columns, element);
        }
        _isWritten = !elements->empty();
    } else {
        const std::vector<ShownEntry> entries = shownEntries(*section.dictionary());
        const bool isList = std::all_of(entries.begin(), entries.end(), [](const auto& entry) {
            return entry.value->dictionary() != nullptr;
        });
        for (const ShownEntry& entry : entries) {
            columns.beginRow();
            columns.add(kNameColumn, Cell{std::string(entry.name)});
            if (isList) {
                addEntry(columns, *entry.value);
            } else {
                columns.add(kValueColumn, Cell{cellOf(*entry.value).text});
            }
        }
        _isWritten = !entries.empty();
    }
    if (_isWritten) {
        columns.table().appendTo(_output.text());
        _output.lineDone();
    }
}

} // namespace pallax
