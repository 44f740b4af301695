#pragma once

#include "plist/PropertyList.h"

#include <memory>
#include <string_view>
#include <vector>

namespace pallax {

/// The lookup table tells, for each named quantity ("kChannel"), every place in the display where
/// that quantity is shown: a dictionary from lookup name to an array of places
/// {"key": display key, "dict": the display dictionary that holds it}.

/// Adds the place `key` in `display` to those of `lookupName`.
void addLookupPlace(const Text& lookupName, const Text& key, const DictionaryRef& display,
                    Dictionary& lookup);

/// Where a value is shown.
struct LookupPlace {
    Text key;
    DictionaryRef display;
};

/// The places of a name, in order. One whose "dict" is no dictionary or whose "key" is no string
/// ends them; those behind it keep their value.
std::vector<LookupPlace> lookupPlaces(std::string_view lookupName, const Dictionary& lookup);

/// Stores the value in every place of the name, in order; a dictionary is then shared between the
/// places. Does nothing for a name without places.
void setLookupValue(std::string_view lookupName, const PropertyList& value,
                    const Dictionary& lookup);

} // namespace pallax
