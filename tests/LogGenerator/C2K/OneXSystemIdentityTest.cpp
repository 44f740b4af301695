#include "LogGenerator/C2K/OneXSystemIdentity.h"

#include "tests/LogGenerator/C2K/C2KFixture.h"

#include <gtest/gtest.h>

namespace pallax {
namespace {

using namespace doubles; // NOLINT: the vocabulary of these tests
using Lines = std::vector<RecordingLog::Line>;

/// At home in system 4139, network 65, base station 2307.
Record identity() {
    return Record(0x134F)
        .u8(2)      // version
        .padTo(42)  //
        .u32(0)     // roaming indicator
        .u32(2)     // system type
        .u16(4139)  // system
        .u16(65)    // network
        .padTo(131) //
        .u8(7)      // packet zone
        .padTo(133) //
        .u8(6)      // protocol revision
        .padTo(184) //
        .u16(2307)  // base station
        .padTo(190);
}

TEST(OneXSystemIdentity, APacketSetsEveryRowOfItsTable) {
    C2KFixture fixture;
    EXPECT_EQ(PropertyList(fixture.writtenBy(identity())),
              PropertyList(Dictionary{{"k1xRoamingHome", "OFF [0]"},
                                      {"kSystemId", "4139"},
                                      {"kNetworkId", "65"},
                                      {"kPacketZoneId", "7"},
                                      {"kBaseId", "2307"},
                                      {"kProtocolRevision", "6"}}));
    EXPECT_EQ(fixture.lines, Lines());
}

TEST(OneXSystemIdentity, EveryRoamingIndicatorHasItsLabel) {
    C2KFixture fixture;
    const auto label = [&fixture](std::uint32_t indicator) {
        Record record = identity();
        for (unsigned byte = 0; byte < 4; ++byte) {
            record.at(42 + byte, indicator >> 8U * byte);
        }
        fixture.feed(record);
        return fixture.text("k1xRoamingHome");
    };
    EXPECT_EQ(label(0), "OFF [0]");
    EXPECT_EQ(label(1), "ON [1]");
    EXPECT_EQ(label(2), "Flashing [2]");
    EXPECT_EQ(label(3), "Out of Neighborhood [3]");
    EXPECT_EQ(label(4), "Out of Building [4]");
    EXPECT_EQ(label(5), "Preferred system [5]");
    EXPECT_EQ(label(6), "Available system [6]");
    EXPECT_EQ(label(7), "Alliance partner [7]");
    EXPECT_EQ(label(8), "Premium partner [8]");
    EXPECT_EQ(label(9), "Full service functionality [9]");
    EXPECT_EQ(label(10), "Partial service functionality [10]");
    EXPECT_EQ(label(11), "Banner ON [11]");
    EXPECT_EQ(label(12), "Banner OFF [12]");
    EXPECT_EQ(label(13), "ERI - 13");
    EXPECT_EQ(label(256), "ERI - 256") << "all 32 bits count";
    EXPECT_EQ(label(0x7FFFFFFF), "ERI - 2147483647");
    EXPECT_EQ(label(0x80000000), "ERI - -2147483648") << "looked up unsigned, shown signed";
    EXPECT_EQ(label(0xFFFFFFFF), "ERI - -1");
    EXPECT_EQ(fixture.value("k1xRoamingHome").displayNumber()->integer(), -1);
}

TEST(OneXSystemIdentity, ASystemTypeOtherThan2IsShownInPlaceOfSystemAndNetwork) {
    C2KFixture fixture;
    const auto shown = [&fixture](unsigned byte46, unsigned byte49) {
        fixture.feed(identity().at(46, byte46).at(49, byte49));
        EXPECT_EQ(fixture.text("kNetworkId") == "65", fixture.text("kSystemId") == "4139");
        return fixture.text("kSystemId");
    };
    EXPECT_EQ(shown(2, 0), "4139");
    EXPECT_EQ(shown(0, 0), "(unknown system type 0)");
    EXPECT_EQ(fixture.text("kNetworkId"), "(unknown system type 0)");
    EXPECT_EQ(fixture.value("kSystemId").displayNumber(), nullptr) << "not a system's number";
    EXPECT_EQ(shown(3, 0), "(unknown system type 3)");
    EXPECT_EQ(shown(2, 1), "(unknown system type 16777218)");
    EXPECT_EQ(shown(2, 0x80), "(unknown system type -2147483646)");
    EXPECT_EQ(fixture.text("kNetworkId"), "(unknown system type -2147483646)");
    EXPECT_EQ(fixture.text("kPacketZoneId"), "7") << "the rest is still shown";
}

TEST(OneXSystemIdentity, NumbersAreUnsigned) {
    C2KFixture fixture;
    Record record = identity();
    for (const unsigned at : {50U, 51U, 52U, 53U, 131U, 133U, 184U, 185U}) {
        record.at(at, 0xFF);
    }
    fixture.feed(record);
    EXPECT_EQ(fixture.text("kSystemId"), "65535");
    EXPECT_EQ(fixture.text("kNetworkId"), "65535");
    EXPECT_EQ(fixture.text("kPacketZoneId"), "255");
    EXPECT_EQ(fixture.text("kProtocolRevision"), "255");
    EXPECT_EQ(fixture.text("kBaseId"), "65535");
}

TEST(OneXSystemIdentity, APacketBelow171BytesIsAnError) {
    C2KFixture fixture;
    EXPECT_TRUE(fixture.writtenBy(Record(0x134F).u8(2).padTo(170)).empty());
    EXPECT_EQ(fixture.lines,
              (Lines{{3, "Log code 0x134f is 170 bytes long but must be at least 171 bytes."}}));
    cutPacketAtEveryLength(identity(), 171);
}

TEST(OneXSystemIdentity, AVersionBelow2IsAnErrorAndNothingIsSet) {
    C2KFixture fixture;
    for (const unsigned version : {0U, 1U}) {
        EXPECT_TRUE(fixture.writtenBy(identity().at(13, version)).empty());
        EXPECT_EQ(fixture.lines,
                  (Lines{{3, "Log code 0x134f has version=" + std::to_string(version) +
                                 "; only version 2 or higher expected; dropping."}}));
    }
    EXPECT_EQ(fixture.writtenBy(identity().at(13, 3)).size(), 6U);
    EXPECT_EQ(fixture.writtenBy(identity().at(13, 255)).size(), 6U);
}

TEST(OneXSystemIdentity, InAPacketThatEndsBeforeItTheBaseStationReads0) {
    C2KFixture fixture;
    const auto baseOf = [&fixture](std::size_t length) {
        ByteBuffer bytes = identity().at(184, 3).at(185, 9).bytes();
        bytes.resize(length);
        fixture.feed(bytes);
        return fixture.text("kBaseId");
    };
    EXPECT_EQ(baseOf(171), "0");
    EXPECT_EQ(baseOf(184), "0");
    EXPECT_EQ(baseOf(185), "3") << "its high byte is past the end";
    EXPECT_EQ(baseOf(186), "2307");
}

TEST(OneXSystemIdentity, AnyBytesWriteOnlyItsRows) {
    anyPacketWritesOnly(0x134F,
                        {"k1xRoamingHome", "kSystemId", "kNetworkId", "kPacketZoneId", "kBaseId",
                         "kProtocolRevision"},
                        {171, 185, 186, 200});
}

} // namespace
} // namespace pallax
