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

template <class Visit>
void forEachPlace(std::string_view lookupName, const Dictionary& lookup, const Visit& visit) {
    const ArrayRef places = placesOf(lookupName, lookup);
    if (places == nullptr) {
        return;
    }
    for (const PropertyList& each : *places) {
        const DictionaryRef place = each.dictionary();
        const PropertyList* key = place != nullptr ? place->find(kKey) : nullptr;
        const PropertyList* dict = place != nullptr ? place->find(kDict) : nullptr;
        const DictionaryRef display = dict != nullptr ? dict->dictionary() : nullptr;
        const Text* name = key != nullptr ? key->text() : nullptr;
        if (display == nullptr || name == nullptr) {
            return;
        }
        visit(*name, display);
    }
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
    std::vector<LookupPlace> places;
    forEachPlace(lookupName, lookup, [&places](const Text& key, const DictionaryRef& display) {
        places.push_back({key, display});
    });
    return places;
}

void setLookupValue(std::string_view lookupName, const PropertyList& value,
                    const Dictionary& lookup) {
    forEachPlace(lookupName, lookup, [&value](const Text& key, const DictionaryRef& display) {
        display->set(key, value);
    });
}

} // namespace pallax
