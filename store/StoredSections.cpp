#include "store/StoredSections.h"

#include "query/Database.h"
#include "query/QueryTable.h"
#include "query/SectionTable.h"
#include "store/StoreConnection.h"
#include "timeline/FieldTable.h"

#include <algorithm>
#include <cstdint>
#include <memory>
#include <optional>
#include <stdexcept>
#include <string_view>
#include <unordered_map>
#include <utility>
#include <variant>
#include <vector>

namespace pallax {

namespace {

constexpr std::int64_t kMicroseconds = 1000; // in a millisecond

/// The value of a field from a time on, in milliseconds since 1970.
struct Held {
    std::string entry; ///< empty: none
    std::int64_t start = 0;
    std::int64_t end = 0;
    std::size_t field = 0; ///< its place in the group
    std::int64_t packet = 0;
    std::size_t site = 0; ///< among the cells that were read; 0: unknown
    QueryValue value;
};

/// What a section showed, recording by recording.
class SectionReader {
public:
    SectionReader(const std::string& file, const FieldTable& fields, const FieldGroup& group,
                  const RowBounds& bounds)
        : _store(StoreConnection::openToRead(file)), _mayContinue(bounds.mayContinue),
          _recordings(_store->prepare(
              "SELECT id, device, name, first FROM recordings WHERE technology = ?1 AND last >= ?2 "
              "AND first <= ?3 AND (?4 IS NULL OR device = ?4) ORDER BY device, first, name")),
          _intervals(_store->prepare(
              "SELECT s.entry, i.time, i.time + i.hold, i.packet, s.site, CASE typeof(i.number) "
              "WHEN 'integer' THEN i.number * s.step ELSE i.number END AS held, CASE WHEN f.kind = "
              "'label' OR i.number IS NULL THEN coalesce(t.text, format(s.format, i.number * "
              "s.step)) END FROM fields f CROSS JOIN series s ON s.field = f.id AND s.recording = "
              "?2 CROSS JOIN intervals i ON i.id BETWEEN s.first_row AND s.last_row LEFT JOIN "
              "texts "
              "t ON t.id = i.text WHERE f.name = ?1 AND i.hold > 0")) {
        for (const auto& [index, name] : group.fields) {
            _fields.push_back(&fields[index]);
        }
        _recordings.bind(1, fields.technology())
            .bind(2, bounds.leastTime / kMicroseconds - 1)
            .bind(3, bounds.mostTime / kMicroseconds + 1)
            .bind(4, bounds.device);
        readSites();
    }

    /// Goes to the next recording; false after the last.
    bool next() {
        if (!_recordings.step()) {
            return false;
        }
        device = _recordings.text(1);
        recording = _recordings.text(2);
        const std::int64_t first = _recordings.integer(3);
        held.clear();
        for (std::size_t field = 0; field < _fields.size(); ++field) {
            _intervals.bind(1, _fields[field]->name).bind(2, _recordings.integer(0));
            while (_intervals.step()) {
                take(field, first);
            }
        }
        std::stable_sort(held.begin(), held.end(), [](const Held& one, const Held& other) {
            return one.entry != other.entry ? one.entry < other.entry : one.start < other.start;
        });
        return true;
    }

    struct Site {
        std::string system;
        std::string identity;
    };
    const Site* site(std::size_t place) const { return place > 0 ? &_sites[place - 1] : nullptr; }

    std::string device;
    std::string recording;
    std::vector<Held> held; ///< by entry and time

private:
    void readSites() {
        Statement sites = _store->prepare("SELECT id, system, identity FROM sites");
        while (sites.step()) {
            _sites.push_back({sites.text(1), sites.text(2)});
            _places[sites.integer(0)] = _sites.size();
        }
    }
    void take(std::size_t field, std::int64_t first) {
        constexpr std::size_t kAskEvery = 4096;
        if (_mayContinue != nullptr && held.size() % kAskEvery == 0 && !(*_mayContinue)()) {
            throw std::runtime_error(kStopped);
        }
        held.push_back({_intervals.text(0), first + _intervals.integer(1),
                        first + _intervals.integer(2), field, _intervals.integer(3),
                        _intervals.isNull(4) ? 0 : _places[_intervals.integer(4)],
                        valueOf(*_fields[field])});
    }
    /// As the tables of a recording have it.
    QueryValue valueOf(const FieldInfo& field) const {
        constexpr int kNumber = 5;
        constexpr int kText = 6;
        if (field.kind != FieldInfo::Kind::Label && !_intervals.isNull(kNumber)) {
            return _intervals.isInteger(kNumber) ? QueryValue(_intervals.integer(kNumber))
                                                 : QueryValue(_intervals.real(kNumber));
        }
        return field.kind != FieldInfo::Kind::Number ? QueryValue(_intervals.text(kText))
                                                     : QueryValue();
    }

    std::unique_ptr<StoreConnection> _store;
    const std::function<bool()>* _mayContinue;
    Statement _recordings;
    Statement _intervals;
    std::vector<const FieldInfo*> _fields;
    std::vector<Site> _sites;
    std::unordered_map<std::int64_t, std::size_t> _places; ///< of sites, by their numbers, from 1
};

/// Joins the values of an entry that hold at the same time to rows.
class StoredRows final : public Rows {
public:
    enum Place : std::size_t { kTime, kPacket, kEntry, kHold, kFirstField };

