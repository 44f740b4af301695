#pragma once

#include "plist/PropertyList.h"

#include <stdexcept>
#include <string>
#include <string_view>

namespace pallax::doubles {

inline std::string quotedText(std::string_view text) {
    std::string out = "\"";
    for (const char character : text) {
        if (character == '"' || character == '\\') {
            out += '\\';
        }
        out += character;
    }
    return out + '"';
}

/// The old text form of strings, arrays and dictionaries, which the program reads but never writes.
/// Throws std::invalid_argument for other types.
inline std::string textForm(const PropertyList& object) {
    if (const auto text = object.string()) {
        return quotedText(*text);
    }
    std::string out;
    if (const ArrayRef elements = object.array()) {
        for (const PropertyList& element : *elements) {
            out += (out.empty() ? "" : ", ") + textForm(element);
        }
        return "(" + out + ")";
    }
    if (const DictionaryRef entries = object.dictionary()) {
        for (const Dictionary::Entry& entry : *entries) {
            out += quotedText(entry.key.view()) + " = " + textForm(entry.value) + "; ";
        }
        return "{ " + out + "}";
    }
    throw std::invalid_argument("no text form is written for the type " +
                                std::string(object.typeName()));
}

} // namespace pallax::doubles
