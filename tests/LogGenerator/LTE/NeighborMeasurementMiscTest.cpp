#include "LogGenerator/LTE/NeighborMeasurementMisc.h"

#include "tests/LogGenerator/LTE/PackedFields.h"
#include "tests/doubles/RecordFixture.h"
#include "tests/doubles/RecordProperties.h"

#include <gtest/gtest.h>

namespace pallax {
namespace {

using namespace doubles; // NOLINT: the vocabulary of these tests
using Lines = std::vector<RecordingLog::Line>;

constexpr auto kPackedMeasurements = std::to_array<PackedField>({
    {"Version", 13, 0, 8, plain},
    {"E-ARFCN", 17, 0, 16, plain},
    {"Qrxlevmin", 19, 0, 6, doubleDbm},
});

Record measurementOf(unsigned byte) {
    return Record(0xB180).append({byte, byte, byte, byte, byte, byte, byte, byte});
}

TEST(NeighborMeasurementMisc, SubscribesToTheIdleModeMeasurement) {
    const RecordFixture<NeighborMeasurementMisc> fixture;
    EXPECT_EQ(fixture.subscriptions(), (std::vector<LogCode>{0xB180}));
    EXPECT_EQ(NeighborMeasurementMisc().getSectionName(), "Neighbor Measurements");
}

TEST(NeighborMeasurementMisc, ShowsBothEndsOfItsRangesInTheOrderOfTheKeys) {
    RecordFixture<NeighborMeasurementMisc> fixture;
    fixture.feed(measurementOf(0));
    EXPECT_EQ(fixture.lines, (Lines{{4, "Neighbor Measurements"}}));
    expectInOrder(fixture.section(),
                  Dictionary{{"Version", "0"}, {"E-ARFCN", "0"}, {"Qrxlevmin", "-140 dBm"}});
    fixture.feed(measurementOf(0xFF));
    expectInOrder(fixture.section(), Dictionary{{"Version", "255"},
                                                {"E-ARFCN", "65535"},
                                                {"Qrxlevmin", "-14 dBm"}}); // 63 x 2 - 140
    EXPECT_EQ(fixture.keys().find("Qrxlevmin")->displayNumber()->integer(), -14);
    EXPECT_EQ(fixture.keys().find("Qrxlevmin")->displayNumber()->unit(), "dBm");
}

TEST(NeighborMeasurementMisc, OneBitAtATimeChangesItsKeyAlone) {
    for (std::size_t byte = 13; byte < 21; ++byte) {
        for (unsigned bit = 0; bit < 8; ++bit) {
            expectInOrder(
                sectionAfter<NeighborMeasurementMisc>(measurementOf(0).at(byte, 1U << bit)),
                withOneBit(kPackedMeasurements, byte, bit));
        }
    }
}

TEST(NeighborMeasurementMisc, APacketOf20BytesChangesNothing) {
    cutAtEveryLength<NeighborMeasurementMisc>(measurementOf(0xFF), 21);
    RecordFixture<NeighborMeasurementMisc> fixture;
    fixture.feed(Record(0xB180).padTo(20));
    EXPECT_EQ(fixture.lines, (Lines{{4, "Neighbor Measurements"}}))
        << "a short packet is dropped silently";
}

TEST(NeighborMeasurementMisc, AnyOtherCodeIsUnknownAndChangesNothing) {
    RecordFixture<NeighborMeasurementMisc> fixture;
    fixture.feed(Record(0xB17F).padTo(100));
    EXPECT_EQ(fixture.lines,
              (Lines{{4, "Neighbor Measurements"}, {3, "Received an unknown log message: 45439"}}));
    EXPECT_TRUE(fixture.keys().empty());
}

TEST(NeighborMeasurementMisc, AnyBytesKeepWithinItsKeys) {
    anyBytesKeepWithin<NeighborMeasurementMisc>({"Version", "E-ARFCN", "Qrxlevmin"});
}

} // namespace
} // namespace pallax
