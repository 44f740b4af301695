#include "sources/modem/ModemObjects.h"

#include "sources/modem/ModemNames.h"

#include <algorithm>
#include <utility>

namespace pallax {

namespace {

/// The first of the values, at most so many: a message may hold any number.
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

std::size_t bytesOf(const Dictionary& values);

/// About what a value takes in memory.
std::size_t bytesOf(const PropertyList& value) {
    std::size_t bytes = sizeof(PropertyList);
    if (const auto text = value.string()) {
        bytes += text->size();
    } else if (const DictionaryRef entries = value.dictionary()) {
        bytes += bytesOf(*entries);
    } else if (const ArrayRef elements = value.array()) {
        for (const PropertyList& element : *elements) {
            bytes += bytesOf(element);
        }
    }
    return bytes;
}

std::size_t bytesOf(const Dictionary& values) {
    std::size_t bytes = 0;
    for (const Dictionary::Entry& entry : values) {
        bytes += sizeof(Dictionary::Entry) + entry.key.view().size() + bytesOf(entry.value);
    }
    return bytes;
}

} // namespace

void ModemObjects::replace(const PropertyList& objects) {
    clear();
    const DictionaryRef told = objects.dictionary();
    for (const Dictionary::Entry& object : told != nullptr ? *told : Dictionary()) {
        if (const DictionaryRef interfaces = object.value.dictionary()) {
            add(object.key.string(), *interfaces);
        }
    }
}

void ModemObjects::clear() {
    _objects.clear();
    _bytes = 0;
}

void ModemObjects::put(Dictionary& values, const Dictionary::Entry& entry) {
    const PropertyList* known = values.find(entry.key.view());
    const std::size_t name =
        known != nullptr ? 0 : sizeof(Dictionary::Entry) + entry.key.view().size();
    const std::size_t before = known != nullptr ? bytesOf(*known) : 0;
    const std::size_t after = _bytes - before + name + bytesOf(entry.value);
    if (after <= kMostBytes) {
        values.set(entry.key, entry.value);
        _bytes = after;
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
            put(object, {interface.key, someOf(*properties, kMostProperties)});
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
    _bytes -= bytesOf(found->second);
    for (const std::string& interface : interfaces) {
        (void)found->second.remove(interface);
    }
    if (!found->second.contains(modem_names::kModem)) {
        _objects.erase(found); // the other interfaces belong to this one
    } else {
        _bytes += bytesOf(found->second);
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
            put(*known, property);
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
