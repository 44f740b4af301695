#include "plist/XmlWritable.h"

#include "plist/PropertyListCodec.h"
#include "tests/doubles/Property.h"

#include <gtest/gtest.h>

#include <string>
#include <vector>

namespace pallax {
namespace {

using Paths = std::vector<std::string>;

struct Writable {
    PropertyList object;
    Paths paths;
};

Writable writable(const PropertyList& object) {
    Paths paths;
    PropertyList changed =
        writableInXml(object, [&](const std::string& path) { paths.push_back(path); });
    return {std::move(changed), std::move(paths)};
}

/// A text with U+FFFD for each "?".
std::string replaced(const std::string& text) {
    std::string out;
    for (const char letter : text) {
        out += letter == '?' ? "\xEF\xBF\xBD" : std::string(1, letter);
    }
    return out;
}

TEST(XmlWritable, WhatXmlCanHoldIsShared) {
    const ArrayRef data = std::make_shared<Array>(Array{"tab\tline\nreturn\r, ü, \xF0\x9F\x98\x80",
                                                        PropertyList::integer(1), PropertyList()});
    const auto result = writable(data);
    EXPECT_EQ(result.object.array(), data);
    EXPECT_EQ(result.paths, Paths{});
}

TEST(XmlWritable, EachForbiddenCharacterIsReplacedByOne) {
    const std::string nul("a\0b", 3);
    EXPECT_EQ(writable(nul).object, PropertyList(replaced("a?b")));
    EXPECT_EQ(writable("\x1b[0m\x1f").object, PropertyList(replaced("?[0m?")));
    EXPECT_EQ(writable("\xEF\xBF\xBE\xEF\xBF\xBF").object, PropertyList(replaced("??")))
        << "U+FFFE and U+FFFF";
    EXPECT_EQ(writable("\xEF\xBF\xBD").paths, Paths{}) << "U+FFFD itself is allowed";
}

TEST(XmlWritable, EachByteThatIsNoUtf8IsReplaced) {
    EXPECT_EQ(writable("x\xFFy").object, PropertyList(replaced("x?y")));
    EXPECT_EQ(writable("\xED\xA0\x80").object, PropertyList(replaced("???"))) << "a lone surrogate";
    EXPECT_EQ(writable("cut \xC3").object, PropertyList(replaced("cut ?")));
}

TEST(XmlWritable, ThePathsOfTheValuesAreTold) {
    const PropertyList object(
        Dictionary{{"Fine", "fine"},
                   {"Data", Array{"fine", Dictionary{{"Bad", "\x01"}, {"Fine", "x"}}, "\x02"}}});
    const auto result = writable(object);
    EXPECT_EQ(result.paths, (Paths{"/Data/1/Bad", "/Data/2"}));
    EXPECT_EQ(result.object,
              PropertyList(Dictionary{
                  {"Fine", "fine"},
                  {"Data", Array{"fine", Dictionary{{"Bad", replaced("?")}, {"Fine", "x"}},
                                 replaced("?")}}}));
    EXPECT_EQ(object.dictionary()->find("Data")->array()->at(2), PropertyList("\x02"))
        << "the object itself is unchanged";
}

TEST(XmlWritable, KeysAreReplacedAndNoEntryTakesTheOthersPlace) {
    const auto result =
        writable(Dictionary{{"k\x01", "1"}, {"k\x02", "2"}, {"k\xEF\xBF\xBD", "3"}});
    Paths keys;
    for (const Dictionary::Entry& entry : *result.object.dictionary()) {
        keys.push_back(entry.key.string());
    }
    EXPECT_EQ(keys, (Paths{replaced("k? (1)"), replaced("k? (2)"), replaced("k?")}));
    EXPECT_EQ(result.paths, (Paths{replaced("/k? (1)"), replaced("/k? (2)")}));
}

TEST(XmlWritable, WhatCannotBeWrittenAnywayStaysAsItIs) {
    Dictionary foreign;
    foreign.appendForeignKey(PropertyList::integer(1), "\x01");
    EXPECT_EQ(writable(foreign).paths, Paths{});
    PropertyList deep = "\x01";
    for (std::size_t depth = 0; depth <= kDeepestPropertyList; ++depth) {
        deep = Array{deep};
    }
    EXPECT_EQ(writable(deep).paths, Paths{});
}

TEST(XmlWritableProperty, AnyTextsCanBeWrittenAndAreReadBack) {
    EXPECT_TRUE(doubles::holds([] {
        const auto texts = doubles::any::texts();
        Dictionary dictionary;
        for (const std::string& text : texts) {
            dictionary.set(Text(text), Array{text});
        }
        const PropertyList object = writable(dictionary).object;
        RC_ASSERT(object.dictionary()->size() == dictionary.size());
        const auto xml = serializeXml(object);
        RC_ASSERT(static_cast<bool>(xml));
        const auto read = parsePropertyList(ByteBuffer(xml->begin(), xml->end()));
        RC_ASSERT(static_cast<bool>(read));
        RC_ASSERT(*read == object);
    }));
}

} // namespace
} // namespace pallax
