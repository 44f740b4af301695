#include "inspecting/StatusText.h"

#include "decoding/DisplayJson.h"
#include "overview/StatusWords.h"
#include "text/Format.h"
#include "text/Printable.h"
#include "text/Utf8.h"

#include <algorithm>
#include <cmath>

namespace pallax {

namespace {

constexpr std::size_t kColumns = 80;
constexpr std::string_view kBetween = " · ";
constexpr std::size_t kLabelWidth = 12;
constexpr std::size_t kLines = 10;
/// With one row of each other kind, they fit in the lines.
constexpr std::size_t kCells = 4;
constexpr std::size_t kNeighbours = 3;

std::size_t widthOf(const std::string& text) {
    std::size_t width = 0;
    for (std::size_t at = 0; at < text.size(); at += utf8At(text, at).size) {
        ++width;
    }
    return width;
}

/// A text that is too wide ends in "…".
std::string fitted(const std::string& text) {
    std::size_t end = 0;
    for (std::size_t width = 1; width < kColumns && end < text.size(); ++width) {
        end += utf8At(text, end).size;
    }
    return widthOf(text) <= kColumns ? text : text.substr(0, end) + "…";
}

/// One line, or several if it is too wide.
struct Row {
    std::string label;
    std::vector<std::string> pieces = {};

    void add(std::string_view piece) {
        if (!piece.empty()) {
            appendPrintable(pieces.emplace_back(), piece);
        }
    }
    void add(std::string_view name, std::string_view text) {
        add(std::string(name) + " " + std::string(text));
    }
    void add(const std::vector<std::string>& all) {
        for (const std::string& piece : all) {
            add(piece);
        }
    }
    /// At most `most` lines, broken between pieces.
    std::vector<std::string> lines(std::size_t most) const {
        std::vector<std::string> lines{label};
        lines.back().append(label.empty() ? 0 : kLabelWidth - label.size(), ' ');
        bool isFirst = true;
        for (const std::string& piece : pieces) {
            const std::string joined = std::string(isFirst ? "" : kBetween) + piece;
            if (!isFirst && lines.size() < most &&
                widthOf(lines.back()) + widthOf(joined) > kColumns) {
                lines.push_back(std::string(kLabelWidth, ' ') + piece);
            } else {
                lines.back() += joined;
            }
            isFirst = false;
        }
        return lines;
    }
};

/// The rows of one status.
class StatusRows {
public:
    explicit StatusRows(const Status& status) : _status(status) {}

    std::vector<Row> rows(const StatusOrigin& origin) const;

private:
    std::string systemOf(const StatusCell& cell) const {
        return _status.cells.size() > 1 ? cell.system + " " : std::string();
    }
    static Row operatorRow(const StatusOperator& network);
    Row cellRow(const StatusCell& cell) const;
    Row levelRow() const;
    Row stateRow() const;
    Row neighbourRow() const;
    Row contextRow() const;

