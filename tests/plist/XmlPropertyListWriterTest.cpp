#include "tests/plist/PropertyListSupport.h"

#include <gtest/gtest.h>

#include <cmath>
#include <limits>

namespace pallax {
namespace {

constexpr NumberFormat kWrittenDbm{"%d dBm"};

/// The line of one value.
std::string written(const PropertyList& object) {
    const auto xml = serializeXml(object);
    if (!xml) {
        return xml.error().text();
    }
    const std::string opening =
        "<?xml version=\"1.0\" encoding=\"UTF-8\"?>\n<plist version=\"1.0\">\n";
    const std::string closing = "\n</plist>\n";
    EXPECT_TRUE(xml->starts_with(opening) && xml->ends_with(closing)) << *xml;
    return xml->substr(opening.size(), xml->size() - opening.size() - closing.size());
}

TEST(XmlPropertyListWriter, WritesOneElementALine) {
    const PropertyList list = Dictionary{
        {"string", "a"},
        {"<key>", DisplayNumber(std::int64_t{-80}, kWrittenDbm)},
        {"list", Array{PropertyList::integer(-5), PropertyList::boolean(true),
                       PropertyList::boolean(false), Array{}, Dictionary{}}},
        {"data", PropertyList::data({0x0F, 0xBD, 0x77, 0x00})},
        {"date", Date(std::chrono::seconds(1700000000))},
        {"real", PropertyList::real(0.1)},
    };
    const auto xml = serializeXml(list);
    ASSERT_EQ(refusalOf(xml), "");
    EXPECT_EQ(*xml, "<?xml version=\"1.0\" encoding=\"UTF-8\"?>\n"
                    "<plist version=\"1.0\">\n"
                    "<dict>\n"
                    "\t<key>string</key>\n"
                    "\t<string>a</string>\n"
                    "\t<key>&lt;key&gt;</key>\n"
                    "\t<string>-80 dBm</string>\n"
                    "\t<key>list</key>\n"
                    "\t<array>\n"
                    "\t\t<integer>-5</integer>\n"
                    "\t\t<true/>\n"
                    "\t\t<false/>\n"
                    "\t\t<array/>\n"
                    "\t\t<dict/>\n"
                    "\t</array>\n"
                    "\t<key>data</key>\n"
                    "\t<data>D713AA==</data>\n"
                    "\t<key>date</key>\n"
                    "\t<date>2023-11-14T22:13:20Z</date>\n"
                    "\t<key>real</key>\n"
                    "\t<real>0.1</real>\n"
                    "</dict>\n"
                    "</plist>\n");
}

TEST(XmlPropertyListWriter, EscapesWhatWouldNotReadBack) {
    EXPECT_EQ(written("<a> & \"b\"\t'c'\r\n"),
              "<string>&lt;a&gt; &amp; \"b\"\t'c'&#13;\n</string>");
    EXPECT_EQ(written(""), "<string></string>");
    EXPECT_EQ(written("\u00E9\U0001F4E1"), "<string>\u00E9\U0001F4E1</string>");
}

TEST(XmlPropertyListWriter, WritesRealsInTheirShortestForm) {
    EXPECT_EQ(written(PropertyList::real(-0.0)), "<real>-0</real>");
    EXPECT_EQ(written(PropertyList::real(5)), "<real>5</real>");
    EXPECT_EQ(written(PropertyList::real(1e300)), "<real>1e+300</real>");
    EXPECT_EQ(written(PropertyList::real(std::numeric_limits<double>::denorm_min())),
              "<real>5e-324</real>");
    EXPECT_EQ(written(PropertyList::real(std::nan(""))), "<real>nan</real>");
    EXPECT_EQ(written(PropertyList::real(-std::nan(""))), "<real>nan</real>");
    EXPECT_EQ(written(PropertyList::real(HUGE_VAL)), "<real>+infinity</real>");
    EXPECT_EQ(written(PropertyList::real(-HUGE_VAL)), "<real>-infinity</real>");
}

TEST(XmlPropertyListWriter, RefusesWhatXmlCannotHold) {
    EXPECT_EQ(written(PropertyList()), "at byte 0: a null object");
    EXPECT_EQ(written(Array{PropertyList()}), "at byte 0: a null object");
    EXPECT_EQ(written("a\x01"), "at byte 0: a text with a control character that XML cannot hold");
    EXPECT_EQ(written(std::string(1, '\0')),
              "at byte 0: a text with a control character that XML cannot hold");
    EXPECT_EQ(written(Dictionary{{"\x1F", "a"}}),
              "at byte 0: a text with a control character that XML cannot hold");
    EXPECT_EQ(written("\xE9"), "at byte 0: a text that is no UTF-8");
    EXPECT_EQ(written(Date(std::chrono::sys_days(std::chrono::January / 1 / 10000))),
              "at byte 0: a date outside the years 0 to 9999");
    Dictionary foreign;
    foreign.appendForeignKey(PropertyList::integer(5), "five");
    EXPECT_EQ(written(foreign), "at byte 0: a key that is no string");
}

TEST(XmlPropertyListWriter, RefusesContainersDeeperThan512) {
    EXPECT_TRUE(serializeXml(nestedArrays(512)));
    EXPECT_EQ(written(nestedArrays(513)), "at byte 0: containers nested deeper than 512");
    const auto circle = std::make_shared<Array>();
    circle->emplace_back(circle);
    EXPECT_EQ(written(circle), "at byte 0: containers nested deeper than 512");
    circle->clear();
}

TEST(XmlPropertyListWriter, RefusesAnOutputLargerThan64Mebibytes) {
    PropertyList shared = Array{};
    for (int level = 0; level < 40; ++level) {
        shared = Array{shared, shared};
    }
    EXPECT_EQ(written(shared), "at byte 0: a property list larger than 64 MiB");
    EXPECT_EQ(written(PropertyList::data(ByteBuffer(std::size_t{50} << 20U))),
              "at byte 0: a property list larger than 64 MiB");
}

} // namespace
} // namespace pallax
