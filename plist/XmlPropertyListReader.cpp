#include "plist/PlainXmlReader.h"
#include "plist/PropertyListCodec.h"
#include "plist/Refusal.h"
#include "plist/XmlMarkupCheck.h"
#include "text/Base64.h"
#include "text/Utf8.h"

#include <pugixml.hpp>

#include <algorithm>
#include <bit>
#include <charconv>
#include <limits>

namespace pallax {

namespace {

// White space belongs to strings; text next to the root element must be visible in order to be
// refused.
constexpr unsigned kParsing = pugi::parse_cdata | pugi::parse_escapes | pugi::parse_eol |
                              pugi::parse_ws_pcdata | pugi::parse_fragment;

constexpr bool isXmlSpace(char letter) {
    return letter == ' ' || letter == '\t' || letter == '\r' || letter == '\n';
}

std::string_view trimmed(std::string_view text) {
    while (!text.empty() && isXmlSpace(text.front())) {
        text.remove_prefix(1);
    }
    while (!text.empty() && isXmlSpace(text.back())) {
        text.remove_suffix(1);
    }
    return text;
}

bool isDigit(char letter) {
    return letter >= '0' && letter <= '9';
}

/// Takes a sign; returns whether it is a minus.
bool takeSign(std::string_view& text) {
    const bool negative = text.starts_with('-');
    if (negative || text.starts_with('+')) {
        text.remove_prefix(1);
    }
    return negative;
}

PropertyList parseInteger(std::size_t offset, std::string_view text) {
    std::string_view digits = trimmed(text);
    const bool negative = takeSign(digits);
    const bool hexadecimal = digits.starts_with("0x") || digits.starts_with("0X");
    digits.remove_prefix(hexadecimal ? 2 : 0);
    std::uint64_t magnitude = 0;
    const char* const last = digits.data() + digits.size();
    const auto [end, error] =
        std::from_chars(digits.data(), last, magnitude, hexadecimal ? 16 : 10);
    if (error == std::errc::invalid_argument || end != last) {
        refuse(offset, "an integer that is no number");
    }
    constexpr auto kMostNegative = std::uint64_t{1} << 63U;
    if (error != std::errc() || (negative && magnitude > kMostNegative)) {
        refuse(offset, "an integer beyond 64 bits");
    }
    return negative
               ? PropertyList::integer(std::bit_cast<std::int64_t>(std::uint64_t{0} - magnitude))
               : PropertyList::unsignedInteger(magnitude);
}

/// "nan", "inf" and "infinity" in any case; nothing for any other text.
std::optional<double> parseSpecialReal(std::string_view text) {
    std::string lower(text);
    std::transform(lower.begin(), lower.end(), lower.begin(), [](char letter) {
        return letter >= 'A' && letter <= 'Z' ? static_cast<char>(letter - 'A' + 'a') : letter;
    });
    if (lower == "nan") {
        return std::numeric_limits<double>::quiet_NaN();
    }
    if (lower == "inf" || lower == "infinity") {
        return std::numeric_limits<double>::infinity();
    }
    return std::nullopt;
}

double parseReal(std::size_t offset, std::string_view text) {
    std::string_view digits = trimmed(text);
    const bool negative = takeSign(digits);
    double number = 0;
    if (const auto special = parseSpecialReal(digits)) {
        number = *special;
    } else {
        // Besides digits, std::from_chars would accept a second sign and "nan(…)".
        const bool plain = !digits.empty() && (digits[0] == '.' || isDigit(digits[0]));
        const char* const last = digits.data() + digits.size();
        const auto [end, error] = std::from_chars(digits.data(), last, number);
        if (error == std::errc::invalid_argument || end != last || !plain) {
            refuse(offset, "a real that is no number");
        }
        if (error != std::errc()) {
            refuse(offset, "a real beyond the range of a double");
        }
    }
    return negative ? -number : number;
}

/// Turns the parsed elements into values; offsets count from the first byte of the input.
class XmlReader {
public:
    explicit XmlReader(std::size_t start) : _start(start) {}

    PropertyList document(pugi::xml_node document) const;

private:
    std::size_t offsetOf(pugi::xml_node node) const;
    bool isElement(pugi::xml_node node) const;
    std::string textOf(pugi::xml_node element) const;

    PropertyList value(pugi::xml_node element, std::size_t depth) const;
    PropertyList scalar(pugi::xml_node element, std::string_view name) const;
    PropertyList truth(pugi::xml_node element, bool truth) const;
    PropertyList array(pugi::xml_node element, std::size_t depth) const;
    PropertyList dictionary(pugi::xml_node element, std::size_t depth) const;

