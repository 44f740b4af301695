#pragma once

#include "LogGenerator/Records/Exceptions.h"
#include "LogGenerator/Records/LogRecord.h"
#include "plist/PropertyList.h"

#include <algorithm>
#include <cstddef>

namespace pallax {

/// The repeated entries of a record. The record claims their number, but only whole entries are
/// walked: those whose bytes, as far as they are read, all lie inside the record.
class EntryList {
public:
    struct Layout {
        std::size_t start;     ///< of entry 0, from byte 0 of the record
        std::size_t stride;    ///< from one entry's start to the next
        std::size_t bytesRead; ///< from an entry's start to the end of the last byte read
    };

    EntryList(const LogRecord& record, const Layout& layout, std::size_t count)
        : _record(record), _layout(layout), _count(count) {}

    std::size_t count() const { return _count; }

    /// The entry, whole or not. Throws ArrayOutOfBoundsException when `index` is not below the
    /// count that the record carries.
    LogRecord at(std::size_t index) const {
        if (index >= _count) {
            throw ArrayOutOfBoundsException();
        }
        return _record.from(_layout.start + index * _layout.stride);
    }

    bool isWhole(std::size_t index) const {
        return _record.has(_layout.start + index * _layout.stride + _layout.bytesRead);
    }

    /// The number of entries before the first one that is not whole. The stride must be at least
    /// 1, so that the cost depends on the record's size, not on the number it claims.
    std::size_t wholeCount() const {
        const std::size_t first = _layout.start + _layout.bytesRead;
        if (_count == 0 || !_record.has(first)) {
            return 0;
        }
        // Most records are whole. Dividing takes as long as reading several fields.
        if (_count <= kFewEntries && _record.has(first + (_count - 1) * _layout.stride)) {
            return _count;
        }
        return std::min(_count, (_record.length() - first) / _layout.stride + 1);
    }

    /// Calls `make` (LogRecord entry, std::size_t index -> PropertyList) for each entry up to the
    /// first that is not whole, and returns the results.
    template <class Make>
    Array map(const Make& make) const {
        const std::size_t whole = wholeCount();
        Array list;
        list.reserve(whole);
        for (std::size_t index = 0; index < whole; ++index) {
            list.emplace_back(make(at(index), index));
        }
        return list;
    }

private:
    static constexpr std::size_t kFewEntries = 255;

    LogRecord _record;
    Layout _layout;
    std::size_t _count;
};

} // namespace pallax
