#include "web/JsonPatch.h"

#include "decoding/DisplayJson.h"

#include <algorithm>

namespace pallax {

namespace {

std::string replacement(const PropertyList& value) {
    std::string patch = "{\"value\":";
    appendJson(patch, value);
    return patch + '}';
}

/// Appends "K":P to an object unless P is empty.
void appendMember(std::string& object, std::string_view key, const std::string& patch) {
    if (!patch.empty()) {
        object += object.empty() ? "" : ",";
        appendJsonString(object, key);
        object += ':' + patch;
    }
}

std::string membersPatch(const Dictionary& before, const Dictionary& after) {
    std::string members;
    std::size_t kept = 0;
    for (const Dictionary::Entry& entry : after) {
        const PropertyList* old = before.find(entry.key.view());
        kept += old != nullptr ? 1 : 0;
        appendMember(members, entry.key.view(),
                     old != nullptr ? jsonPatch(*old, entry.value) : replacement(entry.value));
    }
    return kept == before.size() ? "{\"members\":{" + members + "}}" : replacement(after);
}

/// Lists that only keep their latest entries lose some at the begin.
std::size_t dropped(const Array& before, const Array& after) {
    const auto first = std::find(before.begin(), before.end(), after.front());
    return first != before.end() ? static_cast<std::size_t>(first - before.begin()) : 0;
}

std::string itemsPatch(const Array& before, const Array& after) {
    if (before.empty() || after.empty()) {
        return replacement(after);
    }
    const std::size_t drop = dropped(before, after);
    const std::size_t size = std::min(before.size() - drop, after.size());
    std::string at;
    for (std::size_t index = 0; index < size; ++index) {
        appendMember(at, std::to_string(index), jsonPatch(before[drop + index], after[index]));
    }
    const Array added(after.begin() + static_cast<std::ptrdiff_t>(size), after.end());
    std::string patch = "{\"items\":{\"drop\":" + std::to_string(drop) +
                        ",\"size\":" + std::to_string(size) + ",\"at\":{" + at + "},\"add\":";
    appendJson(patch, added);
    return patch + "}}";
}

} // namespace

std::string jsonPatch(const PropertyList& before, const PropertyList& after) {
    if (before == after) {
        return {};
    }
    if (before.dictionary() != nullptr && after.dictionary() != nullptr) {
        return membersPatch(*before.dictionary(), *after.dictionary());
    }
    if (before.array() != nullptr && after.array() != nullptr) {
        return itemsPatch(*before.array(), *after.array());
    }
    return replacement(after);
}

} // namespace pallax
