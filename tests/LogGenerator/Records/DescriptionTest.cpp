#include "LogGenerator/Records/Description.h"

#include "LogGenerator/Records/Base.h"
#include "LogGenerator/Records/Exceptions.h"

#include <gtest/gtest.h>

#include <array>

namespace pallax {
namespace {

constexpr auto kStates = std::to_array<std::string_view>({"Idle", "Camped"});
constexpr NumberFormat kDbm{"%4.2f dBm"};
constexpr auto kFields = std::to_array<Field>({
    {"Version", u8At(13), Conversion::number()},
    {"Power", bitsAt(14, 3, 9), Conversion::number(kDbm, 0.25, -140.0).except(64, "Not Present")},
    {"State", s16At(16), Conversion::label(kStates, "Lost", 1)},
    {"Barred", bitsAt(18, 0, 1), Conversion::flag("Yes", "No")},
});

TEST(Description, OfFieldsHasTheirKeysAndPlaces) {
    const std::vector<FieldDescription> fields = describeFields(kFields);
    ASSERT_EQ(fields.size(), kFields.size());
    for (std::size_t index = 0; index < fields.size(); ++index) {
        EXPECT_EQ(fields[index].key, kFields[index].key);
        EXPECT_EQ(fields[index].position->byte, kFields[index].position->byte);
        EXPECT_EQ(fields[index].position->bit, kFields[index].position->bit);
        EXPECT_EQ(fields[index].position->width, kFields[index].position->width);
        EXPECT_EQ(fields[index].position->isSigned, kFields[index].position->isSigned);
    }
}

TEST(Description, OfAConversionIsTheConversionAsData) {
    const ShownAs number = kFields[0].conversion;
    EXPECT_EQ(number.format, &kDecimal);
    EXPECT_EQ(number.factor, 1.0);
    EXPECT_EQ(number.offset, 0.0);
    EXPECT_EQ(number.exceptional, std::nullopt);

    const ShownAs level = kFields[1].conversion;
    EXPECT_EQ(level.format, &kDbm);
    EXPECT_EQ(level.factor, 0.25);
    EXPECT_EQ(level.offset, -140.0);
    EXPECT_EQ(level.exceptional, 64);
    EXPECT_EQ(level.exceptionalText, "Not Present");

    const ShownAs label = kFields[2].conversion;
    EXPECT_EQ(label.format, nullptr);
    EXPECT_EQ(label.labels.data(), kStates.data());
    EXPECT_EQ(label.labels.size(), 2U);
    EXPECT_EQ(label.beyond, "Lost");
    EXPECT_EQ(label.shift, 1);

    const ShownAs flag = kFields[3].conversion;
    EXPECT_EQ(flag.beyond, "Yes");
    EXPECT_EQ(flag.exceptional, 0);
    EXPECT_EQ(flag.exceptionalText, "No");
}

TEST(Description, OfGroupsHasACodeForEach) {
    constexpr auto kGroups = std::to_array<FieldGroup>(
        {{0xA001, 19, kFields}, {0xA002, 14, std::span(kFields).first(1)}});
    const RecordDescription description = describeGroups(kGroups);
    ASSERT_EQ(description.size(), 2U);
    EXPECT_EQ(description[0].logCode, 0xA001U);
    EXPECT_EQ(description[0].minimumLength, 19U);
    EXPECT_EQ(description[0].fields.size(), 4U);
    EXPECT_EQ(description[1].logCode, 0xA002U);
    EXPECT_EQ(description[1].minimumLength, 14U);
    EXPECT_EQ(description[1].fields.size(), 1U);
}

TEST(Description, OfAListHasItsLayoutAndTheFieldsOfAnEntry) {
    const ListDescription list = describeList("Cells", {29, 6, 5}, u8At(27), kFields);
    EXPECT_EQ(list.key, "Cells");
    EXPECT_EQ(list.entries.layout.start, 29U);
    EXPECT_EQ(list.entries.layout.stride, 6U);
    EXPECT_EQ(list.entries.layout.bytesRead, 5U);
    EXPECT_EQ(list.count->byte, 27U);
    EXPECT_EQ(list.fields.size(), 4U);
    EXPECT_TRUE(list.isShown);
}

TEST(Description, AnExtentIsOfWholeBytes) {
    EXPECT_EQ(extentOf(bitsAt(14, 3, 9)).byte, 14U);
    EXPECT_EQ(extentOf(bitsAt(14, 3, 5)).length, 1U);
    EXPECT_EQ(extentOf(bitsAt(14, 3, 6)).length, 2U);
    EXPECT_EQ(extentOf(bitsAt(13, 3, 19)).length, 3U);
    EXPECT_EQ(extentOf(u32At(5)).length, 4U);
}

TEST(Description, ARecordWithoutOneCannotBeAsked) {
    const Base record;
    EXPECT_THROW((void)record.describe(), UnrecognisedOperation);
}

} // namespace
} // namespace pallax
