#include "LogGenerator/ZOR_GSM/HSDPAInformation.h"

#include "tests/doubles/ArrayLockHolder.h"
#include "tests/doubles/RecordFixture.h"
#include "tests/doubles/RecordProperties.h"

#include <gtest/gtest.h>

namespace pallax {
namespace {

using namespace doubles; // NOLINT: the vocabulary of these tests
using Lines = std::vector<RecordingLog::Line>;

constexpr const char* kPrimary = "Primary HARQ Process";
constexpr const char* kSecondary = "Secondary HARQ Process";

Record header(unsigned primary, unsigned secondary) {
    return Record(0x4221)
        .u8(3)       // version
        .u16(0x0A64) // 612 sub frames, dual carrier
        .u8(primary)
        .u8(secondary);
}

/// One process of each kind; the secondary one is at 18 + 162 = 180.
Record oneOfEach() {
    Record record = header(1, 1);
    record.u8(4).u32(4000000000).u16(65535).u16(17); // primary, at 18
    record.u8(99).padTo(180);                        // the bytes from 27 are not read
    return record.u8(5).u32(1).u16(2).u16(3);
}

Dictionary process(const char* identity, const char* bits, const char* transmissions,
                   const char* errors) {
    return {{"Process ID", identity},
            {"No Rx Bits", bits},
            {"New Tx", transmissions},
            {"Block Errors", errors}};
}

std::size_t count(RecordFixture<HSDPAInformation>& fixture, std::string_view key) {
    return fixture.keys().find(key)->array()->size();
}

TEST(HSDPAInformation, SubscribesToTheHARQRecord) {
    const HSDPAInformation record;
    const auto codes = record.getLogCodeArray();
    EXPECT_EQ(std::vector<LogCode>(codes.begin(), codes.end()), (std::vector<LogCode>{0x4221}));
    EXPECT_EQ(record.getSectionName(), "HSDPA Info");
    EXPECT_EQ(record.sectionKind(), SectionKind::Keys);
}

TEST(HSDPAInformation, With1PrimaryAnd1SecondaryProcessReadsTheSecondaryEntryAt180) {
    RecordFixture<HSDPAInformation> fixture;
    fixture.feed(oneOfEach());
    expectInOrder(fixture.section(),
                  Dictionary{{"Version", "3"},
                             {"Sub Frames", "612"},
                             {"Carrier Info", "Dual Carrier"},
                             {kPrimary, Array{process("4", "4000000000", "65535", "17")}},
                             {kSecondary, Array{process("5", "1", "2", "3")}}});
    const PropertyList first = fixture.keys().find(kPrimary)->array()->at(0);
    expectInOrder(first, process("4", "4000000000", "65535", "17"));
    EXPECT_EQ(first.dictionary()->find("No Rx Bits")->displayNumber()->integer(), 4000000000);
}

TEST(HSDPAInformation, EachPrimaryProcessMovesTheSecondaryEntriesBy162BytesNotBy9) {
    for (unsigned primary = 0; primary < 4; ++primary) {
        Record record = header(primary, 2);
        record.padTo(18 + 162 * primary);
        record.u8(7).u32(70).u16(71).u16(72).u8(8).u32(80).u16(81).u16(82);
        RecordFixture<HSDPAInformation> fixture;
        fixture.feed(record);
        EXPECT_EQ(
            *fixture.keys().find(kSecondary),
            PropertyList(Array{process("7", "70", "71", "72"), process("8", "80", "81", "82")}))
            << primary << " primary processes";
    }
}

TEST(HSDPAInformation, PrimaryEntriesFollowEachOtherEvery9Bytes) {
    Record record = header(2, 0);
    record.u8(1).u32(10).u16(11).u16(12).u8(2).u32(20).u16(21).u16(22);
    RecordFixture<HSDPAInformation> fixture;
    fixture.feed(record);
    EXPECT_EQ(*fixture.keys().find(kPrimary),
              PropertyList(Array{process("1", "10", "11", "12"), process("2", "20", "21", "22")}));
}

TEST(HSDPAInformation, CarrierBits3ShowReservedAndEveryOtherValueItsLabel) {
    const std::vector<std::string> labels = {"Single Carrier", "MIMO", "Dual Carrier", "Reserved"};
    RecordFixture<HSDPAInformation> fixture;
    for (unsigned byte = 0; byte < 256; ++byte) {
        fixture.feed(header(0, 0).at(15, byte));
        EXPECT_EQ(fixture.text("Carrier Info"), labels[(byte / 4) % 4]);
        EXPECT_EQ(fixture.text("Sub Frames"), std::to_string(0x64 + (byte % 4) * 256));
    }
}

TEST(HSDPAInformation, TheVersionIsAnUnsignedByteAndTheSubFramesTenBits) {
    RecordFixture<HSDPAInformation> fixture;
    fixture.feed(header(0, 0).at(13, 255).at(14, 255).at(15, 255));
    expectInOrder(
        fixture.section(),
        Dictionary{{"Version", "255"}, {"Sub Frames", "1023"}, {"Carrier Info", "Reserved"}});
}

TEST(HSDPAInformation, WithoutPrimaryProcessesTheirKeyIsLeftAsItWas) {
    RecordFixture<HSDPAInformation> fixture;
    fixture.feed(oneOfEach());
    fixture.feed(header(0, 1).u8(6).u32(60).u16(61).u16(62));
    EXPECT_EQ(*fixture.keys().find(kPrimary),
              PropertyList(Array{process("4", "4000000000", "65535", "17")}));
    EXPECT_EQ(*fixture.keys().find(kSecondary), PropertyList(Array{process("6", "60", "61", "62")}))
        << "without primary processes the secondary ones begin at 18";
}

TEST(HSDPAInformation, WithoutSecondaryProcessesTheirKeyIsLeftAsItWas) {
    RecordFixture<HSDPAInformation> fixture;
    fixture.feed(oneOfEach());
    fixture.feed(header(1, 0).u8(6).u32(60).u16(61).u16(62));
    EXPECT_EQ(*fixture.keys().find(kPrimary), PropertyList(Array{process("6", "60", "61", "62")}));
    EXPECT_EQ(*fixture.keys().find(kSecondary), PropertyList(Array{process("5", "1", "2", "3")}));
}

TEST(HSDPAInformation, TheArraysAreReplacedByNewOnes) {
    RecordFixture<HSDPAInformation> fixture;
    fixture.feed(oneOfEach());
    const ArrayRef primary = fixture.keys().find(kPrimary)->array();
    const ArrayRef secondary = fixture.keys().find(kSecondary)->array();
    fixture.feed(header(1, 1).padTo(189));
    EXPECT_EQ(*primary, Array{process("4", "4000000000", "65535", "17")})
        << "the earlier list is unchanged";
    EXPECT_EQ(*secondary, Array{process("5", "1", "2", "3")});
    EXPECT_EQ(*fixture.keys().find(kPrimary), PropertyList(Array{process("0", "0", "0", "0")}));
}

TEST(HSDPAInformation, TheArraysAreReplacedWithoutTheArrayLock) {
    RecordFixture<HSDPAInformation> fixture;
    EXPECT_TRUE(finishesUnderHeldArrayLock(
        kExpectedToFinish, [&fixture] { fixture.feed(oneOfEach()); }, [] {}));
    EXPECT_NE(fixture.keys().find(kSecondary), nullptr);
}

TEST(HSDPAInformation, TheListsStopAtTheFirstEntryThatIsNotWhole) {
    const ByteBuffer bytes = oneOfEach().at(16, 1).at(17, 255).bytes();
    for (std::size_t length = 18; length <= bytes.size(); ++length) {
        RecordFixture<HSDPAInformation> fixture;
        fixture.feed(
            ByteBuffer(bytes.begin(), bytes.begin() + static_cast<std::ptrdiff_t>(length)));
        EXPECT_EQ(count(fixture, kPrimary), length >= 27 ? 1U : 0U) << "cut at " << length;
        EXPECT_EQ(count(fixture, kSecondary), length >= 189 ? 1U : 0U) << "cut at " << length;
    }
}

TEST(HSDPAInformation, A17BytePacketChangesNothing) {
    cutAtEveryLength<HSDPAInformation>(oneOfEach(), 18);
    RecordFixture<HSDPAInformation> fixture;
    fixture.feed(Record(0x4221).padTo(17));
    EXPECT_EQ(fixture.lines, (Lines{{4, "HSDPA Info"}})) << "a short packet is dropped silently";
    EXPECT_TRUE(fixture.keys().empty());
}

TEST(HSDPAInformation, AnyOtherCodeIsIgnoredSilently) {
    RecordFixture<HSDPAInformation> fixture;
    fixture.feed(oneOfEach());
    EXPECT_EQ(fixture.lines, (Lines{{4, "HSDPA Info"}}));
    const PropertyList before = fixture.snapshot();
    fixture.feed(Record(0x4116).padTo(100));
    EXPECT_EQ(fixture.lines, (Lines{{4, "HSDPA Info"}}));
    EXPECT_EQ(fixture.section(), before);
}

TEST(HSDPAInformation, AnyBytesKeepItsSectionWithinItsKeys) {
    anyBytesKeepWithin<HSDPAInformation>(
        {"Version", "Sub Frames", "Carrier Info", kPrimary, kSecondary});
}

} // namespace
} // namespace pallax
