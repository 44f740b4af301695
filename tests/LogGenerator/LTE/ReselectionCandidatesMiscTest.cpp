#include "LogGenerator/LTE/ReselectionCandidatesMisc.h"

#include "tests/doubles/RecordFixture.h"
#include "tests/doubles/RecordProperties.h"

#include <gtest/gtest.h>

namespace pallax {
namespace {

using namespace doubles; // NOLINT: the vocabulary of these tests
using Lines = std::vector<RecordingLog::Line>;

Record noCandidates() {
    return Record(0xB186).u8(2).u8(9).u16(1850).u16(274).u16(0);
}

TEST(ReselectionCandidatesMisc, SubscribesToTheReselectionRecord) {
    const RecordFixture<ReselectionCandidatesMisc> fixture;
    EXPECT_EQ(fixture.subscriptions(), (std::vector<LogCode>{0xB186}));
    EXPECT_EQ(ReselectionCandidatesMisc().getSectionName(), "Reselection Candidates");
}

TEST(ReselectionCandidatesMisc, ShowsTheServingCellInTheOrderOfTheKeys) {
    RecordFixture<ReselectionCandidatesMisc> fixture;
    fixture.feed(noCandidates());
    EXPECT_EQ(fixture.lines, (Lines{{4, "Reselection Candidates"}}));
    expectInOrder(
        fixture.section(),
        Dictionary{{"Version", "2"}, {"Serving EARFCN", "1850"}, {"Serving Cell ID", "274"}});
    EXPECT_EQ(fixture.keys().find("Serving Cell ID")->displayNumber()->integer(), 274);
    const ByteBuffer ones(8, 0xFF);
    expectInOrder(
        sectionAfter<ReselectionCandidatesMisc>(Record(0xB186).append(ones)),
        Dictionary{{"Version", "255"}, {"Serving EARFCN", "65535"}, {"Serving Cell ID", "65535"}});
}

TEST(ReselectionCandidatesMisc, APacketOf20BytesChangesNothing) {
    cutAtEveryLength<ReselectionCandidatesMisc>(noCandidates(), 21);
    RecordFixture<ReselectionCandidatesMisc> fixture;
    fixture.feed(Record(0xB186).padTo(20));
    EXPECT_EQ(fixture.lines, (Lines{{4, "Reselection Candidates"}}))
        << "a short packet is dropped silently";
}

TEST(ReselectionCandidatesMisc, AnyOtherCodeIsUnknownAndChangesNothing) {
    RecordFixture<ReselectionCandidatesMisc> fixture;
    fixture.feed(Record(0xB187).padTo(100));
    EXPECT_EQ(fixture.lines, (Lines{{4, "Reselection Candidates"},
                                    {3, "Received an unknown log message: 45447"}}));
    EXPECT_TRUE(fixture.keys().empty());
}

TEST(ReselectionCandidatesMisc, AnyBytesKeepWithinItsKeys) {
    anyBytesKeepWithin<ReselectionCandidatesMisc>({"Version", "Serving EARFCN", "Serving Cell ID"});
}

} // namespace
} // namespace pallax
