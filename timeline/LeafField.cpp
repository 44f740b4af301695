#include "timeline/LeafField.h"

#include <algorithm>
#include <charconv>
#include <span>
#include <vector>

namespace pallax {

namespace {

/// The name of a child in a display path, without its slash.
std::vector<std::string_view> partsOf(std::string_view path) {
    std::vector<std::string_view> parts;
    for (std::size_t start = 1; start <= path.size() && path.size() > 1;) {
        const std::size_t end = std::min(path.find('/', start), path.size());
        parts.push_back(path.substr(start, end - start));
        start = end + 1;
    }
    return parts;
}

std::optional<std::size_t> placeIn(std::string_view part) {
    std::size_t place = 0;
    const char* const end = part.data() + part.size();
    const auto read = std::from_chars(part.data(), end, place);
    return read.ec == std::errc() && read.ptr == end ? std::optional(place) : std::nullopt;
}

/// The child of a dictionary or array at a path; null if there is none.
PropertyList partAt(PropertyList value, std::string_view path) {
    for (const std::string_view part : partsOf(path)) {
        PropertyList child;
        if (const DictionaryRef keys = value.dictionary()) {
            const PropertyList* found = keys->find(part);
            child = found != nullptr ? *found : PropertyList();
        } else if (const ArrayRef elements = value.array()) {
            const auto place = placeIn(part);
            child = place && *place < elements->size() ? (*elements)[*place] : PropertyList();
        }
        value = child;
    }
    return value;
}

/// Looks for the field of a path: each part of it may be a key or name an entry of a list.
class LeafSearch {
public:
    LeafSearch(const CurrentValues& values, std::string_view path)
        : _values(values), _parts(partsOf(path)) {}

    std::optional<LeafName> found() {
        take(0, "");
        return _found;
    }

private:
    void take(std::size_t part, const std::string& path) {
        if (_found) {
            return;
        }
        if (const auto field = _values.fields().atPath(path)) {
            tryField(*field, part);
        }
        if (_found || part == _parts.size()) {
            return;
        }
        take(part + 1, path + "/" + std::string(_parts[part]));
        if (part > 0) {
            _entries.push_back(_parts[part]);
            take(part + 1, path + "/" + std::string(kEntryName));
            _entries.pop_back();
        }
    }

    /// Accepts the field if it has a value that contains the rest of the path.
    void tryField(FieldIndex field, std::size_t part) {
        LeafName leaf{_values.fields()[field].name, {}, {}};
        const FieldValue* value = nullptr;
        if (_entries.empty()) {
            value = _values.value(field);
        } else if (const EntryValues* entry = entryOf(field)) {
            leaf.entry = _values.entries().words(entry->entry);
            value = entry->value(field);
        }
        for (; part < _parts.size(); ++part) {
            leaf.inner.append("/").append(_parts[part]);
        }
        if (value != nullptr && !partAt(value->shown, leaf.inner).isNull()) {
            _found = std::move(leaf);
        }
    }

    /// The entry by its name, if its list has names, or else by the places in the lists.
    const EntryValues* entryOf(FieldIndex field) const {
        const std::vector<std::string>& identity = _values.fields()[field].identity;
        if (!identity.empty() && identity.front() == kEntryName) {
            const std::string words = "PN " + std::string(_entries.back());
            const EntryValues* named = nullptr;
            _values.forEachEntry([&](const EntryValues& entry) {
                if (entry.value(field) != nullptr &&
                    _values.entries().words(entry.entry) == words) {
                    named = &entry;
                }
            });
            return named;
        }
        std::vector<std::size_t> places;
        for (const std::string_view part : _entries) {
            const auto place = placeIn(part);
            if (!place) {
                return nullptr;
            }
            places.push_back(*place);
        }
        return _values.entryAt(field, places);
    }

    const CurrentValues& _values;
    std::vector<std::string_view> _parts;
    std::vector<std::string_view> _entries; ///< the parts that stand for entries
    std::optional<LeafName> _found;
};

} // namespace

std::optional<LeafName> leafAt(const CurrentValues& values, std::string_view path) {
    return LeafSearch(values, path).found();
}

std::optional<LeafValue> valueOf(const CurrentValues& values, const LeafName& leaf) {
    const auto field = values.fields().named(leaf.field);
    if (!field) {
        return std::nullopt;
    }
    EntryId entryId = kNoEntry;
    const FieldValue* value = leaf.entry.empty() ? values.value(*field) : nullptr;
    if (!leaf.entry.empty()) {
        values.forEachEntry([&](const EntryValues& entry) {
            const FieldValue* held = entry.value(*field);
            if (held != nullptr && values.entries().words(entry.entry) == leaf.entry) {
                entryId = entry.entry;
                value = held;
            }
        });
    }
    if (value == nullptr) {
        return std::nullopt;
    }
    LeafValue found{*field, entryId, *value};
    if (!leaf.inner.empty()) {
        found.value.shown = partAt(value->shown, leaf.inner);
        found.value.raw.reset();
    }
    return found.value.isEmpty() ? std::nullopt : std::optional(std::move(found));
}

} // namespace pallax
