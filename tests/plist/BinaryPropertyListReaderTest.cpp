#include "tests/doubles/InOrder.h"
#include "tests/plist/PropertyListSupport.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <array>
#include <cmath>

namespace pallax {
namespace {

using doubles::sameInOrder;

PropertyListResult parse(const std::vector<ByteBuffer>& objects) {
    return parseBinaryPropertyList(BinaryFile(objects).bytes());
}

PropertyList read(const std::vector<ByteBuffer>& objects) {
    return valueOf(parse(objects));
}

std::string refusal(const std::vector<ByteBuffer>& objects) {
    return refusalOf(parse(objects));
}

/// A file of one object, true: 8 bytes of header, 1 of object, 2 of table, 32 of trailer.
ByteBuffer smallFile() {
    const BinaryFile file(std::vector<ByteBuffer>{{0x09}});
    return {file.bytes().begin(), file.bytes().end()};
}

std::string refusalWith(std::size_t at, std::uint8_t byte) {
    ByteBuffer bytes = smallFile();
    bytes.at(at) = byte;
    return refusalOf(parseBinaryPropertyList(bytes));
}

TEST(BinaryPropertyListReader, ReadsIntegersOfEveryWidth) {
    EXPECT_EQ(read({{0x10, 0xFF}}), PropertyList::integer(255));
    EXPECT_EQ(read({{0x11, 0xFF, 0xFE}}), PropertyList::integer(65534));
    EXPECT_EQ(read({{0x12, 0xFF, 0xFF, 0xFF, 0xFF}}), PropertyList::integer(4294967295));
    EXPECT_EQ(read({{0x13, 0xFF, 0xFF, 0xFF, 0xFF, 0xFF, 0xFF, 0xFF, 0xFE}}),
              PropertyList::integer(-2));
    EXPECT_EQ(read({{0x14, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 7}}),
              PropertyList::integer(7));
    ByteBuffer minusOne(17, 0xFF);
    minusOne[0] = 0x14;
    EXPECT_EQ(read({minusOne}), PropertyList::integer(-1));
}

TEST(BinaryPropertyListReader, ReadsIntegersThatNeed64BitsWithoutASign) {
    const PropertyList least = read({{0x14, 0, 0, 0, 0, 0, 0, 0, 0, 0x80, 0, 0, 0, 0, 0, 0, 0}});
    EXPECT_EQ(least, PropertyList::unsignedInteger(9223372036854775808U));
    EXPECT_EQ(least.integer(), std::nullopt);
    EXPECT_EQ(least.int32(), std::nullopt);
    EXPECT_EQ(least.description(), "9223372036854775808");
    ByteBuffer most(17, 0xFF);
    std::fill(most.begin(), most.begin() + 9, std::uint8_t{0});
    most[0] = 0x14;
    EXPECT_EQ(read({most}).largeInteger(), 18446744073709551615U);
}

TEST(BinaryPropertyListReader, RefusesIntegersBeyond64Bits) {
    EXPECT_EQ(refusal({{0x14, 0, 0, 0, 0, 0, 0, 0, 1, 0, 0, 0, 0, 0, 0, 0, 7}}),
              "at byte 8: an integer beyond 64 bits");
    ByteBuffer belowTheLeast(17, 0xFF);
    belowTheLeast[0] = 0x14;
    belowTheLeast[9] = 0x7F;
    EXPECT_EQ(refusal({belowTheLeast}), "at byte 8: an integer beyond 64 bits");
    EXPECT_EQ(refusal({{0x15}}), "at byte 8: an integer wider than 16 bytes");
}

TEST(BinaryPropertyListReader, ReadsRealsOfFourAndEightBytes) {
    EXPECT_EQ(read({{0x22, 0x3F, 0xC0, 0, 0}}), PropertyList::real(1.5));
    EXPECT_EQ(read({{0x23, 0xBF, 0xF8, 0, 0, 0, 0, 0, 0}}), PropertyList::real(-1.5));
    EXPECT_TRUE(std::isnan(read({{0x22, 0x7F, 0xC0, 0, 0}}).real().value_or(0)));
    EXPECT_EQ(refusal({{0x21, 0, 0}}), "at byte 8: a real of neither 4 nor 8 bytes");
}

TEST(BinaryPropertyListReader, ReadsDatesInWholeSecondsFrom2001) {
    const Date reference{std::chrono::sys_days(std::chrono::January / 1 / 2001)};
    EXPECT_EQ(read({{0x33, 0, 0, 0, 0, 0, 0, 0, 0}}), PropertyList(reference));
    // 1.5 and -1.5 seconds
    EXPECT_EQ(read({{0x33, 0x3F, 0xF8, 0, 0, 0, 0, 0, 0}}),
              PropertyList(reference + std::chrono::seconds(1)));
    EXPECT_EQ(read({{0x33, 0xBF, 0xF8, 0, 0, 0, 0, 0, 0}}),
              PropertyList(reference - std::chrono::seconds(2)));
}

TEST(BinaryPropertyListReader, RefusesDatesOutsideTheYears0To9999) {
    const std::string expected = "at byte 8: a date outside the years 0 to 9999";
    EXPECT_EQ(refusal({{0x33, 0x7F, 0xF8, 0, 0, 0, 0, 0, 0}}), expected); // not a number
    EXPECT_EQ(refusal({{0x33, 0x7F, 0xF0, 0, 0, 0, 0, 0, 0}}), expected); // infinity
    EXPECT_EQ(refusal({{0x33, 0xC3, 0xE0, 0, 0, 0, 0, 0, 0}}), expected); // -2^63
    EXPECT_EQ(refusal({{0x32, 0, 0, 0, 0}}), "at byte 8: a date of other than 8 bytes");
}

TEST(BinaryPropertyListReader, ReadsStringsOfEachKind) {
    EXPECT_EQ(read({{0x52, 'a', 'b'}}), PropertyList("ab"));
    EXPECT_EQ(read({{0x63, 0x00, 0xE9, 0xD8, 0x3D, 0xDC, 0xE1}}), PropertyList("\u00E9\U0001F4E1"));
    EXPECT_EQ(read({{0x72, 0xC3, 0xA9}}), PropertyList("\u00E9"));
    EXPECT_EQ(read({{0x5F, 0x10, 0x01, 'a'}}), PropertyList("a"));
    EXPECT_EQ(read({{0x50}}), PropertyList(""));
}

TEST(BinaryPropertyListReader, RefusesBrokenStrings) {
    EXPECT_EQ(refusal({{0x52, 'a', 0x80}}), "at byte 8: an ASCII string with a byte beyond ASCII");
    EXPECT_EQ(refusal({{0x71, 0xC3}}), "at byte 8: a UTF-8 string that is no UTF-8");
    const std::string half = "at byte 8: a UTF-16 string with half a surrogate pair";
    EXPECT_EQ(refusal({{0x61, 0xD8, 0x3D}}), half);
    EXPECT_EQ(refusal({{0x61, 0xDC, 0xE1}}), half);
    EXPECT_EQ(refusal({{0x62, 0xD8, 0x3D, 0x00, 0x41}}), half);
}

TEST(BinaryPropertyListReader, ReadsContainers) {
    EXPECT_EQ(read({{0xA3, 1, 2, 1}, {0x51, 'a'}, {0x09}}),
              PropertyList(Array{"a", PropertyList::boolean(true), "a"}));
    const PropertyList list = read({{0xD2, 1, 2, 2, 1}, {0x51, 'b'}, {0x51, 'a'}});
    EXPECT_TRUE(sameInOrder(*list.dictionary(), Dictionary{{"b", "a"}, {"a", "b"}}));
}

TEST(BinaryPropertyListReader, AContainerThatReferencesShareBecomesOneForEach) {
    const PropertyList list = read({{0xA2, 1, 1}, {0xA0}});
    ASSERT_EQ(list, PropertyList(Array{Array{}, Array{}}));
    list.array()->front().array()->emplace_back("x");
    EXPECT_EQ(list, PropertyList(Array{Array{"x"}, Array{}}));
}

TEST(BinaryPropertyListReader, AKeyThatStandsTwiceKeepsItsFirstPlaceAndLastValue) {
    const PropertyList list = read({{0xD3, 1, 2, 1, 3, 4, 5},
                                    {0x51, 'a'},
                                    {0x51, 'b'},
                                    {0x51, '1'},
                                    {0x51, '2'},
                                    {0x51, '3'}});
    EXPECT_TRUE(sameInOrder(*list.dictionary(), Dictionary{{"a", "3"}, {"b", "2"}}));
}

TEST(BinaryPropertyListReader, KeepsScalarKeysThatAreNoStringsAsForeignKeys) {
    const PropertyList list =
        read({{0xD4, 1, 2, 3, 4, 4, 4, 4, 4}, {0x10, 5}, {0x09}, {0x42, 0x01, 0xFF}, {0x51, 'a'}});
    std::vector<std::string> keys;
    for (const Dictionary::Entry& entry : *list.dictionary()) {
        keys.push_back((entry.hasStringKey ? "" : "foreign ") + entry.key.string());
    }
    EXPECT_EQ(keys, (std::vector<std::string>{"foreign 5", "foreign true", "foreign <01ff>", "a"}));
}

TEST(BinaryPropertyListReader, RefusesAKeyThatIsAContainer) {
    EXPECT_EQ(refusal({{0xD1, 1, 1}, {0xA0}}), "at byte 8: a dictionary key that is a container");
    EXPECT_EQ(refusal({{0xD1, 0, 1}, {0xA0}}), "at byte 8: a dictionary key that is a container");
}

TEST(BinaryPropertyListReader, RefusesKindsThatNoPropertyListHolds) {
    EXPECT_EQ(refusal({{0x00}}), "at byte 8: a null object");
    EXPECT_EQ(refusal({{0xA1, 1}, {0x00}}), "at byte 10: a null object");
    EXPECT_EQ(refusal({{0x80, 1}}), "at byte 8: a UID, which belongs to object archives");
    EXPECT_EQ(refusal({{0xB0}}), "at byte 8: a set, which no property list holds");
    EXPECT_EQ(refusal({{0xC0}}), "at byte 8: a set, which no property list holds");
    for (const auto marker : std::to_array<std::uint8_t>({0x01, 0x0F, 0x90, 0xE0, 0xF0})) {
        EXPECT_EQ(refusal({{marker}}), "at byte 8: an object of an unknown kind");
    }
}

TEST(BinaryPropertyListReader, RefusesObjectsThatGoPastTheEnd) {
    const std::string expected = "at byte 8: an object that goes past the end of the objects";
    EXPECT_EQ(refusal({{0x11, 1}}), expected);
    EXPECT_EQ(refusal({{0x14, 1}}), expected);
    EXPECT_EQ(refusal({{0x23, 1}}), expected);
    EXPECT_EQ(refusal({{0x33, 1}}), expected);
    EXPECT_EQ(refusal({{0x42, 1}}), expected);
    EXPECT_EQ(refusal({{0x52, 1}}), expected);
    EXPECT_EQ(refusal({{0x61, 1}}), expected);
    EXPECT_EQ(refusal({{0xA2, 0}}), expected);
    EXPECT_EQ(refusal({{0xD1, 0}}), expected);
    EXPECT_EQ(refusal({{0x4F, 0x11, 1}}), expected);
    EXPECT_EQ(refusal({{0x4F, 0x13, 0xFF, 0xFF, 0xFF, 0xFF, 0xFF, 0xFF, 0xFF, 0xFF}}), expected);
    EXPECT_EQ(refusal({{0x6F, 0x13, 0x80, 0, 0, 0, 0, 0, 0, 0}}), expected);
    EXPECT_EQ(refusal({{0xAF, 0x13, 0x40, 0, 0, 0, 0, 0, 0, 0}}), expected);
    EXPECT_EQ(refusal({{0x4F}}), "at byte 8: a count that is no integer");
    EXPECT_EQ(refusal({{0x4F, 0x23, 0}}), "at byte 8: a count that is no integer");
    EXPECT_EQ(refusal({{0x4F, 0x14, 0}}), "at byte 8: a count that is no integer");
}

TEST(BinaryPropertyListReader, RefusesReferencesOutsideTheObjectTable) {
    EXPECT_EQ(refusal({{0xA2, 1, 2}, {0x09}}),
              "at byte 10: an object reference outside the object table");
}

TEST(BinaryPropertyListReader, RefusesAnOffsetOutsideTheObjects) {
    EXPECT_EQ(refusalWith(10, 7), "at byte 9: an object offset outside the objects");
    EXPECT_EQ(refusalWith(10, 9), "at byte 9: an object offset outside the objects");
    EXPECT_EQ(refusalWith(9, 1), "at byte 9: an object offset outside the objects");
}

TEST(BinaryPropertyListReader, RefusesABrokenTrailer) {
    ASSERT_EQ(refusalOf(parseBinaryPropertyList(smallFile())), "");
    const std::string table = "a number of objects that does not fit the offset table";
    EXPECT_EQ(refusalWith(17, 0), "at byte 17: an offset width other than 1 to 8 bytes");
    EXPECT_EQ(refusalWith(17, 9), "at byte 17: an offset width other than 1 to 8 bytes");
    EXPECT_EQ(refusalWith(18, 0), "at byte 18: a reference width other than 1 to 8 bytes");
    EXPECT_EQ(refusalWith(18, 9), "at byte 18: a reference width other than 1 to 8 bytes");
    EXPECT_EQ(refusalWith(17, 1), "at byte 19: " + table);
    EXPECT_EQ(refusalWith(26, 0), "at byte 19: " + table);
    EXPECT_EQ(refusalWith(26, 2), "at byte 19: " + table);
    EXPECT_EQ(refusalWith(19, 0x80), "at byte 19: " + table);
    EXPECT_EQ(refusalWith(34, 1), "at byte 27: a root object outside the object table");
    EXPECT_EQ(refusalWith(42, 8), "at byte 35: an offset table outside the file");
    EXPECT_EQ(refusalWith(42, 12), "at byte 35: an offset table outside the file");
    EXPECT_EQ(refusalWith(35, 0x80), "at byte 35: an offset table outside the file");
}

TEST(BinaryPropertyListReader, RefusesWhatIsNoBinaryPropertyList) {
    const auto refusalOfText = [](std::string_view text) {
        return refusalOf(parseBinaryPropertyList(bytesOf(text)));
    };
    EXPECT_EQ(refusalOfText(""), "at byte 0: an empty input");
    EXPECT_EQ(refusalOfText(" "), "at byte 0: no binary property list");
    EXPECT_EQ(refusalOfText("bplist"), "at byte 6: a binary form other than version 00");
    EXPECT_EQ(refusalOfText("bplist16" + std::string(40, ' ')),
              "at byte 6: a binary form other than version 00");
    EXPECT_EQ(refusalOfText("bplist00"), "at byte 8: a binary property list without its trailer");
}

TEST(BinaryPropertyListReader, RefusesReferencesInCircles) {
    EXPECT_EQ(refusal({{0xA1, 0}}), "at byte 8: a reference in a circle");
    EXPECT_EQ(refusal({{0xA1, 1}, {0xD1, 2, 0}, {0x51, 'a'}}),
              "at byte 8: a reference in a circle");
}

TEST(BinaryPropertyListReader, NestsContainers512Deep) {
    EXPECT_EQ(depthOf(valueOf(parseBinaryPropertyList(*serializeBinary(nestedArrays(512))))), 512U);
    std::vector<ByteBuffer> objects;
    for (std::size_t next = 1; next <= 512; ++next) {
        objects.push_back(
            {0xA1, static_cast<std::uint8_t>(next >> 8U), static_cast<std::uint8_t>(next)});
    }
    objects.push_back({0xA0});
    EXPECT_EQ(refusalOf(parseBinaryPropertyList(BinaryFile(objects, 2).bytes())),
              "at byte 1544: containers nested deeper than 512");
}

TEST(BinaryPropertyListReader, RefusesSharedContainersThatDoubleAtEachOf40Levels) {
    std::vector<ByteBuffer> objects;
    for (std::uint8_t level = 1; level <= 40; ++level) {
        objects.push_back({0xA2, level, level});
    }
    objects.push_back({0xA0});
    const auto result = parse(objects);
    ASSERT_FALSE(result);
    EXPECT_EQ(result.error().reason, "shared references that expand to too many values");
}

TEST(BinaryPropertyListReader, RefusesDataThatOverlapToFarMoreThanTheFile) {
    // Data of 50000 bytes each; each begins 4 bytes after the one before.
    constexpr std::uint8_t kCount = 250;
    std::vector<ByteBuffer> objects = {{0xAF, 0x10, kCount}};
    for (std::uint8_t number = 1; number <= kCount; ++number) {
        objects[0].push_back(number);
        objects.push_back({0x4F, 0x11, 0xC3, 0x50});
    }
    objects.emplace_back(60000, std::uint8_t{0});
    const auto result = parse(objects);
    ASSERT_FALSE(result);
    EXPECT_EQ(result.error().reason, "texts or data that overlap");
}

TEST(BinaryPropertyListReader, ReferencesToOneLongStringShareIt) {
    constexpr std::size_t kCount = 60000;
    ByteBuffer array = {0xAF, 0x11, kCount >> 8U, kCount & 0xFFU};
    array.insert(array.end(), kCount, 1);
    ByteBuffer text = {0x5F, 0x11, 0x10, 0x00};
    text.insert(text.end(), 0x1000, 'x');
    const PropertyList list = read({array, text}); // as copies, 240 MB
    ASSERT_EQ(list.array()->size(), kCount);
    EXPECT_EQ(list.array()->back(), PropertyList(std::string(0x1000, 'x')));
}

} // namespace
} // namespace pallax