    const Status& _status;
};

std::vector<Row> StatusRows::rows(const StatusOrigin& origin) const {
    Row head;
    head.add(origin.title);
    head.add(localDateText(_status.time, origin.ahead));
    head.add(origin.name);
    std::vector<Row> rows{head};
    if (_status.network) {
        rows.push_back(operatorRow(*_status.network));
    }
    const std::size_t cells = _status.cells.size();
    const std::size_t shown = cells <= kCells ? cells : kCells - 1;
    for (std::size_t index = 0; index < shown; ++index) {
        rows.push_back(cellRow(_status.cells[index]));
    }
    if (shown < cells) {
        rows.push_back({"cells", {formatText("%zu more", {cells - shown})}});
    }
    for (Row& row : std::vector<Row>{levelRow(), stateRow(), neighbourRow(), contextRow()}) {
        rows.push_back(std::move(row));
    }
    std::erase_if(rows, [](const Row& row) { return row.pieces.empty(); });
    return rows;
}

Row StatusRows::operatorRow(const StatusOperator& network) {
    Row row{"operator"};
    row.add(operatorWords(network));
    row.add(network.isHome ? "home network" : "");
    if (!network.name.empty()) {
        row.add("name from", nameOf(network.source));
    }
    return row;
}

Row StatusRows::cellRow(const StatusCell& cell) const {
    Row row{systemOf(cell) + "cell"};
    row.add(identityWords(cell));
    std::vector<const StatusValue*> values;
    for (const StatusValue& part : cell.identity) {
        values.push_back(&part);
    }
    row.add(oldAgeWords(_status.time, values));
    if (!cell.channel) {
        return row;
    }
    row.add(channelWords(cell));
    row.add(oldAgeWords(_status.time, {&*cell.channel}));
    return row;
}

Row StatusRows::levelRow() const {
    Row row{"levels"};
    bool isGraded = false;
    const auto add = [&](const StatusCell& cell, std::size_t from, std::size_t to) {
        std::vector<const StatusValue*> values;
        for (std::size_t place = from; place < std::min(to, cell.levels.size()); ++place) {
            const StatusValue& level = cell.levels[place];
            std::string text = systemOf(cell) + level.name + " " + level.text;
            if (level.grade) {
                text.append(" ").append(qualityWord(level));
                isGraded = true;
            }
            row.add(text);
            values.push_back(&level);
        }
        row.add(oldAgeWords(_status.time, values));
    };
    // The first one of a cell is its strength. The end of the row may be cut off.
    const std::size_t first = _status.cells.size() > 1 ? 1 : 0;
    for (const StatusCell& cell : _status.cells) {
        add(cell, 0, first);
    }
    for (const StatusCell& cell : _status.cells) {
        add(cell, first, cell.levels.size());
    }
    if (isGraded) { // in front, where it is never cut off
        row.pieces.insert(row.pieces.begin(), "profile " + _status.profile);
    }
    return row;
}

Row StatusRows::stateRow() const {
    Row row{"state"};
    for (const StatusValue& state : _status.states) {
        row.add(stateWords(state));
    }
    return row;
}

Row StatusRows::neighbourRow() const {
    Row row{"neighbours"};
    std::vector<const StatusValue*> values;
    for (const StatusNeighbour& neighbour : _status.neighbours) {
        if (values.size() == kNeighbours) {
            break;
        }
        row.add(neighbour.cell, neighbour.level.text);
        values.push_back(&neighbour.level);
    }
    row.add(oldAgeWords(_status.time, values));
    return row;
}

Row StatusRows::contextRow() const {
    Row row{"contexts"};
    for (const StatusContext& context : _status.contexts) {
        row.add(contextWords(context));
    }
    return row;
}

PropertyList textOrNull(const std::string& text) {
    return text.empty() ? PropertyList() : PropertyList(text);
}

Dictionary objectOf(const StatusValue& value) {
    return Dictionary{
        {"name", value.name},
        {"field", value.field},
        {"text", value.text},
        {"number", std::isfinite(value.number) ? PropertyList::real(value.number) : PropertyList()},
        {"quality", value.grade ? PropertyList(std::string(nameOf(*value.grade))) : PropertyList()},
        {"read", isoTimeText(value.read)},
    };
}

Array objectsOf(const std::vector<StatusValue>& values) {
    Array objects;
    for (const StatusValue& value : values) {
        objects.emplace_back(objectOf(value));
    }
    return objects;
}

PropertyList operatorObject(const std::optional<StatusOperator>& network) {
    if (!network) {
        return {};
    }
    return Dictionary{
        {"mcc", network->code ? PropertyList(network->code->mcc) : PropertyList()},
        {"mnc", network->code ? PropertyList(network->code->mnc) : PropertyList()},
        {"name", textOrNull(network->name)},
        {"source", network->name.empty() ? PropertyList()
                                         : PropertyList(std::string(nameOf(network->source)))},
        {"country", textOrNull(network->country)},
        {"home", PropertyList::boolean(network->isHome)},
    };
}

Array cellObjects(const std::vector<StatusCell>& cells) {
    Array objects;
    for (const StatusCell& cell : cells) {
        objects.emplace_back(Dictionary{
            {"system", cell.system},
            {"site", textOrNull(cell.site)},
            {"identity", objectsOf(cell.identity)},
            {"channel", cell.channel ? PropertyList(objectOf(*cell.channel)) : PropertyList()},
            {"band", textOrNull(cell.band)},
            {"mhz", cell.megahertz ? PropertyList::real(*cell.megahertz) : PropertyList()},
            {"levels", objectsOf(cell.levels)},
        });
    }
    return objects;
}

} // namespace

void appendStatusText(std::string& out, const StatusOrigin& origin, const Status& status) {
    const std::vector<Row> rows = StatusRows(status).rows(origin);
    std::size_t spare = kLines - rows.size();
    for (const Row& row : rows) {
        const std::vector<std::string> lines = row.lines(spare + 1);
        spare -= lines.size() - 1;
        for (const std::string& line : lines) {
            out.append(fitted(line)).append("\n");
        }
    }
}

void appendStatusJson(std::string& out, const StatusOrigin& origin, const Status& status) {
    Array neighbours;
    for (const StatusNeighbour& neighbour : status.neighbours) {
        neighbours.emplace_back(Dictionary{{"system", neighbour.system},
                                           {"cell", neighbour.cell},
                                           {"level", objectOf(neighbour.level)}});
    }
    Array contexts;
    for (const StatusContext& context : status.contexts) {
        contexts.emplace_back(
            Dictionary{{"name", context.name}, {"state", textOrNull(context.state)}});
    }
    appendJson(out, Dictionary{
                        {"recording", origin.name},
                        {"time", isoTimeText(status.time)},
                        {"packet", origin.packet ? PropertyList::unsignedInteger(*origin.packet)
                                                 : PropertyList()},
                        {"technology", std::string(origin.technology)},
                        {"operator", operatorObject(status.network)},
                        {"cells", cellObjects(status.cells)},
                        {"profile", status.profile},
                        {"states", objectsOf(status.states)},
                        {"neighbours", std::move(neighbours)},
                        {"contexts", std::move(contexts)},
                    });
    out += '\n';
}

} // namespace pallax
