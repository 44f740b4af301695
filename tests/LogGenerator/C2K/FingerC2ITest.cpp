#include "LogGenerator/C2K/FingerC2I.h"

#include "tests/LogGenerator/C2K/C2KFixture.h"
#include "tests/doubles/Property.h"

#include <gtest/gtest.h>

#include <cmath>

namespace pallax {
namespace {

using namespace doubles; // NOLINT: the vocabulary of these tests
using Lines = std::vector<RecordingLog::Line>;

struct Finger {
    unsigned pn;
    unsigned carrierToInterference;
};

Record fingers(const std::vector<Finger>& fingers) {
    Record record(0x108A);
    record.padTo(22).u8(static_cast<unsigned>(fingers.size()));
    for (const Finger& finger : fingers) {
        record.u16(finger.pn).u32(0xFFFFFFFF).u16(finger.carrierToInterference);
        record.u32(0xFFFFFFFF).u16(0xFFFF);
    }
    return record;
}

TEST(FingerC2I, EachFingerHasItsRatioUnderIndexAndPN) {
    C2KFixture fixture;
    EXPECT_EQ(PropertyList(fixture.writtenBy(fingers({{168, 1024}, {4, 100}, {168, 0}}))),
              PropertyList(Dictionary{{"kFingerC2I", Dictionary{{"_sorted", "_sorted"},
                                                                {"0;168", "+3.01 dB"},
                                                                {"1;4", "-7.09 dB"},
                                                                {"2;168", "-inf dB"}}}}));
    EXPECT_EQ(fixture.lines, Lines());
}

TEST(FingerC2I, AFingerOfPN0xFFFFIsSkippedAndTheOthersKeepTheirIndex) {
    C2KFixture fixture;
    fixture.feed(fingers({{0xFFFF, 512}, {168, 512}, {0xFFFF, 512}, {0xFFFE, 256}}));
    EXPECT_EQ(fixture.value("kFingerC2I"),
              PropertyList(Dictionary{
                  {"_sorted", "_sorted"}, {"1;168", "+0.00 dB"}, {"3;65534", "-3.01 dB"}}));
    EXPECT_EQ(shownList(fixture.value("kFingerC2I")), "(168: +0.00 dB, 65534: -3.01 dB)");
}

TEST(FingerC2I, TwoFingersBothOfPN0xFFFFReadNone) {
    C2KFixture fixture;
    fixture.feed(fingers({{168, 512}}));
    fixture.feed(fingers({{0xFFFF, 512}, {0xFFFF, 512}}));
    EXPECT_EQ(fixture.text("kFingerC2I"), "(none)");
}

TEST(FingerC2I, NoFingersReadNone) {
    C2KFixture fixture;
    fixture.feed(fingers({}));
    EXPECT_EQ(fixture.text("kFingerC2I"), "(none)");
    EXPECT_EQ(fixture.lines, Lines());
}

TEST(FingerC2I, AValueThatBecomesAListTurnsItsRowIntoABranchAndBack) {
    C2KFixture fixture;
    const auto row = [&fixture] {
        PathDictionary paths;
        (void)PallaxModelNode::makeTreeFromObject(
            fixture.generator.generateLogUsingState(fixture.state), paths);
        const NodeRef node = paths.at("/kFingerC2I");
        return node->childNodes() != nullptr
                   ? "branch " + std::to_string(node->childNodes()->size())
                   : "leaf " + node->value()->string().value_or("(no text)");
    };
    EXPECT_EQ(row(), "leaf ");
    fixture.feed(fingers({{168, 512}, {4, 512}}));
    EXPECT_EQ(row(), "branch 2");
    fixture.feed(fingers({}));
    EXPECT_EQ(row(), "leaf (none)");
    fixture.feed(fingers({{168, 512}}));
    EXPECT_EQ(row(), "branch 1");
}

TEST(FingerC2I, APacketBelow23BytesIsAnError) {
    C2KFixture fixture;
    EXPECT_TRUE(fixture.writtenBy(Record(0x108A).padTo(22)).empty());
    EXPECT_EQ(fixture.lines,
              (Lines{{3, "Log code 0x108a is 22 bytes long but must be at least 23 bytes."}}));
}

TEST(FingerC2I, AnyLengthButThatOfItsFingersIsAnError) {
    C2KFixture fixture;
    EXPECT_TRUE(fixture.writtenBy(Record(0x108A).padTo(50).at(22, 2)).empty());
    EXPECT_EQ(fixture.lines, (Lines{{3, "Log code 0x108a has bad length of 50 bytes, but has 2 "
                                        "substructs (size=23)."}}));
    EXPECT_EQ(fixture.writtenBy(Record(0x108A).padTo(51).at(22, 2)).size(), 1U);
    EXPECT_TRUE(fixture.writtenBy(Record(0x108A).padTo(52).at(22, 2)).empty());
    EXPECT_EQ(fixture.lines, (Lines{{3, "Log code 0x108a has bad length of 52 bytes, but has 2 "
                                        "substructs (size=23)."}}));
    EXPECT_EQ(fixture.writtenBy(Record(0x108A).padTo(23 + 255 * 14).at(22, 255)).size(), 1U);
    cutPacketAtEveryLength(fingers({{168, 512}, {4, 512}}).u8(0), 51);
}

TEST(FingerC2I, TheRatioIsComputedInDoublePrecision) {
    C2KFixture fixture;
    fixture.feed(fingers({{0, 100}}));
    EXPECT_EQ(fixture.value("kFingerC2I").dictionary()->find("0;0")->displayNumber()->real(),
              10.0 * std::log10(100 / 512.0));
}

TEST(FingerC2I, AnyFingersWriteOnlyItsRow) {
    EXPECT_TRUE(doubles::holds([] {
        C2KFixture fixture;
        std::vector<Finger> drawn;
        for (int count = any::between(0, 6); count > 0; --count) {
            drawn.push_back({any::below(0x10000), any::below(0x10000)});
        }
        const Dictionary rows = fixture.writtenBy(fingers(drawn));
        RC_ASSERT(rows.size() == 1U);
        RC_ASSERT(rows.contains("kFingerC2I"));
        (void)fixture.value("kFingerC2I").description();
    }));
}

TEST(FingerC2I, AnyBytesWriteOnlyItsRow) {
    anyPacketWritesOnly(0x108A, {"kFingerC2I"}, {23, 37, 51, 65, 79});
}

} // namespace
} // namespace pallax
