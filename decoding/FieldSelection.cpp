#include "decoding/FieldSelection.h"

#include "app/tree/ShownEntries.h"
#include "host/Recording.h"
#include "host/Snapshot.h"

#include <algorithm>
#include <fnmatch.h>

namespace pallax {

bool isNamed(const std::string& field, const std::string& name) {
    return ::fnmatch(name.c_str(), field.c_str(), 0) == 0;
}

FieldSelection::FieldSelection(const std::vector<std::string>& names,
                               const RecordedTechnology& technology, const Resources& resources) {
    for (const RecordedTechnology& each : recordedTechnologies()) {
        if (technology.linkType == each.linkType ||
            technology.linkType == kSnapshotTechnology.linkType) {
            add(names, FieldRegistry(gatherReference(each, resources)));
        }
    }
}

void FieldSelection::add(const std::vector<std::string>& names, const FieldRegistry& registry) {
    for (const FieldInfo& field : registry.fields()) {
        if (std::any_of(names.begin(), names.end(),
                        [&field](const std::string& name) { return isNamed(field.name, name); })) {
            _paths.insert(field.path);
        }
    }
}

std::optional<std::string> FieldSelection::unknownName(const std::vector<std::string>& names,
                                                       const Resources& resources) {
    std::vector<std::string> unknown = names;
    for (const RecordedTechnology& technology : recordedTechnologies()) {
        const FieldRegistry registry(gatherReference(technology, resources));
        const auto& fields = registry.fields();
        std::erase_if(unknown, [&fields](const std::string& name) {
            return std::any_of(fields.begin(), fields.end(), [&name](const FieldInfo& field) {
                return isNamed(field.name, name);
            });
        });
    }
    return unknown.empty() ? std::nullopt : std::optional(unknown.front());
}

/// Whether a selected field is at the path or below it.
bool FieldSelection::isInside(const std::string& path) const {
    const auto next = _paths.lower_bound(path);
    if (next != _paths.end() && *next == path) {
        return true;
    }
    const std::string below = path + "/";
    const auto first = _paths.lower_bound(below);
    return first != _paths.end() && first->starts_with(below);
}

PropertyList FieldSelection::of(const PropertyList& display) const {
    return display.isNull() ? display : valueAt(display, "").value_or(Dictionary());
}

std::optional<PropertyList> FieldSelection::valueAt(const PropertyList& value,
                                                    const std::string& path) const {
    if (_paths.contains(path)) {
        return value;
    }
    if (const DictionaryRef entries = value.dictionary()) {
        return entriesOf(*entries, path);
    }
    if (const ArrayRef elements = value.array()) {
        return elementsOf(*elements, path);
    }
    return value; // in place of what the fields are in, such as "" for a list without entries
}

std::optional<PropertyList> FieldSelection::elementsOf(const Array& elements,
                                                       const std::string& path) const {
    const std::string entry = path + "/" + std::string(kEntryName);
    if (!isInside(entry)) {
        return std::nullopt;
    }
    Array selected;
    for (const PropertyList& element : elements) {
        selected.push_back(valueAt(element, entry).value_or(Dictionary()));
    }
    return selected;
}

std::optional<PropertyList> FieldSelection::entriesOf(const Dictionary& entries,
                                                      const std::string& path) const {
    Dictionary selected;
    bool isEmpty = true;
    for (const Dictionary::Entry& entry : entries) {
        if (!entry.hasStringKey) {
            continue;
        }
        if (entry.key.view() == kSortedKey) {
            selected.set(entry.key, entry.value);
            continue;
        }
        std::string child = path + "/" + entry.key.string();
        if (!isInside(child)) {
            child = path + "/" + std::string(kEntryName);
        }
        if (auto value = isInside(child) ? valueAt(entry.value, child) : std::nullopt) {
            selected.set(entry.key, std::move(*value));
            isEmpty = false;
        }
    }
    return isEmpty ? std::nullopt : std::optional<PropertyList>(std::move(selected));
}

bool ChosenFields::isChosen(const std::string& field) const {
    return _names.empty() ||
           std::any_of(_names.begin(), _names.end(),
                       [&field](const std::string& name) { return isNamed(field, name); });
}

} // namespace pallax