    StoredRows(const std::string& file, const FieldTable& fields, const FieldGroup& group,
               const RowBounds& bounds)
        : _reader(file, fields, group, bounds), _current(group.fields.size(), nullptr) {}

    bool next() override {
        while (true) {
            if (_place == _reader.held.size() && _until == kNever) {
                if (!_reader.next()) {
                    return false;
                }
                _place = 0;
            }
            if (goOn()) {
                return true;
            }
        }
    }
    void give(std::size_t column, ColumnValue& value) const override {
        switch (column) {
        case kTime:
            return value.integer(_from * kMicroseconds);
        case kPacket:
            return value.integer(_packet);
        case kEntry:
            return _entry.empty() ? void() : value.text(_entry);
        case kHold:
            return value.integer((_until - _from) * kMicroseconds);
        default:
            return column < kFirstField + _current.size() ? giveField(column - kFirstField, value)
                                                          : giveOrigin(column, value);
        }
    }

private:
    static constexpr std::int64_t kNever = std::numeric_limits<std::int64_t>::max();

    /// Goes to the next instant at which something changes. False if nothing is known from there
    /// on.
    bool goOn() {
        const auto& held = _reader.held;
        if (_until == kNever) { // another entry
            _entry = held.empty() ? "" : held[_place].entry;
            std::fill(_current.begin(), _current.end(), nullptr);
            _from = _place < held.size() ? held[_place].start : kNever;
        } else {
            _from = _until;
        }
        for (; isOfEntry() && held[_place].start == _from; ++_place) {
            _current[held[_place].field] = &held[_place];
        }
        _until = isOfEntry() ? held[_place].start : kNever;
        const Held* latest = nullptr;
        for (const Held*& each : _current) {
            if (each != nullptr && each->end <= _from) {
                each = nullptr;
            }
            if (each != nullptr) {
                _until = std::min(_until, each->end);
                latest = latest == nullptr || each->packet > latest->packet ? each : latest;
            }
        }
        _packet = latest != nullptr ? latest->packet : 0;
        _site = latest != nullptr ? _reader.site(latest->site) : nullptr;
        return latest != nullptr;
    }
    bool isOfEntry() const {
        return _place < _reader.held.size() && _reader.held[_place].entry == _entry;
    }

    void giveField(std::size_t field, ColumnValue& value) const {
        if (_current[field] == nullptr) {
            return;
        }
        const QueryValue& known = _current[field]->value;
        if (const auto* number = std::get_if<std::int64_t>(&known)) {
            value.integer(*number);
        } else if (const auto* real = std::get_if<double>(&known)) {
            value.real(*real);
        } else if (const auto* text = std::get_if<std::string>(&known)) {
            value.text(*text);
        }
    }
    void giveOrigin(std::size_t column, ColumnValue& value) const {
        enum Origin : std::size_t { kSystem, kCell, kDevice };
        switch (column - kFirstField - _current.size()) {
        case kSystem:
            return _site != nullptr ? value.text(_site->system) : void();
        case kCell:
            return _site != nullptr ? value.text(_site->identity) : void();
        case kDevice:
            return value.text(_reader.device);
        default:
            return value.text(_reader.recording);
        }
    }

    SectionReader _reader;
    std::vector<const Held*> _current; ///< by field; null: not known
    std::size_t _place = 0;            ///< of what comes next
    std::string _entry;
    std::int64_t _from = 0;
    std::int64_t _until = kNever; ///< when something changes; never: nothing is known any more
    std::int64_t _packet = 0;
    const SectionReader::Site* _site = nullptr;
};

class StoredSection final : public QueryTable {
public:
    StoredSection(std::string file, const FieldTable& fields, FieldGroup group)
        : _file(std::move(file)), _fields(fields),
          _group(std::move(group)), _columns{{"time", "INTEGER", Column::Role::TimeStamp},
                                             {"packet", "INTEGER"},
                                             {"entry", "TEXT", Column::Role::Plain, !_group.isList},
                                             {"hold", "INTEGER"}} {
        for (const auto& [field, name] : _group.fields) {
            _columns.push_back({name, "", Column::Role::Value});
        }
        _columns.push_back({"system", "TEXT"});
        _columns.push_back({"cell", "TEXT"});
        _columns.push_back({"device", "TEXT", Column::Role::DeviceName});
        _columns.push_back({"recording", "TEXT"});
    }

    const std::vector<Column>& columns() const override { return _columns; }
    double expectedRows() const override {
        constexpr double kMany = 1e6;
        return kMany;
    }
    std::unique_ptr<Rows> rows(const RowBounds& bounds) override {
        return std::make_unique<StoredRows>(_file, _fields, _group, bounds);
    }

private:
    std::string _file;
    const FieldTable& _fields;
    FieldGroup _group;
    std::vector<Column> _columns;
};

} // namespace

void addStoredSections(Database& database, const std::string& file, const FieldTable& fields) {
    for (FieldGroup& group : fieldGroups(fields)) {
        const std::string name = group.name;
        database.add(fields.technology(), name,
                     std::make_unique<StoredSection>(file, fields, std::move(group)));
    }
}

} // namespace pallax
