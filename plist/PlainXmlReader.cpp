#include "plist/PlainXmlReader.h"

#include "plist/PropertyListCodec.h"

#include <charconv>
#include <cstdint>
#include <string>
#include <system_error>
#include <utility>
#include <vector>

namespace pallax {

namespace {

constexpr bool isPlainSpace(char letter) {
    return letter == ' ' || letter == '\t' || letter == '\n';
}

constexpr bool isPlain(char letter) {
    return (letter >= ' ' && letter <= '~' && letter != '&') || letter == '\t' || letter == '\n';
}

/// Consumes the text from its beginning. Once something is not plain, every function returns
/// nothing.
class PlainXmlReader {
public:
    explicit PlainXmlReader(std::string_view rest) : _rest(rest) {}

    std::optional<PropertyList> document() {
        if (take("<?xml version=\"1.0\" encoding=\"UTF-8\"?>")) {
            skipSpaces();
        }
        if (!take("<plist version=\"1.0\">")) {
            return std::nullopt;
        }
        auto result = value(1);
        skipSpaces();
        if (!result || !take("</plist>")) {
            return std::nullopt;
        }
        skipSpaces();
        return _rest.empty() ? std::move(result) : std::nullopt;
    }

private:
    static constexpr std::size_t kUsualEntries = 4;
    static constexpr std::size_t kUsualElements = 8;

    bool take(std::string_view expected) {
        const bool found = _rest.starts_with(expected);
        _rest.remove_prefix(found ? expected.size() : 0);
        return found;
    }

    void skipSpaces() {
        while (!_rest.empty() && isPlainSpace(_rest.front())) {
            _rest.remove_prefix(1);
        }
    }

    /// The text before the end tag; also consumes the tag.
    std::optional<std::string_view> textUntil(std::string_view endTag) {
        std::size_t end = 0;
        while (end < _rest.size() && _rest[end] != '<') {
            if (!isPlain(_rest[end])) {
                return std::nullopt;
            }
            ++end;
        }
        const std::string_view text = _rest.substr(0, end);
        _rest.remove_prefix(end);
        return take(endTag) ? std::optional(text) : std::nullopt;
    }

    std::optional<PropertyList> value(std::size_t depth) {
        skipSpaces();
        if (take("<string>")) {
            const auto text = textUntil("</string>");
            return text ? std::optional<PropertyList>(Text(*text)) : std::nullopt;
        }
        if (take("<dict>")) {
            return dictionary(depth);
        }
        if (take("<array>")) {
            return array(depth);
        }
        return rareValue(depth);
    }

    std::optional<PropertyList> rareValue(std::size_t depth) {
        const bool isReadable = depth <= kDeepestPropertyList;
        if (isReadable && take("<dict/>")) {
            return Dictionary();
        }
        if (isReadable && take("<array/>")) {
            return Array();
        }
        if (take("<integer>")) {
            return integer();
        }
        if (take("<true/>")) {
            return PropertyList::boolean(true);
        }
        return take("<false/>") ? std::optional(PropertyList::boolean(false)) : std::nullopt;
    }

    std::optional<PropertyList> integer() {
        const auto text = textUntil("</integer>");
        std::int64_t number = 0;
        if (!text) {
            return std::nullopt;
        }
        const char* const last = text->data() + text->size();
        const auto [end, error] = std::from_chars(text->data(), last, number);
        return error == std::errc() && end == last ? std::optional(PropertyList::integer(number))
                                                   : std::nullopt;
    }

    std::optional<PropertyList> array(std::size_t depth) {
        if (depth > kDeepestPropertyList) {
            return std::nullopt;
        }
        Array elements;
        elements.reserve(kUsualElements);
        for (skipSpaces(); !take("</array>"); skipSpaces()) {
            auto element = value(depth + 1);
            if (!element) {
                return std::nullopt;
            }
            elements.push_back(*std::move(element));
        }
        return elements;
    }

    std::optional<PropertyList> dictionary(std::size_t depth) {
        if (depth > kDeepestPropertyList) {
            return std::nullopt;
        }
        Dictionary entries;
        entries.reserve(kUsualEntries);
        for (skipSpaces(); !take("</dict>"); skipSpaces()) {
            const auto key = take("<key>") ? textUntil("</key>") : std::nullopt;
            auto entry = key ? value(depth + 1) : std::nullopt;
            if (!entry) {
                return std::nullopt;
            }
            entries.set(sharedKey(*key), *std::move(entry));
        }
        return entries;
    }

    /// Keys repeat in a list; the first ones are kept to be shared.
    Text sharedKey(std::string_view key) {
        constexpr std::size_t kMostKept = 32;
        for (const Text& kept : _keys) {
            if (kept.view() == key) {
                return kept;
            }
        }
        Text made(key);
        if (_keys.size() < kMostKept) {
            _keys.push_back(made);
        }
        return made;
    }

    std::string_view _rest;
    std::vector<Text> _keys;
};

} // namespace

std::optional<PropertyList> readPlainXml(std::string_view xml) {
    return PlainXmlReader(xml).document();
}

} // namespace pallax
