#include "plist/PlainXmlReader.h"

#include "plist/PropertyListCodec.h"
#include "tests/doubles/InOrder.h"
#include "tests/doubles/Property.h"

#include <gtest/gtest.h>

#include <string>
#include <vector>

namespace pallax {
namespace {

using doubles::sameInOrder;

constexpr const char* kHead =
    "<?xml version=\"1.0\" encoding=\"UTF-8\"?>\n<plist version=\"1.0\">\n";
constexpr const char* kTail = "</plist>\n";

std::string listOf(const std::string& value) {
    return kHead + value + kTail;
}

/// The whole reader's result for a text; a comment makes the plain reader refuse it.
PropertyListResult wholeReading(const std::string& xml) {
    const std::string commented = xml + "<!-- -->";
    return parseXmlPropertyList(ByteBuffer(commented.begin(), commented.end()));
}

TEST(PlainXmlReader, ReadsEveryKindOfPlainValue) {
    const auto read = readPlainXml(listOf("<dict>\n\t<key>A</key>\n\t<string> x > y </string>\n"
                                          "<key>B</key><array><integer>-7</integer><true/>"
                                          "<false/><string></string></array>"
                                          "<key>A b</key><dict></dict><key>C</key><dict/>"
                                          "<key>D</key><array/></dict>\n"));
    ASSERT_TRUE(read);
    const Array list{PropertyList::integer(-7), PropertyList::boolean(true),
                     PropertyList::boolean(false), ""};
    EXPECT_EQ(*read, (Dictionary{{"A", " x > y "},
                                 {"B", list},
                                 {"A b", Dictionary()},
                                 {"C", Dictionary()},
                                 {"D", Array()}}));
}

TEST(PlainXmlReader, AKeyThatComesAgainKeepsItsPlaceAndTakesTheLaterValue) {
    const auto read =
        readPlainXml(listOf("<dict><key>A</key><string>1</string><key>B</key>"
                            "<string>2</string><key>A</key><string>3</string></dict>"));
    ASSERT_TRUE(read);
    EXPECT_TRUE(sameInOrder(*read->dictionary(), Dictionary{{"A", "3"}, {"B", "2"}}));
}

TEST(PlainXmlReader, LeavesWhatIsNotPlainToTheWholeReader) {
    for (const char* value : {"",
                              "<string>a&amp;b</string>",
                              "<string>\xC3\xA4</string>",
                              "<string>a\rb</string>",
                              "<string>a\x01z</string>",
                              "<string>a<!-- --></string>",
                              "<string a=\"1\">b</string>",
                              "<string/>",
                              "<real>1.5</real>",
                              "<date>2023-11-14T22:13:20Z</date>",
                              "<data>AAAA</data>",
                              "<integer>+5</integer>",
                              "<integer> 5</integer>",
                              "<integer>0x10</integer>",
                              "<integer>9223372036854775808</integer>",
                              "<dict><key>A</key></dict>",
                              "<dict><string>A</string></dict>",
                              "<array>x</array>",
                              "<string>a</string><string>b</string>",
                              "<array>",
                              "<unknown/>",
                              "<string>a"}) {
        EXPECT_EQ(readPlainXml(listOf(value)), std::nullopt) << value;
    }
    EXPECT_EQ(readPlainXml(listOf("<true/>") + "x"), std::nullopt);
    EXPECT_EQ(readPlainXml("<plist><true/></plist>"), std::nullopt);
}

TEST(PlainXmlReader, ReadsContainersAsDeepAsTheWholeReaderDoes) {
    for (const std::size_t depth : {kDeepestPropertyList, kDeepestPropertyList + 1}) {
        std::string value;
        for (std::size_t count = 0; count < depth; ++count) {
            value = "<array>" + value + "</array>";
        }
        const std::string xml = listOf(value);
        EXPECT_EQ(readPlainXml(xml).has_value(), depth == kDeepestPropertyList);
        EXPECT_EQ(static_cast<bool>(wholeReading(xml)), depth == kDeepestPropertyList);
    }
}

/// A random piece of texts that are plain or almost plain.
std::string randomXml() {
    static const std::vector<std::string> kPieces = {"<dict>",
                                                     "</dict>",
                                                     "<array>",
                                                     "</array>",
                                                     "<key>K</key>",
                                                     "<key></key>",
                                                     "<true/>",
                                                     "<false/>",
                                                     "<string>",
                                                     "</string>",
                                                     "text",
                                                     " ",
                                                     "\n\t",
                                                     "&lt;",
                                                     "\xC3\xA4",
                                                     "<key>L</key><string>v</string>",
                                                     "<integer>12</integer>",
                                                     "<integer>-0</integer>",
                                                     "<string> a b </string>",
                                                     "<dict></dict>",
                                                     "<dict/>",
                                                     "<array/>",
                                                     "<array></array>",
                                                     "<key>M</key><array><true/></array>"};
    std::string value;
    for (int count = doubles::any::between(0, 12); count > 0; --count) {
        value += doubles::any::elementOf(kPieces);
    }
    const std::vector<std::string> openings = {"", "<dict>", "<array>"};
    const std::vector<std::string> endings = {"", "</dict>", "</array>"};
    return listOf(doubles::any::elementOf(openings) + value + doubles::any::elementOf(endings));
}

TEST(PlainXmlReader, WhatItReadsTheWholeReaderReadsAlike) {
    EXPECT_TRUE(doubles::holds([] {
        const std::string xml = randomXml();
        const auto plain = readPlainXml(xml);
        const auto whole = wholeReading(xml);
        RC_CLASSIFY(plain.has_value(), "plain");
        if (plain) {
            RC_ASSERT(static_cast<bool>(whole));
            RC_ASSERT(*whole == *plain);
            RC_ASSERT(whole->description() == plain->description());
        }
    }));
}

} // namespace
} // namespace pallax
