#pragma once

#include "plist/PropertyList.h"

#include <memory>
#include <string_view>
#include <vector>

namespace pallax {

/// The lookup table maps each lookup name ("kChannel") to the places in the display that show it:
/// an array of {"key": display key, "dict": the display dictionary that contains it}.

/// Adds the place `key` in `display` for `lookupName`.
void addLookupPlace(const Text& lookupName, const Text& key, const DictionaryRef& display,
                    Dictionary& lookup);

/// A place where a value is shown.
struct LookupPlace {
    Text key;
    DictionaryRef display;
};

/// The places of a name, in order. They end before the first whose "dict" is not a dictionary or
/// whose "key" is not a string; later places keep their value.
std::vector<LookupPlace> lookupPlaces(std::string_view lookupName, const Dictionary& lookup);

/// Stores the value in all places of the name, in order; the places share a dictionary. Does
/// nothing for a name without places.
void setLookupValue(std::string_view lookupName, const PropertyList& value,
                    const Dictionary& lookup);

} // namespace pallax
