#include "tests/doubles/Property.h"
#include "tests/plist/PropertyListSupport.h"
#include "text/Utf8.h"

#include <gtest/gtest.h>

#include <array>
#include <bit>
#include <cmath>

namespace pallax {
namespace {

namespace any = doubles::any;

/// The values that a form can represent.
enum class Reach { kBinary, kXml, kText };

/// The number of elements of a container or text: small, so that nested ones stay small.
int anyCount() {
    constexpr int kMostElements = 5;
    return any::between(0, kMostElements + 1);
}

std::string anyText(Reach reach) {
    struct Range {
        std::int64_t low;
        std::int64_t high;
    };
    constexpr auto kRanges = std::to_array<Range>({{0, 0x80}, {0x80, 0x3000}, {0xE000, 0x110000}});
    std::string text;
    for (int count = anyCount(); count > 0; --count) {
        const Range range = any::elementOf(kRanges);
        const auto number = static_cast<char32_t>(any::longBetween(range.low, range.high));
        const bool control = number < 0x20 && number != '\t' && number != '\n' && number != '\r';
        appendUtf8(text, reach == Reach::kXml && control ? U'?' : number);
    }
    return text;
}

PropertyList anyScalar(Reach reach) {
    constexpr std::int64_t kYear0 = -62167219200;
    constexpr std::int64_t kYear10000 = 253402300800;
    switch (any::between(0, reach == Reach::kText ? 2 : 8)) {
    case 0:
        return anyText(reach);
    case 1:
        return PropertyList::data(any::bytesBelow(256, static_cast<std::size_t>(anyCount())));
    case 2:
        return PropertyList::integer(static_cast<std::int64_t>(any::bits()));
    case 3:
        return PropertyList::integer(any::longBetween(-300, 70000));
    case 4:
        return PropertyList::unsignedInteger(any::bits());
    case 5: {
        const auto number = std::bit_cast<double>(any::bits());
        return PropertyList::real(std::isnan(number) ? 0.1 : number);
    }
    case 6:
        return PropertyList::boolean(any::boolean());
    default:
        return Date(std::chrono::seconds(any::longBetween(kYear0, kYear10000)));
    }
}

PropertyList anyValue(Reach reach, int depth) {
    const int kind = depth == 0 ? 0 : any::between(0, 3);
    if (kind == 0) {
        return anyScalar(reach);
    }
    if (kind == 1) {
        Array elements;
        for (int count = anyCount(); count > 0; --count) {
            elements.push_back(anyValue(reach, depth - 1));
        }
        return elements;
    }
    Dictionary entries;
    for (int count = anyCount(); count > 0; --count) {
        entries.set(anyText(reach), anyValue(reach, depth - 1));
    }
    return entries;
}

constexpr int kDepth = 3;

/// Writes the text form, with one way for each value.
void appendAsText(std::string& out, const PropertyList& object);

void appendQuoted(std::string& out, std::string_view text) {
    out += '"';
    for (const char letter : text) {
        out += letter == '"' || letter == '\\' ? "\\" : "";
        out += letter;
    }
    out += '"';
}

void appendAsText(std::string& out, const PropertyList& object) {
    if (const auto text = object.string()) {
        appendQuoted(out, *text);
    } else if (const SharedBytes data = object.data()) {
        constexpr std::string_view kDigits = "0123456789abcdef";
        out += '<';
        for (const std::uint8_t byte : *data) {
            out += kDigits[byte / 16U];
            out += kDigits[byte % 16U];
        }
        out += '>';
    } else if (const ArrayRef array = object.array()) {
        out += '(';
        for (const PropertyList& element : *array) {
            appendAsText(out, element);
            out += ',';
        }
        out += ')';
    } else if (const DictionaryRef dictionary = object.dictionary()) {
        out += '{';
        for (const Dictionary::Entry& entry : *dictionary) {
            appendQuoted(out, entry.key.view());
            out += " = ";
            appendAsText(out, entry.value);
            out += ";\n";
        }
        out += '}';
    }
}

TEST(PropertyListRoundTrip, XmlReadsBackAsItWasWritten) {
    EXPECT_TRUE(doubles::holds([] {
        const PropertyList list = anyValue(Reach::kXml, kDepth);
        const auto xml = serializeXml(list);
        RC_ASSERT(refusalOf(xml) == "");
        const auto back = parsePropertyList(bytesOf(*xml));
        RC_ASSERT(refusalOf(back) == "");
        RC_ASSERT(*back == list);
        RC_ASSERT(*serializeXml(*back) == *xml); // the same order too
    }));
}

TEST(PropertyListRoundTrip, BinaryReadsBackAsItWasWritten) {
    EXPECT_TRUE(doubles::holds([] {
        const PropertyList list = anyValue(Reach::kBinary, kDepth);
        const auto bytes = serializeBinary(list);
        RC_ASSERT(refusalOf(bytes) == "");
        const auto back = parsePropertyList(*bytes);
        RC_ASSERT(refusalOf(back) == "");
        RC_ASSERT(*back == list);
        RC_ASSERT(*serializeBinary(*back) == *bytes);
    }));
}

TEST(PropertyListRoundTrip, TextReadsBackAsItWasWritten) {
    EXPECT_TRUE(doubles::holds([] {
        const PropertyList list = anyValue(Reach::kText, kDepth);
        std::string text;
        appendAsText(text, list);
        const auto back = parsePropertyList(bytesOf(text));
        RC_ASSERT(refusalOf(back) == "");
        RC_ASSERT(*back == list);
    }));
}

TEST(PropertyListRoundTrip, CutXmlIsRefused) {
    const auto xml = serializeXml(
        Dictionary{{"a", Array{"x & y", PropertyList::integer(5), PropertyList::data({1, 2, 3})}}});
    const std::string_view whole = std::string_view(*xml).substr(0, xml->size() - 1);
    for (std::size_t length = 0; length < whole.size(); ++length) {
        EXPECT_FALSE(parsePropertyList(bytesOf(whole.substr(0, length)))) << length;
    }
    EXPECT_EQ(refusalOf(parsePropertyList(bytesOf(whole))), "");
}

TEST(PropertyListRoundTrip, CutTextIsRefused) {
    const std::string whole = "{ a = ( \"x \\U0041\", <0fbd77>, { b = c; } ); }";
    for (std::size_t length = 0; length < whole.size(); ++length) {
        EXPECT_FALSE(parsePropertyList(bytesOf(whole.substr(0, length)))) << length;
    }
    EXPECT_EQ(refusalOf(parsePropertyList(bytesOf(whole))), "");
}

} // namespace
} // namespace pallax
