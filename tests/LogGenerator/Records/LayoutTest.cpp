#include "LogGenerator/Records/Layout.h"

#include <gtest/gtest.h>

#include <array>
#include <unordered_map>

namespace pallax {
namespace {

constexpr Condition kFromThreeToFive{u8At(2), 3, 5};
constexpr Condition kFirstIsSet{u8At(0), 1, 1};
constexpr Condition kSecondIsSet{u8At(1), 1, 1};
constexpr Condition kFirstOrText{u8At(0), 1, 1, "off"};

PropertyList noValue(const Place& /*place*/) {
    return {};
}
constexpr Computation kRunning{
    .name = "", .formula = "", .read = {}, .compute = noValue, .isRunning = true};
constexpr Computation kStill{.name = "", .formula = "", .read = {}, .compute = noValue};

bool allows(const CodeLayout& code, const ByteBuffer& bytes) {
    return isAllowed(code, LogRecord(bytes));
}

unsigned shapeOfBytes(const CodeLayout& code, const ByteBuffer& bytes) {
    return shapeOf(code, LogRecord(bytes));
}

TEST(Layout, ARecordIsAllowedFromItsLeastLengthOn) {
    const CodeLayout code{.logCode = 1, .minimumLength = 2};
    EXPECT_FALSE(allows(code, {9}));
    EXPECT_TRUE(allows(code, {9, 9}));
    EXPECT_TRUE(allows(code, {9, 9, 9}));
}

TEST(Layout, ARecordOfExactLengthMayNotBeLonger) {
    const CodeLayout code{.logCode = 1, .minimumLength = 2, .exactLength = true};
    EXPECT_FALSE(allows(code, {9}));
    EXPECT_TRUE(allows(code, {9, 9}));
    EXPECT_FALSE(allows(code, {9, 9, 9}));
}

TEST(Layout, ARecordIsAllowedWhereItsConditionHolds) {
    const CodeLayout code{.logCode = 1, .minimumLength = 2, .condition = &kFromThreeToFive};
    EXPECT_FALSE(allows(code, {9, 9, 2}));
    EXPECT_TRUE(allows(code, {9, 9, 3}));
    EXPECT_TRUE(allows(code, {9, 9, 5}));
    EXPECT_FALSE(allows(code, {9, 9, 6}));
    EXPECT_FALSE(allows(code, {9, 9})) << "the number that is missing is 0";
}

TEST(Layout, ARecordIsReadLateUnlessReadingItDoesMoreThanShowIt) {
    const auto plain =
        std::to_array<Field>({{"Key", u8At(0), Conversion::number()}, computed("Sum", kStill)});
    const auto running = std::to_array<Field>({computed("Sum", kRunning)});
    const auto subpackets = std::to_array<SubpacketLayout>({{.id = 1, .fields = plain}});
    const auto runningSubpackets = std::to_array<SubpacketLayout>({{.id = 1, .fields = running}});
    const auto lists = std::to_array<ListLayout>({{.key = "List", .fields = plain}});
    const auto remembered = std::to_array<ListLayout>({{.fields = plain, .rememberedAs = "it"}});
    const ListPart part{.kind = ListPart::Kind::Keys, .parse = nullptr};

    EXPECT_TRUE(isReadLate({.logCode = 1}));
    EXPECT_TRUE(isReadLate({.logCode = 1,
                            .condition = &kFirstIsSet,
                            .fields = plain,
                            .lists = lists,
                            .subpackets = subpackets}));
    EXPECT_FALSE(isReadLate({.logCode = 1, .fields = running}));
    EXPECT_FALSE(isReadLate({.logCode = 1, .subpackets = runningSubpackets}));
    EXPECT_FALSE(isReadLate({.logCode = 1, .lists = remembered}));
    EXPECT_FALSE(isReadLate({.logCode = 1, .fields = plain, .listPart = &part}));
    EXPECT_FALSE(isReadLate({.logCode = 1,
                             .fields = plain,
                             .logsSection = [](const LogRecord&, const PropertyList&) {}}));
}

TEST(Layout, RecordsThatSetTheSameKeysHaveOneShape) {
    const auto plain = std::to_array<Field>({{"Key", u8At(0), Conversion::number()}});
    const auto orText = std::to_array<Field>({plain[0].when(kFirstOrText)});
    const CodeLayout withoutShapes{.logCode = 1, .fields = plain};
    const CodeLayout alwaysShown{.logCode = 1, .fields = orText};
    EXPECT_FALSE(hasShapes(withoutShapes));
    EXPECT_FALSE(hasShapes(alwaysShown)) << "a text stands for the value";
    EXPECT_EQ(shapeOfBytes(alwaysShown, {1}), shapeOfBytes(alwaysShown, {0}));

    const auto leftOut =
        std::to_array<Field>({plain[0].when(kFirstIsSet), plain[0].when(kSecondIsSet)});
    const CodeLayout code{.logCode = 1, .fields = leftOut};
    EXPECT_TRUE(hasShapes(code));
    EXPECT_EQ(shapeOfBytes(code, {0, 0}), 0U);
    EXPECT_EQ(shapeOfBytes(code, {0, 1}), 1U);
    EXPECT_EQ(shapeOfBytes(code, {1, 0}), 2U);
    EXPECT_EQ(shapeOfBytes(code, {1, 1, 77}), 3U);
}

TEST(Layout, ARecordThatLeavesAListAsItWasHasAShapeOfItsOwn) {
    const auto lists =
        std::to_array<ListLayout>({{.key = "Stays", .count = u8At(1), .staysWithoutEntries = true},
                                   {.key = "Emptied", .count = u8At(2)}});
    const auto leftOut = std::to_array<Field>({Field{"Key", u8At(0)}.when(kFirstIsSet)});
    const CodeLayout code{.logCode = 1, .fields = leftOut, .lists = lists};
    EXPECT_FALSE(hasShapes({.logCode = 1, .lists = std::span(lists).subspan(1)}));
    EXPECT_TRUE(hasShapes({.logCode = 1, .lists = lists}));
    EXPECT_EQ(shapeOfBytes(code, {0, 0, 9}), 0U);
    EXPECT_EQ(shapeOfBytes(code, {0, 1, 9}), 1U);
    EXPECT_EQ(shapeOfBytes(code, {0, 2, 0}), 1U) << "how many does not matter";
    EXPECT_EQ(shapeOfBytes(code, {1, 2, 0}), 3U);
}

TEST(Layout, EachFieldOfEachListIsARowOnce) {
    const auto fields = std::to_array<Field>({{"A", u8At(0)}, {"B", u8At(1)}});
    const auto inner = std::to_array<ListLayout>({{.key = "Inner", .fields = fields}});
    const auto lists = std::to_array<ListLayout>(
        {{.key = "Outer", .fields = fields, .plus = 9, .lists = inner}, {.key = "Bare"}});
    const auto subpackets = std::to_array<SubpacketLayout>(
        {{.id = 1, .fields = fields}, {.id = 2, .lists = lists}, {.id = 3}});
    EXPECT_EQ(rowCount(std::span<const ListLayout>(inner)), 2U);
    EXPECT_EQ(rowCount(std::span<const ListLayout>(lists)), 4U);
    EXPECT_EQ(rowCount(subpackets[0]), 2U);
    EXPECT_EQ(rowCount(subpackets[1]), 4U);
    EXPECT_EQ(rowCount(CodeLayout{
                  .logCode = 1, .fields = fields, .lists = lists, .subpackets = subpackets}),
              12U);
    EXPECT_EQ(rowCount(CodeLayout{.logCode = 1}), 0U);
}

/// A list of entries of 100 bytes with their number at 0, in a record that holds another list of
/// 10-byte entries with their number at 1.
constexpr ListLayout kChecked{
    .entries = {{.start = 2, .stride = 100, .bytesRead = 1}},
    .count = u8At(0),
    .sizeCheck = SizeCheck{u8At(1), 10},
};

/// "100 99" where that is unexpected; empty where it is not.
std::string unexpectedSizes(unsigned count, unsigned others, std::size_t length) {
    ByteBuffer bytes(length);
    bytes[0] = static_cast<std::uint8_t>(count);
    bytes[1] = static_cast<std::uint8_t>(others);
    const LogRecord record(bytes);
    const auto sizes = kChecked.sizesIn(record, count);
    return kChecked.seemsToFit(record, count)
               ? ""
               : std::to_string(sizes.expected) + " " + std::to_string(sizes.actual);
}

TEST(Layout, SizesAreComparedIn8Bits) {
    EXPECT_EQ(unexpectedSizes(1, 0, 100), "");
    EXPECT_EQ(unexpectedSizes(1, 0, 99), "100 99");
    EXPECT_EQ(unexpectedSizes(1, 1, 109), "100 99") << "10 bytes are another list's";
    EXPECT_EQ(unexpectedSizes(3, 0, 44), "") << "300 is 44 in 8 bits";
    EXPECT_EQ(unexpectedSizes(1, 0, 300), "100 44");
    EXPECT_EQ(unexpectedSizes(1, 6, 50), "") << "-10 is 246";
    EXPECT_EQ(unexpectedSizes(0, 0, 100), "0 100") << "that claims no entry";
}

TEST(Layout, WithoutASizeCheckNoSizeIsUnexpected) {
    const ListLayout list{.entries = {{.start = 2, .stride = 100, .bytesRead = 1}},
                          .count = u8At(0)};
    const ByteBuffer bytes = {0, 0};
    EXPECT_TRUE(list.seemsToFit(LogRecord(bytes), 0));
}

TEST(Layout, WhatARecordTellsIsRememberedInPlaceOfWhatWasBefore) {
    using Remembered = std::unordered_map<std::int64_t, std::int64_t>;
    const auto fields = std::to_array<Field>({{"Channel", u8At(0)}, {"BSIC", u8At(1)}});
    const auto lists = std::to_array<ListLayout>({
        {.entries = {{.start = 1, .stride = 2, .bytesRead = 2}},
         .count = u8At(0),
         .fields = fields,
         .rememberedAs = "BSICs"},
        {.entries = {{.start = 1, .stride = 1, .bytesRead = 1}}, .fields = fields, .plus = 4},
    });
    const CodeLayout code{.logCode = 1, .lists = lists};
    RecordMemory memory;
    const auto after = [&](const ByteBuffer& bytes) {
        remember(code, LogRecord(bytes), memory);
        return memory.remembered;
    };
    EXPECT_EQ(after({2, 10, 1, 20, 2}), (Remembered{{10, 1}, {20, 2}}));
    EXPECT_EQ(after({3, 30, 3, 30, 4, 40}), (Remembered{{30, 4}})) << "the last of one; one is cut";
    remember({.logCode = 2, .lists = std::span(lists).subspan(1)}, LogRecord(), memory);
    EXPECT_EQ(memory.remembered, (Remembered{{30, 4}})) << "another code's lists tell nothing";
    EXPECT_EQ(after({0}), Remembered{});
}

} // namespace
} // namespace pallax
