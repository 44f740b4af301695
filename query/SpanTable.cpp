#include "query/SpanTable.h"

#include "packets/StampSequence.h"
#include "query/SampleReader.h"

#include <algorithm>
#include <deque>
#include <unordered_map>

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
                endAll();
            }
        }
        return true;
    }
    std::int64_t number(std::int64_t /*place*/) const override {
        return _ended.front().begin.number();
    }
    void give(std::size_t column, ColumnValue& value) const override {
        const Span& span = _ended.front();
        switch (column) {
        case kStart:
            return value.integer(microseconds(span.begin.time));
        case kPacket:
            return value.integer(static_cast<std::int64_t>(span.begin.packet));
        case kField:
            return value.text(_timeline.fields()[span.begin.field].name);
        case kEntry:
            return span.begin.entry != kNoEntry
                       ? value.text(_timeline.entries().words(span.begin.entry))
                       : void();
        case kHold:
            return value.integer(microseconds(span.end) - microseconds(span.begin.time));
        case kNumber:
            return giveNumber(span.begin.value, value);
        case kText:
            return value.text(span.begin.value.text());
        default:
            return value.text(_timeline.fields()[span.begin.field].unit);
        }
    }

private:
    struct Span {
        SampleReader::Item begin;
        Time end;
        std::uint64_t lastRead = 0; ///< the packet
        ListId list = 0;
    };
    using Key = std::uint64_t; ///< field and entry

    static Key keyOf(FieldIndex field, EntryId entry) {
        constexpr unsigned kHalf = 32;
        return std::uint64_t{field} << kHalf | entry;
    }

    void takeItems() {
        std::size_t gone = 0;
        const auto& items = _reader.items();
        for (std::size_t index = 0; index <= items.size(); ++index) {
            for (; gone < _reader.gone().size() && _reader.gone()[gone].before == index; ++gone) {
                take(_reader.gone()[gone]);
            }
            if (index < items.size()) {
                take(items[index]);
            }
        }
    }
    void goTo(std::uint64_t packet, Time time) {
        if (packet != _packet) {
            endReplaced();
            if (_stamps.stepTo(time)) {
                endAll(); // what was between is unknown
            }
            _stamps.take(time);
            _packet = packet;
            _time = time;
        }
    }
    void take(const SampleReader::Gone& gone) {
        goTo(gone.packet, gone.time);
        if (!gone.field) {
            if (gone.list != 0) {
                _list = gone.list;
                _replaced.push_back(gone.list);
            }
            return;
        }
        end(_open.find(keyOf(*gone.field, kNoEntry)), _time);
    }
    void take(const SampleReader::Item& item) {
        goTo(item.packet, item.time);
        const Key key = keyOf(item.field, item.entry);
        auto found = _open.find(key);
        if (found != _open.end() && !(found->second.begin.value == item.value)) {
            end(found, item.time);
            found = _open.end();
        }
        if (found == _open.end()) {
            found = _open.emplace(key, Span{item, {}, 0, item.entry != kNoEntry ? _list : 0}).first;
        }
        found->second.lastRead = item.packet;
    }
    /// Ends the spans of entries that the packet's lists no longer have.
    void endReplaced() {
        for (const ListId list : _replaced) {
            for (auto each = _open.begin(); each != _open.end();) {
                const auto span = each++;
                if (span->second.list == list && span->second.lastRead != _packet) {
                    end(span, _time);
                }
            }
        }
        _replaced.clear();
    }
    void endAll() {
        endReplaced();
        while (!_open.empty()) {
            end(_open.begin(), _time);
        }
    }
    void end(std::unordered_map<Key, Span>::iterator span, Time time) {
        if (span != _open.end()) {
            span->second.end = std::max(time, span->second.begin.time);
            _ended.push_back(std::move(span->second));
            _open.erase(span);
        }
    }

    Timeline& _timeline;
    SampleReader _reader;
    std::unordered_map<Key, Span> _open;
    std::deque<Span> _ended;
    std::vector<ListId> _replaced; ///< by the current packet
    ListId _list = 0;
    std::uint64_t _packet = 0;
    Time _time;
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
