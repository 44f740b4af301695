#include "tests/plist/PropertyListSupport.h"

#include <gtest/gtest.h>

namespace pallax {
namespace {

std::string refusalOfWriting(const PropertyList& object) {
    return refusalOf(serializeBinary(object));
}

/// The bytes of the only object, between the header and the table of one byte.
ByteBuffer onlyObject(const PropertyList& object) {
    constexpr std::size_t kHeader = 8;
    constexpr std::size_t kTableAndTrailer = 33;
    const auto bytes = serializeBinary(object);
    EXPECT_EQ(refusalOf(bytes), "");
    EXPECT_GT(bytes->size(), kHeader + kTableAndTrailer);
    return {bytes->begin() + kHeader, bytes->end() - kTableAndTrailer};
}

TEST(BinaryPropertyListWriter, WritesHeaderObjectsTableAndTrailer) {
    const auto bytes = serializeBinary(Dictionary{{"k", Array{"k", PropertyList::boolean(true)}}});
    ASSERT_EQ(refusalOf(bytes), "");
    const ByteBuffer expected = {
        'b',  'p',  'l',  'i', 's', 't', '0', '0', //
        0xD1, 0x01, 0x02,                          // 0: the dictionary
        0x51, 'k',                                 // 1: written once
        0xA2, 0x01, 0x03,                          // 2: the array
        0x09,                                      // 3: true
        8,    11,   13,   16,                      // their offsets
        0,    0,    0,    0,   0,   0,   1,   1,   // widths
        0,    0,    0,    0,   0,   0,   0,   4,   // objects
        0,    0,    0,    0,   0,   0,   0,   0,   // the root
        0,    0,    0,    0,   0,   0,   0,   17,  // the table
    };
    EXPECT_EQ(*bytes, expected);
}

TEST(BinaryPropertyListWriter, WritesIntegersInTheFewestBytes) {
    EXPECT_EQ(onlyObject(PropertyList::integer(255)), (ByteBuffer{0x10, 0xFF}));
    EXPECT_EQ(onlyObject(PropertyList::integer(256)), (ByteBuffer{0x11, 1, 0}));
    EXPECT_EQ(onlyObject(PropertyList::integer(65536)), (ByteBuffer{0x12, 0, 1, 0, 0}));
    EXPECT_EQ(onlyObject(PropertyList::integer(4294967296)),
              (ByteBuffer{0x13, 0, 0, 0, 1, 0, 0, 0, 0}));
    EXPECT_EQ(onlyObject(PropertyList::integer(-1)),
              (ByteBuffer{0x13, 0xFF, 0xFF, 0xFF, 0xFF, 0xFF, 0xFF, 0xFF, 0xFF}));
}

TEST(BinaryPropertyListWriter, WritesTheOtherScalars) {
    EXPECT_EQ(onlyObject("ab"), (ByteBuffer{0x52, 'a', 'b'}));
    EXPECT_EQ(onlyObject("\u00E9\U0001F4E1"),
              (ByteBuffer{0x63, 0x00, 0xE9, 0xD8, 0x3D, 0xDC, 0xE1}));
    EXPECT_EQ(onlyObject(PropertyList::data({1, 2})), (ByteBuffer{0x42, 1, 2}));
    EXPECT_EQ(onlyObject(PropertyList::real(1.5)),
              (ByteBuffer{0x23, 0x3F, 0xF8, 0, 0, 0, 0, 0, 0}));
    EXPECT_EQ(onlyObject(Date(std::chrono::seconds(978307201))),
              (ByteBuffer{0x33, 0x3F, 0xF0, 0, 0, 0, 0, 0, 0}));
    EXPECT_EQ(onlyObject("0123456789abcde").at(1), 0x10);
}

TEST(BinaryPropertyListWriter, RefusesWhatTheFormCannotHold) {
    EXPECT_EQ(refusalOfWriting(PropertyList()), "at byte 0: a null object");
    EXPECT_EQ(refusalOfWriting("\xE9"), "at byte 0: a text that is no UTF-8");
    EXPECT_EQ(refusalOfWriting(Date(std::chrono::sys_days(std::chrono::January / 1 / -1))),
              "at byte 0: a date outside the years 0 to 9999");
    Dictionary foreign;
    foreign.appendForeignKey(PropertyList::integer(5), "five");
    EXPECT_EQ(refusalOfWriting(foreign), "at byte 0: a key that is no string");
    EXPECT_EQ(refusalOfWriting(nestedArrays(513)), "at byte 0: containers nested deeper than 512");
}

TEST(BinaryPropertyListWriter, RefusesAnOutputLargerThan64Mebibytes) {
    EXPECT_EQ(refusalOfWriting(PropertyList::data(ByteBuffer(kLargestPropertyList))),
              "at byte 0: a property list larger than 64 MiB");
    const PropertyList data = PropertyList::data(ByteBuffer(std::size_t{63} << 20U));
    EXPECT_EQ(refusalOfWriting(Array{data, Array(std::size_t{1} << 20U, "x")}),
              "at byte 0: a property list larger than 64 MiB");
}

} // namespace
} // namespace pallax
