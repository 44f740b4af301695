#include "LogGenerator/ZOR_GSM/ProcessCO.h"

#include "tests/doubles/RecordFixture.h"
#include "tests/doubles/RecordProperties.h"

#include <gtest/gtest.h>

namespace pallax {
namespace {

using namespace doubles; // NOLINT: the vocabulary of these tests
using Lines = std::vector<RecordingLog::Line>;

Record coState(unsigned mmState) {
    return Record(0x7131).u8(mmState).u8(8).u8(3);
}

TEST(ProcessCO, SubscribesToMMStateAndRegistration) {
    const ProcessCO record;
    const auto codes = record.getLogCodeArray();
    EXPECT_EQ(std::vector<LogCode>(codes.begin(), codes.end()),
              (std::vector<LogCode>{0x7131, 0x7132}));
    EXPECT_EQ(record.getSectionName(), "Process CO");
}

TEST(ProcessCO, ShowsTheMMStateOnly) {
    expectInOrder(sectionAfter<ProcessCO>(coState(20)),
                  Dictionary{{"MM State", "MM_WAIT_FOR_ADDITIONAL_OUTGOING_MM_ CONNECTION"}});
}

TEST(ProcessCO, ShowsTheRegistrationState) {
    const auto shown = [](unsigned value) {
        return sectionAfter<ProcessCO>(Record(0x7132).u8(value).padTo(16));
    };
    expectInOrder(shown(6), Dictionary{{"MM Service State", "REG_STATE_OFFLINE"}});
    expectInOrder(shown(7), Dictionary{{"MM Service State", "Unknown"}});
}

TEST(ProcessCO, EveryMMStateHasItsLabel) {
    const std::vector<std::string> labels = {
        "MM_NULL",
        "Unknown",
        "Unknown",
        "MM_LOCATION_UPDATE_INITIATED",
        "Unknown",
        "MM_WAIT_FOR_OUTGOING_MM_CONNECTION",
        "MM_CONNECTION_ACTIVE",
        "MM_IMSI_DETACH_INITIATED",
        "MM_PROCESS_CM_SERVICE_PROMPT",
        "MM_WAIT_FOR_NETWORK_COMMAND",
        "MM_LOCATION_UPDATE_REJECTED",
        "Unknown",
        "Unknown",
        "MM_WAIT_FOR_RR_CONNECTION_LU",
        "MM_WAIT_FOR_RR_CONNECTION_MM",
        "MM_WAIT_FOR_RR_CONNECTION_IMSI_DETACH",
        "Unknown",
        "MM_REESTABLISHMENT_INITIATED",
        "MM_WAIT_FOR_RR_ACTIVE",
        "MM_IDLE",
        "MM_WAIT_FOR_ADDITIONAL_OUTGOING_MM_ CONNECTION",
        "MM_WAIT_FOR_RR_CONNECTION_ REESTABLISHMENT",
        "MM_WAIT_FOR_REESTABLISH_DECISION",
        "MM_LOCATION_UPDATING_PENDING",
        "Unknown",
        "MM_RR_CONNECTION_RELEASE_NOT_ALLOWED",
    };
    RecordFixture<ProcessCO> fixture;
    for (unsigned value = 0; value < 256; ++value) {
        fixture.feed(coState(value));
        EXPECT_EQ(fixture.text("MM State"), value < labels.size() ? labels[value] : "Unknown")
            << value;
    }
}

TEST(ProcessCO, LogsTheLineOfProcessCS) {
    RecordFixture<ProcessCO> fixture;
    fixture.feed(coState(19));
    EXPECT_EQ(fixture.lines, (Lines{{4, "ProcessCS"}}));
}

TEST(ProcessCO, AnyOtherCodeIsUnknownAndChangesNothing) {
    RecordFixture<ProcessCO> fixture;
    fixture.feed(Record(0x7130).padTo(16));
    EXPECT_EQ(fixture.lines,
              (Lines{{4, "ProcessCS"}, {3, "Received an unknown log message: 28976"}}));
    EXPECT_TRUE(fixture.keys().empty());
}

TEST(ProcessCO, A15BytePacketOfAnySubscribedCodeChangesNothing) {
    cutAtEveryLength<ProcessCO>(coState(19), 16);
    cutAtEveryLength<ProcessCO>(Record(0x7132).u8(1).padTo(16), 16);
}

TEST(ProcessCO, AnyBytesKeepWithinItsKeys) {
    anyBytesKeepWithin<ProcessCO>({"MM Service State", "MM State"});
}

} // namespace
} // namespace pallax
