#include "query/EventTable.h"

#include "query/TimelineTables.h"
#include "timeline/Timeline.h"

namespace pallax {

namespace {

const std::vector<Column>& eventColumns() {
    static const std::vector<Column> columns = {
        {"time", "INTEGER"}, {"packet", "INTEGER"}, {"kind", "TEXT"},
        {"words", "TEXT"},   {"fields", "TEXT"},
    };
    return columns;
}

std::string joined(const std::vector<std::string>& names) {
    std::string text;
    for (const std::string& name : names) {
        text.append(text.empty() ? "" : " ").append(name);
    }
    return text;
}

class EventRows final : public Rows {
public:
    enum Place : std::size_t { kTime, kPacket, kKind, kWords, kFields };

    explicit EventRows(const std::vector<Event>& events) : _events(events) {}

    bool next() override { return ++_next <= _events.size(); }
    void give(std::size_t column, ColumnValue& value) const override {
        const Event& event = _events[_next - 1];
        switch (column) {
        case kTime:
            return value.integer(microseconds(event.time));
        case kPacket:
            return value.integer(static_cast<std::int64_t>(event.packet));
        case kKind:
            return value.text(wordOf(event.kind));
        case kWords:
            return value.text(event.words);
        default:
            return value.text(joined(event.fields));
        }
    }

private:
    const std::vector<Event>& _events;
    std::size_t _next = 0;
};

class EventTable final : public QueryTable {
public:
    explicit EventTable(const Timeline& timeline) : _timeline(timeline) {}

    const std::vector<Column>& columns() const override { return eventColumns(); }
    double expectedRows() const override { return static_cast<double>(_timeline.events().size()); }
    std::unique_ptr<Rows> rows(const RowBounds& /*bounds*/) override {
        return std::make_unique<EventRows>(_timeline.events());
    }

private:
    const Timeline& _timeline;
};

} // namespace

std::unique_ptr<QueryTable> eventTable(const Timeline& timeline) {
    return std::make_unique<EventTable>(timeline);
}

} // namespace pallax
