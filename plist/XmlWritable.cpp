#include "plist/XmlWritable.h"

#include "plist/PropertyListCodec.h"
#include "plist/XmlMarkupCheck.h"
#include "text/Format.h"
#include "text/Printable.h"
#include "text/Utf8.h"

#include <algorithm>
#include <optional>

namespace pallax {

namespace {

/// The text with replacements; nothing if it needs none.
std::optional<std::string> writableText(std::string_view text) {
    constexpr char32_t kFirstForbiddenOfTheEnd = 0xFFFE;
    constexpr char32_t kLastForbiddenOfTheEnd = 0xFFFF;
    std::string out;
    bool isChanged = false;
    for (std::size_t at = 0; at < text.size();) {
        const Utf8CodePoint character = utf8At(text, at);
        const bool isKept =
            character.size > 0 && isXmlCharacter(character.value) &&
            (character.value < kFirstForbiddenOfTheEnd || character.value > kLastForbiddenOfTheEnd);
        out += isKept ? text.substr(at, character.size) : kReplacementCharacter;
        isChanged = isChanged || !isKept;
        at += std::max<std::size_t>(character.size, 1);
    }
    return isChanged ? std::optional(std::move(out)) : std::nullopt;
}

class Replacement {
public:
    using Replaced = std::function<void(const std::string& path)>;

    explicit Replacement(const Replaced& replaced) : _replaced(replaced) {}

    /// Nothing if the object is writable as it is, or nested too deep to be written at all.
    std::optional<PropertyList> of(const PropertyList& object, const std::string& path,
                                   std::size_t depth = 1) {
        if (depth > kDeepestPropertyList) {
            return std::nullopt;
        }
        if (const ArrayRef elements = object.array()) {
            return ofArray(*elements, path, depth);
        }
        if (const DictionaryRef entries = object.dictionary()) {
            return ofDictionary(*entries, path, depth);
        }
        std::string text;
        auto writable = object.appendString(text) ? writableText(text) : std::nullopt;
        if (!writable) {
            return std::nullopt;
        }
        _replaced(path);
        return PropertyList(std::move(*writable));
    }

private:
    std::optional<PropertyList> ofArray(const Array& elements, const std::string& path,
                                        std::size_t depth) {
        std::optional<Array> changed;
        for (std::size_t index = 0; index < elements.size(); ++index) {
            if (auto element = of(elements[index], path + "/" + std::to_string(index), depth + 1)) {
                if (!changed) {
                    changed = elements;
                }
                (*changed)[index] = std::move(*element);
            }
        }
        return changed ? std::optional(PropertyList(std::move(*changed))) : std::nullopt;
    }

    std::optional<PropertyList> ofDictionary(const Dictionary& entries, const std::string& path,
                                             std::size_t depth) {
        bool isChanged = false;
        Dictionary copy;
        for (const Dictionary::Entry& entry : entries) {
            if (!entry.hasStringKey) {
                return std::nullopt; // cannot be written in any case
            }
            auto key = writableText(entry.key.view());
            if (key) {
                while (entries.contains(*key) || copy.contains(*key)) {
                    *key += formatText(" (%zu)", {copy.size() + 1}); // so that no entry replaces
                                                                     // another
                }
            }
            const std::string place = path + "/" + (key ? *key : std::string(entry.key.view()));
            if (key) {
                _replaced(place);
            }
            const auto value = of(entry.value, place, depth + 1);
            isChanged = isChanged || key || value;
            copy.set(key ? Text(std::move(*key)) : entry.key, value ? *value : entry.value);
        }
        return isChanged ? std::optional(PropertyList(std::move(copy))) : std::nullopt;
    }

    const Replaced& _replaced;
};

} // namespace

PropertyList writableInXml(const PropertyList& object,
                           const std::function<void(const std::string& path)>& replaced) {
    const auto changed = Replacement(replaced).of(object, "");
    return changed ? *changed : object;
}

} // namespace pallax
