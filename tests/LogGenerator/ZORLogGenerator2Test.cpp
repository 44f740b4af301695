#include "LogGenerator/ZORLogGenerator2.h"

#include "LogGenerator/Records/Exceptions.h"
#include "tests/doubles/GeneratorFixture.h"
#include "tests/doubles/RecordFixture.h"

#include <gtest/gtest.h>

#include <array>

namespace pallax {
namespace {

using doubles::GeneratorFixture;
using doubles::Record;
using doubles::RecordingLog;
using Lines = std::vector<RecordingLog::Line>;

/// Accepts every record, and throws if the first payload byte is 0xEE.
bool throwsOnMark(const CodeLayout& /*code*/, const LogRecord& record) {
    if (record.u8(LogRecord::kHeaderLength) == 0xEE) {
        throw ArrayOutOfBoundsException();
    }
    return true;
}

PropertyList lengthOf(const Place& place) {
    return DisplayNumber(static_cast<std::int64_t>(place.record.length()), kDecimal);
}

constexpr Computation kLength{"length", "the length of the record", {}, lengthOf};
constexpr auto kFields = std::to_array<Field>({computed("Length", kDecimal, kLength)});
constexpr auto kCodes = std::to_array<CodeLayout>({
    {.logCode = 0x4116, .fields = kFields, .accepts = throwsOnMark},
    {.logCode = 0xFF0020, .fields = kFields, .accepts = throwsOnMark},
});
constexpr RecordLayout kFirst{.section = "First", .logLine = "first", .codes = kCodes};
constexpr RecordLayout kSecond{
    .section = "Second", .logLine = "second", .codes = std::span(kCodes).first<1>()};

class First final : public LayoutRecord {
public:
    First() : LayoutRecord(kFirst) {}
};

class Second final : public LayoutRecord {
public:
    Second() : LayoutRecord(kSecond) {}
};

class ProbeIndex final : public ClassIndex {
public:
    using ClassIndex::ClassIndex;
    std::unique_ptr<First> objFirst = create<First>();
    std::unique_ptr<Second> objSecond = create<Second>();
};

class ProbeGenerator final : public ZORLogGenerator2 {
public:
    explicit ProbeGenerator(const GeneratorEnvironment& environment)
        : ProbeGenerator(environment, std::make_unique<ProbeIndex>(environment.standardOutput)) {}

    const ClassIndex* index;

private:
    struct Held {
        const ClassIndex* address;
        std::unique_ptr<ProbeIndex> probes;
    };
    ProbeGenerator(const GeneratorEnvironment& environment, std::unique_ptr<ProbeIndex> probes)
        : ProbeGenerator(environment, Held{probes.get(), std::move(probes)}) {}
    ProbeGenerator(const GeneratorEnvironment& environment, Held held)
        : ZORLogGenerator2(environment, {"PROBE", std::move(held.probes)}), index(held.address) {}
};

class ZORLogGenerator2Test : public testing::Test {
protected:
    ZORLogGenerator2Test() {
        _fixture.resources.add(
            "PROBE",
            Dictionary{{"First", Dictionary()}, {"Group", Dictionary{{"Second", Dictionary()}}}});
    }

    void feed(const ByteBuffer& message) {
        RecordingLog log;
        _generator.updateState(_state, message);
        _lines = log.take();
    }
    PropertyList display() { return _generator.display(_state); }
    /// The display without bringing it up to date.
    PropertyList lastDisplay() { return *_state.find("Display"); }

