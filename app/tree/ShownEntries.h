#pragma once

#include "plist/PropertyList.h"

#include <memory>
#include <string>
#include <string_view>
#include <vector>

namespace pallax {

/// An entry of a display dictionary as a row: its name, its key and its value. They belong to
/// the dictionary and are valid until its next change.
struct ShownEntry {
    std::string_view name;
    const Text* key;
    const PropertyList* value;

    /// The name as a string that outlives the dictionary; the key's own where it can be.
    std::shared_ptr<const std::string> sharedName() const;
};

/// The rows of a display dictionary, in display order: every entry with a string key and a value
/// that is not null. With the key "_sorted", which is never shown, they are sorted by key, and a
/// key of exactly two pieces around a ";" is named by the second.
std::vector<ShownEntry> shownEntries(const Dictionary& dictionary);

} // namespace pallax
