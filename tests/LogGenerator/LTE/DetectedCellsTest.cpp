#include "LogGenerator/LTE/DetectedCells.h"

#include "tests/LogGenerator/LTE/ConnectedModeRecords.h"
#include "tests/doubles/RecordFixture.h"
#include "tests/doubles/RecordProperties.h"

#include <gtest/gtest.h>

namespace pallax {
namespace {

using namespace doubles; // NOLINT: the vocabulary of these tests
using Lines = std::vector<RecordingLog::Line>;

TEST(DetectedCells, SubscribesToTheConnectedModeMeasurement) {
    const RecordFixture<DetectedCells> fixture;
    EXPECT_EQ(fixture.subscriptions(), (std::vector<LogCode>{0xB179}));
    EXPECT_EQ(DetectedCells().getSectionName(), "Detected Cells");
    EXPECT_EQ(DetectedCells().sectionKind(), SectionKind::List);
}

TEST(DetectedCells, TheEntriesStandBehindTheMeasuredNeighbours) {
    RecordFixture<DetectedCells> fixture;
    fixture.feed(twoMeasuredOneDetected());
    EXPECT_EQ(fixture.lines, (Lines{{4, "Detected Cells"}}));
    EXPECT_EQ(fixture.list(), (Array{Dictionary{{"Physical Cell ID", "301"}}}));
    const Dictionary& cell = *fixture.list()[0].dictionary();
    EXPECT_EQ(cell.find("Physical Cell ID")->displayNumber()->integer(), 301);
}

TEST(DetectedCells, ShowsEveryEntryInPacketOrder) {
    RecordFixture<DetectedCells> fixture;
    fixture.feed(connectedModeHead(0, 3).u16(503).u16(0).u16(0xFFFF));
    EXPECT_EQ(fixture.list(),
              (Array{Dictionary{{"Physical Cell ID", "503"}}, Dictionary{{"Physical Cell ID", "0"}},
                     Dictionary{{"Physical Cell ID", "65535"}}}));
}

TEST(DetectedCells, ACountOf0EmptiesTheListSilently) {
    RecordFixture<DetectedCells> fixture;
    fixture.list() = Array{"what was shown before"};
    fixture.feed(twoMeasuredOneDetected().at(28, 0));
    EXPECT_EQ(fixture.lines, (Lines{{4, "Detected Cells"}}));
    EXPECT_TRUE(fixture.list().empty());
}

TEST(DetectedCells, TheListStopsAtTheFirstEntryThatIsNotWhole) {
    const ByteBuffer bytes = connectedModeHead(1, 255).padTo(41).bytes();
    for (std::size_t length = 29; length <= bytes.size(); ++length) {
        RecordFixture<DetectedCells> fixture;
        fixture.list() = Array{"what was shown before"};
        fixture.feed(
            ByteBuffer(bytes.begin(), bytes.begin() + static_cast<std::ptrdiff_t>(length)));
        EXPECT_EQ(fixture.list().size(), length < 35 ? 0 : (length - 35) / 2)
            << "cut at " << length;
    }
}

TEST(DetectedCells, APacketOf28BytesLeavesTheListAsItWas) {
    cutAtEveryLength<DetectedCells>(twoMeasuredOneDetected(), 29);
    RecordFixture<DetectedCells> fixture;
    fixture.feed(twoMeasuredOneDetected());
    fixture.feed(Record(0xB179).padTo(28));
    EXPECT_EQ(fixture.lines, (Lines{{4, "Detected Cells"}}));
    EXPECT_EQ(fixture.list().size(), 1U);
}

TEST(DetectedCells, AnyOtherCodeIsUnknownAndChangesNothing) {
    RecordFixture<DetectedCells> fixture;
    fixture.feed(twoMeasuredOneDetected());
    fixture.feed(Record(0xB186).padTo(100));
    EXPECT_EQ(fixture.lines,
              (Lines{{4, "Detected Cells"}, {3, "Received an unknown log message: 45446"}}));
    EXPECT_EQ(fixture.list().size(), 1U);
}

TEST(DetectedCells, AnyBytesKeepItsEntriesWithinItsKeys) {
    anyBytesKeepWithin<DetectedCells>({"Physical Cell ID"});
}

} // namespace
} // namespace pallax
