#pragma once

#include "timeline/CurrentValues.h"

#include <vector>

namespace pallax {

/// What differs between two instants.
struct Change {
    enum class Kind {
        Value,  ///< a value has changed, come or gone
        Added,  ///< an entry has come, with this value
        Removed ///< an entry has gone, with this value
    };
    Kind kind = Kind::Value;
    FieldIndex field = 0;
    EntryId entry = kNoEntry; ///< wherever the entry stands in its list
    FieldValue before;        ///< empty: there was none
    FieldValue after;         ///< empty: there is none
};

/// By field, outside lists; then by entry, as their lists have them: those that have changed or
/// gone, and then the new ones.
std::vector<Change> changesBetween(const CurrentValues& before, const CurrentValues& after);

} // namespace pallax
