#include "sources/modem/ModemObjects.h"

#include "sources/modem/ModemNames.h"

#include <algorithm>
#include <utility>

namespace pallax {

namespace {

/// A copy that shares nothing, within the limit.
Dictionary someOf(const Dictionary& values, std::size_t most) {
    Dictionary some;
    for (const Dictionary::Entry& entry : values) {
        if (some.size() == most) {
            break;
        }
        some.set(entry.key, entry.value);
    }
    return some;
}

} // namespace

void ModemObjects::replace(const PropertyList& objects) {
    _objects.clear();
    const DictionaryRef told = objects.dictionary();
    for (const Dictionary::Entry& object : told != nullptr ? *told : Dictionary()) {
        if (const DictionaryRef interfaces = object.value.dictionary()) {
            add(object.key.string(), *interfaces);
        }
    }
}

void ModemObjects::add(const std::string& path, const Dictionary& interfaces) {
    if (!_objects.contains(path) && _objects.size() == kMostObjects) {
        return;
    }
    Dictionary& object = _objects[path];
    for (const Dictionary::Entry& interface : interfaces) {
        const DictionaryRef properties = interface.value.dictionary();
        const bool hasRoom =
            object.size() < kMostInterfaces || object.contains(interface.key.view());
        if (properties != nullptr && hasRoom) {
            object.set(interface.key, someOf(*properties, kMostProperties));
        }
    }
    if (object.empty()) {
        _objects.erase(path);
    }
}

void ModemObjects::remove(const std::string& path, const std::vector<std::string>& interfaces) {
    const auto found = _objects.find(path);
    if (found == _objects.end()) {
        return;
    }
    for (const std::string& interface : interfaces) {
        (void)found->second.remove(interface);
    }
    if (!found->second.contains(modem_names::kModem)) {
        _objects.erase(found); // the other interfaces belong to this one
    }
}

bool ModemObjects::change(const std::string& path, const std::string& interface,
                          const Dictionary& properties) {
    const auto found = _objects.find(path);
    const PropertyList* there = found != _objects.end() ? found->second.find(interface) : nullptr;
    const DictionaryRef known = there != nullptr ? there->dictionary() : nullptr;
    if (known == nullptr) {
        return false;
    }
    for (const Dictionary::Entry& property : properties) {
        if (known->size() < kMostProperties || known->contains(property.key.view())) {
            known->set(property.key, property.value);
        }
    }
    return true;
}

const Dictionary* ModemObjects::find(const std::string& path) const {
    const auto found = _objects.find(path);
    return found != _objects.end() ? &found->second : nullptr;
}

std::vector<std::string> ModemObjects::modems() const {
    std::vector<std::string> paths;
    for (const auto& [path, interfaces] : _objects) {
        if (path.starts_with(modem_names::kModemFolder) &&
            interfaces.contains(modem_names::kModem)) {
            paths.push_back(path);
        }
    }
    std::stable_sort(paths.begin(), paths.end(), [](const auto& a, const auto& b) {
        return a.size() < b.size(); // "/10" is after "/9"
    });
    return paths;
}

} // namespace pallax
