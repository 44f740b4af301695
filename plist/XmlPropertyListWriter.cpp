#include "plist/PropertyListCodec.h"
#include "plist/Refusal.h"
#include "plist/XmlMarkupCheck.h"
#include "text/Base64.h"
#include "text/Utf8.h"

#include <algorithm>
#include <array>
#include <charconv>
#include <cmath>

namespace pallax {

namespace {

constexpr std::string_view kOpening = "<?xml version=\"1.0\" encoding=\"UTF-8\"?>\n"
                                      "<plist version=\"1.0\">\n";
constexpr std::string_view kClosing = "</plist>\n";

/// Stands in XML as it is, whatever comes before and after it.
bool needsNoEscape(char letter) {
    return letter >= ' ' && letter <= '~' && letter != '&' && letter != '<' && letter != '>';
}

void appendEscaped(std::string& out, std::string_view text) {
    for (std::size_t at = 0; at < text.size();) {
        const auto rest = text.substr(at);
        const auto plain = static_cast<std::size_t>(
            std::find_if_not(rest.begin(), rest.end(), needsNoEscape) - rest.begin());
        if (plain > 0) {
            out += rest.substr(0, plain);
            at += plain;
            continue;
        }
        const Utf8CodePoint next = utf8At(text, at);
        if (next.size == 0) {
            refuse(0, "a text that is no UTF-8");
        }
        if (!isXmlCharacter(next.value)) {
            refuse(0, "a text with a control character that XML cannot hold");
        }
        switch (next.value) {
        case '&':
            out += "&amp;";
            break;
        case '<':
            out += "&lt;";
            break;
        case '>':
            out += "&gt;";
            break;
        case '\r': // as it stands, a reader would take it for a line end and make it an LF
            out += "&#13;";
            break;
        default:
            out += text.substr(at, next.size);
            break;
        }
        at += next.size;
    }
}

/// The shortest text that reads back as the same value.
std::string realText(double number) {
    if (std::isnan(number)) {
        return "nan";
    }
    if (std::isinf(number)) {
        return number > 0 ? "+infinity" : "-infinity";
    }
    constexpr std::size_t kLongest = 32;
    std::array<char, kLongest> digits{};
    const auto end = std::to_chars(digits.data(), digits.data() + digits.size(), number).ptr;
    return {digits.data(), end};
}

class XmlWriter {
public:
    std::string write(const PropertyList& object) {
        _out += kOpening;
        value(object, 1);
        _out += kClosing;
        return std::move(_out);
    }

private:
    void value(const PropertyList& object, std::size_t depth);
    void scalar(const PropertyList& object);
    void date(Date date);
    void array(const Array& array, std::size_t depth);
    void dictionary(const Dictionary& dictionary, std::size_t depth);

    void element(std::string_view name, std::string_view text);
    void textElement(std::string_view name, std::string_view text);
    void indent(std::size_t depth) { _out.append(depth - 1, '\t'); }

    std::string _out;
};

void XmlWriter::element(std::string_view name, std::string_view text) {
    _out.append("<").append(name).append(">").append(text);
    _out.append("</").append(name).append(">\n");
}

void XmlWriter::textElement(std::string_view name, std::string_view text) {
    _out.append("<").append(name).append(">");
    appendEscaped(_out, text);
    _out.append("</").append(name).append(">\n");
}

void XmlWriter::value(const PropertyList& object, std::size_t depth) {
    // What is larger could not be read back; shared containers can make it so.
    if (_out.size() > kLargestPropertyList - kClosing.size()) {
        refuse(0, "a property list larger than 64 MiB");
    }
    indent(depth);
    if (const ArrayRef elements = object.array()) {
        array(*elements, depth);
    } else if (const DictionaryRef entries = object.dictionary()) {
        dictionary(*entries, depth);
    } else {
        scalar(object);
    }
}

void XmlWriter::scalar(const PropertyList& object) {
    if (const auto text = object.string()) {
        textElement("string", *text);
    } else if (const auto integer = object.integer()) {
        element("integer", std::to_string(*integer));
    } else if (const auto large = object.largeInteger()) {
        element("integer", std::to_string(*large));
    } else if (const auto real = object.real()) {
        element("real", realText(*real));
    } else if (const auto truth = object.boolean()) {
        _out += *truth ? "<true/>\n" : "<false/>\n";
    } else if (const SharedBytes data = object.data()) {
        element("data", base64Text(*data));
    } else if (const auto moment = object.date()) {
        date(*moment);
    } else {
        refuse(0, "a null object");
    }
}

void XmlWriter::date(Date date) {
    const auto text = isoDateText(date);
    if (!text) {
        refuse(0, "a date outside the years 0 to 9999");
    }
    element("date", *text);
}

void XmlWriter::array(const Array& array, std::size_t depth) {
    requireDepth(0, depth);
    if (array.empty()) {
        _out += "<array/>\n";
        return;
    }
    _out += "<array>\n";
    for (const PropertyList& element : array) {
        value(element, depth + 1);
    }
    indent(depth);
    _out += "</array>\n";
}

void XmlWriter::dictionary(const Dictionary& dictionary, std::size_t depth) {
    requireDepth(0, depth);
    if (dictionary.empty()) {
        _out += "<dict/>\n";
        return;
    }
    _out += "<dict>\n";
    for (const Dictionary::Entry& entry : dictionary) {
        if (!entry.hasStringKey) {
            refuse(0, "a key that is no string");
        }
        indent(depth + 1);
        textElement("key", entry.key.view());
        value(entry.value, depth + 1);
    }
    indent(depth);
    _out += "</dict>\n";
}

} // namespace

Result<std::string, CodecError> serializeXml(const PropertyList& object) {
    return refusedOr<std::string>([&]() -> Result<std::string, CodecError> {
        std::string xml = XmlWriter().write(object);
        if (xml.size() > kLargestPropertyList) {
            refuse(0, "a property list larger than 64 MiB");
        }
        return xml;
    });
}

} // namespace pallax