    std::size_t _start;
};

std::size_t XmlReader::offsetOf(pugi::xml_node node) const {
    const std::ptrdiff_t offset = node.offset_debug();
    if (offset < 0) {
        return _start;
    }
    // The parser gives the position of an element's name, after its "<".
    const std::size_t bracket = node.type() == pugi::node_element ? 1 : 0;
    return _start + static_cast<std::size_t>(offset) - bracket;
}

/// False for white space between elements, the only text allowed there.
bool XmlReader::isElement(pugi::xml_node node) const {
    if (node.type() == pugi::node_element) {
        return true;
    }
    if (!trimmed(node.value()).empty()) {
        refuse(offsetOf(node), "a text between elements");
    }
    return false;
}

/// The whole text of an element without children; comments and CDATA sections may split it.
std::string XmlReader::textOf(pugi::xml_node element) const {
    std::string text;
    for (const pugi::xml_node child : element.children()) {
        if (child.type() == pugi::node_element) {
            refuse(offsetOf(child), std::string("an element inside <") + element.name() + ">");
        }
        text += child.value();
    }
    return text;
}

PropertyList XmlReader::document(pugi::xml_node document) const {
    std::optional<PropertyList> result;
    pugi::xml_node root;
    for (const pugi::xml_node node : document.children()) {
        if (!isElement(node)) {
            continue;
        }
        if (root || std::string_view(node.name()) != "plist") {
            refuse(offsetOf(node), "a root element other than one <plist>");
        }
        root = node;
    }
    if (!root) {
        refuse(_start, "no <plist> element");
    }
    for (const pugi::xml_node node : root.children()) {
        if (!isElement(node)) {
            continue;
        }
        if (result) {
            refuse(offsetOf(node), "a second value inside <plist>");
        }
        result = value(node, 1);
    }
    if (!result) {
        refuse(offsetOf(root), "no value inside <plist>");
    }
    return *std::move(result);
}

PropertyList XmlReader::value(pugi::xml_node element, std::size_t depth) const {
    const std::string_view name = element.name();
    if (name == "dict") {
        return dictionary(element, depth);
    }
    return name == "array" ? array(element, depth) : scalar(element, name);
}

PropertyList XmlReader::scalar(pugi::xml_node element, std::string_view name) const {
    if (name == "string") {
        return textOf(element);
    }
    if (name == "integer") {
        return parseInteger(offsetOf(element), textOf(element));
    }
    if (name == "real") {
        return PropertyList::real(parseReal(offsetOf(element), textOf(element)));
    }
    if (name == "true" || name == "false") {
        return truth(element, name == "true");
    }
    if (name == "data") {
        if (auto bytes = parseBase64(textOf(element))) {
            return PropertyList::data(*std::move(bytes));
        }
        refuse(offsetOf(element), "data that is no base64");
    }
    if (name == "date") {
        if (const auto date = parseIsoDate(trimmed(textOf(element)))) {
            return *date;
        }
        refuse(offsetOf(element), "a date that is none");
    }
    refuse(offsetOf(element), "an unknown element <" + std::string(name) + ">");
}

PropertyList XmlReader::truth(pugi::xml_node element, bool truth) const {
    if (!trimmed(textOf(element)).empty()) {
        refuse(offsetOf(element), "a text inside a boolean");
    }
    return PropertyList::boolean(truth);
}

PropertyList XmlReader::array(pugi::xml_node element, std::size_t depth) const {
    requireDepth(offsetOf(element), depth);
    Array elements;
    for (const pugi::xml_node child : element.children()) {
        if (isElement(child)) {
            elements.push_back(value(child, depth + 1));
        }
    }
    return elements;
}

PropertyList XmlReader::dictionary(pugi::xml_node element, std::size_t depth) const {
    requireDepth(offsetOf(element), depth);
    Dictionary entries;
    pugi::xml_node key;
    for (const pugi::xml_node child : element.children()) {
        if (!isElement(child)) {
            continue;
        }
        const bool isKey = std::string_view(child.name()) == "key";
        if (isKey == static_cast<bool>(key)) {
            refuse(offsetOf(child), isKey ? "a key without a value" : "a value without a key");
        }
        if (isKey) {
            key = child;
            continue;
        }
        entries.set(textOf(key), value(child, depth + 1));
        key = {};
    }
    if (key) {
        refuse(offsetOf(key), "a key without a value");
    }
    return entries;
}

PropertyList readXml(Bytes bytes) {
    requireReadableSize(bytes);
    std::string text(bytes.begin(), bytes.end());
    if (auto plain = readPlainXml(text)) {
        return *std::move(plain);
    }
    checkXmlMarkup(text);
    const std::size_t start = text.starts_with(kUtf8Mark) ? kUtf8Mark.size() : 0;
    pugi::xml_document document;
    // Includes the terminating null; otherwise the parser would overwrite the last byte with one.
    const pugi::xml_parse_result parsed = document.load_buffer_inplace(
        text.data() + start, text.size() - start + 1, kParsing, pugi::encoding_utf8);
    if (!parsed) {
        refuse(start + static_cast<std::size_t>(std::max<std::ptrdiff_t>(parsed.offset, 0)),
               std::string("malformed XML: ") + parsed.description());
    }
    return XmlReader(start).document(document.root());
}

} // namespace

PropertyListResult parseXmlPropertyList(Bytes bytes) {
    return refusedOr<PropertyList>([&]() -> PropertyListResult { return readXml(bytes); });
}

} // namespace pallax
