#include "LogGenerator/GSM/GSMLogGenerator.h"

#include "LogGenerator/Technologies/Technologies.h"
#include "app/tree/PallaxModelNode.h"
#include "tests/LogGenerator/GSM/ObjectStream.h"
#include "tests/doubles/GeneratorFixture.h"
#include "tests/doubles/Property.h"
#include "tests/doubles/RecordingLog.h"

#include <gtest/gtest.h>

#include <array>

namespace pallax {
namespace {

using doubles::RecordingLog;
using Failure = GSMLogGenerator::InternalInconsistencyException;
using Lines = std::vector<RecordingLog::Line>;

/// A generator and the state that it fills.
struct Stream {
    void feed(const ByteBuffer& message) { generator->updateState(state, message); }

    /// The failure of a message: "message|file|line"; "none" without one.
    std::string failureOf(const ByteBuffer& message) {
        try {
            feed(message);
        } catch (const Failure& failure) {
            return formatText("%@|%s|%d", {failure.message(), failure.file(), failure.line()});
        }
        return "none";
    }

    PropertyList value(std::string_view key) const {
        (void)generator->display(state);
        const PropertyList* found = state.find(key);
        return found != nullptr ? *found : PropertyList();
    }
    Array history() const { return *value("History").array(); }

    doubles::GeneratorFixture fixture;
    std::unique_ptr<LogGenerator> generator = GSMLogGenerator::generator(fixture.environment());
    Dictionary state;
};

class GSMLogGeneratorTest : public testing::Test, protected Stream {};

const Dictionary kExample = {{"Cell", Dictionary{{"ARFCN", "12"}}},
                             {"List", Array{"header", "a", Dictionary{{"x", "b"}}}}};
const Dictionary kExampleDisplay = {{"Cell", "12"}, {"List", Array{"a", "b"}}};

constexpr const char* kNotDeserialized =
    "Could not deserialize the object|LogGenerator/GSM/GSMLogGenerator|90";
constexpr const char* kUnknownInteger =
    "Unknown object of type integer encountered|LogGenerator/GSM/GSMLogGenerator|78";

TEST_F(GSMLogGeneratorTest, TheTechnologyFactorySelectsItForIFXBeforeAnyOther) {
    const auto made =
        LogGenerator::generatorFromTechnology("IFX", technologies(), fixture.environment());
    EXPECT_NE(dynamic_cast<GSMLogGenerator*>(made.get()), nullptr);
    EXPECT_EQ(technologies().front().identifier, "IFX");
}

TEST_F(GSMLogGeneratorTest, OfItsLifeOnlyTheBasesLineIsLogged) {
    const RecordingLog log;
    auto made = GSMLogGenerator::generator(fixture.environment());
    const auto* self = static_cast<const void*>(made.get());
    made.reset();
    EXPECT_EQ(log.lines(), (Lines{{4, formatText("Creating Log object: %p", {self})}}));
    EXPECT_EQ(fixture.standardOutput.lines, std::vector<std::string>{});
}

TEST_F(GSMLogGeneratorTest, TheStartCommandHasSetStateOnly) {
    EXPECT_EQ(generator->getStartCommand(), PropertyList(Dictionary{{"SetState", "Streaming"}}));
}

TEST_F(GSMLogGeneratorTest, AMessageInTheXmlFormIsDisplayed) {
    feed(bytesOf("<?xml version=\"1.0\" encoding=\"UTF-8\"?><plist version=\"1.0\"><dict>"
                 "<key>Cell</key><dict><key>ARFCN</key><string>12</string></dict>"
                 "<key>List</key><array><string>header</string><string>a</string>"
                 "<dict><key>x</key><string>b</string></dict></array></dict></plist>"));
    EXPECT_EQ(value("Display").description(), PropertyList(kExampleDisplay).description());
}

TEST_F(GSMLogGeneratorTest, AMessageInTheBinaryFormIsDisplayed) {
    feed(binaryMessage(kExample));
    EXPECT_EQ(value("Display").description(), PropertyList(kExampleDisplay).description());
}

TEST_F(GSMLogGeneratorTest, AMessageInTheTextFormIsDisplayed) {
    feed(bytesOf("{ Cell = { ARFCN = 12; }; List = ( header, a, { x = b; } ); }"));
    EXPECT_EQ(value("Display").description(), PropertyList(kExampleDisplay).description());
}

TEST_F(GSMLogGeneratorTest, AMessageWritesTheThreeKeysOfTheState) {
    feed(xmlMessage(kExample));
    EXPECT_EQ(state.size(), 3U);
    EXPECT_EQ(value("DisplayState"), PropertyList(kExample)) << "unchanged";
    EXPECT_EQ(value("Display"), PropertyList(kExampleDisplay));
    EXPECT_EQ(value("ExtraInfo"), PropertyList(Dictionary{}));
}

TEST_F(GSMLogGeneratorTest, AMessageLogsNothing) {
    const RecordingLog log;
    feed(xmlMessage(kExample));
    EXPECT_EQ(failureOf(bytesOf("{")), kNotDeserialized);
    EXPECT_EQ(log.lines(), Lines{});
}

TEST_F(GSMLogGeneratorTest, ThePreviousDisplayIsReplacedWhole) {
    feed(xmlMessage(kExample));
    feed(binaryMessage(Dictionary{{"Cell", Dictionary{{"BSIC", "7"}, {"C1", "20"}}}}));
    EXPECT_EQ(value("Display"),
              PropertyList(Dictionary{{"Cell", Dictionary{{"BSIC", "7"}, {"C1", "20"}}}}));
    EXPECT_EQ(value("DisplayState"), value("Display"));
}

TEST_F(GSMLogGeneratorTest, ExtraInfoIsANewEmptyDictionaryOnEveryMessage) {
    feed(xmlMessage(kExample));
    const DictionaryRef first = value("ExtraInfo").dictionary();
    first->set("kept", "by somebody");
    feed(xmlMessage(kExample));
    EXPECT_NE(value("ExtraInfo").dictionary(), first);
    EXPECT_TRUE(value("ExtraInfo").dictionary()->empty());
}

TEST_F(GSMLogGeneratorTest, OtherKeysOfTheStateAreLeftAlone) {
    state.set("Template", "of another technology");
    state.set("History", Array{"an entry"});
    feed(xmlMessage(kExample));
    EXPECT_EQ(value("Template"), PropertyList("of another technology"));
    EXPECT_EQ(value("History"), PropertyList(Array{"an entry"}));
}

TEST_F(GSMLogGeneratorTest, AMessageThatIsNoDictionaryIsDisplayedAsWhatItIs) {
    feed(bytesOf("( header, a, b )"));
    EXPECT_EQ(value("Display"), PropertyList(Array{"a", "b"}));
    feed(bytesOf("\"no service\""));
    EXPECT_EQ(value("Display"), PropertyList("no service"));
}

TEST_F(GSMLogGeneratorTest, AnUndecodableMessageIsTheAssertionOfLine90) {
    EXPECT_EQ(failureOf(bytesOf("{ Cell = 12;")), kNotDeserialized);
    EXPECT_EQ(failureOf(bytesOf("<plist><dict>")), kNotDeserialized);
    EXPECT_EQ(failureOf(bytesOf("bplist00")), kNotDeserialized);
    EXPECT_EQ(failureOf({0x01, 0x00, 0x00, 0x16, 0x41}), kNotDeserialized) << "a log record";
    EXPECT_TRUE(state.empty());
    try {
        feed(bytesOf("{"));
        FAIL() << "nothing thrown";
    } catch (const std::exception& failure) {
        EXPECT_STREQ(failure.what(), "Could not deserialize the object "
                                     "(LogGenerator/GSM/GSMLogGenerator, line 90)");
    }
}

TEST_F(GSMLogGeneratorTest, AnEmptyMessageCountsAsNullAndIsUndecodable) {
    EXPECT_EQ(failureOf({}), kNotDeserialized);
    EXPECT_TRUE(state.empty());
}

TEST_F(GSMLogGeneratorTest, AMessageHoldingANumberIsTheAssertionOfLine78NamingTheNumbersClass) {
    const Dictionary message{{"Cell", Dictionary{{"ARFCN", PropertyList::integer(12)}}}};
    EXPECT_EQ(failureOf(xmlMessage(message)), kUnknownInteger);
    EXPECT_EQ(failureOf(binaryMessage(message)), kUnknownInteger);
    EXPECT_TRUE(state.empty());
}

TEST_F(GSMLogGeneratorTest, AMessageHoldingDataIsTheAssertionOfLine78InEachForm) {
    const std::string expected =
        "Unknown object of type data encountered|LogGenerator/GSM/GSMLogGenerator|78";
    const Dictionary message{{"Cell", PropertyList::data({0x0F, 0xBD})}};
    EXPECT_EQ(failureOf(xmlMessage(message)), expected);
    EXPECT_EQ(failureOf(binaryMessage(message)), expected);
    EXPECT_EQ(failureOf(bytesOf("{ Cell = <0fbd>; }")), expected);
}

TEST_F(GSMLogGeneratorTest, AfterAFailureTheStateIsAsItWasBeforeTheMessage) {
    feed(xmlMessage(kExample));
    (void)generator->generateLogUsingState(state);
    value("ExtraInfo").dictionary()->set("kept", "1");
    const DictionaryRef display = value("Display").dictionary();
    const std::string before = PropertyList(state).description();
    EXPECT_EQ(failureOf(bytesOf("{")), kNotDeserialized);
    EXPECT_EQ(failureOf(xmlMessage(Dictionary{{"A", "x"}, {"B", PropertyList::integer(1)}})),
              kUnknownInteger);
    EXPECT_EQ(PropertyList(state).description(), before);
    EXPECT_EQ(value("Display").dictionary(), display);
    feed(xmlMessage(Dictionary{{"A", "x"}}));
    EXPECT_EQ(value("Display"), PropertyList(Dictionary{{"A", "x"}})) << "later messages are shown";
}

TEST_F(GSMLogGeneratorTest, TheDisplayTickUpdatesTheHistoryAndReturnsTheDisplay) {
    feed(xmlMessage(kExample));
    const PropertyList display = generator->generateLogUsingState(state);
    EXPECT_EQ(display.dictionary(), value("Display").dictionary());
    EXPECT_EQ(PropertyList(history()).description(),
              PropertyList(Array{Dictionary{
                               {"DisplayState", kExample},
                               {"Display", kExampleDisplay},
                               {"ExtraInfo", Dictionary{}},
                               {"Date", "2023-11-14 22:13:20 +0000"},
                               {"Description", "Snapshot (2023-11-14 22:13:20 +0000)"},
                           }})
                  .description());
}

TEST_F(GSMLogGeneratorTest, ADisplayTickBeforeAnyMessageReturnsNullAndLeavesAnEmptyEntry) {
    EXPECT_TRUE(generator->generateLogUsingState(state).isNull());
    EXPECT_EQ(PropertyList(history()), PropertyList(Array{Dictionary{}}));
}

TEST_F(GSMLogGeneratorTest, TheHistoryKeepsFiveCopiesOfPastDisplays) {
    for (int message = 1; message <= 7; ++message) {
        feed(xmlMessage(Dictionary{{"Message", std::to_string(message)}}));
        (void)generator->generateLogUsingState(state);
    }
    std::vector<std::string> shown;
    for (const PropertyList& entry : history()) {
        shown.push_back(entry.dictionary()->find("Display")->description());
    }
    EXPECT_EQ(shown,
              (std::vector<std::string>{"{ Message = 3; }", "{ Message = 4; }", "{ Message = 5; }",
                                        "{ Message = 6; }", "{ Message = 7; }"}));
}

TEST_F(GSMLogGeneratorTest, TheSaveContentsAreTheHistoryEntriesInANewArrayWithoutADlfEntry) {
    feed(xmlMessage(kExample));
    (void)generator->generateLogUsingState(state);
    feed(xmlMessage(Dictionary{{"Cell", "13"}}));
    (void)generator->generateLogUsingState(state);
    const PropertyList contents = generator->getSaveContentsFromState(state);
    EXPECT_EQ(contents, PropertyList(history()));
    EXPECT_EQ(contents.array()->size(), 2U);
    EXPECT_NE(contents.array(), value("History").array());
    for (const PropertyList& entry : *contents.array()) {
        EXPECT_FALSE(entry.dictionary()->contains("DLF"));
    }
    EXPECT_TRUE(serializeXml(contents)) << "a snapshot file can hold them";
}

TEST_F(GSMLogGeneratorTest, WithoutAHistoryTheSaveContentsAreEmpty) {
    EXPECT_EQ(generator->getSaveContentsFromState(state), PropertyList(Array{}));
    state.set("History", "no array");
    EXPECT_EQ(generator->getSaveContentsFromState(state), PropertyList(Array{}));
}

/// `depth` nested containers of two entries each; the innermost contains two strings.
PropertyList nested(std::size_t depth, bool arrays) {
    PropertyList inner = "x";
    for (; depth > 0; --depth) {
        inner = arrays ? PropertyList(Array{"header", inner})
                       : PropertyList(Dictionary{{"a", inner}, {"b", "y"}});
    }
    return inner;
}

TEST_F(GSMLogGeneratorTest, TheDeepestNestingThatIsReadIsDisplayed) {
    for (const bool arrays : {false, true}) {
        const PropertyList object = nested(kDeepestPropertyList, arrays);
        for (const ByteBuffer& message :
             {xmlMessage(object), binaryMessage(object), textMessage(object)}) {
            feed(message);
            std::size_t depth = 0;
            for (PropertyList at = value("Display"); !at.isString(); ++depth) {
                at = arrays ? at.array()->front() : *at.dictionary()->find("a");
            }
            EXPECT_EQ(depth, kDeepestPropertyList);
            PathDictionary paths;
            (void)PallaxModelNode::makeTreeFromObject(value("Display"), paths);
            EXPECT_EQ(paths.size(), (arrays ? 1U : 2U) * kDeepestPropertyList + 1U);
        }
    }
}

TEST_F(GSMLogGeneratorTest, AChainOfTheDeepestNestingFoldsToOneEntry) {
    PropertyList chain = "x";
    for (std::size_t depth = 0; depth < kDeepestPropertyList; ++depth) {
        chain = Dictionary{{"a", chain}};
    }
    feed(textMessage(chain));
    EXPECT_EQ(value("Display"), PropertyList(Dictionary{{"a", "x"}}));
}

TEST_F(GSMLogGeneratorTest, DeeperNestingIsUndecodable) {
    const std::string deeper = doubles::textForm(nested(kDeepestPropertyList + 1, false));
    EXPECT_EQ(failureOf(bytesOf(deeper)), kNotDeserialized);
    EXPECT_EQ(failureOf(bytesOf(std::string(100000, '('))), kNotDeserialized);
}

TEST(GSMLogGeneratorProperty, TheThreeFormsOfAMessageAreDisplayedAlike) {
    EXPECT_TRUE(doubles::holds([] {
        Stream stream;
        const PropertyList object = anyMessage();
        const std::string expected = GSMLogGenerator::processObject(object).description();
        for (const ByteBuffer& message :
             {xmlMessage(object), binaryMessage(object), textMessage(object)}) {
            stream.feed(message);
            RC_ASSERT(stream.value("DisplayState") == object);
            RC_ASSERT(stream.value("Display").description() == expected);
        }
    }));
}

TEST(GSMLogGeneratorProperty, AValueOfAnotherTypeAnywhereLeavesTheStateAsItWas) {
    EXPECT_TRUE(doubles::holds([] {
        Stream stream;
        stream.feed(xmlMessage(anyMessage()));
        const std::string before = PropertyList(stream.state).description();
        PropertyList object = PropertyList::integer(doubles::any::integer());
        for (int depth = doubles::any::between(1, 8); depth > 0; --depth) {
            switch (doubles::any::between(0, 3)) {
            case 0:
                object = Dictionary{{"K", object}};
                break;
            case 1:
                object = Dictionary{{"A", anyObject(1)}, {"K", object}, {"Z", anyObject(1)}};
                break;
            default:
                object = Array{anyObject(1), object};
                break;
            }
        }
        RC_ASSERT(stream.failureOf(binaryMessage(object)) == kUnknownInteger);
        RC_ASSERT(PropertyList(stream.state).description() == before);
    }));
}

TEST(GSMLogGeneratorProperty, AnyBytesAreDisplayedOrLeaveTheStateAsItWas) {
    EXPECT_TRUE(doubles::holds([] {
        Stream stream;
        stream.feed(xmlMessage(kExample));
        const std::string before = PropertyList(stream.state).description();
        const PropertyList object = anyMessage();
        const std::array forms = {xmlMessage(object), binaryMessage(object), textMessage(object)};
        ByteBuffer message = forms.at(doubles::any::index(forms.size()));
        // Changes a byte of the message, or cuts it.
        const auto at = doubles::any::index(message.size());
        if (doubles::any::boolean()) {
            message[at] = doubles::any::byte();
        } else {
            message.resize(at);
        }
        if (stream.failureOf(message) != "none") {
            RC_CLASSIFY(true, "refused");
            RC_ASSERT(PropertyList(stream.state).description() == before);
        } else {
            // Compares texts, because NaN does not equal itself.
            const PropertyList shown = GSMLogGenerator::processObject(stream.value("DisplayState"));
            RC_ASSERT(stream.value("Display").description() == shown.description());
        }
    }));
}

TEST_F(GSMLogGeneratorTest, TheDisplayOfADictionaryIsMadeWhenItIsNeeded) {
    feed(xmlMessage(Dictionary{{"Cell", Dictionary{{"ARFCN", "11"}}}}));
    feed(xmlMessage(kExample));
    EXPECT_TRUE(state.find("Display")->dictionary()->empty());
    EXPECT_EQ(generator->generateLogUsingState(state), PropertyList(kExampleDisplay));
    EXPECT_EQ(*state.find("Display"), PropertyList(kExampleDisplay));
    EXPECT_EQ(*history().back().dictionary()->find("Display"), PropertyList(kExampleDisplay));
}

TEST_F(GSMLogGeneratorTest, AMessageThatIsRefusedLeavesTheDisplayToCome) {
    feed(xmlMessage(kExample));
    EXPECT_EQ(failureOf(bytesOf("{")), kNotDeserialized);
    EXPECT_EQ(value("Display"), PropertyList(kExampleDisplay));
    feed(xmlMessage(Dictionary{{"Cell", Dictionary{{"ARFCN", "11"}}}}));
    feed(bytesOf("\"no service\""));
    EXPECT_EQ(value("Display"), PropertyList("no service")) << "not the dictionary before it";
}

} // namespace
} // namespace pallax
