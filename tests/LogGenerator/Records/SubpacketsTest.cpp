#include "LogGenerator/Records/Subpackets.h"

#include "tests/doubles/AnySubpacket.h"
#include "tests/doubles/Property.h"
#include "tests/doubles/RecordProperties.h"
#include "tests/doubles/RecordingLog.h"

#include <gtest/gtest.h>

namespace pallax {
namespace {

using namespace doubles; // NOLINT: the vocabulary of these tests
using Lines = std::vector<RecordingLog::Line>;

constexpr std::size_t kNowhere = 0;

/// Where the subpacket with that id starts, from byte 0 of the packet; `kNowhere` without one.
std::size_t startOf(std::uint8_t id, const ByteBuffer& bytes) {
    const LogRecord packet{Bytes(bytes)};
    const auto found = findSubpacket(packet, id);
    return found ? packet.length() - found->length() : kNowhere;
}

TEST(Subpackets, TheyFollowOneAnotherFromOffset17BySize) {
    const ByteBuffer bytes =
        packetOf(0x119C, {Subpacket(7).padTo(10), Subpacket(9).padTo(300), Subpacket(8)}).bytes();
    const RecordingLog log;
    EXPECT_EQ(startOf(7, bytes), 17U);
    EXPECT_EQ(startOf(9, bytes), 27U);
    EXPECT_EQ(startOf(8, bytes), 327U);
    EXPECT_EQ(startOf(6, bytes), kNowhere);
    EXPECT_EQ(log.lines(), Lines());
}

TEST(Subpackets, TheFirstOfTwoWithTheSameIdIsFound) {
    EXPECT_EQ(startOf(7, packetOf(0x119C, {Subpacket(1), Subpacket(7), Subpacket(7)}).bytes()),
              21U);
}

TEST(Subpackets, ACountOf0MeansThereIsNone) {
    const RecordingLog log;
    EXPECT_EQ(startOf(7, packetOf(0x119C, {Subpacket(7).claim(9999)}).at(14, 0).bytes()), kNowhere);
    EXPECT_EQ(log.lines(), Lines());
}

TEST(Subpackets, WhatStandsBehindTheCountIsNotSearched) {
    const Record packet = packetOf(0x119C, {Subpacket(7), Subpacket(8)});
    EXPECT_EQ(startOf(8, Record(packet).at(14, 1).bytes()), kNowhere);
    EXPECT_EQ(startOf(8, Record(packet).at(14, 2).bytes()), 21U);
}

TEST(Subpackets, AnEndAtTheBound17BytesPastThePacketIsABadSize) {
    // The packet ends at 17 + 4; the bound is 17 + 21 = 38, 21 bytes behind the subpacket's start.
    RecordingLog log;
    EXPECT_EQ(startOf(7, packetOf(0x119C, {Subpacket(7).claim(20)}).bytes()), 17U);
    EXPECT_EQ(log.take(), Lines());
    EXPECT_EQ(startOf(7, packetOf(0x119C, {Subpacket(7).claim(21)}).bytes()), kNowhere);
    EXPECT_EQ(log.take(), (Lines{{3, "Log code error in subpkt#0: bad size (21)."}}));
    EXPECT_EQ(startOf(7, packetOf(0x119C, {Subpacket(7).claim(0xFFFF)}).bytes()), kNowhere);
    EXPECT_EQ(log.take(), (Lines{{3, "Log code error in subpkt#0: bad size (65535)."}}));
}

TEST(Subpackets, TheSizeIsCheckedBeforeTheIdAndTellsItsNumber) {
    RecordingLog log;
    const ByteBuffer bytes =
        packetOf(0x119C, {Subpacket(1), Subpacket(2), Subpacket(3).claim(500)}).bytes();
    EXPECT_EQ(startOf(2, bytes), 21U);
    EXPECT_EQ(log.take(), Lines()) << "the walk ends at what it looks for";
    EXPECT_EQ(startOf(3, bytes), kNowhere);
    EXPECT_EQ(log.take(), (Lines{{3, "Log code error in subpkt#2: bad size (500)."}}));
    EXPECT_EQ(startOf(4, bytes), kNowhere);
    EXPECT_EQ(log.take(), (Lines{{3, "Log code error in subpkt#2: bad size (500)."}}));
}

TEST(Subpackets, PastThePacketEveryByteIsZero) {
    RecordingLog log;
    // Its end lies past the packet but inside the bound; what follows has the id and the size 0.
    const ByteBuffer bytes = packetOf(0x119C, {Subpacket(7).claim(12)}).at(14, 255).bytes();
    EXPECT_EQ(startOf(8, bytes), kNowhere);
    EXPECT_EQ(log.take(), Lines());
    EXPECT_EQ(startOf(0, bytes), bytes.size()) << "an empty view";
}

TEST(Subpackets, ASubpacketOfSize0IsMetAgainAndAgain) {
    RecordingLog log;
    EXPECT_EQ(
        startOf(8, packetOf(0x119C, {Subpacket(7).claim(0), Subpacket(8)}).at(14, 255).bytes()),
        kNowhere);
    EXPECT_EQ(log.lines(), Lines());
}

TEST(Subpackets, AHeaderThatThePacketCutsIsReadAsFarAsItGoes) {
    const ByteBuffer whole = packetOf(0x119C, {Subpacket(7).padTo(10)}).bytes();
    for (std::size_t length = 17; length <= 20; ++length) {
        const ByteBuffer cut(whole.begin(), whole.begin() + static_cast<std::ptrdiff_t>(length));
        EXPECT_EQ(startOf(7, cut), length == 17 ? kNowhere : 17U) << "cut at " << length;
    }
}

TEST(Subpackets, WhateverIsFoundHasItsIdAndLiesInThePacket) {
    EXPECT_TRUE(doubles::holds([] {
        std::vector<Subpacket> subpackets;
        for (int count = any::between(1, 6); count > 0; --count) {
            subpackets.push_back(anySubpacket(1 + any::below(4)));
            if (any::between(0, 4) == 0) {
                subpackets.back().claim(any::below(100));
            }
        }
        ByteBuffer bytes = packetOf(0x119C, subpackets).bytes();
        bytes.resize(kSubpacketsStart + any::index(bytes.size() + 1 - kSubpacketsStart));
        const auto id = static_cast<std::uint8_t>(any::between(1, 5));
        const LogRecord packet{Bytes(bytes)};
        if (const auto found = findSubpacket(packet, id)) {
            RC_ASSERT(found->u8(0) == id);
            RC_ASSERT(found->length() + kSubpacketsStart <= packet.length());
        }
    }));
}

} // namespace
} // namespace pallax
