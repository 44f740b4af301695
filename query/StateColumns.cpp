#include "query/StateColumns.h"

#include "query/TimelineTables.h"
#include "timeline/CurrentValues.h"

#include <algorithm>
#include <chrono>
#include <map>
#include <set>

namespace pallax {

namespace {

/// SQLite has no more columns by default, and each field takes two.
constexpr std::size_t kMostStateFields = 900;

enum StatePlace : std::size_t { kStateTime, kStatePacket, kStateTick, kFirstStateField };

/// The name, with a number if another column has it.
std::string unused(const std::string& name, std::set<std::string>& names) {
    std::string found = name;
    for (int number = 2; !names.insert(found).second; ++number) {
        found = name + "_" + std::to_string(number);
    }
    return found;
}

} // namespace

StateColumns::StateColumns(const FieldTable& fields, const std::vector<std::string>& taken)
    : _fields(fields), _columns{{"time", "INTEGER", Column::Role::TimeStamp},
                                {"packet", "INTEGER", Column::Role::PacketNumber},
                                {"tick", "INTEGER"}} {
    std::map<std::string, int> uses{{"time", 1}, {"packet", 1}, {"tick", 1}};
    for (const std::string& name : taken) {
        ++uses[name];
    }
    for (FieldIndex index = 0; index < fields.size(); ++index) {
        if (!fields[index].isInList && _shown.size() < kMostStateFields) {
            _shown.push_back(index);
            ++uses[lastWordOf(fields[index].name)];
        }
    }
    std::set<std::string> names{"time", "packet", "tick"};
    names.insert(taken.begin(), taken.end());
    for (const FieldIndex field : _shown) {
        const std::string& name = fields[field].name;
        const std::string word = lastWordOf(name);
        _columns.push_back({unused(uses[word] == 1 ? word : longName(name), names), ""});
    }
    for (std::size_t place = 0; place < _shown.size(); ++place) {
        const std::string& name = _columns[kFirstStateField + place].name;
        _columns.push_back({unused(name + "_age", names), "REAL", Column::Role::Plain, true});
    }
}

std::optional<std::string> StateColumns::nameOf(std::string_view fieldName) const {
    for (std::size_t place = 0; place < _shown.size(); ++place) {
        if (_fields[_shown[place]].name == fieldName) {
            return _columns[kFirstStateField + place].name;
        }
    }
    return std::nullopt;
}

void StateColumns::give(std::size_t column, const StateMoment& moment, const CurrentValues& values,
                        ColumnValue& value) const {
    switch (column) {
    case kStateTime:
        return value.integer(microseconds(moment.time));
    case kStatePacket:
        return value.integer(static_cast<std::int64_t>(moment.packet));
    case kStateTick:
        return moment.tick ? value.integer(static_cast<std::int64_t>(*moment.tick)) : void();
    default:
        break;
    }
    const std::size_t place = column - kFirstStateField;
    const FieldIndex field = _shown[place % _shown.size()];
    const FieldValue* held = values.value(field);
    if (held == nullptr) {
        return;
    }
    if (place < _shown.size()) {
        return giveTyped(_fields[field], *held, value);
    }
    giveAge(moment, held->read, value);
}

std::string StateColumns::longName(std::string_view fieldName) {
    std::string name(fieldName.substr(fieldName.find('.') + 1));
    std::replace(name.begin(), name.end(), '.', '_');
    return name;
}

void StateColumns::giveAge(const StateMoment& moment, Time read, ColumnValue& value) {
    value.real(std::chrono::duration<double>(moment.time - read).count());
}

} // namespace pallax
