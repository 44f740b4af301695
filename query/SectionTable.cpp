#include "query/SectionTable.h"

#include "query/SampleReader.h"

#include <algorithm>

namespace pallax {

namespace {

/// The column of a value that has no name of its own.
constexpr std::string_view kValueColumn = "value";
/// SQLite has no more columns by default.
constexpr std::size_t kMostColumns = 1900;

/// The name of the table for a field: its name without the technology and, if it has a key, without
/// the last part.
std::string groupNameOf(const FieldInfo& field) {
    std::string name = field.name.substr(field.name.find('.') + 1);
    if (!field.key.empty() && name.find('.') != std::string::npos) {
        name.erase(name.rfind('.'));
    }
    std::replace(name.begin(), name.end(), '.', '_');
    return name;
}

class SectionRows final : public Rows {
public:
    enum Place : std::size_t { kTime, kPacket, kEntry, kPlace };

    SectionRows(Timeline& timeline, const PacketRange& range, const FieldGroup& group,
                const std::vector<std::size_t>& columnOf)
        : _timeline(timeline), _group(group), _columnOf(columnOf), _reader(timeline, range),
          _row(group.fields.size()) {}

    bool next() override {
        std::fill(_row.begin(), _row.end(), nullptr);
        bool isBegun = false;
        while (true) {
            for (; _next < _reader.items().size(); ++_next) {
                const SampleReader::Item& item = _reader.items()[_next];
                if (item.field >= _columnOf.size() || _columnOf[item.field] == kNone) {
                    continue;
                }
                const FieldValue*& value = _row[_columnOf[item.field]];
                if (isBegun &&
                    (item.packet != _packet || item.entry != _entry || value != nullptr)) {
                    return true;
                }
                if (!isBegun) {
                    begin(item);
                    isBegun = true;
                }
                value = &item.value;
            }
            // Whole packets are read, so that a row never goes on after the items.
            if (isBegun || !_reader.readMore()) {
                return isBegun;
            }
            _next = 0;
        }
    }

    std::int64_t number(std::int64_t /*place*/) const override {
        return SampleReader::numberInPacket(_packet, _place);
    }
    void give(std::size_t column, ColumnValue& value) const override {
        switch (column) {
        case kTime:
            return value.integer(microseconds(_time));
        case kPacket:
            return value.integer(static_cast<std::int64_t>(_packet));
        case kEntry:
            return _entry != kNoEntry ? value.text(_timeline.entries().words(_entry)) : void();
        case kPlace:
            return _entry != kNoEntry ? value.integer(static_cast<std::int64_t>(_place)) : void();
        default:
            break;
        }
        const std::size_t field = column - kPlace - 1;
        if (_row[field] != nullptr) {
            giveTyped(_timeline.fields()[_group.fields[field].first], *_row[field], value);
        }
    }

    static constexpr std::size_t kNone = static_cast<std::size_t>(-1);

private:
    void begin(const SampleReader::Item& item) {
        _place = item.packet == _packet ? _place + 1 : 1;
        _packet = item.packet;
        _time = item.time;
        _entry = item.entry;
    }

    Timeline& _timeline;
    const FieldGroup& _group;
    const std::vector<std::size_t>& _columnOf; ///< by field
    SampleReader _reader;
    std::size_t _next = 0; ///< of the reader's items
    std::vector<const FieldValue*> _row;
    std::uint64_t _packet = 0;
    Time _time;
    EntryId _entry = kNoEntry;
    std::size_t _place = 0; ///< of the entry in its list, from 1
};

class SectionTable final : public QueryTable {
public:
    SectionTable(Timeline& timeline, FieldGroup group)
        : _timeline(timeline),
          _group(std::move(group)), _columns{
                                        {"time", "INTEGER", Column::Role::TimeStamp},
                                        {"packet", "INTEGER", Column::Role::PacketNumber},
                                        {"entry", "TEXT", Column::Role::Plain, !_group.isList},
                                        {"place", "INTEGER", Column::Role::Plain, !_group.isList}} {
        for (const auto& [field, name] : _group.fields) {
            _columnOf.resize(std::max<std::size_t>(_columnOf.size(), field + 1),
                             SectionRows::kNone);
            _columnOf[field] = _columns.size() - SectionRows::kPlace - 1;
            _columns.push_back({name, ""});
        }
    }

    const std::vector<Column>& columns() const override { return _columns; }
    double expectedRows() const override { return static_cast<double>(_timeline.packets()); }
    std::unique_ptr<Rows> rows(const RowBounds& bounds) override {
        return std::make_unique<SectionRows>(_timeline, packetsIn(_timeline, bounds), _group,
                                             _columnOf);
    }

private:
    Timeline& _timeline;
    FieldGroup _group;
    std::vector<Column> _columns;
    std::vector<std::size_t> _columnOf;
};

} // namespace

std::vector<FieldGroup> fieldGroups(const FieldTable& fields) {
    std::vector<FieldGroup> groups;
    for (FieldIndex index = 0; index < fields.size(); ++index) {
        const FieldInfo& field = fields[index];
        const std::string name = groupNameOf(field);
        auto group = std::find_if(groups.begin(), groups.end(),
                                  [&](const FieldGroup& each) { return each.name == name; });
        if (group == groups.end()) {
            group = groups.insert(groups.end(), FieldGroup{name, false, {}});
        }
        if (group->fields.size() < kMostColumns) {
            group->isList = group->isList || field.isInList;
            group->fields.emplace_back(index, field.key.empty() ? std::string(kValueColumn)
                                                                : lastWordOf(field.name));
        }
    }
    return groups;
}

std::unique_ptr<QueryTable> sectionTable(Timeline& timeline, FieldGroup group) {
    return std::make_unique<SectionTable>(timeline, std::move(group));
}

} // namespace pallax