    GeneratorFixture _fixture;
    ProbeGenerator _generator{_fixture.environment()};
    Dictionary _state;
    Lines _lines;
};

const PropertyList kEmptyDisplay =
    Dictionary{{"First", Dictionary()}, {"Group", Dictionary{{"Second", Dictionary()}}}};

TEST_F(ZORLogGenerator2Test, TheFirstPacketLoadsTheTemplateBuildsTheDisplayAndIsThenDispatched) {
    feed(Record(0x4116).bytes());
    const PropertyList shown = Dictionary{{"Length", "13"}};
    const PropertyList expected =
        Dictionary{{"First", shown}, {"Group", Dictionary{{"Second", shown}}}};
    EXPECT_EQ(display(), expected);
    EXPECT_EQ(*_state.find("Template"), kEmptyDisplay) << "the template stays as loaded";
    EXPECT_EQ(*_state.find("ExtraInfo"), PropertyList(Dictionary()));
    EXPECT_EQ(_generator.generateLogUsingState(_state), expected);
}

TEST_F(ZORLogGenerator2Test, LinesOfTheFirstPacketInOrder) {
    feed(Record(0x4116).prefixed());
    const auto* index = static_cast<const void*>(_generator.index);
    const auto* self = static_cast<const void*>(&_generator);
    EXPECT_EQ(_lines,
              (Lines{{4, formatText("Initialized class index: %p, Self: %p", {index, self})},
                     {4, "Dictionary = 1"},
                     {4, "String = 0"},
                     {4, "First"},
                     {4, "Second"},
                     {6, "Log Header 0x81"},
                     {4, "first"},
                     {4, "second"}}));
}

TEST_F(ZORLogGenerator2Test, TheCallThatBuildsTheDisplayReturnsNull) {
    EXPECT_TRUE(_generator.getDisplayFromState(_state).isNull());
    EXPECT_EQ(_generator.getDisplayFromState(_state), kEmptyDisplay);
}

TEST_F(ZORLogGenerator2Test, TheFirstDisplayGeneratedOfAFreshStateIsNull) {
    EXPECT_TRUE(_generator.generateLogUsingState(_state).isNull());
    EXPECT_EQ(_generator.generateLogUsingState(_state), kEmptyDisplay);
    EXPECT_EQ(_state.find("History")->array()->size(), 2U);
}

TEST_F(ZORLogGenerator2Test,
       ARecordOf13BytesWithType0xFFAndCode0x0020ReachesTheSubscribersOf0xFF0020) {
    feed(Record(0xFF0020).bytes());
    EXPECT_EQ(*display().dictionary()->find("First"), PropertyList(Dictionary{{"Length", "13"}}));
    EXPECT_EQ(*display().dictionary()->find("Group"),
              PropertyList(Dictionary{{"Second", Dictionary()}}));
}

TEST_F(ZORLogGenerator2Test, APrefixedMessageIsDispatchedUnderTheCodeInItsBytes5And6) {
    feed({0x81, 0x00, 0x01, 0, 0, 0x16, 0x41, 0, 0, 0, 0, 0, 0, 0, 0});
    EXPECT_EQ(*display().dictionary()->find("First"), PropertyList(Dictionary{{"Length", "13"}}));
}

TEST_F(ZORLogGenerator2Test, ARecordOfExactly12BytesIsDropped) {
    feed(Record(0x4116).bytes()); // the display is built
    feed({0x81, 0x00, 0x01, 0, 0, 0x16, 0x41, 0, 0, 0, 0, 0, 0, 0});
    EXPECT_EQ(_lines,
              (Lines{{6, "Log Header 0x81"}, {4, "Invalid data packet len=12 expected=13"}}));
}

TEST_F(ZORLogGenerator2Test, ANullRecordIsReportedWithLength0) {
    feed(Record(0x4116).bytes());
    feed({0x81, 0x00});
    EXPECT_EQ(_lines, (Lines{{6, "Log Header 0x81"},
                             {4, "Packet length too small (len=2). Ignoring packet"},
                             {4, "Invalid data packet len=0 expected=13"}}));
    feed({});
    EXPECT_EQ(_lines, (Lines{{4, "buffer is null"}, {4, "Invalid data packet len=0 expected=13"}}));
}

TEST_F(ZORLogGenerator2Test, LogType2IsDropped) {
    (void)_generator.getDisplayFromState(_state);
    for (const unsigned type : {0U, 2U, 254U}) {
        feed(Record(0x4116).at(0, type).bytes());
        EXPECT_EQ(_lines.back(),
                  (RecordingLog::Line{3, formatText("Invalid log type: %x. Dropping.", {type})}));
    }
    EXPECT_EQ(display(), kEmptyDisplay);
}

TEST_F(ZORLogGenerator2Test, ACodeWithoutSubscribersChangesNothing) {
    feed(Record(0x4117).bytes());
    EXPECT_EQ(display(), kEmptyDisplay);
}

TEST_F(ZORLogGenerator2Test, APacketIsCapturedExactlyAsReceived) {
    const ByteBuffer prefixed = Record(0x4116).prefixed();
    const ByteBuffer unwanted = Record(0x4117).bytes();
    feed(prefixed);
    feed(unwanted);
    feed({0x01, 0x02}); // too short for a record, but captured
    (void)_generator.generateLogUsingState(_state);
    ByteBuffer expected = prefixed;
    expected.insert(expected.end(), unwanted.begin(), unwanted.end());
    expected.insert(expected.end(), {0x01, 0x02});
    EXPECT_EQ(*_state.find("DisplayState"), PropertyList::data(expected));
}

TEST_F(ZORLogGenerator2Test, EachDisplayGenerationHandsOverTheBytesSinceThePreviousOne) {
    feed({1});
    (void)_generator.generateLogUsingState(_state);
    feed({2, 3});
    (void)_generator.generateLogUsingState(_state);
    EXPECT_EQ(*_state.find("DisplayState"), PropertyList::data({2, 3}));
    (void)_generator.generateLogUsingState(_state);
    EXPECT_EQ(*_state.find("DisplayState"), PropertyList::data({}));
    const Array history = *_state.find("History")->array();
    ASSERT_EQ(history.size(), 3U);
    EXPECT_EQ(*history[0].dictionary()->find("DisplayState"), PropertyList::data({1}));
    EXPECT_EQ(*history[1].dictionary()->find("DisplayState"), PropertyList::data({2, 3}));
}

TEST_F(ZORLogGenerator2Test, ARecordThatThrowsLetsItsExceptionLeaveAndIsNotCaptured) {
    EXPECT_THROW(_generator.updateState(_state, Record(0x4116).u8(0xEE).bytes()),
                 ArrayOutOfBoundsException);
    (void)_generator.generateLogUsingState(_state);
    EXPECT_EQ(*_state.find("DisplayState"), PropertyList::data({}));
}

const PropertyList kShownOfTheLatest =
    Dictionary{{"First", Dictionary{{"Length", "40"}}},
               {"Group", Dictionary{{"Second", Dictionary{{"Length", "40"}}}}}};

TEST_F(ZORLogGenerator2Test, KeptRecordsAreReadWhenTheDisplayIsGenerated) {
    _generator.updateState(_state, Record(0x4116).bytes());
    _generator.updateState(_state, Record(0x4116).padTo(40).bytes());
    EXPECT_EQ(lastDisplay(), kEmptyDisplay);
    EXPECT_EQ(_generator.generateLogUsingState(_state), kShownOfTheLatest);
}

TEST_F(ZORLogGenerator2Test, KeptRecordsAreReadWhenTheDisplayIsAskedFor) {
    _generator.updateState(_state, Record(0x4116).padTo(40).bytes());
    EXPECT_EQ(lastDisplay(), kEmptyDisplay);
    EXPECT_EQ(_generator.display(_state), kShownOfTheLatest);
}

TEST_F(ZORLogGenerator2Test, ARecordThatThrowsIsReadAtOnceAndTheKeptOnesAreShown) {
    _generator.updateState(_state, Record(0x4116).padTo(40).bytes());
    EXPECT_THROW(_generator.updateState(_state, Record(0x4116).u8(0xEE).bytes()),
                 ArrayOutOfBoundsException);
    EXPECT_EQ(display(), kShownOfTheLatest) << "both; the exception kept it from the second record";
}

TEST_F(ZORLogGenerator2Test, SubscribedCodesBecomeTheStartCommand) {
    doubles::expectInOrder(_generator.getStartCommand(),
                           Dictionary{{"SetState", "Streaming"},
                                      {"SetZorellLogCodes", Array{PropertyList::integer(16662)}},
                                      {"SetHxExtraCodes", Array{PropertyList::integer(32)}}});
}

TEST_F(ZORLogGenerator2Test, AMissingTemplateLeavesTheDisplayNullAndPacketsAreStillDispatched) {
    GeneratorFixture empty;
    ProbeGenerator generator(empty.environment());
    Dictionary state;
    RecordingLog log;
    generator.updateState(state, Record(0x4116).prefixed());
    EXPECT_EQ(log.lines(), (Lines{{3, "Cannot load template for display"},
                                  {6, "Log Header 0x81"},
                                  {4, "first"},
                                  {4, "second"}}));
    EXPECT_THROW(generator.updateState(state, Record(0x4116).u8(0xEE).bytes()),
                 ArrayOutOfBoundsException)
        << "the records are called";
    EXPECT_TRUE(generator.generateLogUsingState(state).isNull());
    EXPECT_FALSE(state.contains("Display"));
    EXPECT_FALSE(state.contains("Template"));
}

TEST_F(ZORLogGenerator2Test, ATemplateWhoseRootIsNoDictionaryCannotBeLoaded) {
    _fixture.resources.add("PROBE", Array{"text"});
    feed(Record(0x4116).prefixed());
    EXPECT_EQ(_lines.front(), (RecordingLog::Line{3, "Cannot load template for display"}));
    EXPECT_FALSE(_state.contains("Display"));
}

TEST_F(ZORLogGenerator2Test, ATemplateKeptInTheStateIsNotLoadedAgain) {
    _state.set("Template", Dictionary{{"First", Dictionary{{"Length", "none yet"}}}});
    (void)_generator.getDisplayFromState(_state);
    EXPECT_EQ(display(), PropertyList(Dictionary{{"First", Dictionary{{"Length", "none yet"}}}}));
    feed(Record(0x4116).bytes());
    EXPECT_EQ(display(), PropertyList(Dictionary{{"First", Dictionary{{"Length", "13"}}}}));
    EXPECT_EQ(*_state.find("Template"),
              PropertyList(Dictionary{{"First", Dictionary{{"Length", "none yet"}}}}))
        << "the display is a copy";
}

TEST_F(ZORLogGenerator2Test, ANewGeneratorFindsTheDisplayAndItsRecordsNeverGetASection) {
    feed(Record(0x4116).bytes());
    const PropertyList before = display().description();
    ProbeGenerator restarted(_fixture.environment());
    restarted.updateState(_state, Record(0x4116).padTo(40).bytes());
    EXPECT_EQ(PropertyList(display().description()), before);
    EXPECT_EQ(restarted.generateLogUsingState(_state), display()) << "it keeps its last values";
}

TEST_F(ZORLogGenerator2Test, ATemplateHoldingANumberLeafLogsReceivedAnObjectOfUnknownType) {
    RecordingLog log;
    const PropertyList processed =
        _generator.processTemplate(Dictionary{{"Text", "kept"},
                                              {"Number", PropertyList::integer(1)},
                                              {"List", Array{"a", PropertyList::boolean(true)}}});
    EXPECT_EQ(log.lines(), (Lines{{3, "Received an object of unknown type"},
                                  {4, "Processing the template"},
                                  {3, "Received an object of unknown type"},
                                  {4, "Processing the template"}}));
    doubles::expectInOrder(processed, Dictionary{{"Text", "kept"}, {"List", Array{"a"}}});
}

TEST_F(ZORLogGenerator2Test, ADictionaryKeyThatIsNoStringIsSkipped) {
    Dictionary templateObject;
    templateObject.appendForeignKey(PropertyList::integer(5), "five");
    templateObject.set("Text", "kept");
    RecordingLog log;
    doubles::expectInOrder(_generator.processTemplate(templateObject),
                           Dictionary{{"Text", "kept"}});
    EXPECT_EQ(log.lines(), (Lines{{3, "Dictionary Key is not a string?"}}));
}

TEST_F(ZORLogGenerator2Test, IfASectionNameOccursTwiceTheLastOneProcessedIsTheSection) {
    _fixture.resources.add("PROBE", Dictionary{{"A", Dictionary{{"First", Dictionary()}}},
                                               {"B", Array{Dictionary{{"First", Dictionary()}}}}});
    feed(Record(0xFF0020).bytes());
    const PropertyList shown = Dictionary{{"Length", "13"}};
    EXPECT_EQ(display(), PropertyList(Dictionary{{"A", Dictionary{{"First", Dictionary()}}},
                                                 {"B", Array{Dictionary{{"First", shown}}}}}));
}

TEST_F(ZORLogGenerator2Test, PrintDictLogsWhatADisplayMustNotHoldAndChangesNothing) {
    const PropertyList object = Dictionary{{"Text", "fine"},
                                           {"Number", PropertyList::integer(1)},
                                           {"List", Array{PropertyList::real(2)}}};
    RecordingLog log;
    ZORLogGenerator2::printDict(object);
    EXPECT_EQ(log.lines(), (Lines{{3, "Received an object of unknown type"},
                                  {3, "Received an object of unknown type"}}));
}

TEST(ZORLogGenerator2, ItsLifeIsLogged) {
    GeneratorFixture fixture;
    RecordingLog log;
    auto generator = std::make_unique<ProbeGenerator>(fixture.environment());
    const auto* self = static_cast<const void*>(generator.get());
    const auto* index = static_cast<const void*>(generator->index);
    const Lines created = log.take();
    generator.reset();
    EXPECT_EQ(created, (Lines{{4, "Array Count: 2"},
                              {4, "Array Count: 1"},
                              {3, formatText("Creating ZORLogGenerator2 object with %p", {index})},
                              {4, formatText("Creating Log object: %p", {self})},
                              {3, "Class Index: 1"}}));
    EXPECT_EQ(log.lines(),
              (Lines{{4, formatText("ZOR_GSMLogGenerator is destructed %p", {self})}}));
    EXPECT_EQ(fixture.standardOutput.lines, (std::vector<std::string>{"Deallocing ClassIndex"}));
}

} // namespace
} // namespace pallax
