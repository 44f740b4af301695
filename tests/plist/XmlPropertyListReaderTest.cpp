#include "tests/doubles/InOrder.h"
#include "tests/plist/PropertyListSupport.h"

#include <gtest/gtest.h>

#include <cmath>

namespace pallax {
namespace {

using doubles::sameInOrder;

PropertyListResult parseXml(std::string_view xml) {
    return parseXmlPropertyList(bytesOf(xml));
}

PropertyList read(std::string_view xml) {
    return valueOf(parseXml(xml));
}

/// The value of one element inside <plist>.
PropertyList readValue(std::string_view element) {
    return read("<plist>" + std::string(element) + "</plist>");
}

/// Offsets count from the element, without the <plist> before it.
std::string refusalOfValue(std::string_view element) {
    constexpr std::string_view kOpening = "<plist>";
    const auto result = parseXml(std::string(kOpening) + std::string(element) + "</plist>");
    if (result) {
        return "";
    }
    return CodecError{result.error().offset - kOpening.size(), result.error().reason}.text();
}

TEST(XmlPropertyListReader, ReadsEveryType) {
    const PropertyList list =
        read("<?xml version=\"1.0\" encoding=\"UTF-8\"?>\n"
             "<!DOCTYPE plist PUBLIC \"-//X//DTD>\" \"http://x.example/d\">\n"
             "<plist version=\"1.0\">\n"
             "<dict>\n"
             "\t<key>string</key>\n\t<string>a &amp; b</string>\n"
             "\t<key>integer</key>\n\t<integer>-5</integer>\n"
             "\t<key>real</key>\n\t<real>1.5e3</real>\n"
             "\t<key>yes</key>\n\t<true/>\n"
             "\t<key>no</key>\n\t<false></false>\n"
             "\t<key>data</key>\n\t<data>\n\tD71\n\t3\n\t</data>\n"
             "\t<key>date</key>\n\t<date>2023-11-14T22:13:20Z</date>\n"
             "\t<key>array</key>\n\t<array><string>x</string><array/></array>\n"
             "\t<key>dict</key>\n\t<dict/>\n"
             "</dict>\n</plist>\n");
    const PropertyList expected = Dictionary{
        {"string", "a & b"},
        {"integer", PropertyList::integer(-5)},
        {"real", PropertyList::real(1500)},
        {"yes", PropertyList::boolean(true)},
        {"no", PropertyList::boolean(false)},
        {"data", PropertyList::data({0x0F, 0xBD, 0x77})},
        {"date", Date(std::chrono::seconds(1700000000))},
        {"array", Array{"x", Array{}}},
        {"dict", Dictionary{}},
    };
    ASSERT_EQ(list, expected);
    EXPECT_TRUE(sameInOrder(*list.dictionary(), *expected.dictionary()));
}

TEST(XmlPropertyListReader, KeepsTheWhiteSpaceOfStrings) {
    EXPECT_EQ(readValue("<string>  a\t\n b </string>"), PropertyList("  a\t\n b "));
    EXPECT_EQ(readValue("<string>   </string>"), PropertyList("   "));
    EXPECT_EQ(readValue("<string></string>"), PropertyList(""));
    EXPECT_EQ(readValue("<string/>"), PropertyList(""));
    EXPECT_EQ(readValue("<dict><key> k </key><true/></dict>"),
              PropertyList(Dictionary{{" k ", PropertyList::boolean(true)}}));
}

TEST(XmlPropertyListReader, ALineEndIsAnLfUnlessItIsReferredTo) {
    EXPECT_EQ(readValue("<string>a\r\nb\rc&#13;d&#xD;&#10;</string>"),
              PropertyList("a\nb\nc\rd\r\n"));
}

TEST(XmlPropertyListReader, ReadsTheFiveEntitiesAndCharacterReferences) {
    EXPECT_EQ(readValue("<string>&lt;&gt;&amp;&quot;&apos;&#65;&#x20AC;&#x1F4E1;</string>"),
              PropertyList("<>&\"'A\u20AC\U0001F4E1"));
}

TEST(XmlPropertyListReader, CommentsInstructionsAndSectionsMayPartAText) {
    EXPECT_EQ(readValue("<string>a<!-- &no; -->b<?pi &no;?>c<![CDATA[<&no;>]]>d</string>"),
              PropertyList("abc<&no;>d"));
    EXPECT_EQ(read("<!-- one --><plist><!-- two --><true/><?three?></plist><!-- four -->"),
              PropertyList::boolean(true));
}

TEST(XmlPropertyListReader, SkipsAByteOrderMark) {
    EXPECT_EQ(read("\xEF\xBB\xBF<plist><string>\u00E9</string></plist>"), PropertyList("\u00E9"));
    EXPECT_EQ(refusalOf(parseXml("\xEF\xBB\xBF<plist><int/></plist>")),
              "at byte 10: an unknown element <int>");
}

TEST(XmlPropertyListReader, ReadsIntegersOf64Bits) {
    const auto integer = [](std::string_view text) {
        return readValue("<integer>" + std::string(text) + "</integer>");
    };
    EXPECT_EQ(integer(" +7 "), PropertyList::integer(7));
    EXPECT_EQ(integer("0x7f"), PropertyList::integer(127));
    EXPECT_EQ(integer("-0X10"), PropertyList::integer(-16));
    EXPECT_EQ(integer("9223372036854775807"), PropertyList::integer(INT64_MAX));
    EXPECT_EQ(integer("-9223372036854775808"), PropertyList::integer(INT64_MIN));
    EXPECT_EQ(integer("9223372036854775808"), PropertyList::unsignedInteger(9223372036854775808U));
    EXPECT_EQ(integer("0xFFFFFFFFFFFFFFFF"), PropertyList::unsignedInteger(UINT64_MAX));
    for (const char* text : {"18446744073709551616", "-9223372036854775809", "99999999999999999999",
                             "0x10000000000000000"}) {
        EXPECT_EQ(refusalOfValue("<integer>" + std::string(text) + "</integer>"),
                  "at byte 0: an integer beyond 64 bits");
    }
    for (const char* text : {"", "x", "1.5", "--1", "0x", "1 2", "-"}) {
        EXPECT_EQ(refusalOfValue("<integer>" + std::string(text) + "</integer>"),
                  "at byte 0: an integer that is no number");
    }
}

TEST(XmlPropertyListReader, ReadsReals) {
    const auto real = [](std::string_view text) {
        return readValue("<real>" + std::string(text) + "</real>").real().value_or(-777);
    };
    EXPECT_EQ(real("+0.25"), 0.25);
    EXPECT_EQ(real(" -1e-3 "), -1e-3);
    EXPECT_EQ(real(".5"), 0.5);
    EXPECT_EQ(real("INF"), HUGE_VAL);
    EXPECT_EQ(real("+infinity"), HUGE_VAL);
    EXPECT_EQ(real("-infinity"), -HUGE_VAL);
    EXPECT_TRUE(std::isnan(real("nan")));
    EXPECT_TRUE(std::signbit(real("-0")));
    for (const char* text : {"", "1,5", "1.5x", "+-1", "--1", "nan(1)", "0x10", "."}) {
        EXPECT_EQ(refusalOfValue("<real>" + std::string(text) + "</real>"),
                  "at byte 0: a real that is no number")
            << text;
    }
    EXPECT_EQ(refusalOfValue("<real>1e400</real>"),
              "at byte 0: a real beyond the range of a double");
}

TEST(XmlPropertyListReader, ReadsDataStrictlyExceptWhiteSpace) {
    EXPECT_EQ(readValue("<data/>"), PropertyList::data({}));
    EXPECT_EQ(readValue("<data> A A\n= =\t</data>"), PropertyList::data({0}));
    for (const char* text : {"A", "AA", "AAA", "AA=", "A===", "=AAA",
                             "AA==AA==", "AB==", "A_==", "====", "AAAA===="}) {
        EXPECT_EQ(refusalOfValue("<data>" + std::string(text) + "</data>"),
                  "at byte 0: data that is no base64")
            << text;
    }
}

TEST(XmlPropertyListReader, RefusesADateThatIsNone) {
    EXPECT_EQ(refusalOfValue("<date>2023-02-29T00:00:00Z</date>"),
              "at byte 0: a date that is none");
    EXPECT_EQ(refusalOfValue("<date/>"), "at byte 0: a date that is none");
}

TEST(XmlPropertyListReader, AKeyThatStandsTwiceKeepsItsFirstPlaceAndLastValue) {
    const PropertyList list = readValue("<dict><key>a</key><string>1</string>"
                                        "<key>b</key><string>2</string>"
                                        "<key>a</key><string>3</string></dict>");
    EXPECT_TRUE(sameInOrder(*list.dictionary(), Dictionary{{"a", "3"}, {"b", "2"}}));
}

TEST(XmlPropertyListReader, RefusesKeysAndValuesOutOfTurn) {
    EXPECT_EQ(refusalOfValue("<dict><key>a</key></dict>"), "at byte 6: a key without a value");
    EXPECT_EQ(refusalOfValue("<dict><key>a</key><key>b</key><true/></dict>"),
              "at byte 18: a key without a value");
    EXPECT_EQ(refusalOfValue("<dict><true/></dict>"), "at byte 6: a value without a key");
    EXPECT_EQ(refusalOfValue("<array><key>a</key></array>"), "at byte 7: an unknown element <key>");
}

TEST(XmlPropertyListReader, RefusesWhatDoesNotBelong) {
    EXPECT_EQ(refusalOfValue("<int>5</int>"), "at byte 0: an unknown element <int>");
    EXPECT_EQ(refusalOfValue("<array>x</array>"), "at byte 7: a text between elements");
    EXPECT_EQ(refusalOfValue("x<true/>"), "at byte 0: a text between elements");
    EXPECT_EQ(refusalOfValue("<true>x</true>"), "at byte 0: a text inside a boolean");
    EXPECT_EQ(refusalOfValue("<string>a<b/></string>"), "at byte 9: an element inside <string>");
    EXPECT_EQ(refusalOfValue("<true/><true/>"), "at byte 7: a second value inside <plist>");
    EXPECT_EQ(refusalOf(parseXml("<plist/>")), "at byte 0: no value inside <plist>");
    EXPECT_EQ(refusalOf(parseXml("<dict/>")), "at byte 0: a root element other than one <plist>");
    EXPECT_EQ(refusalOf(parseXml("<plist><true/></plist><plist/>")),
              "at byte 22: a root element other than one <plist>");
    EXPECT_EQ(refusalOf(parseXml("<plist><true/></plist>x")),
              "at byte 22: a text between elements");
    EXPECT_EQ(refusalOf(parseXml("x<plist><true/></plist>")), "at byte 0: a text between elements");
}

TEST(XmlPropertyListReader, RefusesAnEmptyInput) {
    EXPECT_EQ(refusalOf(parseXml("")), "at byte 0: an empty input");
    EXPECT_EQ(refusalOf(parseXml(" \n")), "at byte 0: no <plist> element");
    EXPECT_EQ(refusalOf(parseXml("\xEF\xBB\xBF")), "at byte 3: no <plist> element");
    EXPECT_EQ(refusalOf(parseXml("<?xml version=\"1.0\"?>")), "at byte 0: no <plist> element");
}

TEST(XmlPropertyListReader, RefusesMalformedXml) {
    EXPECT_EQ(refusalOf(parseXml("<plist><true></plist>")),
              "at byte 15: malformed XML: Start-end tags mismatch");
    EXPECT_EQ(refusalOf(parseXml("<plist><true/>")),
              "at byte 13: malformed XML: Start-end tags mismatch");
    EXPECT_EQ(refusalOf(parseXml("<plist><![CDATA[x</plist>")),
              "at byte 16: malformed XML: Error parsing CDATA section");
}

TEST(XmlPropertyListReader, RefusesEntitiesBeyondTheFiveOfXml) {
    EXPECT_EQ(refusalOfValue("<string>a&nbsp;</string>"),
              "at byte 9: an entity beyond the five of XML");
    EXPECT_EQ(refusalOfValue("<string a=\">&b;\"/>"),
              "at byte 12: an entity beyond the five of XML");
    EXPECT_EQ(refusalOfValue("<string>a & b</string>"),
              "at byte 10: an \"&\" that begins no reference");
    EXPECT_EQ(refusalOfValue("<string>&amp</string>"),
              "at byte 8: an \"&\" that begins no reference");
    EXPECT_EQ(refusalOfValue("<string>&#x;</string>"),
              "at byte 8: a character reference that is no number");
    EXPECT_EQ(refusalOfValue("<string>&#12a;</string>"),
              "at byte 8: a character reference that is no number");
}

TEST(XmlPropertyListReader, RefusesADocumentTypeWithDeclarations) {
    EXPECT_EQ(refusalOf(parseXml("<!DOCTYPE plist [<!ENTITY a \"x\">]><plist><true/></plist>")),
              "at byte 16: a document type with declarations of its own");
    EXPECT_EQ(read("<!DOCTYPE plist SYSTEM '[>]'><plist><true/></plist>"),
              PropertyList::boolean(true));
}

TEST(XmlPropertyListReader, RefusesCharactersThatXmlCannotHold) {
    using namespace std::string_view_literals;
    EXPECT_EQ(refusalOfValue("<string>a\0</string>"sv),
              "at byte 9: a control character that XML cannot hold");
    EXPECT_EQ(refusalOfValue("<string>a\x1F</string>"),
              "at byte 9: a control character that XML cannot hold");
    for (const char* number : {"0", "x1", "31", "xD800", "x110000", "99999999999999999999"}) {
        EXPECT_EQ(refusalOfValue("<string>&#" + std::string(number) + ";</string>"),
                  "at byte 8: a reference to a character that XML cannot hold")
            << number;
    }
}

TEST(XmlPropertyListReader, RefusesEncodingsOtherThanUtf8) {
    EXPECT_EQ(refusalOfValue("<string>\xE9</string>"), "at byte 8: a byte that is no UTF-8");
    EXPECT_EQ(refusalOfValue("<string>\xC0\x80</string>"), "at byte 8: a byte that is no UTF-8");
    EXPECT_EQ(refusalOfValue("<string>\xED\xA0\x80</string>"),
              "at byte 8: a byte that is no UTF-8");
    EXPECT_EQ(refusalOf(parseXml("\xFE\xFF")), "at byte 0: UTF-16, where only UTF-8 is read");
    EXPECT_EQ(refusalOf(parseXml("<?xml version='1.0' encoding='latin1'?><plist><true/></plist>")),
              "at byte 30: an encoding other than UTF-8");
    EXPECT_EQ(read("<?xml version='1.0' encoding='utf-8'?><plist><true/></plist>"),
              PropertyList::boolean(true));
}

TEST(XmlPropertyListReader, NestsContainers512Deep) {
    const auto nested = [](std::size_t depth) {
        return "<plist>" + repeated("<array>", depth) + repeated("</array>", depth) + "</plist>";
    };
    EXPECT_EQ(depthOf(read(nested(512))), 512U);
    EXPECT_EQ(refusalOf(parseXml(nested(513))), "at byte 3591: containers nested deeper than 512");
    EXPECT_EQ(refusalOf(parseXml(nested(1000000))),
              "at byte 3591: containers nested deeper than 512");
}

} // namespace
} // namespace pallax
