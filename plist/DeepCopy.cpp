#include "plist/DeepCopy.h"

#include <utility>

namespace pallax {

namespace {

void addEntry(Dictionary& to, const Dictionary::Entry& like, PropertyList value) {
    if (like.hasStringKey) {
        to.set(like.key, std::move(value));
    } else {
        to.appendForeignKey(like.key, std::move(value));
    }
}

bool areOfOneKind(const PropertyList& one, const PropertyList& other) {
    return (one.dictionary() != nullptr && other.dictionary() != nullptr) ||
           (one.array() != nullptr && other.array() != nullptr);
}

Array deepCopyOf(const Array& elements) {
    Array copy;
    copy.reserve(elements.size());
    for (const PropertyList& element : elements) {
        copy.push_back(deepCopy(element));
    }
    return copy;
}

} // namespace

PropertyList deepCopy(const PropertyList& object) {
    if (const DictionaryRef entries = object.dictionary()) {
        Dictionary copy;
        copy.reserve(entries->size());
        for (const Dictionary::Entry& entry : *entries) {
            addEntry(copy, entry, deepCopy(entry.value));
        }
        return copy;
    }
    if (const ArrayRef elements = object.array()) {
        return deepCopyOf(*elements);
    }
    return object;
}

void copyInto(const PropertyList& target, const PropertyList& source) {
    if (!areOfOneKind(target, source)) {
        return;
    }
    if (const ArrayRef elements = target.array()) {
        *elements = deepCopyOf(*source.array());
        return;
    }
    Dictionary& entries = *target.dictionary();
    Dictionary content;
    for (const Dictionary::Entry& entry : *source.dictionary()) {
        const PropertyList* there = entry.hasStringKey ? entries.find(entry.key.view()) : nullptr;
        if (there != nullptr && areOfOneKind(*there, entry.value)) {
            copyInto(*there, entry.value);
            addEntry(content, entry, *there);
        } else {
            addEntry(content, entry, deepCopy(entry.value));
        }
    }
    entries = std::move(content);
}

std::size_t memoryOf(const PropertyList& object) {
    constexpr std::size_t kControlBlock = 16;
    std::size_t bytes = sizeof(PropertyList);
    if (const DictionaryRef entries = object.dictionary()) {
        bytes += sizeof(Dictionary) + kControlBlock;
        for (const Dictionary::Entry& entry : *entries) {
            bytes += sizeof(Dictionary::Entry) - sizeof(PropertyList) + memoryOf(entry.value);
        }
    } else if (const ArrayRef elements = object.array()) {
        bytes += sizeof(Array) + kControlBlock;
        for (const PropertyList& element : *elements) {
            bytes += memoryOf(element);
        }
    } else if (const Text* text = object.text()) {
        bytes += text->view().size();
    } else if (const SharedBytes data = object.data()) {
        bytes += data->size();
    }
    return bytes;
}

} // namespace pallax
