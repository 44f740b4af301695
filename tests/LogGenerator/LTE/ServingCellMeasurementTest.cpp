#include "LogGenerator/LTE/ServingCellMeasurement.h"

#include "tests/LogGenerator/LTE/PackedFields.h"
#include "tests/doubles/RecordFixture.h"
#include "tests/doubles/RecordProperties.h"

#include <gtest/gtest.h>

namespace pallax {
namespace {

using namespace doubles; // NOLINT: the vocabulary of these tests
using Lines = std::vector<RecordingLog::Line>;

constexpr std::size_t kLength = 33;

std::string searchDb(std::uint32_t raw) {
    return raw == 32 ? "Not Present" : scaledText(raw, 2, 0, 0, " dB");
}
std::string searchDbm(std::uint32_t raw) {
    return raw == 32 ? "Not Present" : scaledText(raw, 2, 0, 0, " dBm");
}
std::string powerLimit(std::uint32_t raw) {
    return raw == 64 ? "Not Present" : less30Dbm(raw);
}
std::string trueOrFalse(std::uint32_t raw) {
    return raw != 0 ? "True" : "False";
}

constexpr auto kPackedServingCell = std::to_array<PackedField>({
    {"Version", 13, 0, 8, plain},
    {"E-ARFCN", 17, 0, 16, plain},
    {"Physical Cell ID", 19, 0, 9, plain},
    {"Serving Layer Priority", 20, 1, 4, plain},
    {"Measured RSRP", 21, 0, 9, quarterDbm},
    {"Average RSRP", 22, 1, 9, quarterDbm},
    {"Measured RSRQ", 23, 2, 7, quarterDb},
    {"Average RSRQ", 24, 1, 7, quarterDb},
    {"Measured RSSI", 25, 0, 9, halfDbm},
    {"Qrxlevmin", 26, 1, 6, doubleDbm},
    {"P_Max", 26, 7, 7, powerLimit},
    {"Max UE Tx Power", 27, 6, 6, less30Dbm},
    {"Srxlev", 29, 0, 7, less30Dbm},
    {"Num of Consecutive DRX Cycles of S < 0", 29, 7, 6, plain},
    {"S Intra Search", 30, 5, 6, searchDb},
    {"S Non Intra Search", 31, 3, 6, searchDbm},
    {"Measurement Rules Updated", 32, 1, 1, trueOrFalse},
    {"Measurement Rules", 32, 2, 4, plain},
});

/// The record with this value in every payload byte.
Record servingCellOf(unsigned byte) {
    Record record(0xB17F);
    for (std::size_t at = 13; at < kLength; ++at) {
        record.u8(byte);
    }
    return record;
}

TEST(ServingCellMeasurement, SubscribesToItsRecord) {
    const RecordFixture<ServingCellMeasurement> fixture;
    EXPECT_EQ(fixture.subscriptions(), (std::vector<LogCode>{0xB17F}));
    EXPECT_EQ(ServingCellMeasurement().getSectionName(), "Serving Cell Measurements");
}

TEST(ServingCellMeasurement, AnAllZeroRecordShowsTheLowerEndsInTheOrderOfTheKeys) {
    expectInOrder(sectionAfter<ServingCellMeasurement>(servingCellOf(0)),
                  Dictionary{{"Version", "0"},
                             {"E-ARFCN", "0"},
                             {"Physical Cell ID", "0"},
                             {"Serving Layer Priority", "0"},
                             {"Measured RSRP", "-140.00 dBm"},
                             {"Average RSRP", "-140.00 dBm"},
                             {"Measured RSRQ", "-30.00 dB"},
                             {"Average RSRQ", "-30.00 dB"},
                             {"Measured RSSI", "-140.00 dBm"},
                             {"Qrxlevmin", "-140 dBm"},
                             {"P_Max", "-30 dBm"},
                             {"Max UE Tx Power", "-30 dBm"},
                             {"Srxlev", "-30 dBm"},
                             {"Num of Consecutive DRX Cycles of S < 0", "0"},
                             {"S Intra Search", "0 dB"},
                             {"S Non Intra Search", "0 dBm"},
                             {"Measurement Rules Updated", "False"},
                             {"Measurement Rules", "0"}});
}

TEST(ServingCellMeasurement, AnAllOneRecordShowsTheUpperEnds) {
    expectInOrder(sectionAfter<ServingCellMeasurement>(servingCellOf(0xFF)),
                  Dictionary{{"Version", "255"},
                             {"E-ARFCN", "65535"},
                             {"Physical Cell ID", "511"},
                             {"Serving Layer Priority", "15"},
                             {"Measured RSRP", "-12.25 dBm"}, // 511 x 0.25 - 140
                             {"Average RSRP", "-12.25 dBm"},
                             {"Measured RSRQ", "1.75 dB"}, // 127 x 0.25 - 30
                             {"Average RSRQ", "1.75 dB"},
                             {"Measured RSSI", "115.50 dBm"}, // 511 x 0.5 - 140
                             {"Qrxlevmin", "-14 dBm"},        // 63 x 2 - 140
                             {"P_Max", "97 dBm"},             // 127 - 30
                             {"Max UE Tx Power", "33 dBm"},   // 63 - 30
                             {"Srxlev", "97 dBm"},
                             {"Num of Consecutive DRX Cycles of S < 0", "63"},
                             {"S Intra Search", "126 dB"},
                             {"S Non Intra Search", "126 dBm"},
                             {"Measurement Rules Updated", "True"},
                             {"Measurement Rules", "15"}});
}

TEST(ServingCellMeasurement, OneBitAtATimeChangesItsKeyAlone) {
    for (std::size_t byte = 13; byte < kLength; ++byte) {
        for (unsigned bit = 0; bit < 8; ++bit) {
            expectInOrder(
                sectionAfter<ServingCellMeasurement>(servingCellOf(0).at(byte, 1U << bit)),
                withOneBit(kPackedServingCell, byte, bit));
        }
    }
}

TEST(ServingCellMeasurement, ShowsAMeasurement) {
    const Record record = servingCellOf(0)
                              .at(13, 4)
                              .at(17, 0x3A)
                              .at(18, 0x07) // 1850
                              .at(19, 0x12)
                              .at(20, 0x01 | 5 << 1) // cell 274, priority 5
                              .at(21, 0xB5)          // 181 x 0.25 - 140
                              .at(22, 180U << 1U & 0xFFU)
                              .at(23, 180U >> 7U | (82U & 0x3FU) << 2U) // 82 x 0.25 - 30
                              .at(24, 82U >> 6U | 80U << 1U)            // 80 x 0.25 - 30
                              .at(25, 0x96)                             // 150 x 0.5 - 140
                              .at(26, 6U << 1U | (53U & 1U) << 7U)      // 6 x 2 - 140, 53 - 30
                              .at(27, 53U >> 1U | (53U & 3U) << 6U)
                              .at(28, 53U >> 2U)
                              .at(29, 58)                   // 58 - 30
                              .at(30, 31U << 5U & 0xFFU)    // 31 x 2
                              .at(31, 31U >> 3U | 4U << 3U) // 4 x 2
                              .at(32, 1U << 1U | 3U << 2U);
    RecordFixture<ServingCellMeasurement> fixture;
    fixture.feed(record);
    EXPECT_EQ(fixture.lines, (Lines{{4, "Serving Cell Measurements"}}));
    expectInOrder(fixture.section(), Dictionary{{"Version", "4"},
                                                {"E-ARFCN", "1850"},
                                                {"Physical Cell ID", "274"},
                                                {"Serving Layer Priority", "5"},
                                                {"Measured RSRP", "-94.75 dBm"},
                                                {"Average RSRP", "-95.00 dBm"},
                                                {"Measured RSRQ", "-9.50 dB"},
                                                {"Average RSRQ", "-10.00 dB"},
                                                {"Measured RSSI", "-65.00 dBm"},
                                                {"Qrxlevmin", "-128 dBm"},
                                                {"P_Max", "23 dBm"},
                                                {"Max UE Tx Power", "23 dBm"},
                                                {"Srxlev", "28 dBm"},
                                                {"Num of Consecutive DRX Cycles of S < 0", "0"},
                                                {"S Intra Search", "62 dB"},
                                                {"S Non Intra Search", "8 dBm"},
                                                {"Measurement Rules Updated", "True"},
                                                {"Measurement Rules", "3"}});
    EXPECT_EQ(fixture.keys().find("Measured RSRP")->displayNumber()->real(), -94.75);
    EXPECT_EQ(fixture.keys().find("Measured RSRP")->displayNumber()->unit(), "dBm");
    EXPECT_EQ(fixture.keys().find("P_Max")->displayNumber()->integer(), 23);
}

TEST(ServingCellMeasurement, PMax64IsNotPresent) {
    RecordFixture<ServingCellMeasurement> fixture;
    fixture.feed(servingCellOf(0).at(27, 1U << 5U)); // bit 6 of the field
    EXPECT_EQ(fixture.text("P_Max"), "Not Present");
    fixture.feed(servingCellOf(0).at(27, 1U << 5U).at(26, 1U << 7U));
    EXPECT_EQ(fixture.text("P_Max"), "35 dBm") << "65 is a power again";
}

TEST(ServingCellMeasurement, MaxUETxPowerIsNeverNotPresent) {
    RecordFixture<ServingCellMeasurement> fixture;
    for (unsigned raw = 0; raw < 128; ++raw) { // one bit more than the field has
        fixture.feed(servingCellOf(0).at(27, raw << 6U & 0xFFU).at(28, raw >> 2U));
        EXPECT_EQ(fixture.text("Max UE Tx Power"),
                  std::to_string(static_cast<int>(raw % 64) - 30) + " dBm");
    }
}

TEST(ServingCellMeasurement, SIntraSearchIsShownInDBAndSNonIntraSearchInDBm) {
    RecordFixture<ServingCellMeasurement> fixture;
    const auto feed = [&fixture](unsigned raw) {
        fixture.feed(servingCellOf(0)
                         .at(30, raw << 5U & 0xFFU)
                         .at(31, raw >> 3U | (raw << 3U & 0xFFU))
                         .at(32, raw >> 5U));
    };
    feed(31);
    EXPECT_EQ(fixture.text("S Intra Search"), "62 dB");
    EXPECT_EQ(fixture.text("S Non Intra Search"), "62 dBm");
    EXPECT_EQ(fixture.keys().find("S Intra Search")->displayNumber()->unit(), "dB");
    EXPECT_EQ(fixture.keys().find("S Non Intra Search")->displayNumber()->unit(), "dBm");
    feed(32);
    EXPECT_EQ(fixture.text("S Intra Search"), "Not Present");
    EXPECT_EQ(fixture.text("S Non Intra Search"), "Not Present");
    feed(33);
    EXPECT_EQ(fixture.text("S Intra Search"), "66 dB");
    EXPECT_EQ(fixture.text("S Non Intra Search"), "66 dBm");
}

TEST(ServingCellMeasurement, APacketOf32BytesChangesNothing) {
    cutAtEveryLength<ServingCellMeasurement>(servingCellOf(0xFF), kLength);
    RecordFixture<ServingCellMeasurement> fixture;
    fixture.feed(Record(0xB17F).padTo(kLength - 1));
    EXPECT_EQ(fixture.lines, (Lines{{4, "Serving Cell Measurements"}}))
        << "a short packet is dropped silently";
}

TEST(ServingCellMeasurement, AnyOtherCodeIsUnknownAndChangesNothing) {
    RecordFixture<ServingCellMeasurement> fixture;
    fixture.feed(Record(0xB180).padTo(100));
    EXPECT_EQ(fixture.lines, (Lines{{4, "Serving Cell Measurements"},
                                    {3, "Received an unknown log message: 45440"}}));
    EXPECT_TRUE(fixture.keys().empty());
}

TEST(ServingCellMeasurement, AnyBytesKeepWithinItsKeys) {
    std::set<std::string> keys;
    for (const PackedField& field : kPackedServingCell) {
        keys.insert(field.key);
    }
    anyBytesKeepWithin<ServingCellMeasurement>(keys);
}

} // namespace
} // namespace pallax
