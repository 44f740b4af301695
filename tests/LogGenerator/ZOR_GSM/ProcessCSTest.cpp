#include "LogGenerator/ZOR_GSM/ProcessCS.h"

#include "tests/doubles/RecordFixture.h"
#include "tests/doubles/RecordProperties.h"

#include <gtest/gtest.h>

namespace pallax {
namespace {

using namespace doubles; // NOLINT: the vocabulary of these tests
using Lines = std::vector<RecordingLog::Line>;

Record csState(unsigned mmState, unsigned subState, unsigned status) {
    return Record(0x7131).u8(mmState).u8(subState).u8(status);
}

TEST(ProcessCS, SubscribesToMMStateAndRegistration) {
    const ProcessCS record;
    const auto codes = record.getLogCodeArray();
    EXPECT_EQ(std::vector<LogCode>(codes.begin(), codes.end()),
              (std::vector<LogCode>{0x7131, 0x7132}));
    EXPECT_EQ(record.getSectionName(), "Process CS");
}

TEST(ProcessCS, Bytes20And8And3GiveTheAdditionalConnectionNormalServiceAndAreaNotAllowed) {
    expectInOrder(sectionAfter<ProcessCS>(csState(20, 8, 3)),
                  Dictionary{{"MM State", "MM_WAIT_FOR_ADDITIONAL_OUTGOING_MM_ CONNECTION"},
                             {"MM Sub State", "MM_NORMAL_SERVICE"},
                             {"LU Reject Cause", "LOCATION_AREA_NOT_ALLOWED"}});
}

TEST(ProcessCS, AnInTableGapAndAValueOutOfRangeShowUnknown) {
    RecordFixture<ProcessCS> fixture;
    for (const unsigned value : {1U, 26U, 255U}) {
        fixture.feed(csState(value, 9, 4));
        expectInOrder(fixture.section(), Dictionary{{"MM State", "Unknown"},
                                                    {"MM Sub State", "Unknown"},
                                                    {"LU Reject Cause", "Unknown"}});
    }
}

TEST(ProcessCS, EverySubStateAndRejectCauseHasItsLabel) {
    const std::vector<std::string> subStates = {
        "MM_NULL_SUBSTATE",        "MM_NO_IMSI",
        "MM_PLMN_SEARCH",          "MM_LIMITED_SERVICE",
        "MM_ATTEMPTING_TO_UPDATE", "MM_LOCATION_UPDATE_NEEDED",
        "MM_NO_CELL_AVAILABLE",    "MM_PLMN_SEARCH_NORMAL_SERVICE",
        "MM_NORMAL_SERVICE",
    };
    const std::vector<std::string> causes = {"UPDATED", "NOT_UPDATED", "ROAMING_NOT_ALLOWED",
                                             "LOCATION_AREA_NOT_ALLOWED"};
    RecordFixture<ProcessCS> fixture;
    for (unsigned value = 0; value < 256; ++value) {
        fixture.feed(csState(0, value, value));
        EXPECT_EQ(fixture.text("MM Sub State"),
                  value < subStates.size() ? subStates[value] : "Unknown");
        EXPECT_EQ(fixture.text("LU Reject Cause"),
                  value < causes.size() ? causes[value] : "Unknown");
    }
}

TEST(ProcessCS, ShowsEveryRegistrationState) {
    const std::vector<std::string> labels = {
        "REG_STATE_INACTIVE",      "REG_STATE_IDLE",          "REG_STATE_REGISTERING",
        "REG_STATE_DEREGISTERING", "REG_STATE_MANUAL_SEARCH", "REG_STATE_AUTOMATIC_SEARCH",
        "REG_STATE_OFFLINE",
    };
    RecordFixture<ProcessCS> fixture;
    for (unsigned value = 0; value < 256; ++value) {
        fixture.feed(Record(0x7132).u8(value).padTo(16));
        EXPECT_EQ(fixture.text("MM Service State"),
                  value < labels.size() ? labels[value] : "Unknown");
    }
}

TEST(ProcessCS, AKeyKeepsItsLastValueUntilItIsOverwritten) {
    RecordFixture<ProcessCS> fixture;
    fixture.feed(csState(19, 8, 0));
    fixture.feed(Record(0x7132).u8(1).padTo(16));
    expectInOrder(fixture.section(), Dictionary{{"MM State", "MM_IDLE"},
                                                {"MM Sub State", "MM_NORMAL_SERVICE"},
                                                {"LU Reject Cause", "UPDATED"},
                                                {"MM Service State", "REG_STATE_IDLE"}});
}

TEST(ProcessCS, LogsItsLineOnEveryCall) {
    RecordFixture<ProcessCS> fixture;
    fixture.feed(csState(19, 8, 0));
    EXPECT_EQ(fixture.lines, (Lines{{4, "ProcessCS"}}));
    fixture.feed(Record(0x7131).bytes());
    EXPECT_EQ(fixture.lines, (Lines{{4, "ProcessCS"}})) << "a short packet is dropped silently";
}

TEST(ProcessCS, AnyOtherCodeIsUnknownAndChangesNothing) {
    RecordFixture<ProcessCS> fixture;
    fixture.feed(Record(0x4116).padTo(16));
    EXPECT_EQ(fixture.lines,
              (Lines{{4, "ProcessCS"}, {3, "Received an unknown log message: 16662"}}));
    EXPECT_TRUE(fixture.keys().empty());
}

TEST(ProcessCS, A15BytePacketOfAnySubscribedCodeChangesNothing) {
    cutAtEveryLength<ProcessCS>(csState(19, 8, 0), 16);
    cutAtEveryLength<ProcessCS>(Record(0x7132).u8(1).padTo(16), 16);
}

TEST(ProcessCS, AnyBytesKeepWithinItsKeys) {
    anyBytesKeepWithin<ProcessCS>(
        {"MM Service State", "MM State", "MM Sub State", "LU Reject Cause"});
}

} // namespace
} // namespace pallax
