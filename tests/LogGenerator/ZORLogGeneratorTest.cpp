#include "LogGenerator/ZORLogGenerator.h"

#include "tests/doubles/GeneratorFixture.h"
#include "tests/doubles/InOrder.h"
#include "tests/doubles/RecordingLog.h"

#include <gtest/gtest.h>

namespace pallax {
namespace {

using doubles::GeneratorFixture;
using doubles::RecordingLog;
using doubles::sameInOrder;
using Lines = std::vector<RecordingLog::Line>;

/// A generator that only captures.
class Capturing final : public ZORLogGenerator {
public:
    using ZORLogGenerator::ZORLogGenerator;
    void updateState(Dictionary& /*state*/, Bytes data) override { capture(data); }
    PropertyList generateLogUsingState(Dictionary& state) override {
        handOverCapture(state);
        return {};
    }
};

class ZORLogGeneratorTest : public testing::Test {
protected:
    static Dictionary stateWithHistory(Array entries) {
        return Dictionary{{"History", std::move(entries)}};
    }
    static PropertyList entryWith(ByteBuffer bytes) {
        return Dictionary{{"DisplayState", PropertyList::data(std::move(bytes))}};
    }
    ByteBuffer dlfOf(const Dictionary& state) {
        return _generator.generateDlfFromState(state).value_or(ByteBuffer());
    }
    static std::string textAt(const ByteBuffer& bytes, std::ptrdiff_t offset, std::ptrdiff_t size) {
        return {bytes.begin() + offset, bytes.begin() + offset + size};
    }

    GeneratorFixture _fixture;
    Capturing _generator{_fixture.environment()};
};

TEST_F(ZORLogGeneratorTest, AnEmptyHistoryGivesADlfOfExactly161Bytes) {
    const ByteBuffer dlf = dlfOf({});
    EXPECT_EQ(dlf.size(), 161U);
    const Array contents = *_generator.getSaveContentsFromState({}).array();
    ASSERT_EQ(contents.size(), 1U);
    const Dictionary expected{{"Description", "DLF binary (161 bytes)"},
                              {"DLF", PropertyList::data(dlf)}};
    EXPECT_TRUE(sameInOrder(*contents[0].dictionary(), expected));
}

TEST_F(ZORLogGeneratorTest, TheHeaderNamesBuildTimeAndZone) {
    _fixture.clock.setZone({std::chrono::hours(2), true});
    const ByteBuffer dlf = dlfOf({});
    EXPECT_EQ(textAt(dlf, 12, 4), std::string("\x01\x00\x01\x00", 4));
    EXPECT_EQ(textAt(dlf, 16, 7), std::string("Pallax\0", 7));
    EXPECT_EQ(textAt(dlf, 23, 16), std::string("EXECUTABLE_NAME\0", 16));
    EXPECT_EQ(textAt(dlf, 63, 18), std::string("Sep 13 2024 00:18\0", 18));
    EXPECT_EQ(textAt(dlf, 81, 4), std::string("\x00\xF1\x53\x65", 4)); // 1700000000
    EXPECT_EQ(textAt(dlf, 85, 4), std::string("\x78\x00\x01\x00", 4)); // 120 minutes, summer
}

TEST_F(ZORLogGeneratorTest, TheFractionOfTheSecondIsDiscarded) {
    _fixture.clock.advance(std::chrono::milliseconds(999));
    EXPECT_EQ(textAt(dlfOf({}), 81, 4), std::string("\x00\xF1\x53\x65", 4)); // 1700000000
}

TEST_F(ZORLogGeneratorTest, AZoneIsRoundedTowardZeroMinutes) {
    _fixture.clock.setZone({std::chrono::seconds(-12599), false});
    EXPECT_EQ(textAt(dlfOf({}), 85, 4), std::string("\x2F\xFF\x00\x00", 4)); // -209
}

TEST_F(ZORLogGeneratorTest, WithoutABundleVersionTheApplicationTextIsNone) {
    _fixture.bundle.bundleVersion = std::nullopt;
    EXPECT_EQ(textAt(dlfOf({}), 16, 7), std::string("(none)\0", 7));
}

TEST_F(ZORLogGeneratorTest, ADisplayStateOf1ByteAddsNothingOneOf10BytesAdds9) {
    EXPECT_EQ(dlfOf(stateWithHistory({entryWith({0x01})})).size(), 161U);
    EXPECT_EQ(dlfOf(stateWithHistory({entryWith({})})).size(), 161U);
    EXPECT_EQ(dlfOf(stateWithHistory({entryWith(ByteBuffer(10))})).size(), 170U);
}

TEST_F(ZORLogGeneratorTest, EntriesAreAppendedOldestFirstWithoutEachFirstByte) {
    const ByteBuffer dlf = dlfOf(stateWithHistory({entryWith({1, 2, 3}), entryWith({4, 5})}));
    EXPECT_EQ(textAt(dlf, 161, 3), "\x02\x03\x05");
}

TEST_F(ZORLogGeneratorTest, AnEntryWithoutDisplayStateIsSkipped) {
    EXPECT_EQ(dlfOf(stateWithHistory({Dictionary(), entryWith({1, 2})})).size(), 162U);
}

TEST_F(ZORLogGeneratorTest, ADisplayStateThatIsNoDataLosesTheDlfButNotTheHistory) {
    const Dictionary state = stateWithHistory(
        {entryWith({1, 2}), Dictionary{{"DisplayState", "text"}}, entryWith({3, 4})});
    RecordingLog log;
    EXPECT_EQ(_generator.generateDlfFromState(state), std::nullopt);
    EXPECT_EQ(
        log.lines(),
        (Lines{{16, "Got wrong class writing history to DLF; aborting writing the DLF file"}}));
    EXPECT_EQ(_generator.getSaveContentsFromState(state).array()->size(), 3U);
}

TEST_F(ZORLogGeneratorTest, AHeaderThatDoesNotFitIsLoggedWithTheRawPriority16) {
    RecordingLog log;
    EXPECT_EQ(dlfHeader(160, _fixture.environment()), std::nullopt);
    EXPECT_EQ(log.lines(), (Lines{{16, "Could not write DLF header (result=3)"}}));
}

TEST_F(ZORLogGeneratorTest, SaveContentsAreTheHistoryEntriesAndTheDlf) {
    const Dictionary state = stateWithHistory({entryWith({1, 2}), entryWith({3})});
    const Array contents = *_generator.getSaveContentsFromState(state).array();
    ASSERT_EQ(contents.size(), 3U);
    EXPECT_EQ(contents[0], entryWith({1, 2}));
    EXPECT_EQ(contents[1], entryWith({3}));
    EXPECT_EQ(*contents[2].dictionary()->find("Description"), "DLF binary (162 bytes)");
    EXPECT_EQ(state.find("History")->array()->size(), 2U) << "the history itself is unchanged";
}

TEST_F(ZORLogGeneratorTest, TheCaptureIsHandedOverAndStartsEmpty) {
    Dictionary state;
    _generator.updateState(state, ByteBuffer{1, 2});
    _generator.updateState(state, ByteBuffer{3});
    (void)_generator.generateLogUsingState(state);
    EXPECT_EQ(*state.find("DisplayState"), PropertyList::data({1, 2, 3}));
    (void)_generator.generateLogUsingState(state);
    EXPECT_EQ(*state.find("DisplayState"), PropertyList::data({}));
}

} // namespace
} // namespace pallax
