#include "sources/modem/ModemChoice.h"

#include "sources/modem/BusValues.h"
#include "sources/modem/ModemNames.h"
#include "sources/modem/ModemObjects.h"

#include <algorithm>
#include <utility>

namespace pallax {

namespace {

using namespace bus_values;

/// The text of a property of the modem at a path; empty if it has none.
std::string propertyOf(const ModemObjects& objects, const std::string& path,
                       std::string_view property) {
    const DictionaryRef modem = dictionaryIn(*objects.find(path), modem_names::kModem);
    return modem != nullptr ? textIn(*modem, property).value_or("") : "";
}

bool isEnabled(const ModemObjects& objects, const std::string& path) {
    const DictionaryRef modem = dictionaryIn(*objects.find(path), modem_names::kModem);
    return modem != nullptr && integerIn(*modem, "State").value_or(0) >= modem_names::kEnabled;
}

bool isEqualIgnoringCase(std::string_view a, std::string_view b) {
    const auto small = [](char letter) {
        return letter >= 'A' && letter <= 'Z' ? static_cast<char>(letter - 'A' + 'a') : letter;
    };
    return std::equal(a.begin(), a.end(), b.begin(), b.end(),
                      [small](char left, char right) { return small(left) == small(right); });
}

} // namespace

std::optional<std::string> ModemChoice::in(const ModemObjects& objects) {
    if (_device.empty()) {
        auto path = wantedIn(objects);
        if (path) {
            const std::string device = propertyOf(objects, *path, "Device");
            _device = device.empty() ? *path : device;
        }
        return path;
    }
    for (const std::string& path : objects.modems()) {
        if (propertyOf(objects, path, "Device") == _device || path == _device) {
            return path;
        }
    }
    return std::nullopt;
}

std::optional<std::string> ModemChoice::wantedIn(const ModemObjects& objects) const {
    const std::vector<std::string> paths = objects.modems();
    const auto first = [&paths](const auto& isWanted) {
        const auto found = std::find_if(paths.begin(), paths.end(), isWanted);
        return found != paths.end() ? std::optional(*found) : std::nullopt;
    };
    if (_wanted == kAuto) {
        const auto enabled =
            first([&](const std::string& path) { return isEnabled(objects, path); });
        return enabled || paths.empty() ? enabled : std::optional(paths.front());
    }
    const auto named = first([&](const std::string& path) {
        return path == _wanted || path == modem_names::kModemFolder + _wanted;
    });
    return named ? named : first([&](const std::string& path) {
        return isEqualIgnoringCase(propertyOf(objects, path, "Model"), _wanted);
    });
}

} // namespace pallax
