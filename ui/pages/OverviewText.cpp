#include "ui/pages/OverviewText.h"

#include "overview/StatusWords.h"
#include "ui/contents/TimeOfDay.h"
#include "ui/drawing/Plot.h"
#include "ui/drawing/TextWidth.h"
#include "ui/drawing/Tints.h"
#include "ui/pages/EventText.h"

#include <algorithm>
#include <cmath>
#include <string_view>
#include <utility>

namespace pallax::terminal {

namespace {

constexpr int kBetweenCells = 2; // columns of a table
constexpr int kBarColumns = 8;
constexpr int kMostCurveColumns = 24;
constexpr int kFewestCurveColumns = 12; // fewer tell nothing
constexpr int kNameColumns = 12;        // of a block's name beside its rows
constexpr int kLeastBeside = 60;        // a narrower column has the names above the rows
constexpr int kTall = 30;               // rows that have room for blank ones and longer lists
constexpr Style kName{.bold = true};
constexpr Style kPale{.dim = true};

/// One cell of a table.
struct TableText {
    std::string text;
    Style style = {};
    bool isNumber = false; ///< at the right edge of its column
};

/// A named group of rows.
struct Block {
    std::string name;
    std::vector<TextRow> rows = {};
    std::size_t least = static_cast<std::size_t>(-1); ///< rows that are never left out
    bool namesItself = false;                         ///< its rows can do without its name
};

/// Makes the blocks of an overview, with rows of at most `columns` columns.
class Blocks {
public:
    Blocks(const Overview& overview, const Marks& marks, int columns)
        : _overview(overview), _status(overview.status), _marks(marks), _columns(columns) {}

    Block network() const;
    std::vector<Block> cells() const;
    Block levels() const;
    Block states() const;
    Block neighbours(std::size_t most) const;
    Block contexts() const;
    Block events() const;

private:
    std::string systemOf(const std::string& system) const {
        return _status.cells.size() > 1 ? system + " " : std::string();
    }
    std::vector<TextRow> wrapped(const std::vector<std::string>& words) const;
    std::vector<TextRow> table(std::vector<std::vector<TableText>> rows) const;
    std::vector<TableText> levelCells(std::string name, const StatusValue& level) const;
    std::string bar(const StatusValue& level) const;
    std::string curve(const StatusValue& level, int columns) const;
    /// The columns beside such a table.
    int roomBeside(const std::vector<std::vector<TableText>>& rows) const;

