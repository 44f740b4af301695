#include "query/SpanTable.h"

#include "packets/StampSequence.h"
#include "query/SampleReader.h"
#include "timeline/SpanMaker.h"

#include <deque>

namespace pallax {

namespace {

const std::vector<Column>& spanColumns() {
    static const std::vector<Column> columns = {
        {"start", "INTEGER"}, {"packet", "INTEGER"}, {"field", "TEXT", Column::Role::FieldName},
        {"entry", "TEXT"},    {"hold", "INTEGER"},   {"number", "REAL"},
        {"text", "TEXT"},     {"unit", "TEXT"},
    };
    return columns;
}

/// The spans in the order of their ends.
class SpanRows final : public Rows {
public:
    enum Place : std::size_t { kStart, kPacket, kField, kEntry, kHold, kNumber, kText, kUnit };

    SpanRows(Timeline& timeline, const PacketRange& range, std::optional<FieldIndex> field)
        : _timeline(timeline), _reader(timeline, range, field) {}

    bool next() override {
        if (!_ended.empty()) {
            _ended.pop_front();
        }
        while (_ended.empty()) {
            if (_isAtEnd) {
                return false;
            }
            if (_reader.readMore()) {
                takeItems();
            } else {
                _isAtEnd = true;
                _spans.endAll();
            }
        }
        return true;
    }
    std::int64_t number(std::int64_t /*place*/) const override {
        return SampleReader::numberInPacket(_ended.front().packet, _ended.front().place);
    }
    void give(std::size_t column, ColumnValue& value) const override {
        const Span& span = _ended.front();
        switch (column) {
        case kStart:
            return value.integer(microseconds(span.start));
        case kPacket:
            return value.integer(static_cast<std::int64_t>(span.packet));
        case kField:
            return value.text(_timeline.fields()[span.field].name);
        case kEntry:
            return span.entry != kNoEntry ? value.text(_timeline.entries().words(span.entry))
                                          : void();
        case kHold:
            return value.integer(microseconds(span.end) - microseconds(span.start));
        case kNumber:
            return giveNumber(span.value, value);
        case kText:
            return value.text(span.value.text());
        default:
            return value.text(_timeline.fields()[span.field].unit);
        }
    }

private:
    void takeItems() {
        std::size_t gone = 0;
        const auto& items = _reader.items();
        for (std::size_t index = 0; index <= items.size(); ++index) {
            for (; gone < _reader.gone().size() && _reader.gone()[gone].before == index; ++gone) {
                take(_reader.gone()[gone]);
            }
            if (index < items.size()) {
                const SampleReader::Item& item = items[index];
                goTo(item.packet, item.time);
                _spans.valueRead(item.field, item.entry, item.value, item.place);
            }
        }
    }
    void goTo(std::uint64_t packet, Time time) {
        if (packet != _packet) {
            if (_stamps.stepTo(time)) {
                _spans.endAll(); // what was between is unknown
            }
            _stamps.take(time);
            _spans.beginPacket(packet, time);
            _packet = packet;
        }
    }
    void take(const SampleReader::Gone& gone) {
        goTo(gone.packet, gone.time);
        if (gone.field) {
            _spans.valueRemoved(*gone.field);
        } else if (gone.list != 0) {
            _spans.listReplaced(gone.list);
        }
    }

    Timeline& _timeline;
    SampleReader _reader;
    SpanMaker _spans;
    std::deque<Span>& _ended = _spans.ended();
    std::uint64_t _packet = 0;
    StampSequence _stamps;
    bool _isAtEnd = false;
};

class SpanTable final : public QueryTable {
public:
    explicit SpanTable(Timeline& timeline) : _timeline(timeline) {}

    const std::vector<Column>& columns() const override { return spanColumns(); }
    double expectedRows() const override { return static_cast<double>(_timeline.packets()); }
    std::unique_ptr<Rows> rows(const RowBounds& bounds) override {
        RowBounds all;
        all.mayContinue = bounds.mayContinue;
        PacketRange range = packetsIn(_timeline, all);
        std::optional<FieldIndex> field;
        if (bounds.field) {
            field = _timeline.fields().named(*bounds.field);
            range = field ? range : PacketRange{};
        }
        return std::make_unique<SpanRows>(_timeline, range, field);
    }

private:
    Timeline& _timeline;
};

} // namespace

std::unique_ptr<QueryTable> spanTable(Timeline& timeline) {
    return std::make_unique<SpanTable>(timeline);
}

} // namespace pallax
