#include "query/CellTable.h"

#include "query/CellFinder.h"

#include <utility>

namespace pallax {

namespace {

const std::vector<Column>& cellColumns() {
    static const std::vector<Column> columns = {
        {"role", "TEXT"},         {"system", "TEXT"},
        {"identity", "TEXT"},     {"code", ""},
        {"channel", ""},          {"first_time", "INTEGER"},
        {"last_time", "INTEGER"}, {"packet", "INTEGER"},
        {"readings", "INTEGER"},  {"measure", "TEXT"},
        {"best_level", "REAL"},   {"last_level", "REAL"},
    };
    return columns;
}

using Cells = std::shared_ptr<const std::vector<FoundCell>>;

class CellRows final : public Rows {
public:
    enum Place : std::size_t {
        kRole,
        kSystem,
        kIdentity,
        kCode,
        kChannel,
        kFirst,
        kLast,
        kPacket,
        kReadings,
        kMeasure,
        kBest,
        kLatest
    };

    explicit CellRows(Cells cells) : _cells(std::move(cells)) {}

    bool next() override { return ++_next <= _cells->size(); }
    void give(std::size_t column, ColumnValue& value) const override {
        const FoundCell& cell = (*_cells)[_next - 1];
        switch (column) {
        case kRole:
            return value.text(wordOf(cell.role));
        case kSystem:
            return value.text(nameOf(cell.system));
        case kIdentity:
            return value.text(cell.identity);
        case kCode:
            return giveAny(cell.code, value);
        case kChannel:
            return giveAny(cell.channel, value);
        case kFirst:
            return value.integer(microseconds(cell.first));
        case kLast:
            return value.integer(microseconds(cell.last));
        case kPacket:
            return value.integer(static_cast<std::int64_t>(cell.packet));
        case kReadings:
            return value.integer(static_cast<std::int64_t>(cell.readings));
        default:
            return giveLevel(cell, column, value);
        }
    }

private:
    static void giveAny(const FieldValue& held, ColumnValue& value) {
        if (!std::isnan(held.number)) {
            value.integer(static_cast<std::int64_t>(held.number));
        } else if (!held.isEmpty()) {
            value.text(held.text());
        }
    }
    static void giveLevel(const FoundCell& cell, std::size_t column, ColumnValue& value) {
        if (!cell.hasLevel) {
            return;
        }
        if (column == kMeasure) {
            return value.text(infoOf(cellTermsOf(cell.system).level).name);
        }
        value.real(column == kBest ? cell.best : cell.latest);
    }

    Cells _cells;
    std::size_t _next = 0;
};

class CellTable final : public QueryTable {
public:
    explicit CellTable(Timeline& timeline) : _timeline(timeline) {}

    const std::vector<Column>& columns() const override { return cellColumns(); }
    double expectedRows() const override {
        constexpr double kSome = 100;
        return kSome;
    }
    std::unique_ptr<Rows> rows(const RowBounds& bounds) override {
        if (!_cells || _packets != _timeline.packets()) {
            RowBounds all;
            all.mayContinue = bounds.mayContinue;
            CellFinder finder(_timeline.fields(), _timeline.entries());
            SampleReader reader(_timeline, packetsIn(_timeline, all));
            while (reader.readMore()) {
                finder.take(reader.items());
            }
            _cells = std::make_shared<const std::vector<FoundCell>>(std::move(finder).found());
            _packets = _timeline.packets();
        }
        return std::make_unique<CellRows>(_cells);
    }

private:
    Timeline& _timeline;
    Cells _cells; ///< of the first `_packets`: a join asks for the rows again and again
    std::uint64_t _packets = 0;
};

} // namespace

std::unique_ptr<QueryTable> cellTable(Timeline& timeline) {
    return std::make_unique<CellTable>(timeline);
}

} // namespace pallax
