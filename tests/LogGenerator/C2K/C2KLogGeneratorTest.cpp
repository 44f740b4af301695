#include "LogGenerator/C2K/C2KLogGenerator.h"

#include "LogGenerator/Technologies/Technologies.h"
#include "platform/TelephonyConstants.h"
#include "tests/doubles/GeneratorFixture.h"
#include "tests/doubles/RecordFixture.h"

#include <gtest/gtest.h>

#include <algorithm>

namespace pallax {
namespace {

using doubles::GeneratorFixture;
using doubles::Record;
using doubles::RecordingLog;
using Lines = std::vector<RecordingLog::Line>;

/// An EV-DO status packet on that channel (below 256), in device state Inactive.
Record statusOn(unsigned channel) {
    return Record(0x1183).u8(channel).padTo(50);
}

const PropertyList kTemplate =
    Dictionary{{"Serving", Dictionary{{"Channel", "kChannel"}, {"_sorted", "_sorted"}}},
               {"Channel", "kChannel"}};

PropertyList displayOn(const char* channel) {
    return Dictionary{{"Serving", Dictionary{{"Channel", channel}, {"_sorted", "_sorted"}}},
                      {"Channel", channel}};
}

class C2KLogGeneratorTest : public testing::Test {
protected:
    C2KLogGeneratorTest() { _fixture.resources.add("C2KTemplate", kTemplate); }

    /// Feeds a message from the log channel.
    void feed(const ByteBuffer& message) {
        RecordingLog log;
        _generator.updateState(_state, message);
        _lines = log.take();
    }
    PropertyList display() { return _generator.display(_state); }
    /// The bytes captured since the previous call.
    ByteBuffer captured() {
        (void)_generator.generateLogUsingState(_state);
        return *_state.find("DisplayState")->data();
    }

