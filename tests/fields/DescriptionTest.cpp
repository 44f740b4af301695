#include "fields/Description.h"

#include <gtest/gtest.h>

#include <array>

namespace pallax {
namespace {

constexpr NumberFormat kDbm{"%4.2f dBm"};
constexpr auto kStates = std::to_array<std::string_view>({"Idle", "Camped"});
constexpr Condition kIsCamped{u8At(13), 1, 1};

constexpr auto kFields = std::to_array<Field>({
    {"Version", u8At(13), Conversion::number(), "The version."},
    Field{"Power", bitsAt(14, 3, 9), Conversion::number(kDbm, 0.25, -140.0)}.when(kIsCamped),
    Field{"State", s16At(16), Conversion::label(kStates, "Lost", 1)}.identifying(),
    Field{"Subscriber", u8At(18), Conversion::flag("Yes", "No")}.personal(),
});
constexpr auto kInner = std::to_array<ListLayout>({{
    .key = "Inner",
    .entries = {{.start = 1, .stride = 1, .bytesRead = 1}},
    .fields = std::span(kFields).first<1>(),
    .plus = 3,
}});
constexpr auto kLists = std::to_array<ListLayout>({{
    .key = "Cells",
    .entries = {{.start = 29, .stride = 6, .bytesRead = 5}},
    .count = u8At(27),
    .fields = kFields,
    .lists = kInner,
    .only = &kIsCamped,
}});
constexpr auto kCodes = std::to_array<CodeLayout>({
    {.logCode = 0xA001, .name = "First", .minimumLength = 19, .fields = kFields, .lists = kLists},
    {.logCode = 0xA002, .minimumLength = 14, .fields = std::span(kFields).first<1>()},
});
constexpr RecordLayout kLayout{.section = "Section", .logLine = "section", .codes = kCodes};

TEST(Description, HasTheCodesOfTheLayout) {
    const RecordDescription description = describe(kLayout);
    ASSERT_EQ(description.size(), 2U);
    EXPECT_EQ(description[0].logCode, 0xA001U);
    EXPECT_EQ(description[0].name, "First");
    EXPECT_EQ(description[0].minimumLength, 19U);
    EXPECT_EQ(description[1].logCode, 0xA002U);
    EXPECT_EQ(description[1].fields.size(), 1U);
}

TEST(Description, HasTheFieldsWithWhatTheyTell) {
    const std::vector<FieldDescription> fields = describe(kLayout).front().fields;
    ASSERT_EQ(fields.size(), 4U);
    EXPECT_EQ(fields[0].key, "Version");
    EXPECT_EQ(fields[0].meaning, "The version.");
    EXPECT_EQ(fields[1].position->byte, 14U);
    EXPECT_EQ(fields[1].position->bit, 3U);
    EXPECT_EQ(fields[1].position->width, 9U);
    EXPECT_EQ(fields[1].shownAs.factor, 0.25);
    EXPECT_EQ(fields[1].condition->most, 1);
    EXPECT_EQ(fields[0].condition, std::nullopt);
    EXPECT_TRUE(fields[2].position->isSigned);
    EXPECT_TRUE(fields[2].identifies);
    EXPECT_FALSE(fields[1].identifies);
    EXPECT_TRUE(fields[3].isPersonal);
    EXPECT_FALSE(fields[2].isPersonal);
}

TEST(Description, HasTheListsAtEveryDepth) {
    const ListDescription list = describe(kLayout).front().lists.front();
    EXPECT_EQ(list.key, "Cells");
    EXPECT_EQ(list.entries.layout.start, 29U);
    EXPECT_EQ(list.entries.layout.stride, 6U);
    EXPECT_EQ(list.entries.layout.bytesRead, 5U);
    EXPECT_EQ(list.count->byte, 27U);
    EXPECT_EQ(list.fields.size(), 4U);
    EXPECT_EQ(list.only->position.byte, 13U);
    EXPECT_TRUE(list.isShown);
    ASSERT_EQ(list.lists.size(), 1U);
    EXPECT_EQ(list.lists.front().plus, 3U);
}

TEST(Description, NumbersItsRowsAsTheReaderDoes) {
    const RecordDescription description = describe(kLayout, 100);
    EXPECT_EQ(description[0].fields[0].row, 100U);
    EXPECT_EQ(description[0].fields[3].row, 103U);
    EXPECT_EQ(description[0].lists[0].fields[0].row, 104U);
    EXPECT_EQ(description[0].lists[0].lists[0].fields[0].row, 108U);
    EXPECT_EQ(description[1].fields[0].row, 109U);
    EXPECT_EQ(rowCount(kCodes[0]), 9U);
}

TEST(Description, AnExtentIsOfWholeBytes) {
    EXPECT_EQ(extentOf(bitsAt(14, 3, 9)).byte, 14U);
    EXPECT_EQ(extentOf(bitsAt(14, 3, 5)).length, 1U);
    EXPECT_EQ(extentOf(bitsAt(14, 3, 6)).length, 2U);
    EXPECT_EQ(extentOf(bitsAt(13, 3, 19)).length, 3U);
    EXPECT_EQ(extentOf(u32At(5)).length, 4U);
}

} // namespace
} // namespace pallax
