#include "query/SampleTable.h"

#include "query/SampleReader.h"

#include <utility>

namespace pallax {

namespace {

const std::vector<Column>& sampleColumns() {
    static const std::vector<Column> columns = {
        {"time", "INTEGER", Column::Role::TimeStamp},
        {"packet", "INTEGER", Column::Role::PacketNumber},
        {"field", "TEXT", Column::Role::FieldName},
        {"entry", "TEXT"},
        {"raw", "INTEGER"},
        {"number", "REAL"},
        {"text", "TEXT"},
        {"unit", "TEXT"},
    };
    return columns;
}

class SampleRows final : public Rows {
public:
    enum Place : std::size_t { kTime, kPacket, kField, kEntry, kRaw, kNumber, kText, kUnit };

    SampleRows(Timeline& timeline, const PacketRange& range, std::optional<FieldIndex> field)
        : _timeline(timeline), _reader(timeline, range, field) {}

    bool next() override {
        ++_place;
        while (_place >= _reader.items().size()) {
            if (!_reader.readMore()) {
                return false;
            }
            _place = 0;
        }
        return true;
    }
    std::int64_t number(std::int64_t /*place*/) const override {
        return _reader.items()[_place].number();
    }
    void give(std::size_t column, ColumnValue& value) const override {
        const SampleReader::Item& item = _reader.items()[_place];
        switch (column) {
        case kTime:
            return value.integer(microseconds(item.time));
        case kPacket:
            return value.integer(static_cast<std::int64_t>(item.packet));
        case kField:
            return value.text(_timeline.fields()[item.field].name);
        case kEntry:
            return item.entry != kNoEntry ? value.text(_timeline.entries().words(item.entry))
                                          : void();
        case kRaw:
            return item.value.raw ? value.integer(*item.value.raw) : void();
        case kNumber:
            return giveNumber(item.value, value);
        case kText:
            return value.text(item.value.text());
        default:
            return value.text(_timeline.fields()[item.field].unit);
        }
    }

private:
    Timeline& _timeline;
    SampleReader _reader;
    std::size_t _place = static_cast<std::size_t>(-1); // before the first
};

class SampleTable final : public QueryTable {
public:
    explicit SampleTable(Timeline& timeline) : _timeline(timeline) {}

    const std::vector<Column>& columns() const override { return sampleColumns(); }
    double expectedRows() const override {
        constexpr double kPerPacket = 10;
        return static_cast<double>(_timeline.packets()) * kPerPacket;
    }
    std::unique_ptr<Rows> rows(const RowBounds& bounds) override {
        PacketRange range = packetsIn(_timeline, bounds);
        std::optional<FieldIndex> field;
        if (bounds.field) {
            field = _timeline.fields().named(*bounds.field);
            if (!field) {
                range = {};
            }
        }
        return std::make_unique<SampleRows>(_timeline, range, field);
    }

private:
    Timeline& _timeline;
};

} // namespace

std::unique_ptr<QueryTable> sampleTable(Timeline& timeline) {
    return std::make_unique<SampleTable>(timeline);
}

} // namespace pallax
