#include "LogGenerator/ZOR_GSM/EquivalentPLMNList.h"

#include "tests/doubles/RecordFixture.h"
#include "tests/doubles/RecordProperties.h"

#include <gtest/gtest.h>

namespace pallax {
namespace {

using namespace doubles; // NOLINT: the vocabulary of these tests
using Lines = std::vector<RecordingLog::Line>;

/// Two entries; the second begins three bytes after the first.
Record twoNetworks() {
    return Record(0x7150).padTo(16).u8(2).append({3, 0, 1, 1, 0, 0, 2, 6, 0});
}

PropertyList network(const char* countryCode, const char* networkCode) {
    return Dictionary{{"Mobile Country Code", countryCode}, {"Mobile Network Code", networkCode}};
}

TEST(EquivalentPLMNList, SubscribesToItsRecordAndFillsAList) {
    const RecordFixture<EquivalentPLMNList> fixture;
    EXPECT_EQ(fixture.subscriptions(), (std::vector<LogCode>{0x7150}));
    EXPECT_EQ(EquivalentPLMNList().getSectionName(), "Equivalent PLMN List");
    EXPECT_EQ(EquivalentPLMNList().sectionKind(), SectionKind::List);
}

TEST(EquivalentPLMNList, EntriesStandThreeBytesApartAndSixAreReadOfEach) {
    RecordFixture<EquivalentPLMNList> fixture;
    fixture.feed(twoNetworks());
    EXPECT_EQ(fixture.section(), PropertyList(Array{network("310", "10"), network("106", "20")}));
    EXPECT_EQ(fixture.lines, (Lines{{4, "Equivalent PLMN List"}}));
    expectInOrder(fixture.list()[0],
                  Dictionary{{"Mobile Country Code", "310"}, {"Mobile Network Code", "10"}});
    ASSERT_NE(fixture.list()[1].dictionary()->find("Mobile Country Code")->displayNumber(),
              nullptr);
}

TEST(EquivalentPLMNList, BytesAreWholeDigitsOfWhichNoneIsRefused) {
    EXPECT_EQ(sectionAfter<EquivalentPLMNList>(
                  Record(0x7150).padTo(16).u8(1).append({255, 1, 255, 2, 255, 3})),
              PropertyList(Array{network("28305", "123")}));
}

TEST(EquivalentPLMNList, NoEntriesEmptyTheList) {
    RecordFixture<EquivalentPLMNList> fixture;
    fixture.feed(twoNetworks());
    fixture.feed(Record(0x7150).padTo(17));
    EXPECT_TRUE(fixture.list().empty());
}

TEST(EquivalentPLMNList, A16BytePacketKeepsTheEntries) {
    RecordFixture<EquivalentPLMNList> fixture;
    fixture.feed(twoNetworks());
    fixture.feed(Record(0x7150).padTo(16));
    EXPECT_EQ(fixture.list().size(), 2U);
    EXPECT_EQ(fixture.lines, (Lines{{4, "Equivalent PLMN List"}}));
    cutAtEveryLength<EquivalentPLMNList>(twoNetworks(), 17);
}

TEST(EquivalentPLMNList, TheListStopsAtTheLastWholeEntry) {
    const auto entriesIn = [](std::size_t length) {
        ByteBuffer bytes = twoNetworks().at(16, 255).bytes();
        bytes.resize(length);
        RecordFixture<EquivalentPLMNList> fixture;
        fixture.feed(bytes);
        return fixture.list().size();
    };
    EXPECT_EQ(entriesIn(17), 0U);
    EXPECT_EQ(entriesIn(22), 0U);
    EXPECT_EQ(entriesIn(23), 1U);
    EXPECT_EQ(entriesIn(25), 1U);
    EXPECT_EQ(entriesIn(26), 2U);
}

TEST(EquivalentPLMNList, ShowsAsManyAsItsCountSays) {
    RecordFixture<EquivalentPLMNList> fixture;
    fixture.feed(Record(0x7150).padTo(16).u8(255).padTo(17 + 3 * 254 + 6));
    EXPECT_EQ(fixture.list().size(), 255U);
    fixture.feed(Record(0x7150).padTo(16).u8(1).padTo(100));
    EXPECT_EQ(fixture.list().size(), 1U) << "a new list replaces the old one";
}

TEST(EquivalentPLMNList, AnyOtherCodeIsUnknownAndChangesNothing) {
    RecordFixture<EquivalentPLMNList> fixture;
    fixture.feed(twoNetworks());
    fixture.feed(Record(0x7151).padTo(40));
    EXPECT_EQ(fixture.lines,
              (Lines{{4, "Equivalent PLMN List"}, {3, "Received an unknown log message: 29009"}}));
    EXPECT_EQ(fixture.list().size(), 2U);
}

TEST(EquivalentPLMNList, AnyBytesKeepWithinTheKeysOfItsEntries) {
    anyBytesKeepWithin<EquivalentPLMNList>({"Mobile Country Code", "Mobile Network Code"});
}

} // namespace
} // namespace pallax
