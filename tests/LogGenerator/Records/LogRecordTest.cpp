#include "LogGenerator/Records/LogRecord.h"

#include "tests/doubles/Property.h"

#include <gtest/gtest.h>

namespace pallax {
namespace {

const ByteBuffer kFourBytes = {0x01, 0x82, 0x03, 0xFF};

TEST(LogRecord, ReadsLittleEndianNumbersByOffset) {
    const LogRecord record(kFourBytes);
    EXPECT_EQ(record.u8(1), 0x82);
    EXPECT_EQ(record.u16(0), 0x8201);
    EXPECT_EQ(record.u32(0), 0xFF038201U);
    EXPECT_EQ(record.s16(2), static_cast<std::int16_t>(0xFF03));
}

TEST(LogRecord, BytesPastTheEndReadAsZero) {
    const LogRecord record(kFourBytes);
    EXPECT_EQ(record.u8(4), 0);
    EXPECT_EQ(record.u16(3), 0x00FF);
    EXPECT_EQ(record.u32(2), 0x0000FF03U);
    EXPECT_EQ(record.read(u32At(100)), 0);
    EXPECT_EQ(LogRecord().u8(0), 0);
}

TEST(LogRecord, PositionsReadSignedUnsignedAndBigEndian) {
    const LogRecord record(kFourBytes);
    EXPECT_EQ(record.read(u8At(1)), 0x82);
    EXPECT_EQ(record.read(s8At(1)), -126);
    EXPECT_EQ(record.read(u16At(0)), 0x8201);
    EXPECT_EQ(record.read(s16At(0)), 0x8201 - 0x10000);
    EXPECT_EQ(record.read(u32At(0)), 0xFF038201);
    EXPECT_EQ(record.read(s32At(0)), 0xFF038201 - 0x100000000);
    EXPECT_EQ(record.read(bigEndianU16At(0)), 0x0182);
}

TEST(LogRecord, AFieldThatCrossesBytesTakesItsLowBitsFromTheLowerByte) {
    const ByteBuffer bytes = {0x00, 0x80};
    EXPECT_EQ(LogRecord(bytes).read(bitsAt(0, 7, 9)), 256);
    const ByteBuffer other = {0x80, 0x01};
    EXPECT_EQ(LogRecord(other).read(bitsAt(0, 7, 9)), 3);
    EXPECT_EQ(LogRecord(other).read(bitsAt(0, 0, 9)), 0x180);
}

TEST(LogRecord, HasAsksWhetherEveryByteBelowTheEndLiesInside) {
    const LogRecord record(kFourBytes);
    EXPECT_TRUE(record.has(4));
    EXPECT_FALSE(record.has(5));
    EXPECT_TRUE(LogRecord().has(0));
}

TEST(LogRecord, PayloadFollowsTheHeader) {
    const ByteBuffer bytes(15, 7);
    EXPECT_EQ(LogRecord(bytes).payload().size(), 2U);
    EXPECT_TRUE(LogRecord(kFourBytes).payload().empty());
    EXPECT_EQ(LogRecord(kFourBytes).from(2).u8(0), 0x03);
    EXPECT_EQ(LogRecord(kFourBytes).from(9).length(), 0U);
}

TEST(LogRecordProperty, AnyBitFieldEqualsItsBitsOneByOne) {
    EXPECT_TRUE(doubles::holds([] {
        const ByteBuffer bytes = doubles::any::bytes();
        const LogRecord record(bytes);
        const auto byte = doubles::any::index(bytes.size() + 4);
        const auto bit = doubles::any::below(8);
        const auto width = 1 + doubles::any::below(32);
        std::int64_t expected = 0;
        for (unsigned index = 0; index < width; ++index) {
            const unsigned place = bit + index;
            const unsigned at = record.u8(byte + place / 8U);
            expected |= static_cast<std::int64_t>((at >> (place % 8U)) & 1U) << index;
        }
        RC_ASSERT(record.read(bitsAt(byte, bit, width)) == expected);
    }));
}

} // namespace
} // namespace pallax
