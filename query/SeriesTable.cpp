#include "query/SeriesTable.h"

#include "query/FieldNames.h"
#include "query/TimelineTables.h"
#include "text/Format.h"
#include "timeline/Series.h"

#include <stdexcept>
#include <utility>

namespace pallax {

namespace {

constexpr std::int64_t kUsualBuckets = 1000;
constexpr std::int64_t kMostBuckets = 65536;

const std::vector<Column>& seriesColumns() {
    static const std::vector<Column> columns = {
        {"bucket", "INTEGER"},
        {"time", "INTEGER"},
        {"packet", "INTEGER"},
        {"packets", "INTEGER"},
        {"first", ""},
        {"min", "REAL"},
        {"max", "REAL"},
        {"last", ""},
        {"entry", "TEXT"},
        {"field", "TEXT", Column::Role::FieldArgument, true},
        {"buckets", "INTEGER", Column::Role::CountArgument, true},
    };
    return columns;
}

class SeriesRows final : public Rows {
public:
    enum Place : std::size_t {
        kBucket,
        kTime,
        kPacket,
        kPackets,
        kFirst,
        kMin,
        kMax,
        kLast,
        kEntry,
        kField,
        kBuckets
    };

    SeriesRows(const Timeline& timeline, std::string field, std::int64_t buckets,
               std::vector<EntryBuckets> entries)
        : _timeline(timeline), _field(std::move(field)), _buckets(buckets),
          _call(std::hash<std::string>()(_field + "," + std::to_string(buckets))),
          _entries(std::move(entries)) {}

    bool next() override {
        for (_bucket += _isBegun ? 1 : 0, _isBegun = true; _entry < _entries.size();
             ++_entry, _bucket = 0) {
            const auto& buckets = _entries[_entry].buckets;
            while (_bucket < buckets.size() && buckets[_bucket].isEmpty()) {
                ++_bucket;
            }
            if (_bucket < buckets.size()) {
                return true;
            }
        }
        return false;
    }
    std::int64_t number(std::int64_t /*place*/) const override {
        constexpr unsigned kEntryAndBucket = 32;
        constexpr unsigned kBucketBits = 16;
        return static_cast<std::int64_t>(_call << kEntryAndBucket | _entry << kBucketBits |
                                         _bucket);
    }
    void give(std::size_t column, ColumnValue& value) const override {
        const Bucket& bucket = _entries[_entry].buckets[_bucket];
        switch (column) {
        case kBucket:
            return value.integer(static_cast<std::int64_t>(_bucket));
        case kTime:
            return value.integer(microseconds(bucket.time));
        case kPacket:
            return value.integer(static_cast<std::int64_t>(bucket.from));
        case kPackets:
            return value.integer(static_cast<std::int64_t>(packetsIn(bucket)));
        case kFirst:
            return giveValue(bucket.first, value);
        case kMin:
            return giveValue(bucket.least, value);
        case kMax:
            return giveValue(bucket.most, value);
        case kLast:
            return giveValue(bucket.last, value);
        case kEntry:
            return giveEntry(value);
        case kField:
            return value.text(_field);
        default:
            return value.integer(_buckets);
        }
    }

private:
    /// The last bucket ends with a cell of the reduction, which may be longer than the timeline.
    std::uint64_t packetsIn(const Bucket& bucket) const {
        return std::min(bucket.to, _timeline.packets() + 1) - bucket.from;
    }
    void giveValue(const SeriesValue& held, ColumnValue& value) const {
        if (held.isNumber()) {
            value.real(held.number());
        } else if (!held.isEmpty()) {
            value.text(_timeline.series().texts().text(held.text()));
        }
    }
    void giveEntry(ColumnValue& value) const {
        const EntryId entry = _entries[_entry].entry;
        if (entry != kNoEntry) {
            value.text(_timeline.entries().words(entry));
        }
    }

    const Timeline& _timeline;
    std::string _field; ///< as the query names it
    std::int64_t _buckets;
    std::uint64_t _call; ///< other arguments have other numbers
    std::vector<EntryBuckets> _entries;
    std::size_t _entry = 0;
    std::size_t _bucket = 0;
    bool _isBegun = false;
};

class SeriesTable final : public QueryTable {
public:
    explicit SeriesTable(Timeline& timeline) : _timeline(timeline), _names(timeline.fields()) {}

    const std::vector<Column>& columns() const override { return seriesColumns(); }
    double expectedRows() const override { return kUsualBuckets; }
    std::unique_ptr<Rows> rows(const RowBounds& bounds) override {
        if (!bounds.field) {
            throw std::invalid_argument("series() takes a field and a number of buckets");
        }
        const std::int64_t buckets = bounds.count.value_or(kUsualBuckets);
        if (buckets < 1 || buckets > kMostBuckets) {
            throw std::invalid_argument(
                formatText("series() takes 1 to %lld buckets, not %lld", {kMostBuckets, buckets}));
        }
        const FieldIndex field = _names.find(*bounds.field);
        return std::make_unique<SeriesRows>(
            _timeline, *bounds.field, buckets,
            readBucketsOfEntries(_timeline, field, static_cast<std::size_t>(buckets)));
    }

private:
    Timeline& _timeline;
    FieldNames _names;
};

} // namespace

std::unique_ptr<QueryTable> seriesTable(Timeline& timeline) {
    return std::make_unique<SeriesTable>(timeline);
}

} // namespace pallax
