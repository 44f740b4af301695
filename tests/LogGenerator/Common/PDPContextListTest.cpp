#include "LogGenerator/Common/PDPContextList.h"

#include "tests/doubles/Property.h"
#include "tests/doubles/PropertyListRecord.h"
#include "tests/doubles/RecordFixture.h"
#include "tests/doubles/RecordProperties.h"

#include <gtest/gtest.h>

namespace pallax {
namespace {

using namespace doubles; // NOLINT: the vocabulary of these tests
using Lines = std::vector<RecordingLog::Line>;

constexpr LogCode kContexts = 0xFF0002;

Array twoContexts() {
    return {Dictionary{{"APN", "internet"}, {"Context", PropertyList::integer(1)}},
            Dictionary{{"APN", "ims"}, {"Address", PropertyList::data({10, 0, 0, 1})}}};
}

TEST(PDPContextList, SubscribesToTheContextsAndFillsAList) {
    const RecordFixture<PDPContextList> fixture;
    EXPECT_EQ(fixture.subscriptions(), (std::vector<LogCode>{0xFF0002}));
    EXPECT_EQ(PDPContextList().getSectionName(), "PDP Context Info");
    EXPECT_EQ(PDPContextList().sectionKind(), SectionKind::List);
}

TEST(PDPContextList, TheElementsAreStoredUnchangedAndInOrder) {
    EXPECT_EQ(sectionAfter<PDPContextList>(propertyListRecord(kContexts, twoContexts())),
              PropertyList(twoContexts()));
}

TEST(PDPContextList, ElementsOfAnyTypeAreKept) {
    const Array mixed = {"text", PropertyList::integer(7), Array{"inner"}};
    EXPECT_EQ(sectionAfter<PDPContextList>(propertyListRecord(kContexts, mixed)),
              PropertyList(mixed));
}

TEST(PDPContextList, ReadsTheXmlAndTheTextFormToo) {
    const PropertyList expected = Array{Dictionary{{"APN", "ims"}}};
    EXPECT_EQ(sectionAfter<PDPContextList>(textRecord(
                  kContexts, "<?xml version=\"1.0\"?><plist version=\"1.0\"><array><dict>"
                             "<key>APN</key><string>ims</string></dict></array></plist>")),
              expected);
    EXPECT_EQ(sectionAfter<PDPContextList>(textRecord(kContexts, "( { APN = ims; } )")), expected);
}

TEST(PDPContextList, ANewArrayReplacesTheEntries) {
    RecordFixture<PDPContextList> fixture;
    fixture.feed(propertyListRecord(kContexts, twoContexts()));
    EXPECT_EQ(fixture.lines, (Lines{{4, "PDPContextList"}}));
    fixture.feed(propertyListRecord(kContexts, Array{"other"}));
    EXPECT_EQ(fixture.lines, (Lines{{4, "PDPContextList"}}));
    EXPECT_EQ(fixture.section(), PropertyList(Array{"other"}));
}

TEST(PDPContextList, AnEmptyArrayEmptiesIt) {
    RecordFixture<PDPContextList> fixture;
    fixture.feed(propertyListRecord(kContexts, twoContexts()));
    fixture.feed(propertyListRecord(kContexts, Array()));
    EXPECT_TRUE(fixture.list().empty());
}

TEST(PDPContextList, ADictionaryLeavesItUnchangedAndReportsNothing) {
    RecordFixture<PDPContextList> fixture;
    fixture.feed(propertyListRecord(kContexts, twoContexts()));
    fixture.feed(propertyListRecord(kContexts, Dictionary{{"APN", "ims"}}));
    EXPECT_EQ(fixture.lines, (Lines{{4, "PDPContextList"}}));
    EXPECT_EQ(fixture.section(), PropertyList(twoContexts()));
}

TEST(PDPContextList, APayloadThatDoesNotDecodeCountsAsNoArray) {
    RecordFixture<PDPContextList> fixture;
    fixture.feed(propertyListRecord(kContexts, twoContexts()));
    const ByteBuffer whole = propertyListRecord(kContexts, Array{"other"}).bytes();
    for (std::size_t length = 0; length < whole.size(); ++length) {
        const ByteBuffer cut(whole.begin(), whole.begin() + static_cast<std::ptrdiff_t>(length));
        fixture.feed(cut, kContexts);
        EXPECT_EQ(fixture.lines, (Lines{{4, "PDPContextList"}})) << "cut at " << length;
        EXPECT_EQ(fixture.section(), PropertyList(twoContexts())) << "cut at " << length;
    }
}

TEST(PDPContextList, TheCodeIsNotChecked) {
    RecordFixture<PDPContextList> fixture;
    fixture.feed(propertyListRecord(0xFF0003, Array{"other"}));
    EXPECT_EQ(fixture.lines, (Lines{{4, "PDPContextList"}}));
    EXPECT_EQ(fixture.section(), PropertyList(Array{"other"}));
}

TEST(PDPContextList, AnyBytesNeitherThrowNorLeaveAKey) {
    anyBytesKeepWithin<PDPContextList>({}); // random bytes are never an array of dictionaries
}

TEST(PDPContextList, AnyArrayIsShownAsItIsAndAnythingElseChangesNothing) {
    EXPECT_TRUE(doubles::holds([] {
        RecordFixture<PDPContextList> fixture;
        fixture.list() = Array{"what was shown before"};
        const PropertyList root = any::propertyList({"APN", "Address"});
        fixture.feed(propertyListRecord(kContexts, root));
        const bool list = root.array() != nullptr;
        RC_CLASSIFY(list);
        RC_ASSERT(fixture.section() == (list ? root : Array{"what was shown before"}));
    }));
}

} // namespace
} // namespace pallax
