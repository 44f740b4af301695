#include "LogGenerator/ZOR_GSM/CellChangeCounters.h"
#include "LogGenerator/ZOR_GSM/CodingScheme.h"
#include "LogGenerator/ZOR_GSM/NonRankedGSMSet.h"
#include "LogGenerator/ZOR_GSM/NonRankedUMTSSet.h"
#include "LogGenerator/ZOR_GSM/UMTSRRMeasurement.h"
#include "tests/doubles/RecordFixture.h"
#include "tests/doubles/RecordProperties.h"

#include <gtest/gtest.h>

namespace pallax {
namespace {

using namespace doubles; // NOLINT: the vocabulary of these tests
using Lines = std::vector<RecordingLog::Line>;

/// Subscribes to no code. If called anyway, it logs its line and changes nothing.
template <class RecordClass>
void expectSilent(std::string_view section, const std::string& line) {
    RecordFixture<RecordClass> fixture;
    EXPECT_EQ(fixture.record().getSectionName(), section);
    EXPECT_TRUE(fixture.record().getLogCodeArray().empty());
    const PropertyList before = fixture.snapshot();
    fixture.feed(Record(0x5137).padTo(100));
    EXPECT_EQ(fixture.lines, (Lines{{4, line}}));
    EXPECT_EQ(fixture.section(), before);
}

TEST(SilentRecords, CodingSchemeLogsTheLineOfTheCounters) {
    expectSilent<CodingScheme>("Coding Scheme", "CellChangeCounters");
}

TEST(SilentRecords, CellChangeCounters) {
    expectSilent<CellChangeCounters>("Cell Change Counters", "CellChangeCounters");
}

TEST(SilentRecords, UMTSRRMeasurement) {
    expectSilent<UMTSRRMeasurement>("UMTS RR Measurement", "UMTSRRMeasurement");
}

TEST(SilentRecords, NonRankedGSMSet) {
    expectSilent<NonRankedGSMSet>("Non-Ranked GSM Set", "NonRankedGSMSet");
}

TEST(SilentRecords, NonRankedUMTSSet) {
    expectSilent<NonRankedUMTSSet>("Non-Ranked UMTS Set", "NonRankedUMTSSet");
}

TEST(SilentRecords, AnyBytesUnderAnyCodeLeaveNoKey) {
    const std::vector<LogCode> codes = {0x5137, 0x417A, 0x4005, 0xFF0001, 0x0000};
    anyBytesKeepWithin<CodingScheme>({}, codes);
    anyBytesKeepWithin<CellChangeCounters>({}, codes);
    anyBytesKeepWithin<UMTSRRMeasurement>({}, codes);
    anyBytesKeepWithin<NonRankedGSMSet>({}, codes);
    anyBytesKeepWithin<NonRankedUMTSSet>({}, codes);
}

} // namespace
} // namespace pallax
