#include "app/tree/ShownEntries.h"

#include <algorithm>

namespace pallax {

namespace {

constexpr char kSortSeparator = ';';

/// The name of a key in a sorted dictionary: the second of exactly two parts, otherwise the whole
/// key.
std::string_view nameOfSortedKey(std::string_view key) {
    const std::size_t separator = key.find(kSortSeparator);
    if (separator == std::string_view::npos ||
        key.find(kSortSeparator, separator + 1) != std::string_view::npos) {
        return key;
    }
    return key.substr(separator + 1);
}

} // namespace

std::shared_ptr<const std::string> ShownEntry::sharedName() const {
    return name.size() == key->view().size() ? key->sharedString()
                                             : std::make_shared<const std::string>(name);
}

std::vector<ShownEntry> shownEntries(const Dictionary& dictionary) {
    std::vector<ShownEntry> shown;
    shown.reserve(dictionary.size());
    for (const Dictionary::Entry& entry : dictionary) {
        if (entry.hasStringKey && entry.key.view() != kSortedKey && !entry.value.isNull()) {
            shown.push_back({entry.key.view(), &entry.key, &entry.value});
        }
    }
    const PropertyList* mark = dictionary.find(kSortedKey);
    if (mark != nullptr && !mark->isNull()) {
        std::sort(shown.begin(), shown.end(),
                  [](const ShownEntry& a, const ShownEntry& b) { return a.name < b.name; });
        for (ShownEntry& entry : shown) {
            entry.name = nameOfSortedKey(entry.name);
        }
    }
    return shown;
}

} // namespace pallax
