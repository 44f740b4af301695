#include "LogGenerator/LTE/ConnectedModeMeasurementMisc.h"

#include "tests/doubles/RecordFixture.h"
#include "tests/doubles/RecordProperties.h"

#include <gtest/gtest.h>

namespace pallax {
namespace {

using namespace doubles; // NOLINT: the vocabulary of these tests
using Lines = std::vector<RecordingLog::Line>;

constexpr std::string_view kName = "Connected mode LTE Intra-frequency Measurement";

Record measurement() {
    return Record(0xB179)
        .u32(0)
        .u16(1850) // E-ARFCN
        .u16(274)  // physical cell ID
        .u16(5121) // subframe number
        .u16(181)  // RSRP: 181 x 0.25 - 140
        .u16(83)   // RSRQ: 83 x 0.125 - 20
        .u8(0)     // measured neighbours
        .u8(0);    // detected cells
}

TEST(ConnectedModeMeasurementMisc, SubscribesToTheConnectedModeMeasurement) {
    const RecordFixture<ConnectedModeMeasurementMisc> fixture;
    EXPECT_EQ(fixture.subscriptions(), (std::vector<LogCode>{0xB179}));
    EXPECT_EQ(ConnectedModeMeasurementMisc().getSectionName(), kName);
}

TEST(ConnectedModeMeasurementMisc, ShowsTheServingValuesInTheOrderOfTheKeys) {
    RecordFixture<ConnectedModeMeasurementMisc> fixture;
    fixture.feed(measurement());
    EXPECT_EQ(fixture.lines, (Lines{{4, std::string(kName)}}));
    expectInOrder(fixture.section(), Dictionary{{"E-ARFCN", "1850"},
                                                {"Serving Physical Cell ID", "274"},
                                                {"Subframe Number", "5121"},
                                                {"Serving Filtered RSRP", "-94.75 dBm"},
                                                {"Serving Filtered RSRQ", "-9.62 dB"}});
    const Dictionary& keys = fixture.keys();
    EXPECT_EQ(keys.find("Serving Filtered RSRQ")->displayNumber()->real(), -9.625);
    EXPECT_EQ(keys.find("Serving Filtered RSRQ")->displayNumber()->unit(), "dB");
    EXPECT_EQ(keys.find("Serving Filtered RSRP")->displayNumber()->unit(), "dBm");
}

TEST(ConnectedModeMeasurementMisc, ShowsBothEndsOfItsRanges) {
    expectInOrder(sectionAfter<ConnectedModeMeasurementMisc>(Record(0xB179).padTo(29)),
                  Dictionary{{"E-ARFCN", "0"},
                             {"Serving Physical Cell ID", "0"},
                             {"Subframe Number", "0"},
                             {"Serving Filtered RSRP", "-140.00 dBm"},
                             {"Serving Filtered RSRQ", "-20.00 dB"}});
    const ByteBuffer ones(16, 0xFF);
    expectInOrder(sectionAfter<ConnectedModeMeasurementMisc>(Record(0xB179).append(ones)),
                  Dictionary{{"E-ARFCN", "65535"},
                             {"Serving Physical Cell ID", "65535"},
                             {"Subframe Number", "65535"},
                             {"Serving Filtered RSRP", "16243.75 dBm"},
                             {"Serving Filtered RSRQ", "8171.88 dB"}}); // 8171.875
}

TEST(ConnectedModeMeasurementMisc, APacketOf28BytesChangesNothing) {
    cutAtEveryLength<ConnectedModeMeasurementMisc>(measurement(), 29);
    RecordFixture<ConnectedModeMeasurementMisc> fixture;
    fixture.feed(Record(0xB179).padTo(28));
    EXPECT_EQ(fixture.lines, (Lines{{4, std::string(kName)}}))
        << "a short packet is dropped silently";
}

TEST(ConnectedModeMeasurementMisc, AnyOtherCodeIsUnknownAndChangesNothing) {
    RecordFixture<ConnectedModeMeasurementMisc> fixture;
    fixture.feed(Record(0xB180).padTo(100));
    EXPECT_EQ(fixture.lines,
              (Lines{{4, std::string(kName)}, {3, "Received an unknown log message: 45440"}}));
    EXPECT_TRUE(fixture.keys().empty());
}

TEST(ConnectedModeMeasurementMisc, AnyBytesKeepWithinItsKeys) {
    anyBytesKeepWithin<ConnectedModeMeasurementMisc>({"E-ARFCN", "Serving Physical Cell ID",
                                                      "Subframe Number", "Serving Filtered RSRP",
                                                      "Serving Filtered RSRQ"});
}

} // namespace
} // namespace pallax
