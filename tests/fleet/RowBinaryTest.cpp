#include "fleet/RowBinary.h"

#include <gtest/gtest.h>

namespace pallax {
namespace {

std::string bytes(std::initializer_list<int> values) {
    std::string text;
    for (const int value : values) {
        text += static_cast<char>(value);
    }
    return text;
}

TEST(RowBinaryTest, IntegersAreLittleEndian) {
    RowBinary row;
    row.add(std::uint8_t{0xFE}).add(std::uint16_t{0x1234}).add(std::int32_t{-2});
    EXPECT_EQ(row.bytes(), bytes({0xFE, 0x34, 0x12, 0xFE, 0xFF, 0xFF, 0xFF}));
    row.clear();
    row.add(std::uint64_t{0x0102030405060708});
    EXPECT_EQ(row.bytes(), bytes({8, 7, 6, 5, 4, 3, 2, 1}));
}

TEST(RowBinaryTest, RealNumbersAreTheirBits) {
    RowBinary row;
    row.add(-2.0);
    EXPECT_EQ(row.bytes(), bytes({0, 0, 0, 0, 0, 0, 0, 0xC0}));
}

TEST(RowBinaryTest, TextsHaveTheirLengthInGroupsOfSevenBits) {
    RowBinary row;
    row.add("").add(std::string("a\0b", 3));
    EXPECT_EQ(row.bytes(), bytes({0, 3, 'a', 0, 'b'}));
    for (const std::size_t length : {127U, 128U, 16383U, 16384U}) {
        row.clear();
        row.add(std::string(length, 'x'));
        const std::string prefix = length == 127     ? bytes({127})
                                   : length == 128   ? bytes({0x80, 1})
                                   : length == 16383 ? bytes({0xFF, 0x7F})
                                                     : bytes({0x80, 0x80, 1});
        EXPECT_EQ(row.bytes(), prefix + std::string(length, 'x'));
    }
}

TEST(RowBinaryTest, NullIsAByte) {
    RowBinary row;
    row.add(std::optional<std::int64_t>()).add(std::optional(std::string("x")));
    EXPECT_EQ(row.bytes(), bytes({1, 0, 1, 'x'}));
}

} // namespace
} // namespace pallax
