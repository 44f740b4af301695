#pragma once

#include "timeline/CurrentValues.h"

#include <optional>
#include <string>
#include <string_view>

namespace pallax {

/// A field with the words of its entry: what is shown in one place of the display, wherever its
/// entry stands and whichever tables number both.
struct LeafName {
    std::string field;
    std::string entry; ///< EntryTable::words; empty outside lists
    /// The keys in the field's value if that is a dictionary or an array: "/State".
    std::string inner;

    friend bool operator==(const LeafName&, const LeafName&) = default;
};

/// The field that is shown at a path of the display ("/Neighbor Cells List/2/Measured RSRP"), with
/// the entry that stands there now. Nothing if no field has a value there.
std::optional<LeafName> leafAt(const CurrentValues& values, std::string_view path);

/// The current value of a leaf.
struct LeafValue {
    FieldIndex field = 0;
    EntryId entry = kNoEntry;
    FieldValue value; ///< the part at `inner`
};
/// Nothing if there is none: the entry may have left its list.
std::optional<LeafValue> valueOf(const CurrentValues& values, const LeafName& leaf);

} // namespace pallax
