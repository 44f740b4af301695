#include "sources/modem/ModemIdentities.h"

#include "sources/modem/BusValues.h"
#include "sources/modem/ModemNames.h"
#include "sources/modem/ModemSections.h"
#include "sources/modem/ModemView.h"

#include <string>
#include <utility>
#include <vector>

namespace pallax {

namespace {

using namespace bus_values;
using modem_sections::interfaceNamed;

/// The identities of device and person, without the plus sign of a number.
std::vector<std::string> identitiesOf(const ModemView& view) {
    constexpr std::size_t kShortest = 7; // less may be part of anything
    std::vector<std::string> identities;
    const auto add = [&identities](const std::optional<std::string>& text) {
        const std::string digits =
            text && text->starts_with("+") ? text->substr(1) : text.value_or("");
        if (digits.size() >= kShortest) {
            identities.push_back(digits);
        }
    };
    const DictionaryRef modem = interfaceNamed(view, modem_names::kModem);
    const DictionaryRef cdma = interfaceNamed(view, modem_names::kModemCdma);
    for (const char* property : {"Imsi", "SimIdentifier", "Eid"}) {
        add(textIn(view.sim, property));
    }
    for (const char* property : {"Meid", "Esn"}) {
        add(textIn(*cdma, property));
    }
    add(textIn(*interfaceNamed(view, modem_names::kModem3gpp), "Imei"));
    add(textIn(*modem, "EquipmentIdentifier"));
    add(view.equipment);
    const ArrayRef numbers = arrayIn(*modem, "OwnNumbers");
    for (const PropertyList& number : numbers != nullptr ? *numbers : Array()) {
        add(number.string());
    }
    return identities;
}

PropertyList hidden(const PropertyList& value, const std::vector<std::string>& identities) {
    if (const auto text = value.string()) {
        std::string shown = *text;
        for (const std::string& identity : identities) {
            for (auto at = shown.find(identity); at != std::string::npos;
                 at = shown.find(identity, at)) {
                shown.replace(at, identity.size(), identity.size(), '0');
                at += identity.size();
            }
        }
        return shown == *text ? value : PropertyList(shown);
    }
    if (const DictionaryRef entries = value.dictionary()) {
        Dictionary result;
        for (const Dictionary::Entry& entry : *entries) {
            result.set(entry.key, hidden(entry.value, identities));
        }
        return result;
    }
    Array result;
    const ArrayRef elements = value.array();
    for (const PropertyList& element : elements != nullptr ? *elements : Array()) {
        result.push_back(hidden(element, identities));
    }
    return result;
}

} // namespace

Dictionary withoutIdentities(const Dictionary& picture, const ModemView& view) {
    const std::vector<std::string> identities = identitiesOf(view);
    return identities.empty() ? picture : *hidden(picture, identities).dictionary();
}

} // namespace pallax
