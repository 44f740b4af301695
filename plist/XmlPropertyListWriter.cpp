#include "plist/PropertyListCodec.h"
#include "plist/Refusal.h"
#include "plist/XmlStream.h"
#include "text/Base64.h"

#include <array>
#include <charconv>
#include <cmath>

namespace pallax {

namespace {

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

void tellScalar(XmlStream& out, const PropertyList& object) {
    if (const auto text = object.string()) {
        out.text(*text);
    } else if (const auto integer = object.integer()) {
        out.element("integer", std::to_string(*integer));
    } else if (const auto large = object.largeInteger()) {
        out.element("integer", std::to_string(*large));
    } else if (const auto real = object.real()) {
        out.element("real", realText(*real));
    } else if (const auto truth = object.boolean()) {
        out.boolean(*truth);
    } else if (const SharedBytes data = object.data()) {
        out.element("data", base64Text(*data));
    } else if (const auto date = object.date()) {
        const auto moment = isoDateText(*date);
        if (!moment) {
            refuse(0, "a date outside the years 0 to 9999");
        }
        out.element("date", *moment);
    } else {
        refuse(0, "a null object");
    }
}

void tell(XmlStream& out, const PropertyList& object);

void tellArray(XmlStream& out, const Array& array) {
    if (array.empty()) {
        return out.emptyArray();
    }
    out.beginArray();
    for (const PropertyList& element : array) {
        tell(out, element);
    }
    out.endArray();
}

void tellDictionary(XmlStream& out, const Dictionary& dictionary) {
    if (dictionary.empty()) {
        return out.emptyDictionary();
    }
    out.beginDictionary();
    for (const Dictionary::Entry& entry : dictionary) {
        if (!entry.hasStringKey) {
            refuse(0, "a key that is no string");
        }
        out.key(entry.key.view());
        tell(out, entry.value);
    }
    out.endDictionary();
}

void tell(XmlStream& out, const PropertyList& object) {
    if (const ArrayRef elements = object.array()) {
        tellArray(out, *elements);
    } else if (const DictionaryRef entries = object.dictionary()) {
        tellDictionary(out, *entries);
    } else {
        tellScalar(out, object);
    }
}

} // namespace

Result<std::string, CodecError> serializeXml(const PropertyList& object) {
    return refusedOr<std::string>([&]() -> Result<std::string, CodecError> {
        XmlStream stream;
        tell(stream, object);
        const std::string_view xml = stream.finish();
        if (xml.size() > kLargestPropertyList) {
            refuse(0, "a property list larger than 64 MiB");
        }
        return std::string(xml);
    });
}

} // namespace pallax
