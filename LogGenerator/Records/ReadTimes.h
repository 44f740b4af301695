#pragma once

#include "LogGenerator/Records/Sample.h"
#include "text/Date.h"

#include <algorithm>
#include <cstddef>
#include <optional>
#include <string_view>
#include <utility>
#include <vector>

namespace pallax {

/// The packet times at which a display sink last read rows of fields, replaced lists and removed
/// keys.
class ReadTimes {
public:
    /// Keeps times for the rows from `first` on; others have none.
    void setRows(FieldId first, std::size_t count) {
        _first = first;
        _rows.assign(count, kNever);
    }
    /// Sets the time of the next packet.
    void setPacket(Time packet) { _packet = packet; }

    void noteRow(FieldId row) {
        if (const std::size_t place = row - _first; place < _rows.size()) {
            _rows[place] = _packet;
        }
    }
    /// Notes that a list was replaced or a key removed. The key must live as long as the program.
    void noteKey(std::string_view key) {
        const auto found = std::find_if(_keys.begin(), _keys.end(),
                                        [key](const auto& each) { return each.first == key; });
        if (found != _keys.end()) {
            found->second = _packet;
        } else {
            _keys.emplace_back(key, _packet);
        }
    }

    std::optional<Time> ofRow(FieldId row) const {
        const std::size_t place = row - _first;
        return place < _rows.size() ? known(_rows[place]) : std::nullopt;
    }
    std::optional<Time> ofKey(std::string_view key) const {
        const auto found = std::find_if(_keys.begin(), _keys.end(),
                                        [key](const auto& each) { return each.first == key; });
        return found != _keys.end() ? std::optional(found->second) : std::nullopt;
    }
    /// The latest time of all.
    std::optional<Time> latest() const {
        Time latest = kNever;
        for (const Time row : _rows) {
            latest = std::max(latest, row);
        }
        for (const auto& [key, time] : _keys) {
            latest = std::max(latest, time);
        }
        return known(latest);
    }

    /// About how many bytes it holds.
    std::size_t bytes() const {
        return _rows.size() * sizeof(Time) + _keys.size() * sizeof(_keys[0]);
    }

private:
    static constexpr Time kNever = Time::min();

    static std::optional<Time> known(Time time) {
        return time != kNever ? std::optional(time) : std::nullopt;
    }

    FieldId _first = 0;
    Time _packet{};
    std::vector<Time> _rows;
    std::vector<std::pair<std::string_view, Time>> _keys;
};

} // namespace pallax
