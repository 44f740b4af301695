#include "LogGenerator/C2K/C2KLookup.h"

namespace pallax {

namespace {

constexpr std::string_view kKey = "key";
constexpr std::string_view kDict = "dict";

/// The array under a name, or null.
ArrayRef placesOf(std::string_view lookupName, const Dictionary& lookup) {
    const PropertyList* found = lookup.find(lookupName);
    return found != nullptr ? found->array() : nullptr;
}

} // namespace

void addLookupPlace(const Text& lookupName, const Text& key, const DictionaryRef& display,
                    Dictionary& lookup) {
    ArrayRef places = placesOf(lookupName.view(), lookup);
    if (places == nullptr) {
        places = std::make_shared<Array>();
        lookup.set(lookupName, places);
    }
    Dictionary place;
    place.setFixed(kKey, key);
    place.setFixed(kDict, display);
    places->emplace_back(std::move(place));
}

std::vector<LookupPlace> lookupPlaces(std::string_view lookupName, const Dictionary& lookup) {
    std::vector<LookupPlace> found;
    const ArrayRef places = placesOf(lookupName, lookup);
    if (places == nullptr) {
        return found;
    }
    for (const PropertyList& each : *places) {
        const DictionaryRef place = each.dictionary();
        const PropertyList* key = place != nullptr ? place->find(kKey) : nullptr;
        const PropertyList* dict = place != nullptr ? place->find(kDict) : nullptr;
        const DictionaryRef display = dict != nullptr ? dict->dictionary() : nullptr;
        const Text* name = key != nullptr ? key->text() : nullptr;
        if (display == nullptr || name == nullptr) {
            break;
        }
        found.push_back({*name, display});
    }
    return found;
}

void setLookupValue(std::string_view lookupName, const PropertyList& value,
                    const Dictionary& lookup) {
    for (const LookupPlace& place : lookupPlaces(lookupName, lookup)) {
        place.display->set(place.key, value);
    }
}

} // namespace pallax
