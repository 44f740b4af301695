#include "LogGenerator/ZOR_GSM/GPRSInformation.h"

#include "tests/doubles/RecordFixture.h"
#include "tests/doubles/RecordProperties.h"

#include <gtest/gtest.h>

namespace pallax {
namespace {

using namespace doubles; // NOLINT: the vocabulary of these tests
using Lines = std::vector<RecordingLog::Line>;

/// Network control (0x51F5) with the bytes 13, 14 and 15.
Record control(unsigned pfc, unsigned threshold, unsigned order) {
    return Record(0x51F5).u8(pfc).u8(threshold).u8(order).padTo(18);
}

/// The text of `key` after a record with `value` in byte `offset`.
std::string shown(Record record, std::size_t offset, unsigned value, std::string_view key) {
    RecordFixture<GPRSInformation> fixture;
    fixture.feed(record.at(offset, value));
    return fixture.text(key);
}

/// Each byte value shows its label: 255 the first, 0 the second, and so on, else "Unknown".
void expectLabelsByBytePlusOne(const Record& record, std::size_t offset, std::string_view key,
                               const std::vector<std::string>& labels) {
    for (unsigned value = 0; value < 256; ++value) {
        const unsigned entry = (value + 1) % 256;
        EXPECT_EQ(shown(record, offset, value, key),
                  entry < labels.size() ? labels[entry] : "Unknown")
            << value;
    }
}

TEST(GPRSInformation, SubscribesToItsSevenRecordsInTheirOrder) {
    const RecordFixture<GPRSInformation> fixture;
    EXPECT_EQ(fixture.subscriptions(),
              (std::vector<LogCode>{0x51F5, 0x7135, 0x51F6, 0x51FB, 0x51FD, 0x51F4, 0x5137}));
    EXPECT_EQ(GPRSInformation().getSectionName(), "GPRS Information");
}

// 0x51F4

TEST(GPRSInformation, TheSI13PositionIsLabelledByBytePlusOne) {
    expectInOrder(sectionAfter<GPRSInformation>(Record(0x51F4).u8(9).u8(0)),
                  Dictionary{{"SI13 Position", "Located on BCCH"}});
    expectLabelsByBytePlusOne(Record(0x51F4), 14, "SI13 Position",
                              {"Not Available", "Located on BCCH", "Located on Extended BCCH"});
}

// 0x51F5

TEST(GPRSInformation, ThreeBytesOf255ShowAvailableForPFCAndNotAvailableForTheOthers) {
    expectInOrder(sectionAfter<GPRSInformation>(control(255, 255, 255)),
                  Dictionary{{"Network Control Order", "Not Available"},
                             {"PFC Supported", "Available"},
                             {"Priority Access Threshold", "Not Available"}});
}

TEST(GPRSInformation, Byte15As3ShowsTheControlOrderUnknownAndByte14As0TheThresholdBarred) {
    expectInOrder(
        sectionAfter<GPRSInformation>(control(1, 0, 3)),
        Dictionary{{"Network Control Order", "Unknown"},
                   {"PFC Supported", "Supported"},
                   {"Priority Access Threshold", "Barred (PKT access not allowed in the Cell)"}});
}

TEST(GPRSInformation, TheNetworkControlOrderIsLabelledByBytePlusOne) {
    expectLabelsByBytePlusOne(control(0, 0, 0), 15, "Network Control Order",
                              {"Not Available", "NC0", "NC1", "NC2"});
}

TEST(GPRSInformation, PFCIsLabelledByBytePlusOneAndItsFirstEntryReadsAvailable) {
    expectLabelsByBytePlusOne(control(0, 0, 0), 13, "PFC Supported",
                              {"Available", "Not Supported", "Supported"});
}

TEST(GPRSInformation, ThePriorityAccessThresholdIsLabelledByBytePlusOne) {
    expectLabelsByBytePlusOne(control(0, 0, 0), 14, "Priority Access Threshold",
                              {"Not Available", "Barred (PKT access not allowed in the Cell)",
                               "Barred", "Barred", "1 Only", "1 to 2", "1 to 3", "1 to 4",
                               "Allowed"});
}

// 0x51F6

TEST(GPRSInformation, ShowsThePacketTimers) {
    expectInOrder(
        sectionAfter<GPRSInformation>(Record(0x51F6).padTo(15).append({4, 64, 1}).padTo(24)),
        Dictionary{
            {"T3192", "80 ms"}, {"Access Burst Type", "11-bit format"}, {"DRX Timer Max", "64"}});
}

TEST(GPRSInformation, Byte15As9ShowsT3192WithQuestionMarksAndByte17As0The8BitFormat) {
    expectInOrder(
        sectionAfter<GPRSInformation>(Record(0x51F6).padTo(15).append({9, 255, 0}).padTo(24)),
        Dictionary{
            {"T3192", "?? ms"}, {"Access Burst Type", "8-bit format"}, {"DRX Timer Max", "255"}});
}

TEST(GPRSInformation, EveryT3192HasItsLabel) {
    const std::vector<std::string> labels = {"500 ms", "1000 ms", "1500 ms", "0 ms",
                                             "80 ms",  "120 ms",  "160 ms",  "200 ms"};
    for (unsigned value = 0; value < 256; ++value) {
        EXPECT_EQ(shown(Record(0x51F6).padTo(24), 15, value, "T3192"),
                  value < labels.size() ? labels[value] : "?? ms");
    }
}

// 0x51FB

TEST(GPRSInformation, ShowsPBCCHAsANumber) {
    RecordFixture<GPRSInformation> fixture;
    fixture.feed(Record(0x51FB).u8(201).padTo(34));
    expectInOrder(fixture.section(), Dictionary{{"PBCCH Present", "201"}});
    EXPECT_EQ(fixture.keys().find("PBCCH Present")->displayNumber()->integer(), 201);
}

// 0x51FD

Record packetStatus(unsigned packetSI) {
    return Record(0x51FD).append({10, 11, 12, 13}).padTo(33).u8(packetSI).padTo(35);
}

TEST(GPRSInformation, ThePacketStatusOf35BytesWithByte33As1ShowsSupported) {
    expectInOrder(sectionAfter<GPRSInformation>(packetStatus(1)),
                  Dictionary{{"Ext Measurement Order", "13"},
                             {"Packet PSI Status", "10"},
                             {"Packet SI Status", "Supported"},
                             {"Count LR", "11"},
                             {"Count HR", "12"}});
    EXPECT_EQ(shown(packetStatus(0), 33, 0, "Packet SI Status"), "Not Supported");
    EXPECT_EQ(shown(packetStatus(0), 33, 255, "Packet SI Status"), "Supported");
}

TEST(GPRSInformation, ThePacketStatusOf34BytesChangesNothing) {
    ByteBuffer bytes = packetStatus(1).bytes();
    bytes.pop_back();
    ASSERT_EQ(bytes.size(), 34U);
    RecordFixture<GPRSInformation> fixture;
    fixture.feed(bytes);
    EXPECT_TRUE(fixture.keys().empty());
    EXPECT_EQ(fixture.lines, (Lines{{4, "GPRSInformation"}}));
}

// 0x5137 and 0x7135

TEST(GPRSInformation, ShowsWhetherTheReselectHysteresisIsApplied) {
    for (const unsigned applied : {0U, 1U, 255U}) {
        expectInOrder(
            sectionAfter<GPRSInformation>(Record(0x5137).padTo(26).u8(applied).padTo(29)),
            Dictionary{{"Cell Reselect Hysteresis", applied == 0 ? "Not Applied" : "Applied"}});
    }
}

TEST(GPRSInformation, EveryOperatingModeHasItsLabelAndByte13As3ShowsUnknown) {
    const std::vector<std::string> labels = {"Class 1", "Class 2", "Class 3"};
    for (unsigned value = 0; value < 256; ++value) {
        expectInOrder(sectionAfter<GPRSInformation>(Record(0x7135).u8(value).padTo(32)),
                      Dictionary{{"Network Operating Mode",
                                  value < labels.size() ? labels[value] : "Unknown"}});
    }
}

// All together

TEST(GPRSInformation, APacketOneByteTooShortChangesNothing) {
    cutAtEveryLength<GPRSInformation>(Record(0x51F4).u8(1).u8(1), 15);
    cutAtEveryLength<GPRSInformation>(control(1, 1, 1), 18);
    cutAtEveryLength<GPRSInformation>(Record(0x51F6).padTo(24), 24);
    cutAtEveryLength<GPRSInformation>(Record(0x51FB).padTo(34), 34);
    cutAtEveryLength<GPRSInformation>(packetStatus(1), 35);
    cutAtEveryLength<GPRSInformation>(Record(0x5137).padTo(29), 29);
    cutAtEveryLength<GPRSInformation>(Record(0x7135).padTo(32), 32);
}

TEST(GPRSInformation, LogsItsLineOnEveryAcceptedPacket) {
    RecordFixture<GPRSInformation> fixture;
    for (const LogCode logCode : fixture.subscriptions()) {
        const std::size_t before = fixture.keys().size();
        fixture.feed(Record(logCode).padTo(40));
        EXPECT_EQ(fixture.lines, (Lines{{4, "GPRSInformation"}})) << std::hex << logCode;
        EXPECT_GT(fixture.keys().size(), before) << std::hex << logCode << " was not accepted";
    }
}

TEST(GPRSInformation, KeysPersistUntilTheyAreOverwritten) {
    RecordFixture<GPRSInformation> fixture;
    fixture.feed(control(0, 7, 0));
    fixture.feed(Record(0x51FB).u8(1).padTo(34));
    fixture.feed(control(1, 7, 2));
    expectInOrder(fixture.section(), Dictionary{{"Network Control Order", "NC2"},
                                                {"PFC Supported", "Supported"},
                                                {"Priority Access Threshold", "Allowed"},
                                                {"PBCCH Present", "1"}});
}

TEST(GPRSInformation, TheUnhandledCodesOfItsRangeAndAnyOtherAreUnknown) {
    RecordFixture<GPRSInformation> fixture;
    const std::vector<std::pair<LogCode, std::string>> unknown = {
        {0x51F7, "20983"}, {0x51F8, "20984"}, {0x51F9, "20985"}, {0x51FA, "20986"},
        {0x51FC, "20988"}, {0x51F3, "20979"}, {0x51FE, "20990"}, {0xFF0001, "16711681"}};
    for (const auto& [logCode, text] : unknown) {
        fixture.feed(Record(logCode).padTo(40));
        EXPECT_EQ(fixture.lines,
                  (Lines{{4, "GPRSInformation"}, {3, "Received an unknown log message: " + text}}));
    }
    EXPECT_TRUE(fixture.keys().empty());
}

TEST(GPRSInformation, AnyBytesKeepWithinItsKeys) {
    anyBytesKeepWithin<GPRSInformation>(
        {"SI13 Position", "Network Control Order", "PFC Supported", "Priority Access Threshold",
         "T3192", "Access Burst Type", "DRX Timer Max", "PBCCH Present", "Ext Measurement Order",
         "Packet PSI Status", "Packet SI Status", "Count LR", "Count HR",
         "Cell Reselect Hysteresis", "Network Operating Mode"});
}

} // namespace
} // namespace pallax
