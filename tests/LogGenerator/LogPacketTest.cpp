#include "LogGenerator/LogPacket.h"

#include "tests/doubles/Property.h"
#include "tests/doubles/RecordBuilder.h"
#include "tests/doubles/RecordingLog.h"

#include <gtest/gtest.h>

namespace pallax {
namespace {

using doubles::Record;
using doubles::RecordingLog;
using Lines = std::vector<RecordingLog::Line>;

ByteBuffer stripped(const ByteBuffer& message) {
    const Bytes record = LogPacketStripPrefix(message);
    return {record.begin(), record.end()};
}

TEST(LogPacketStripPrefix, NullInputIsLoggedAndGivesNull) {
    RecordingLog log;
    EXPECT_TRUE(LogPacketStripPrefix({}).empty());
    EXPECT_EQ(log.lines(), (Lines{{4, "buffer is null"}}));
}

TEST(LogPacketStripPrefix, APrefixOf0x81IsTakenOff) {
    RecordingLog log;
    EXPECT_EQ(stripped({0x81, 0x00, 0x01, 0x02}), (ByteBuffer{0x01, 0x02}));
    EXPECT_EQ(log.lines(), (Lines{{6, "Log Header 0x81"}}));
}

TEST(LogPacketStripPrefix, Byte1OfThePrefixIsNotInterpreted) {
    EXPECT_EQ(stripped({0x81, 0xFF, 0x07}), (ByteBuffer{0x07}));
}

TEST(LogPacketStripPrefix, AnyOtherFirstByteMeansTheMessageIsTheRecord) {
    RecordingLog log;
    const ByteBuffer message = {0x01, 0x00, 0x00, 0x16, 0x41};
    const Bytes record = LogPacketStripPrefix(message);
    EXPECT_EQ(record.data(), message.data());
    EXPECT_EQ(record.size(), message.size());
    EXPECT_EQ(log.lines(), (Lines{{6, "Log Header 0x1"},
                                  {4, "Returning buffer without modifications <01000016 41>"}}));
}

TEST(LogPacketStripPrefix, AMessageOfOneOrTwoBytesBehind0x81IsIgnored) {
    RecordingLog log;
    EXPECT_TRUE(LogPacketStripPrefix(ByteBuffer{0x81}).empty());
    EXPECT_TRUE(LogPacketStripPrefix(ByteBuffer{0x81, 0x00}).empty());
    EXPECT_EQ(log.lines(), (Lines{{6, "Log Header 0x81"},
                                  {4, "Packet length too small (len=1). Ignoring packet"},
                                  {6, "Log Header 0x81"},
                                  {4, "Packet length too small (len=2). Ignoring packet"}}));
}

TEST(LogPacketGetLogCode, IsThe16BitNumberAtOffset3) {
    EXPECT_EQ(LogPacketGetLogCode(LogRecord(Record(0x4116).bytes())), 0x4116U);
}

TEST(LogPacketGetLogCode, ARecordOfType0xFFWithCodeBytes0x20And0x00YieldsTheCode0xFF0020) {
    const ByteBuffer record = {0xFF, 0, 0, 0x20, 0x00, 0, 0, 0, 0, 0, 0, 0, 0};
    EXPECT_EQ(LogPacketGetLogCode(LogRecord(record)), 0xFF0020U);
}

TEST(LogPacketGetLogCode, ChecksNeitherLengthNorLogType) {
    EXPECT_EQ(LogPacketGetLogCode(LogRecord(ByteBuffer{0x02, 0, 0, 0x34, 0x12})), 0x1234U);
    EXPECT_EQ(LogPacketGetLogCode(LogRecord(ByteBuffer{0x01})), 0U);
}

TEST(LogPacketProperty, StrippingAPrefixedMessageGivesItBack) {
    EXPECT_TRUE(doubles::holds([] {
        const ByteBuffer record = doubles::any::bytes();
        ByteBuffer message = {0x81, doubles::any::byte()};
        message.insert(message.end(), record.begin(), record.end());
        RC_ASSERT(stripped(message) == record);
    }));
}

} // namespace
} // namespace pallax