    const Overview& _overview;
    const Status& _status;
    const Marks& _marks;
    int _columns;
};

/// Words in as many rows as they need, broken only between them.
std::vector<TextRow> Blocks::wrapped(const std::vector<std::string>& words) const {
    std::vector<TextRow> rows;
    int used = 0;
    for (const std::string& word : words) {
        if (word.empty()) {
            continue;
        }
        const int more = columnsOf(_marks.dot) + columnsOf(word);
        if (rows.empty() || used + more > _columns) {
            rows.push_back({{word}});
            used = columnsOf(word);
        } else {
            rows.back().push_back({std::string(_marks.dot), kPale});
            rows.back().push_back({word});
            used += more;
        }
    }
    return rows;
}

std::vector<int> widthsOf(const std::vector<std::vector<TableText>>& rows) {
    std::vector<int> widths;
    for (const auto& row : rows) {
        widths.resize(std::max(widths.size(), row.size()));
        for (std::size_t index = 0; index < row.size(); ++index) {
            widths[index] = std::max(widths[index], columnsOf(row[index].text));
        }
    }
    return widths;
}

int Blocks::roomBeside(const std::vector<std::vector<TableText>>& rows) const {
    int room = _columns;
    for (const int width : widthsOf(rows)) {
        room -= width > 0 ? width + kBetweenCells : 0;
    }
    return room;
}

/// Rows of cells with aligned columns. Columns that do not fit are left out, starting with the
/// last.
std::vector<TextRow> Blocks::table(std::vector<std::vector<TableText>> rows) const {
    const std::vector<int> widths = widthsOf(rows);
    std::vector<TextRow> shown;
    for (auto& row : rows) {
        TextRow& text = shown.emplace_back();
        int used = 0;
        for (std::size_t index = 0; index < row.size(); ++index) {
            TableText& cell = row[index];
            if (widths[index] == 0) {
                continue;
            }
            const int gap = used > 0 ? kBetweenCells : 0;
            if (used > 0 && used + gap + widths[index] > _columns) {
                break;
            }
            const auto spare = static_cast<std::size_t>(widths[index] - columnsOf(cell.text));
            const auto before = static_cast<std::size_t>(gap) + (cell.isNumber ? spare : 0);
            text.push_back({std::string(before, ' ')});
            text.push_back({std::move(cell.text), cell.style});
            text.push_back({std::string(cell.isNumber ? 0 : spare, ' ')});
            used += gap + widths[index];
        }
    }
    return shown;
}

std::string Blocks::bar(const StatusValue& level) const {
    const auto share = shareOf(level);
    std::string text;
    for (int column = 0; share && column < kBarColumns; ++column) {
        text += column < std::lround(*share * kBarColumns) ? _marks.barFull : _marks.barEmpty;
    }
    return text;
}

std::string Blocks::curve(const StatusValue& level, int columns) const {
    for (const Overview::LevelCurve& each : _overview.curves) {
        if (each.leaf.field == level.field && each.leaf.entry == level.entry) {
            return sparkline(_marks, each.curve, _overview.curvesFrom, _overview.curvesTo, columns);
        }
    }
    return "";
}

/// Name, level, quality and bar.
std::vector<TableText> Blocks::levelCells(std::string name, const StatusValue& level) const {
    const Style style = isOverdue(_status.time, level) ? kPale : Style();
    const Style quality = level.grade && !style.dim ? Style{.tint = tintOf(*level.grade)} : style;
    return {{std::move(name)},
            {level.text, style, true},
            {std::string(qualityWord(level)), quality},
            {bar(level), quality}};
}

Block Blocks::network() const {
    Block block{"Operator"};
    block.namesItself = true;
    if (_status.network) {
        block.rows = wrapped(
            {operatorWords(*_status.network), _status.network->isHome ? "home network" : ""});
    }
    return block;
}

std::vector<Block> Blocks::cells() const {
    std::vector<Block> blocks;
    for (const StatusCell& cell : _status.cells) {
        const bool isOnly = _status.cells.size() == 1;
        Block block{isOnly ? "Cell" : cell.system + " cell"};
        block.namesItself = isOnly;
        std::vector<const StatusValue*> parts;
        for (const StatusValue& part : cell.identity) {
            parts.push_back(&part);
        }
        std::vector<std::string> words = identityWords(cell);
        words.push_back(oldAgeWords(_status.time, parts));
        block.rows = wrapped(words);
        if (cell.channel) {
            words = channelWords(cell);
            words.insert(words.end(), cell.details.begin(), cell.details.end());
            words.push_back(oldAgeWords(_status.time, {&*cell.channel}));
            for (TextRow& row : wrapped(words)) {
                block.rows.push_back(std::move(row));
            }
        }
        blocks.push_back(std::move(block));
    }
    return blocks;
}

Block Blocks::levels() const {
    std::vector<std::vector<TableText>> rows;
    std::vector<const StatusValue*> levels;
    bool isGraded = false;
    for (const StatusCell& cell : _status.cells) {
        for (const StatusValue& level : cell.levels) {
            levels.push_back(&level);
            rows.push_back(levelCells(systemOf(cell.system) + level.name, level));
            rows.back().push_back({oldAgeWords(_status.time, {&level}), kPale});
            isGraded = isGraded || level.grade;
        }
    }
    const int room = std::min(roomBeside(rows), kMostCurveColumns);
    for (std::size_t row = 0; room >= kFewestCurveColumns && row < rows.size(); ++row) {
        rows[row].push_back({curve(*levels[row], room)});
    }
    Block block{"Levels", table(std::move(rows))};
    block.namesItself = true;
    if (isGraded) {
        block.rows.push_back({{"quality by the profile " + _status.profile, kPale}});
    }
    return block;
}

Block Blocks::states() const {
    std::vector<std::string> words;
    for (const StatusValue& state : _status.states) {
        words.push_back(stateWords(state));
    }
    return {"State", wrapped(words)};
}

Block Blocks::neighbours(std::size_t most) const {
    std::vector<std::vector<TableText>> rows;
    for (const StatusNeighbour& neighbour : _status.neighbours) {
        if (rows.size() == most) {
            break;
        }
        const StatusValue& level = neighbour.level;
        std::vector<TableText>& row = rows.emplace_back();
        row.push_back({systemOf(neighbour.system) + neighbour.cell});
        for (TableText& cell : levelCells(level.name, level)) {
            row.push_back(std::move(cell));
        }
        if (_overview.knowsAges) { // an age is worth more than the bar
            row.insert(row.end() - 1, {ageWords(_status.time - level.read), kPale, true});
        }
    }
    constexpr std::size_t kLeast = 3;
    return {"Neighbours", table(std::move(rows)), kLeast};
}

Block Blocks::contexts() const {
    std::vector<std::string> words;
    for (const StatusContext& context : _status.contexts) {
        words.push_back(contextWords(context));
    }
    return {"Contexts", wrapped(words)};
}

/// The latest first.
Block Blocks::events() const {
    constexpr std::size_t kLeast = 3;
    Block block{"Events", {}, kLeast};
    for (auto event = _overview.events.rbegin(); event != _overview.events.rend(); ++event) {
        block.rows.push_back({{timeOfDay(event->time, _overview.ahead) + "  ", kPale},
                              {eventWords(event->words, _marks)}});
    }
    return block;
}

/// Blocks below each other.
class Stack {
public:
    Stack(int columns, bool isSpaced) : _isBeside(columns >= kLeastBeside), _isSpaced(isSpaced) {}

