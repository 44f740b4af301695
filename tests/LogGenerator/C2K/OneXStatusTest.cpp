#include "LogGenerator/C2K/OneXStatus.h"

#include "LogGenerator/C2K/TrafficFER.h"
#include "tests/LogGenerator/C2K/C2KFixture.h"
#include "tests/LogGenerator/C2K/OneXRecords.h"
#include "tests/doubles/Property.h"

#include <gtest/gtest.h>

#include <set>
#include <string>

namespace pallax {
namespace {

using namespace doubles; // NOLINT: the vocabulary of these tests
using Lines = std::vector<RecordingLog::Line>;

TEST(OneXStatus, InTrafficAPacketSetsEveryRowOfItsTable) {
    C2KFixture fixture;
    EXPECT_EQ(PropertyList(fixture.writtenBy(oneXStatus(kTrafficState, twoPilots()))),
              PropertyList(
                  Dictionary{{"k1xDeviceState", "Traffic [8]"},
                             {"k1xRx0BandClass", "800 MHz cellular band [0]"},
                             {"k1xRx0ChanNum", "283"},
                             {"k1xRxAGC0", "-76.61 dBm"},
                             {"k1xRx1BandClass", "1.8 to 2.0GHz PCS band [1]"},
                             {"k1xRx1ChanNum", "25"},
                             {"k1xRxAGC1", "-49.89 dBm"},
                             {"k1xTxAGC", "-12.50 dBm"},
                             {"k1xActiveSetInfo", Dictionary{{"_sorted", "_sorted"},
                                                             {"0;4", "-14.79 dB"},
                                                             {"1;168", "(ref pilot) -5.09 dB"}}}}));
    EXPECT_EQ(fixture.lines, Lines());
}

TEST(OneXStatus, OutsideTrafficTheSecondReceiverAndTheTransmitterReadNA) {
    for (const unsigned state : {0U, 6U, 7U, 9U, 255U}) {
        C2KFixture fixture;
        fixture.feed(oneXStatus(state));
        EXPECT_EQ(fixture.text("k1xRx0BandClass"), "800 MHz cellular band [0]");
        EXPECT_EQ(fixture.text("k1xRx0ChanNum"), "283");
        EXPECT_EQ(fixture.text("k1xRxAGC0"), "-76.61 dBm");
        for (const char* name : {"k1xRx1BandClass", "k1xRx1ChanNum", "k1xRxAGC1", "k1xTxAGC"}) {
            EXPECT_EQ(fixture.text(name), "N/A") << name << " in state " << state;
        }
    }
}

TEST(OneXStatus, EveryDeviceStateHasItsLabel) {
    C2KFixture fixture;
    const auto label = [&fixture](unsigned state) {
        fixture.feed(oneXStatus(state));
        return fixture.text("k1xDeviceState");
    };
    EXPECT_EQ(label(0), "Inactive [0]");
    EXPECT_EQ(label(1), "Deep sleep in start state [1]");
    EXPECT_EQ(label(2), "Initial state for CDMA operation [2]");
    EXPECT_EQ(label(3), "Acquisition [3]");
    EXPECT_EQ(label(4), "Sync [4]");
    EXPECT_EQ(label(5), "Slew [5]");
    EXPECT_EQ(label(6), "Paging [6]");
    EXPECT_EQ(label(7), "Slotted mode sleep state [7]");
    EXPECT_EQ(label(8), "Traffic [8]");
    EXPECT_EQ(label(9), "UnSlew [9]");
    EXPECT_EQ(label(10), "Operation in PCG state [10]");
    EXPECT_EQ(label(11), "Powerup state [11]");
    EXPECT_EQ(label(12), "[Bad Value 12]");
    EXPECT_EQ(label(255), "[Bad Value 255]");
}

/// The rows of a radio subpacket in traffic.
C2KFixture& withRadio(C2KFixture& fixture, const Subpacket& radioSubpacket) {
    fixture.feed(
        packetOf(0x119C, {systemState(kTrafficState), radioSubpacket, noPilots(), noFingers()}));
    return fixture;
}

TEST(OneXStatus, BandClassesBeyondTheTableAreBadValues) {
    C2KFixture fixture;
    (void)withRadio(fixture, Subpacket(2).u8(12).u8(13).padTo(14));
    EXPECT_EQ(fixture.text("k1xRx0BandClass"), "800 MHz European PAMR band [12]");
    EXPECT_EQ(fixture.text("k1xRx1BandClass"), "[Bad Value 13]");
    (void)withRadio(fixture, Subpacket(2).u8(255).u8(9).padTo(14));
    EXPECT_EQ(fixture.text("k1xRx0BandClass"), "[Bad Value 255]");
    EXPECT_EQ(fixture.text("k1xRx1BandClass"), "900 MHzband [9]");
}

TEST(OneXStatus, GainsAreSignedAndScaled) {
    C2KFixture fixture;
    const auto gains = [&fixture](int receive0, int receive1, int transmit) {
        (void)withRadio(fixture, Subpacket(2).padTo(10).s8(receive0).s8(receive1).s16(transmit));
        return fixture.text("k1xRxAGC0") + ", " + fixture.text("k1xRxAGC1") + ", " +
               fixture.text("k1xTxAGC");
    };
    EXPECT_EQ(gains(0, 127, 0), "-63.25 dBm, -20.83 dBm, +0.00 dBm");
    EXPECT_EQ(gains(-128, -1, 32767), "-106.00 dBm, -63.58 dBm, +3276.70 dBm");
    EXPECT_EQ(gains(1, 0, -32768), "-62.91 dBm, -63.25 dBm, -3276.80 dBm");
    EXPECT_EQ(gains(1, 0, 235), "-62.91 dBm, -63.25 dBm, +23.50 dBm");
    EXPECT_EQ(fixture.value("k1xRxAGC0").displayNumber()->real(), 1.0 * 334 / 1000 - 63.248);
    EXPECT_EQ(fixture.value("k1xRxAGC0").displayNumber()->unit(), "dBm");
    (void)gains(0, 0, -123);
    EXPECT_EQ(fixture.value("k1xTxAGC").displayNumber()->real(), -123 / 10.0);
}

TEST(OneXStatus, ChannelsAreUnsigned16BitNumbers) {
    C2KFixture fixture;
    (void)withRadio(fixture, Subpacket(2).u16(0).u16(0xFFFF).u16(0x8001).padTo(14));
    EXPECT_EQ(fixture.text("k1xRx0ChanNum"), "65535");
    EXPECT_EQ(fixture.text("k1xRx1ChanNum"), "32769");
}

TEST(OneXStatus, AMissingSubpacketIsAWarningAndNothingIsSet) {
    struct Case {
        unsigned missing;
        const char* found;
    };
    for (const Case& each : {Case{1, "(ss=0,rf=1,ai=1,fi=1)"}, Case{2, "(ss=1,rf=0,ai=1,fi=1)"},
                             Case{3, "(ss=1,rf=1,ai=0,fi=1)"}, Case{4, "(ss=1,rf=1,ai=1,fi=0)"}}) {
        std::vector<Subpacket> subpackets;
        for (unsigned id = 1; id <= 4; ++id) {
            subpackets.push_back(Subpacket(id == each.missing ? 9 : id).padTo(14));
        }
        C2KFixture fixture;
        EXPECT_TRUE(fixture.writtenBy(packetOf(0x119C, subpackets)).empty());
        EXPECT_EQ(fixture.lines, (Lines{{4, "Log code 0x119c: missing subpacket " +
                                                std::string(each.found) + "."}}));
    }
    C2KFixture fixture;
    EXPECT_TRUE(fixture.writtenBy(Record(0x119C).padTo(17)).empty());
    EXPECT_EQ(fixture.lines,
              (Lines{{4, "Log code 0x119c: missing subpacket (ss=0,rf=0,ai=0,fi=0)."}}));
}

TEST(OneXStatus, TheSubpacketsMayStandInAnyOrder) {
    C2KFixture fixture;
    fixture.feed(packetOf(0x119C, {noFingers(), twoPilots(), radio(), Subpacket(9).padTo(40),
                                   systemState(kTrafficState)}));
    EXPECT_EQ(fixture.text("k1xDeviceState"), "Traffic [8]");
    EXPECT_EQ(shownList(fixture.value("k1xActiveSetInfo")),
              "(4: -14.79 dB, 168: (ref pilot) -5.09 dB)");
}

TEST(OneXStatus, TheBadSizeLineComesOnceForEachIdThatIsSearched) {
    C2KFixture fixture;
    const RecordingLog::Line badSize{3, "Log code error in subpkt#1: bad size (999)."};
    EXPECT_TRUE(fixture
                    .writtenBy(packetOf(
                        0x119C, {systemState(6), Subpacket(2).claim(999), noPilots(), noFingers()}))
                    .empty());
    EXPECT_EQ(fixture.lines,
              (Lines{badSize,
                     badSize,
                     badSize,
                     {4, "Log code 0x119c: missing subpacket (ss=1,rf=0,ai=0,fi=0)."}}));
}

TEST(OneXStatus, APacketBelow17BytesIsAnError) {
    C2KFixture fixture;
    EXPECT_TRUE(fixture.writtenBy(Record(0x119C).padTo(16)).empty());
    EXPECT_EQ(fixture.lines,
              (Lines{{3, "Log code 0x119c is 16 bytes long but must be at least 17 bytes."}}));
}

TEST(OneXStatus, CutAtEveryLengthItWritesNothingBeforeTheLastSubpacketsId) {
    const Record packet = oneXStatus(kTrafficState, twoPilots());
    cutPacketAtEveryLength(packet, packet.bytes().size() - 3);
}

TEST(OneXStatus, FieldsPastThePacketsEndReadAsZero) {
    C2KFixture fixture;
    // The radio subpacket is the last one and claims to be longer than the packet.
    const Record packet = packetOf(0x119C, {noFingers(), noPilots(), systemState(kTrafficState),
                                            Subpacket(2).u8(1).claim(14)});
    fixture.feed(packet);
    EXPECT_EQ(fixture.text("k1xRx0BandClass"), "1.8 to 2.0GHz PCS band [1]");
    EXPECT_EQ(fixture.text("k1xRx1BandClass"), "800 MHz cellular band [0]");
    EXPECT_EQ(fixture.text("k1xRx0ChanNum"), "0");
    EXPECT_EQ(fixture.text("k1xRxAGC1"), "-63.25 dBm");
    EXPECT_EQ(fixture.text("k1xTxAGC"), "+0.00 dBm");
}

TEST(OneXStatus, OutsideTrafficTheRateOfTheCallIsShownAsOldOnceAndForgotten) {
    C2KFixture fixture;
    fixture.feed(trafficFrame(1));
    fixture.feed(trafficFrame(0));
    EXPECT_EQ(fixture.text("k1xTrafficFER"), "1.54%");
    fixture.feed(oneXStatus(kTrafficState));
    EXPECT_EQ(fixture.text("k1xTrafficFER"), "1.54%") << "the call still lasts";
    fixture.feed(oneXStatus(6));
    EXPECT_EQ(fixture.text("k1xTrafficFER"), "1.54% (old)");
    EXPECT_EQ(fixture.value("k1xTrafficFER").displayNumber()->unit(), "%");
    EXPECT_FALSE(fixture.state.contains("TrafficFER"));
    EXPECT_FALSE(fixture.writtenBy(oneXStatus(6)).contains("k1xTrafficFER")) << "only once";
    fixture.feed(trafficFrame(1));
    EXPECT_EQ(fixture.text("k1xTrafficFER"), "1.56%") << "the filter starts again";
}

TEST(OneXStatus, WithoutAnyRateNoneIsShownAsOld) {
    C2KFixture fixture;
    EXPECT_FALSE(fixture.writtenBy(oneXStatus(6)).contains("k1xTrafficFER"));
    fixture.state.set("TrafficFER", "no number");
    EXPECT_FALSE(fixture.writtenBy(oneXStatus(6)).contains("k1xTrafficFER"));
    EXPECT_TRUE(fixture.state.contains("TrafficFER")) << "a value that is not a rate stays";
    fixture.state.set("TrafficFER", PropertyList::integer(1));
    fixture.feed(oneXStatus(6));
    EXPECT_EQ(fixture.text("k1xTrafficFER"), "100.00% (old)");
}

TEST(OneXStatus, AnySubpacketsWriteOnlyItsRows) {
    EXPECT_TRUE(doubles::holds([] {
        C2KFixture fixture;
        fixture.state.set("TrafficFER", PropertyList::real(0.5));
        const Dictionary rows = fixture.writtenBy(
            packetOf(0x119C, {anySubpacket(1), anySubpacket(2), anySubpacket(3), anySubpacket(4)}));
        std::set<std::string> names;
        for (const auto& row : rows) {
            names.insert(row.key.string());
            (void)row.value.description();
        }
        std::set<std::string> expected = {"k1xDeviceState", "k1xRx0BandClass", "k1xRx0ChanNum",
                                          "k1xRxAGC0",      "k1xRx1BandClass", "k1xRx1ChanNum",
                                          "k1xRxAGC1",      "k1xTxAGC",        "k1xActiveSetInfo"};
        if (fixture.text("k1xDeviceState") != "Traffic [8]") {
            expected.insert("k1xTrafficFER");
        }
        RC_ASSERT(names == expected);
    }));
}

TEST(OneXStatus, InEveryStateButTrafficTheRateOfTheCallIsShownAsOld) {
    for (const unsigned state : {0U, 7U, 9U, 11U, 255U}) {
        C2KFixture fixture;
        fixture.feed(trafficFrame(1));
        fixture.feed(oneXStatus(state));
        EXPECT_EQ(fixture.text("k1xTrafficFER"), "1.56% (old)") << state;
        EXPECT_FALSE(fixture.state.contains("TrafficFER")) << state;
    }
}

TEST(OneXStatus, APacketThatIsRefusedLeavesTheRateOfTheCall) {
    C2KFixture fixture;
    fixture.feed(trafficFrame(1));
    EXPECT_TRUE(fixture.writtenBy(Record(0x119C).padTo(16)).empty());
    EXPECT_TRUE(fixture.writtenBy(packetOf(0x119C, {systemState(6), radio(), noPilots()})).empty());
    EXPECT_EQ(fixture.state.find("TrafficFER")->real(), 0.015625);
}

TEST(OneXStatus, TheOldRateIsMadeAPercentageInSinglePrecision) {
    const volatile float single = 0.1F * 100.0F;
    ASSERT_NE(double{0.1F} * 100.0, static_cast<double>(single));
    EXPECT_EQ(shownOldTrafficFER(0.1F).displayNumber()->real(), static_cast<double>(single));
}

} // namespace
} // namespace pallax