    GeneratorFixture _fixture;
    C2KLogGenerator _generator{_fixture.environment()};
    Dictionary _state;
    Lines _lines;
};

TEST_F(C2KLogGeneratorTest, TheStartCommandListsExactlyTheEightCodesInTheirOrder) {
    Array codes;
    for (const int code : {4234, 4483, 4498, 4790, 4508, 4509, 4734, 4943}) {
        codes.push_back(PropertyList::integer(code));
    }
    doubles::expectInOrder(_generator.getStartCommand(),
                           Dictionary{{"SetState", "Streaming"}, {"SetZorellLogCodes", codes}});
}

TEST_F(C2KLogGeneratorTest, TheFirstPacketMakesTheDisplayAndSetsBothPlacesOfAName) {
    feed(statusOn(25).prefixed());
    EXPECT_EQ(display(), displayOn("25"));
    EXPECT_EQ(*_state.find("Template"), kTemplate) << "it is unchanged";
    EXPECT_EQ(*_state.find("ExtraInfo"), PropertyList(Dictionary()));
    EXPECT_EQ(_state.find("Lookup")->dictionary()->find("kChannel")->array()->size(), 2U);
    EXPECT_EQ(_lines, (Lines{{4, "Processing the template"},
                             {4, "Processing the template"},
                             {6, "Log Header 0x81"}}));
}

TEST_F(C2KLogGeneratorTest, TheDisplayIsMadeOnceAndReturnedByTheCallThatMakesIt) {
    const PropertyList made = _generator.getDisplayFromState(_state);
    EXPECT_EQ(made, displayOn(""));
    EXPECT_EQ(_generator.getDisplayFromState(_state).dictionary(), made.dictionary());
    EXPECT_EQ(_generator.generateLogUsingState(_state).dictionary(), made.dictionary());
}

TEST_F(C2KLogGeneratorTest, ATemplateKeptInTheStateIsNotLoadedAgain) {
    _state.set("Template", Dictionary{{"Only", "kChannel"}});
    feed(statusOn(25).bytes());
    EXPECT_EQ(display(), PropertyList(Dictionary{{"Only", "25"}}));
}

TEST_F(C2KLogGeneratorTest, EvenAPacketThatIsIgnoredMakesTheDisplay) {
    _state.set("ExtraInfo", Dictionary{{"of", "another technology"}});
    feed({});
    ASSERT_TRUE(_state.contains("Display"));
    EXPECT_EQ(display(), displayOn(""));
    EXPECT_EQ(_lines, (Lines{{4, "Processing the template"}, {4, "Processing the template"}}));
    EXPECT_EQ(*_state.find("ExtraInfo"), PropertyList(Dictionary()));
}

TEST_F(C2KLogGeneratorTest, OnlyOnePrefixIsStripped) {
    (void)_generator.getDisplayFromState(_state);
    ByteBuffer message = statusOn(25).prefixed();
    message.insert(message.begin(), {0x81, 0x00});
    feed(message);
    EXPECT_EQ(_lines, (Lines{{6, "Log Header 0x81"}, {3, "Invalid log type: 81. Dropping."}}));
    EXPECT_EQ(display(), displayOn(""));
}

TEST_F(C2KLogGeneratorTest, APacketOf12BytesIsIgnoredSilently) {
    (void)_generator.getDisplayFromState(_state);
    ByteBuffer message = statusOn(25).bytes();
    message.resize(12);
    feed(message);
    EXPECT_EQ(_lines, Lines());
    feed({});
    EXPECT_EQ(_lines, Lines()) << "a null message";
    EXPECT_EQ(captured(), ByteBuffer());
    EXPECT_EQ(display(), displayOn(""));
}

TEST_F(C2KLogGeneratorTest, TheLengthIsThatOfTheMessageBeforeThePrefixIsStripped) {
    (void)_generator.getDisplayFromState(_state);
    ByteBuffer message = statusOn(25).prefixed();
    message.resize(13);
    feed(message);
    EXPECT_EQ(_lines, (Lines{{6, "Log Header 0x81"},
                             {3, "Log code 0x1183 is 11 bytes long but should be 50 bytes."}}));
    message.erase(message.begin(), message.begin() + 2);
    EXPECT_EQ(captured(), message) << "the eleven bytes after the prefix";
    message = statusOn(25).prefixed();
    message.resize(12);
    feed(message);
    EXPECT_EQ(_lines, Lines());
    EXPECT_EQ(captured(), ByteBuffer());
}

TEST_F(C2KLogGeneratorTest, LogType2LogsTheInvalidTypeAndThePacketIsStillParsed) {
    (void)_generator.getDisplayFromState(_state);
    const Record packet = statusOn(25).at(0, 2);
    feed(packet.prefixed());
    EXPECT_EQ(_lines, (Lines{{6, "Log Header 0x81"}, {3, "Invalid log type: 2. Dropping."}}));
    EXPECT_EQ(display(), displayOn("25"));
    EXPECT_EQ(captured(), packet.bytes());
    feed(statusOn(26).at(0, 0).prefixed());
    EXPECT_EQ(_lines.back(), (RecordingLog::Line{3, "Invalid log type: 0. Dropping."}));
    EXPECT_EQ(display(), displayOn("26"));
}

TEST_F(C2KLogGeneratorTest, APacketOf13BytesWithLogType2ReachesItsParser) {
    (void)_generator.getDisplayFromState(_state);
    feed(Record(0x1183).at(0, 2).bytes());
    EXPECT_EQ(_lines, (Lines{{6, "Log Header 0x2"},
                             {4, "Returning buffer without modifications <02000083 11000000 "
                                 "00000000 00>"},
                             {3, "Invalid log type: 2. Dropping."},
                             {3, "Log code 0x1183 is 13 bytes long but should be 50 bytes."}}));
}

TEST_F(C2KLogGeneratorTest, LogType0xFFIsLoggedAndItsCodeMatchesNoParser) {
    (void)_generator.getDisplayFromState(_state);
    feed(statusOn(25).at(0, 0xFF).prefixed());
    EXPECT_EQ(_lines, (Lines{{6, "Log Header 0x81"}, {3, "Invalid log type: ff. Dropping."}}));
    EXPECT_EQ(display(), displayOn(""));
    EXPECT_EQ(captured(), ByteBuffer());
}

TEST_F(C2KLogGeneratorTest, AnyOtherCodeIsNeitherParsedNorCapturedNorLogged) {
    (void)_generator.getDisplayFromState(_state);
    for (const LogCode code : {0x1182U, 0x1184U, 0x8311U, 0U, 0xFFFFU}) {
        feed(Record(code).padTo(50).prefixed());
        EXPECT_EQ(_lines, (Lines{{6, "Log Header 0x81"}}));
    }
    EXPECT_EQ(captured(), ByteBuffer());
}

TEST_F(C2KLogGeneratorTest, KnownPacketsAreCapturedBehindTheirPrefixInOrderAcceptedOrNot) {
    ByteBuffer expected;
    for (const LogCode code :
         {0x1183U, 0x108AU, 0x119CU, 0x1192U, 0x12B6U, 0x127EU, 0x119DU, 0x134FU}) {
        const Record rejected = Record(code).u8(code & 0xFFU);
        feed(rejected.prefixed());
        expected.insert(expected.end(), rejected.bytes().begin(), rejected.bytes().end());
    }
    const Record accepted = statusOn(25);
    feed(accepted.bytes());
    expected.insert(expected.end(), accepted.bytes().begin(), accepted.bytes().end());
    EXPECT_EQ(captured(), expected);
    EXPECT_EQ(captured(), ByteBuffer()) << "a tick moves it to the state";
}

TEST_F(C2KLogGeneratorTest, EveryCodeHasItsOwnParser) {
    const auto complaint = [this](LogCode code) {
        feed(Record(code).prefixed());
        return _lines.back().text.substr(0, 15);
    };
    EXPECT_EQ(complaint(0x108A), "Log code 0x108a");
    EXPECT_EQ(complaint(0x1183), "Log code 0x1183");
    EXPECT_EQ(complaint(0x1192), "Log code 0x1192");
    EXPECT_EQ(complaint(0x12B6), "Log code 0x12b6");
    EXPECT_EQ(complaint(0x119C), "Log code 0x119c");
    EXPECT_EQ(complaint(0x119D), "Log code 0x119d");
    EXPECT_EQ(complaint(0x127E), "Log code 0x127e");
    EXPECT_EQ(complaint(0x134F), "Log code 0x134f");
}

TEST_F(C2KLogGeneratorTest, ATickHandsTheCaptureOverAndKeepsTheHistory) {
    feed(statusOn(25).bytes());
    EXPECT_EQ(_generator.generateLogUsingState(_state), displayOn("25"));
    EXPECT_EQ(*_state.find("DisplayState"), PropertyList::data(statusOn(25).bytes()));
    feed(statusOn(26).bytes());
    (void)_generator.generateLogUsingState(_state);
    const Array history = *_state.find("History")->array();
    ASSERT_EQ(history.size(), 2U);
    EXPECT_EQ(*history[0].dictionary()->find("DisplayState"),
              PropertyList::data(statusOn(25).bytes()));
    EXPECT_EQ(*history[1].dictionary()->find("DisplayState"),
              PropertyList::data(statusOn(26).bytes()));
    EXPECT_EQ(*history[1].dictionary()->find("ExtraInfo"), PropertyList(Dictionary()));
    const PropertyList saved = _generator.getSaveContentsFromState(_state);
    ASSERT_EQ(saved.array()->size(), 3U);
    EXPECT_EQ(*saved.array()->back().dictionary()->find("Description"),
              PropertyList("DLF binary (259 bytes)"))
        << "the version report and both captures without their first byte";
}

TEST_F(C2KLogGeneratorTest, AHistoryEntryKeepsTheExtraInformationOfItsTick) {
    feed(Record(0x1192).u32(1).padTo(241).bytes());
    (void)_generator.generateLogUsingState(_state);
    feed(Record(0x1192).u32(2).padTo(241).bytes());
    (void)_generator.generateLogUsingState(_state);
    const Array history = *_state.find("History")->array();
    EXPECT_EQ(*history[0].dictionary()->find("ExtraInfo"),
              PropertyList(Dictionary{{"FLDataSeqNum1", PropertyList::integer(1)},
                                      {"FLDataSent1", PropertyList::integer(0)}}));
    EXPECT_EQ(*history[1].dictionary()->find("ExtraInfo")->dictionary()->find("FLDataSeqNum2"),
              PropertyList::integer(1));
}

TEST_F(C2KLogGeneratorTest, ValuesAreNeverCleared) {
    feed(statusOn(25).bytes());
    feed(Record(0x1183).bytes()); // rejected
    feed(Record(0x119D).padTo(17).bytes());
    EXPECT_EQ(display(), displayOn("25"));
}

TEST_F(C2KLogGeneratorTest, ANewGeneratorGoesOnWithTheDisplayOfTheFormerOne) {
    feed(statusOn(25).bytes());
    C2KLogGenerator restarted(_fixture.environment());
    restarted.updateState(_state, statusOn(26).bytes());
    EXPECT_EQ(restarted.generateLogUsingState(_state), displayOn("26"));
}

TEST_F(C2KLogGeneratorTest, ADisplayWithoutLookupTableKeepsItsValues) {
    _state.set("Display", Dictionary{{"Channel", "of another technology"}});
    feed(statusOn(25).bytes());
    EXPECT_EQ(display(), PropertyList(Dictionary{{"Channel", "of another technology"}}));
    EXPECT_EQ(captured(), statusOn(25).bytes());
}

/// A template that cannot be loaded.
class C2KWithoutTemplate : public testing::Test {
protected:
    GeneratorFixture _fixture;
    C2KLogGenerator _generator{_fixture.environment()};
    Dictionary _state;
    RecordingLog _log;
    const RecordingLog::Line _cannotLoad{3, "Cannot load C2K template for display"};
};

TEST_F(C2KWithoutTemplate, EveryCallTriesAgainAndNothingIsParsedIntoPlaces) {
    _generator.updateState(_state, statusOn(25).prefixed());
    EXPECT_EQ(_log.take(), (Lines{_cannotLoad, {6, "Log Header 0x81"}}));
    EXPECT_TRUE(_generator.generateLogUsingState(_state).isNull());
    EXPECT_EQ(_log.take(), Lines{_cannotLoad});
    for (const char* key : {"Template", "Display", "Lookup", "ExtraInfo"}) {
        EXPECT_FALSE(_state.contains(key)) << key;
    }
    EXPECT_EQ(*_state.find("DisplayState"), PropertyList::data(statusOn(25).bytes()));
    EXPECT_EQ(
        *_state.find("History"),
        PropertyList(Array{Dictionary{{"DisplayState", PropertyList::data(statusOn(25).bytes())}}}))
        << "without a display the entry ends there";
}

TEST_F(C2KWithoutTemplate, OneThatComesLaterIsUsed) {
    _generator.updateState(_state, statusOn(25).prefixed());
    _fixture.resources.add("C2KTemplate", kTemplate);
    _generator.updateState(_state, statusOn(26).prefixed());
    EXPECT_EQ(_generator.display(_state), displayOn("26"));
}

TEST_F(C2KWithoutTemplate, OneWhoseRootIsNoDictionaryCannotBeLoaded) {
    _fixture.resources.add("C2KTemplate", Array{"kChannel"});
    EXPECT_TRUE(_generator.getDisplayFromState(_state).isNull());
    EXPECT_EQ(_log.take(), Lines{_cannotLoad});
    EXPECT_FALSE(_state.contains("Template"));
}

TEST_F(C2KWithoutTemplate, RunningValuesAreStillKept) {
    _generator.updateState(_state, Record(0x1192).u32(7).padTo(241).prefixed());
    EXPECT_EQ(*_state.find("FLDataSeqNum"), PropertyList::integer(7));
}

TEST(C2KLogGenerator, ItsCreationIsLoggedByTheBaseAndItsEndIsSilent) {
    GeneratorFixture fixture;
    RecordingLog log;
    auto generator = C2KLogGenerator::generator(fixture.environment());
    const auto* self = static_cast<const void*>(generator.get());
    generator.reset();
    EXPECT_EQ(log.lines(), (Lines{{4, formatText("Creating Log object: %p", {self})}}));
    EXPECT_TRUE(fixture.standardOutput.lines.empty());
}

TEST(Technologies, TheCDMAIdentifierGivesTheCDMAGeneratorAndIsComparedBetweenGSMAndLTE) {
    GeneratorFixture fixture;
    const auto generator =
        LogGenerator::generatorFromTechnology("Zorell_CDMA", technologies(), fixture.environment());
    EXPECT_NE(dynamic_cast<C2KLogGenerator*>(generator.get()), nullptr);
    const auto rows = technologies();
    const auto found = std::find_if(rows.begin(), rows.end(), [](const Technology& technology) {
        return technology.identifier == kHXLogChannelTechnology_Zorell_CDMA;
    });
    ASSERT_TRUE(found != rows.end() && found != rows.begin() && found + 1 != rows.end());
    EXPECT_EQ((found - 1)->identifier, kHXLogChannelTechnology_Zorell_GSM);
    EXPECT_EQ((found + 1)->identifier, kHXLogChannelTechnology_Zorell_LTE);
}

TEST_F(C2KLogGeneratorTest, OfPacketsThatReplaceEachOtherTheLatestIsShown) {
    _generator.updateState(_state, statusOn(25).bytes());
    _generator.updateState(_state, statusOn(26).bytes());
    EXPECT_EQ(*_state.find("Display"), displayOn(""));
    EXPECT_EQ(_generator.generateLogUsingState(_state), displayOn("26"));
    _generator.updateState(_state, statusOn(27).bytes());
    EXPECT_EQ(_generator.display(_state), displayOn("27"));
}

TEST_F(C2KLogGeneratorTest, APacketThatIsRefusedReplacesNothing) {
    _generator.updateState(_state, statusOn(25).bytes());
    _generator.updateState(_state, statusOn(26).padTo(51).bytes());
    EXPECT_EQ(_generator.display(_state), displayOn("25"));
}

} // namespace
} // namespace pallax
