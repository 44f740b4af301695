#pragma once

#include "plist/PropertyList.h"

#include <memory>
#include <string>
#include <string_view>
#include <vector>

namespace pallax {

/// Asks for a dictionary's entries in sorted order; never shown.
inline constexpr std::string_view kSortedKey = "_sorted";

/// An entry of a display dictionary as a row. Its members refer to the dictionary and are valid
/// until its next change.
struct ShownEntry {
    std::string_view name;
    const Text* key;
    const PropertyList* value;

    /// The name as a string that outlives the dictionary; shares the key's string if possible.
    std::shared_ptr<const std::string> sharedName() const;
};

/// The rows of a display dictionary, in display order: every entry with a string key and a non-null
/// value. If the key "_sorted" is present, which is never shown, the rows are sorted by key, and a
/// key of exactly two parts separated by ";" is named by the second.
std::vector<ShownEntry> shownEntries(const Dictionary& dictionary);

} // namespace pallax
