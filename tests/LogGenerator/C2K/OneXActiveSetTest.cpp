#include "LogGenerator/C2K/OneXStatus.h"
#include "tests/LogGenerator/C2K/C2KFixture.h"
#include "tests/LogGenerator/C2K/OneXRecords.h"

#include <gtest/gtest.h>

/// The list of the active set in the 1x status packet.
namespace pallax {
namespace {

using namespace doubles; // NOLINT: the vocabulary of these tests

/// The shown list after a packet that ends with the active set and is cut at `length`.
std::string listAfter(const Record& packet, std::size_t length) {
    C2KFixture fixture;
    ByteBuffer bytes = packet.bytes();
    bytes.resize(std::min(length, bytes.size()));
    fixture.feed(bytes);
    const PropertyList& list = fixture.value("k1xActiveSetInfo");
    return list.isString() ? "(not set)" : shownList(list);
}

Record packetWith(const Subpacket& activeSet) {
    return packetOf(0x119C, {systemState(kTrafficState), radio(), noFingers(), activeSet});
}

std::string listOf(const Subpacket& activeSet) {
    return listAfter(packetWith(activeSet), SIZE_MAX);
}

/// The level of one pilot of PN 4 and size 0 with that energy.
std::string levelOf(unsigned divisor, unsigned gain, unsigned exponent, unsigned energy) {
    return listOf(
        Subpacket(3).u16(divisor).u8(gain).u8(exponent).u8(1).u8(0).u16(0xFFFF).u16(4).putU16(
            24, energy));
}

TEST(OneXActiveSet, WithoutPilotsTheListHoldsNothingButItsMark) {
    C2KFixture fixture;
    fixture.feed(oneXStatus(kTrafficState, noPilots()));
    EXPECT_EQ(fixture.value("k1xActiveSetInfo"), PropertyList(Dictionary{{"_sorted", "_sorted"}}));
    EXPECT_EQ(shownList(fixture.value("k1xActiveSetInfo")), "()") << "a branch without rows";
}

TEST(OneXActiveSet, TheLevelIsThatOfTheFormula) {
    EXPECT_EQ(levelOf(64, 1, 2, 6000), "(4: -5.09 dB)");
    EXPECT_EQ(levelOf(64, 1, 2, 900), "(4: -14.79 dB)");
    EXPECT_EQ(levelOf(64, 2, 3, 6000), "(4: -1.97 dB)");
    EXPECT_EQ(levelOf(64, 1, 0, 65535), "(4: -6.85 dB)") << "two to the power of -3";
    EXPECT_EQ(levelOf(65535, 255, 10, 65535), "(4: -30.67 dB)");
    EXPECT_EQ(levelOf(1, 1, 255, 65535), "(4: +1564.84 dB)");
}

TEST(OneXActiveSet, TheLevelIsNeverBelowMinus50) {
    EXPECT_EQ(levelOf(64, 1, 2, 289), "(4: -42.66 dB)");
    EXPECT_EQ(levelOf(64, 1, 2, 288), "(4: -50.00 dB)") << "exactly 1/N";
    EXPECT_EQ(levelOf(64, 1, 2, 287), "(4: -50.00 dB)") << "below 0";
    EXPECT_EQ(levelOf(64, 1, 2, 0), "(4: -50.00 dB)");
}

TEST(OneXActiveSet, ANotANumberGivesTheOtherOperandOfTheMaximum) {
    EXPECT_EQ(levelOf(0, 1, 2, 6000), "(4: -50.00 dB)") << "infinity less infinity";
    EXPECT_EQ(levelOf(0, 1, 2, 0), "(4: -50.00 dB)") << "0 / 0";
    EXPECT_EQ(levelOf(64, 0, 2, 0), "(4: -50.00 dB)") << "0 / 0";
    EXPECT_EQ(levelOf(64, 0, 2, 1), "(4: +inf dB)") << "1 / 0";
}

TEST(OneXActiveSet, APilotOfTheReferencePNIsMarked) {
    EXPECT_EQ(listOf(twoPilots()), "(4: -14.79 dB, 168: (ref pilot) -5.09 dB)");
    EXPECT_EQ(listOf(twoPilots().putU16(10, 4)), "(4: (ref pilot) -14.79 dB, 168: -5.09 dB)");
    EXPECT_EQ(listOf(twoPilots().putU16(10, 0)), "(4: -14.79 dB, 168: -5.09 dB)");
    EXPECT_EQ(listOf(twoPilots().putU16(10, 4).putU16(32, 4)),
              "(4: (ref pilot) -14.79 dB, 4: (ref pilot) -5.09 dB)");
}

TEST(OneXActiveSet, TheSizeOfAPilotGivesItsStrideAndTheOffsetOfItsEnergy) {
    struct Case {
        unsigned size;
        std::size_t stride;
        std::size_t energy;
    };
    for (const Case& each : {Case{0, 12, 24}, Case{1, 20, 28}, Case{2, 24, 32}, Case{3, 32, 36},
                             Case{4, 36, 40}, Case{5, 44, 44}, Case{255, 1544, 1044}}) {
        Subpacket activeSet(3);
        activeSet.u16(64).u8(1).u8(2).u8(3).u8(each.size).u16(0xFFFF);
        for (std::size_t pilot = 0; pilot < 3; ++pilot) {
            activeSet.putU16(pilot * each.stride + 12, 900 + static_cast<unsigned>(pilot));
        }
        // The energy of a pilot of size 0 has the place of the next pilot's PN.
        activeSet.putU16(2 * each.stride + each.energy, 6000);
        const std::string list = listOf(activeSet);
        const std::string last = "902: -5.09 dB)";
        EXPECT_EQ(list.substr(list.size() - last.size()), last) << "size " << each.size;
        EXPECT_EQ(list.substr(0, 5), "(900:") << "size " << each.size;
        EXPECT_NE(list.find(", 901:"), std::string::npos) << "size " << each.size;
    }
}

TEST(OneXActiveSet, TheListStopsAtTheFirstPilotThatIsNotWhole) {
    // It claims to be so short that it is found in the shortest packet, too.
    const Record packet = packetWith(twoPilots().claim(12));
    const std::size_t end = packet.bytes().size(); // the end of the second pilot's energy
    const std::size_t start = end - 50;
    EXPECT_EQ(listAfter(packet, end), "(4: -14.79 dB, 168: (ref pilot) -5.09 dB)");
    for (std::size_t length = start + 30; length < end; ++length) {
        EXPECT_EQ(listAfter(packet, length), "(4: -14.79 dB)") << "cut at " << length;
    }
    for (std::size_t length = start + 1; length < start + 30; ++length) {
        EXPECT_EQ(listAfter(packet, length), "()") << "cut at " << length;
    }
    EXPECT_EQ(listAfter(packet, start), "(not set)");
}

TEST(OneXActiveSet, APilotMayLieBehindItsSubpacket) {
    // The active set claims to end where its first pilot starts, so the pilot is in the next
    // subpacket.
    const Record packet = packetOf(0x119C, {systemState(kTrafficState), radio(), noFingers(),
                                            Subpacket(3).u16(64).u8(1).u8(2).u8(1).u8(0).u16(4),
                                            Subpacket(4).padTo(14)});
    EXPECT_EQ(listAfter(packet, SIZE_MAX), "(4: (ref pilot) -50.00 dB)");
}

TEST(OneXActiveSet, ACountOf255InAShortPacketShowsWhatIsWhole) {
    EXPECT_EQ(listOf(noPilots().padTo(26).putU16(8, 255)), "(0: (ref pilot) -50.00 dB)");
}

} // namespace
} // namespace pallax
