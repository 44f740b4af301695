#include "host/PortFrame.h"

#include "tests/doubles/Property.h"

#include <gtest/gtest.h>

#include <limits>

namespace pallax {
namespace {

FrameHeader headerOf(FrameKind kind, std::int32_t identifier = 0) {
    FrameHeader header;
    header.kind = kind;
    header.identifier = identifier;
    return header;
}

/// Feeds the bytes in pieces of `size` and collects the frames.
std::vector<PortFrame> framesOf(PortFrameParser& parser, Bytes bytes, std::size_t size) {
    std::vector<PortFrame> frames;
    while (!bytes.empty() && parser.fault().empty()) {
        Bytes piece = bytes.first(std::min(size, bytes.size()));
        bytes = bytes.subspan(piece.size());
        while (!piece.empty() && parser.fault().empty()) {
            piece = piece.subspan(parser.feed(piece));
            if (auto frame = parser.take()) {
                frames.push_back(std::move(*frame));
            }
        }
    }
    return frames;
}

/// The error for a header with `value` in the byte at `offset`.
std::string faultWith(std::size_t offset, std::uint8_t value) {
    auto bytes = encodeHeader(headerOf(FrameKind::Message), 0);
    bytes.at(offset) = value;
    PortFrameParser parser;
    (void)parser.feed(bytes);
    EXPECT_FALSE(parser.take() && !parser.fault().empty());
    return std::string(parser.fault());
}

TEST(PortFrame, AHeaderIsLaidOutAsDocumented) {
    FrameHeader header = headerOf(FrameKind::Request, -2);
    header.number = 0x01020304;
    header.isLive = true;
    header.sourceTime = Time(std::chrono::nanoseconds(0x1122334455667788));
    const std::array<std::uint8_t, kFrameHeaderSize> expected = {
        'P',  'L',  'X',  'M',                          // magic
        2,    0,                                        // kind
        1,    0,                                        // flags
        0xFE, 0xFF, 0xFF, 0xFF,                         // identifier
        5,    1,    0,    0,                            // length, 261
        0x88, 0x77, 0x66, 0x55, 0x44, 0x33, 0x22, 0x11, // source time
        4,    3,    2,    1,                            // request number
        0,    0,    0,    0,                            // reserved
    };
    EXPECT_EQ(encodeHeader(header, 261), expected);
}

TEST(PortFrame, FramesAreFoundHoweverTheStreamIsCut) {
    ByteBuffer stream;
    FrameHeader timed = headerOf(FrameKind::Message);
    timed.sourceTime = Time{};
    appendFrame(stream, timed, ByteBuffer{1, 2, 3});
    appendFrame(stream, headerOf(FrameKind::Clock), {});
    appendFrame(stream, headerOf(FrameKind::Request, 7), ByteBuffer(70, 9));
    appendFrame(stream, headerOf(FrameKind::End), {});
    const std::vector<PortFrame> expected = {{timed, {1, 2, 3}},
                                             {headerOf(FrameKind::Clock), {}},
                                             {headerOf(FrameKind::Request, 7), ByteBuffer(70, 9)},
                                             {headerOf(FrameKind::End), {}}};
    for (std::size_t size = 1; size <= stream.size(); ++size) {
        PortFrameParser parser;
        EXPECT_EQ(framesOf(parser, stream, size), expected) << "in pieces of " << size;
        EXPECT_FALSE(parser.isInsideFrame());
    }
}

TEST(PortFrame, AStreamThatIsCutInAFrameGivesTheFramesBefore) {
    ByteBuffer stream;
    appendFrame(stream, headerOf(FrameKind::Message), ByteBuffer{1});
    const std::size_t whole = stream.size();
    appendFrame(stream, headerOf(FrameKind::Message), ByteBuffer{2, 3});
    for (std::size_t length = 0; length < stream.size(); ++length) {
        PortFrameParser parser;
        const auto frames = framesOf(parser, Bytes(stream).first(length), stream.size());
        EXPECT_EQ(frames.size(), length >= whole ? 1U : 0U);
        EXPECT_EQ(parser.isInsideFrame(), length != 0 && length != whole);
        EXPECT_EQ(parser.fault(), "");
    }
}

TEST(PortFrame, WhatIsNoFrameIsAFault) {
    EXPECT_EQ(faultWith(0, 'p'), "no frame where one should begin");
    EXPECT_EQ(faultWith(3, 'L'), "no frame where one should begin");
    EXPECT_EQ(faultWith(4, 0), "an unknown kind of frame");
    EXPECT_EQ(faultWith(4, 8), "an unknown kind of frame");
    EXPECT_EQ(faultWith(5, 1), "an unknown kind of frame");
    EXPECT_EQ(faultWith(6, 1), "");
    EXPECT_EQ(faultWith(6, 2), "an unknown flag");
    EXPECT_EQ(faultWith(7, 1), "an unknown flag");
    EXPECT_EQ(faultWith(31, 1), "a reserved field that is not zero");
    EXPECT_EQ(faultWith(15, 2), "a message of more than 16 MiB");
    EXPECT_EQ(faultWith(4, 1), "");
}

TEST(PortFrame, SixteenMebibytesAreTheMost) {
    PortFrameParser parser;
    (void)parser.feed(encodeHeader(headerOf(FrameKind::Message), kLargestMessage));
    EXPECT_EQ(parser.fault(), "");
    PortFrameParser other;
    (void)other.feed(encodeHeader(headerOf(FrameKind::Message), kLargestMessage + 1));
    EXPECT_EQ(other.fault(), "a message of more than 16 MiB");
}

TEST(PortFrame, AClockOrEndWithDataIsAFault) {
    for (const FrameKind kind : {FrameKind::Clock, FrameKind::End, FrameKind::NoReply}) {
        PortFrameParser parser;
        (void)parser.feed(encodeHeader(headerOf(kind), 1));
        EXPECT_EQ(parser.fault(), "data in a frame that carries none");
    }
}

TEST(PortFrame, ARemarkIsLaidOutAsDocumented) {
    const StampRemark gap{StampRemark::Kind::Gap, std::chrono::nanoseconds(0x0102030405060708)};
    EXPECT_EQ(encodeRemark(gap), (ByteBuffer{2, 0, 0, 0, 8, 7, 6, 5, 4, 3, 2, 1}));
    EXPECT_EQ(decodeRemark(encodeRemark(gap)), gap);
}

TEST(PortFrame, OtherDataAreNoRemark) {
    ByteBuffer data = encodeRemark({StampRemark::Kind::OutOfRange, {}});
    EXPECT_TRUE(decodeRemark(data));
    data[0] = 0;
    EXPECT_EQ(decodeRemark(data), std::nullopt);
    data[0] = 4;
    EXPECT_EQ(decodeRemark(data), std::nullopt);
    data[0] = 1;
    data.back() = 0x80; // a negative size
    EXPECT_EQ(decodeRemark(data), std::nullopt);
    data.pop_back();
    EXPECT_EQ(decodeRemark(data), std::nullopt);
    EXPECT_EQ(decodeRemark({}), std::nullopt);
}

TEST(PortFrame, AfterAFaultNothingIsTaken) {
    PortFrameParser parser;
    const ByteBuffer garbage(kFrameHeaderSize, 0xAA);
    EXPECT_EQ(parser.feed(garbage), kFrameHeaderSize);
    EXPECT_EQ(parser.feed(garbage), 0U);
    EXPECT_EQ(parser.take(), std::nullopt);
}

TEST(PortFrame, AnyFramesAreParsedAgain) {
    EXPECT_TRUE(doubles::holds([] {
        const std::vector<ByteBuffer> messages = doubles::any::buffers();
        const auto identifier = static_cast<std::int32_t>(doubles::any::bits());
        ByteBuffer stream;
        std::vector<PortFrame> expected;
        for (const ByteBuffer& message : messages) {
            FrameHeader header = headerOf(FrameKind::Message, identifier);
            header.isLive = doubles::any::boolean();
            header.sourceTime = Time(std::chrono::nanoseconds(
                doubles::any::longBetween(std::numeric_limits<std::int64_t>::min() + 1,
                                          std::numeric_limits<std::int64_t>::max())));
            appendFrame(stream, header, message);
            expected.push_back({header, message});
        }
        PortFrameParser parser;
        const auto size = 1 + doubles::any::index(99);
        RC_ASSERT(framesOf(parser, stream, size) == expected);
    }));
}

} // namespace
} // namespace pallax
