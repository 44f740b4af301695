#include "tests/doubles/Property.h"
#include "tests/plist/PropertyListSupport.h"
#include "text/Utf8.h"

#include <gtest/gtest.h>
#include <rapidcheck.h>

#include <bit>
#include <cmath>

namespace pallax {
namespace {

/// Which values a form can hold.
enum class Reach { kBinary, kXml, kText };

/// With up to so many elements, that nested containers stay small.
template <class Container>
rc::Gen<Container> sized(rc::Gen<Container> generator) {
    constexpr int kMostElements = 5;
    return rc::gen::resize(kMostElements, std::move(generator));
}

/// Numbers of any size, however few elements surround them.
template <class Number>
rc::Gen<Number> fullRange(rc::Gen<Number> generator) {
    return rc::gen::resize(rc::kNominalSize, std::move(generator));
}

rc::Gen<std::string> texts(Reach reach) {
    const auto codePoint =
        rc::gen::map(rc::gen::oneOf(fullRange(rc::gen::inRange<std::uint32_t>(0, 0x80)),
                                    fullRange(rc::gen::inRange<std::uint32_t>(0x80, 0x3000)),
                                    fullRange(rc::gen::inRange<std::uint32_t>(0xE000, 0x110000))),
                     [reach](std::uint32_t number) {
                         const bool control =
                             number < 0x20 && number != '\t' && number != '\n' && number != '\r';
                         return reach == Reach::kXml && control ? U'?' : char32_t{number};
                     });
    return rc::gen::map(sized(rc::gen::container<std::vector<char32_t>>(codePoint)),
                        [](const std::vector<char32_t>& codePoints) {
                            std::string text;
                            for (const char32_t next : codePoints) {
                                appendUtf8(text, next);
                            }
                            return text;
                        });
}

rc::Gen<PropertyList> scalars(Reach reach) {
    auto strings =
        rc::gen::map(texts(reach), [](std::string text) { return PropertyList(std::move(text)); });
    auto data = rc::gen::map(
        sized(rc::gen::container<ByteBuffer>(fullRange(rc::gen::arbitrary<std::uint8_t>()))),
        [](ByteBuffer bytes) { return PropertyList::data(std::move(bytes)); });
    if (reach == Reach::kText) {
        return rc::gen::oneOf(strings, data);
    }
    const auto integer = [](std::int64_t number) { return PropertyList::integer(number); };
    const auto real = [](std::uint64_t bits) {
        const auto number = std::bit_cast<double>(bits);
        return PropertyList::real(std::isnan(number) ? 0.1 : number);
    };
    const auto boolean = [](bool truth) { return PropertyList::boolean(truth); };
    const auto date = [](std::int64_t seconds) {
        return PropertyList(Date(std::chrono::seconds(seconds)));
    };
    constexpr std::int64_t kYear0 = -62167219200;
    constexpr std::int64_t kYear10000 = 253402300800;
    return rc::gen::oneOf(
        strings, data, rc::gen::map(fullRange(rc::gen::arbitrary<std::int64_t>()), integer),
        rc::gen::map(fullRange(rc::gen::inRange<std::int64_t>(-300, 70000)), integer),
        rc::gen::map(fullRange(rc::gen::arbitrary<std::uint64_t>()),
                     [](std::uint64_t number) { return PropertyList::unsignedInteger(number); }),
        rc::gen::map(fullRange(rc::gen::arbitrary<std::uint64_t>()), real),
        rc::gen::map(rc::gen::arbitrary<bool>(), boolean),
        rc::gen::map(fullRange(rc::gen::inRange<std::int64_t>(kYear0, kYear10000)), date));
}

rc::Gen<PropertyList> values(Reach reach, int depth) {
    if (depth == 0) {
        return scalars(reach);
    }
    const auto inner = values(reach, depth - 1);
    return rc::gen::oneOf(
        scalars(reach),
        rc::gen::map(sized(rc::gen::container<Array>(inner)),
                     [](Array elements) { return PropertyList(std::move(elements)); }),
        rc::gen::map(sized(rc::gen::container<std::vector<std::pair<std::string, PropertyList>>>(
                         rc::gen::pair(texts(reach), inner))),
                     [](const std::vector<std::pair<std::string, PropertyList>>& pairs) {
                         Dictionary entries;
                         for (const auto& [key, value] : pairs) {
                             entries.set(key, value);
                         }
                         return PropertyList(std::move(entries));
                     }));
}

constexpr int kDepth = 3;

/// A writer of the text form that knows but one way to write each value.
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
        const PropertyList list = *values(Reach::kXml, kDepth);
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
        const PropertyList list = *values(Reach::kBinary, kDepth);
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
        const PropertyList list = *values(Reach::kText, kDepth);
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