    static int innerColumns(int columns) {
        return columns >= kLeastBeside ? columns - kNameColumns : columns;
    }
    void add(Block block) {
        if (!block.rows.empty()) {
            _blocks.push_back(std::move(block));
        }
    }
    /// At most `most` rows if lists can be shortened so far, the last list first.
    std::vector<TextRow> rows(std::size_t most) &&;

private:
    std::size_t height() const;
    bool hasHeading(const Block& block) const { return !_isBeside && !block.namesItself; }

    bool _isBeside;
    bool _isSpaced;
    std::vector<Block> _blocks;
};

std::size_t Stack::height() const {
    std::size_t height = _isSpaced && !_blocks.empty() ? _blocks.size() - 1 : 0;
    for (const Block& block : _blocks) {
        height += block.rows.size() + (hasHeading(block) ? 1 : 0);
    }
    return height;
}

std::vector<TextRow> Stack::rows(std::size_t most) && {
    for (auto block = _blocks.rbegin(); block != _blocks.rend(); ++block) {
        const std::size_t all = height();
        const std::size_t count = block->rows.size();
        const std::size_t least = std::min(block->least, count);
        const std::size_t beyond = all > most ? all - most : 0;
        block->rows.resize(std::max(least, count - std::min(beyond, count)));
    }
    std::vector<TextRow> rows;
    for (Block& block : _blocks) {
        if (_isSpaced && !rows.empty()) {
            rows.emplace_back();
        }
        if (hasHeading(block)) {
            rows.push_back({{block.name, kName}});
        }
        for (std::size_t index = 0; index < block.rows.size(); ++index) {
            TextRow row = std::move(block.rows[index]);
            if (_isBeside) {
                std::string name = index == 0 ? block.name : "";
                name.resize(kNameColumns, ' ');
                row.insert(row.begin(), {std::move(name), kName});
            }
            rows.push_back(std::move(row));
        }
    }
    return rows;
}

} // namespace

int OverviewText::rows() const {
    std::size_t most = 0;
    for (const Column& column : columns) {
        most = std::max(most, column.rows.size());
    }
    return static_cast<int>(most);
}

OverviewText overviewText(const Overview& overview, const Marks& marks, Span area, int rows) {
    constexpr int kLeastPerColumn = 70; // room for a table beside its name
    constexpr int kBetweenColumns = 3;
    const int all = area.right - area.left;
    const int count =
        std::clamp((all + kBetweenColumns) / (kLeastPerColumn + kBetweenColumns), 1, 3);
    const int columns = (all - (count - 1) * kBetweenColumns) / count;
    const bool isTall = rows >= kTall;
    const Blocks blocks(overview, marks, Stack::innerColumns(columns));
    std::vector<Stack> stacks(static_cast<std::size_t>(count), Stack(columns, isTall));
    stacks.front().add(blocks.network());
    for (Block& cell : blocks.cells()) {
        stacks.front().add(std::move(cell));
    }
    stacks.front().add(blocks.levels());
    Stack& lists = stacks[count > 1 ? 1 : 0];
    Stack& rest = count == 2 ? stacks.front() : stacks.back();
    rest.add(blocks.states());
    if (count > 1) {
        rest.add(blocks.contexts());
    }
    lists.add(blocks.neighbours(isTall ? 16 : 8));
    if (count == 1) {
        lists.add(blocks.contexts());
    }
    (count == 2 ? lists : rest).add(blocks.events());
    OverviewText text;
    int left = area.left;
    for (Stack& stack : stacks) {
        text.columns.push_back(
            {{left, left + columns},
             std::move(stack).rows(static_cast<std::size_t>(std::max(rows, 0)))});
        left += columns + kBetweenColumns;
    }
    return text;
}

} // namespace pallax::terminal
