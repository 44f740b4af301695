#include "LogGenerator/C2K/EVDOActiveSet.h"

#include "tests/LogGenerator/C2K/C2KFixture.h"

#include <gtest/gtest.h>

namespace pallax {
namespace {

using namespace doubles; // NOLINT: the vocabulary of these tests
using Lines = std::vector<RecordingLog::Line>;

struct Pilot {
    unsigned pn;
    unsigned energy;
};

Record activeSet(const std::vector<Pilot>& pilots) {
    Record record(0x12B6);
    record.padTo(15).u8(static_cast<unsigned>(pilots.size())).padTo(25);
    for (const Pilot& pilot : pilots) {
        record.u16(pilot.pn).u16(pilot.energy).append({1, 2, 3, 4, 5, 6, 7, 8});
    }
    return record;
}

TEST(EVDOActiveSet, EachPilotHasItsEnergyUnderIndexAndPN) {
    C2KFixture fixture;
    EXPECT_EQ(PropertyList(fixture.writtenBy(activeSet({{168, 512}, {4, 128}, {0xFFFF, 1024}}))),
              PropertyList(Dictionary{{"kActiveSetPilots", Dictionary{{"_sorted", "_sorted"},
                                                                      {"0;168", "+0.00 dB"},
                                                                      {"1;4", "-6.02 dB"},
                                                                      {"2;65535", "+3.01 dB"}}}}));
    EXPECT_EQ(fixture.lines, Lines());
    EXPECT_EQ(shownList(fixture.value("kActiveSetPilots")),
              "(168: +0.00 dB, 4: -6.02 dB, 65535: +3.01 dB)");
}

TEST(EVDOActiveSet, NoPilotsReadNone) {
    C2KFixture fixture;
    fixture.feed(activeSet({{168, 512}}));
    fixture.feed(activeSet({}));
    EXPECT_EQ(fixture.text("kActiveSetPilots"), "(none)");
    EXPECT_EQ(fixture.lines, Lines());
}

TEST(EVDOActiveSet, AnEnergyOf0ReadsMinusInfinity) {
    C2KFixture fixture;
    fixture.feed(activeSet({{1, 0}, {2, 1}, {3, 0xFFFF}}));
    EXPECT_EQ(shownList(fixture.value("kActiveSetPilots")),
              "(1: -inf dB, 2: -27.09 dB, 3: +21.07 dB)");
}

TEST(EVDOActiveSet, TenPilotsAndMoreAreOrderedByTheTextOfTheirIndex) {
    C2KFixture fixture;
    std::vector<Pilot> pilots;
    for (unsigned pn = 100; pn < 112; ++pn) {
        pilots.push_back({pn, 512});
    }
    fixture.feed(activeSet(pilots));
    EXPECT_EQ(shownList(fixture.value("kActiveSetPilots")),
              "(100: +0.00 dB, 110: +0.00 dB, 111: +0.00 dB, 101: +0.00 dB, 102: +0.00 dB, "
              "103: +0.00 dB, 104: +0.00 dB, 105: +0.00 dB, 106: +0.00 dB, 107: +0.00 dB, "
              "108: +0.00 dB, 109: +0.00 dB)")
        << "\"1;\" sorts behind \"10;\" and \"11;\"";
}

TEST(EVDOActiveSet, APacketBelow25BytesIsAnError) {
    C2KFixture fixture;
    EXPECT_TRUE(fixture.writtenBy(Record(0x12B6).padTo(24)).empty());
    EXPECT_EQ(fixture.lines,
              (Lines{{3, "Log code 0x12b6 is 24 bytes long but must be at least 25 bytes."}}));
    EXPECT_EQ(fixture.writtenBy(Record(0x12B6).padTo(25)).size(), 1U);
}

TEST(EVDOActiveSet, APacketWithoutRoomForItsPilotsIsAnError) {
    C2KFixture fixture;
    EXPECT_TRUE(fixture.writtenBy(Record(0x12B6).padTo(48).at(15, 2)).empty());
    EXPECT_EQ(fixture.lines,
              (Lines{{3, "Log code 0x12b6 is 48 bytes long, but has 2 substructs."}}));
    EXPECT_EQ(fixture.writtenBy(Record(0x12B6).padTo(49).at(15, 2)).size(), 1U);
    EXPECT_EQ(fixture.writtenBy(Record(0x12B6).padTo(55).at(15, 2)).size(), 1U)
        << "more may follow";
    EXPECT_TRUE(fixture.writtenBy(Record(0x12B6).padTo(3084).at(15, 255)).empty());
    EXPECT_EQ(fixture.lines,
              (Lines{{3, "Log code 0x12b6 is 3084 bytes long, but has 255 substructs."}}));
    EXPECT_EQ(fixture.writtenBy(Record(0x12B6).padTo(3085).at(15, 255)).size(), 1U);
    cutPacketAtEveryLength(activeSet({{168, 512}, {4, 128}}), 49);
}

TEST(EVDOActiveSet, AnyBytesWriteOnlyItsRow) {
    anyPacketWritesOnly(0x12B6, {"kActiveSetPilots"}, {25, 37, 49, 61, 73, 200});
}

} // namespace
} // namespace pallax
