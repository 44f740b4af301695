#include "query/PacketTable.h"

#include "LogGenerator/LogPacket.h"
#include "query/TimelineTables.h"
#include "timeline/Timeline.h"

namespace pallax {

namespace {

const std::vector<Column>& packetColumns() {
    static const std::vector<Column> columns = {
        {"time", "INTEGER", Column::Role::TimeStamp},
        {"packet", "INTEGER", Column::Role::PacketNumber},
        {"length", "INTEGER"},
        {"code", "INTEGER"},
    };
    return columns;
}

class PacketRows final : public Rows {
public:
    enum Place : std::size_t { kTime, kPacket, kLength, kCode };

    PacketRows(const Timeline& timeline, const PacketRange& range)
        : _hasCodes(!timeline.fields().isObjectStream()), _last(range.last),
          _reader(range.first <= range.last ? timeline.journal().reader(range.first) : nullptr) {}

    bool next() override {
        const auto packet = _reader ? _reader->next() : std::nullopt;
        if (!packet || packet->number > _last) {
            return false;
        }
        _packet = *packet;
        return true;
    }
    std::int64_t number(std::int64_t /*place*/) const override {
        return static_cast<std::int64_t>(_packet.number);
    }
    void give(std::size_t column, ColumnValue& value) const override {
        switch (column) {
        case kTime:
            return value.integer(microseconds(_packet.time));
        case kPacket:
            return value.integer(static_cast<std::int64_t>(_packet.number));
        case kLength:
            return value.integer(static_cast<std::int64_t>(_packet.data.size()));
        default:
            if (_hasCodes) {
                value.integer(LogPacketGetLogCode(LogRecord(LogPacketRecord(_packet.data))));
            }
        }
    }

private:
    bool _hasCodes;
    std::uint64_t _last;
    std::unique_ptr<PacketReader> _reader;
    JournalPacket _packet;
};

class PacketTable final : public QueryTable {
public:
    explicit PacketTable(const Timeline& timeline) : _timeline(timeline) {}

    const std::vector<Column>& columns() const override { return packetColumns(); }
    double expectedRows() const override { return static_cast<double>(_timeline.packets()); }
    std::unique_ptr<Rows> rows(const RowBounds& bounds) override {
        return std::make_unique<PacketRows>(_timeline, packetsIn(_timeline, bounds));
    }

private:
    const Timeline& _timeline;
};

} // namespace

std::unique_ptr<QueryTable> packetTable(Timeline& timeline) {
    return std::make_unique<PacketTable>(timeline);
}

} // namespace pallax
