#include "LogGenerator/ZOR_GSM/ProcessPS.h"

#include "tests/doubles/RecordFixture.h"
#include "tests/doubles/RecordProperties.h"

#include <gtest/gtest.h>

namespace pallax {
namespace {

using namespace doubles; // NOLINT: the vocabulary of these tests
using Lines = std::vector<RecordingLog::Line>;

Record psState(unsigned gmmState, unsigned subState, unsigned status) {
    return Record(0x7130).u8(gmmState).u8(subState).u8(status);
}

TEST(ProcessPS, SubscribesToGMMStateAndRegistration) {
    const ProcessPS record;
    const auto codes = record.getLogCodeArray();
    EXPECT_EQ(std::vector<LogCode>(codes.begin(), codes.end()),
              (std::vector<LogCode>{0x7130, 0x7132}));
    EXPECT_EQ(record.getSectionName(), "Process PS");
}

TEST(ProcessPS, ShowsItsGMMStateUnderMMState) {
    expectInOrder(sectionAfter<ProcessPS>(psState(3, 9, 2)),
                  Dictionary{{"MM State", "GMM_REGISTERED"},
                             {"MM Sub State", "GMM_ATTEMPING_TO_UPDATE"},
                             {"Attach Reject Cause", "GMM_GU3_PLMN_NOT_ALLOWED"}});
}

TEST(ProcessPS, ASubStateOf13ShowsUnknown) {
    RecordFixture<ProcessPS> fixture;
    fixture.feed(psState(7, 13, 4));
    expectInOrder(fixture.section(), Dictionary{{"MM State", "Unknown"},
                                                {"MM Sub State", "Unknown"},
                                                {"Attach Reject Cause", "Unknown"}});
}

TEST(ProcessPS, EveryStateSubStateAndRejectCauseHasItsLabel) {
    const std::vector<std::string> states = {
        "GMM_NULL",
        "GMM_DEREGISTERED",
        "GMM_REGISTERED_INITIATED",
        "GMM_REGISTERED",
        "GMM_DEREGISTERED_INITIATED",
        "GMM_ROUTING_AREA_UPDATE_INITIATED",
        "GMM_SERVICE_REQUEST_INITIATED",
    };
    const std::vector<std::string> subStates = {
        "GMM_NORMAL_SERVICE",
        "GMM_LIMITED_SERVICE",
        "GMM_ATTACH_NEEDED",
        "GMM_ATTEMPTING_TO_ATTACH",
        "GMM_NO_IMSI",
        "GMM_NO_CELL_AVAILABLE",
        "GMM_PLMN_SEARCH",
        "GMM_SUSPENDED",
        "GMM_UPDATE_NEEDED",
        "GMM_ATTEMPING_TO_UPDATE",
        "GMM_ATTEMPTING_TO_UPDATE_MM",
        "GMM_IMSI_DETACH_INITIATED",
        "GMM_NULL_SUBSTATE",
    };
    const std::vector<std::string> causes = {
        "GMM_GU1_UPDATED",
        "GMM_GU2_NOT_UPDATED",
        "GMM_GU3_PLMN_NOT_ALLOWED",
        "GMM_GU3_ROUTING_AREA_NOT_ALLOWED",
    };
    RecordFixture<ProcessPS> fixture;
    for (unsigned value = 0; value < 256; ++value) {
        fixture.feed(psState(value, value, value));
        EXPECT_EQ(fixture.text("MM State"), value < states.size() ? states[value] : "Unknown");
        EXPECT_EQ(fixture.text("MM Sub State"),
                  value < subStates.size() ? subStates[value] : "Unknown");
        EXPECT_EQ(fixture.text("Attach Reject Cause"),
                  value < causes.size() ? causes[value] : "Unknown");
    }
}

TEST(ProcessPS, ShowsTheRegistrationState) {
    expectInOrder(sectionAfter<ProcessPS>(Record(0x7132).u8(6).padTo(16)),
                  Dictionary{{"MM Service State", "REG_STATE_OFFLINE"}});
    expectInOrder(sectionAfter<ProcessPS>(Record(0x7132).u8(7).padTo(16)),
                  Dictionary{{"MM Service State", "Unknown"}});
}

TEST(ProcessPS, LogsItsLineAndUnknownCodes) {
    RecordFixture<ProcessPS> fixture;
    fixture.feed(psState(3, 0, 0));
    EXPECT_EQ(fixture.lines, (Lines{{4, "ProcessPS"}}));
    const PropertyList before = fixture.snapshot();
    fixture.feed(Record(0x7131).padTo(16));
    EXPECT_EQ(fixture.lines,
              (Lines{{4, "ProcessPS"}, {3, "Received an unknown log message: 28977"}}));
    EXPECT_EQ(fixture.section(), before);
}

TEST(ProcessPS, A15BytePacketOfAnySubscribedCodeChangesNothing) {
    cutAtEveryLength<ProcessPS>(psState(3, 0, 0), 16);
    cutAtEveryLength<ProcessPS>(Record(0x7132).u8(1).padTo(16), 16);
}

TEST(ProcessPS, AnyBytesKeepWithinItsKeys) {
    anyBytesKeepWithin<ProcessPS>(
        {"MM Service State", "MM State", "MM Sub State", "Attach Reject Cause"});
}

} // namespace
} // namespace pallax
