#include "LogGenerator/Records/FieldGroup.h"

#include "tests/doubles/RecordFixture.h"

#include <gtest/gtest.h>

#include <array>

namespace pallax {
namespace {

using namespace doubles; // NOLINT: the vocabulary of these tests
using Lines = std::vector<RecordingLog::Line>;

constexpr auto kFirst = std::to_array<Field>({{"First", u8At(13), Conversion::number()}});
constexpr auto kSecond = std::to_array<Field>({
    {"Beta", u8At(14), Conversion::number()},
    {"Alpha", u8At(13), Conversion::number()},
});
constexpr auto kGroups = std::to_array<FieldGroup>({{0x5002, 16, kFirst}, {0x5001, 15, kSecond}});
constexpr auto kLogCodes = logCodesOf(kGroups);

class GroupExample final : public Base {
public:
    std::string_view getSectionName() const override { return "GroupExample"; }
    std::span<const LogCode> getLogCodeArray() const override { return kLogCodes; }
    void updateWithData(const LogRecord& record, LogCode logCode) override {
        showGroup(kGroups, record, logCode);
    }
};

TEST(FieldGroup, TheCodesStandInTheOrderOfTheGroups) {
    EXPECT_EQ(RecordFixture<GroupExample>().subscriptions(),
              (std::vector<LogCode>{0x5002, 0x5001}));
}

TEST(FieldGroup, TheGroupOfTheCodeIsShownInItsOrder) {
    expectInOrder(sectionAfter<GroupExample>(Record(0x5001).append({1, 2})),
                  Dictionary{{"Beta", "2"}, {"Alpha", "1"}});
    expectInOrder(sectionAfter<GroupExample>(Record(0x5002).append({1, 2, 3})),
                  Dictionary{{"First", "1"}});
}

TEST(FieldGroup, EachGroupAsksItsOwnMinimumAndAShorterRecordChangesNothingSilently) {
    cutAtEveryLength<GroupExample>(Record(0x5002).append({1, 2, 3}), 16);
    cutAtEveryLength<GroupExample>(Record(0x5001).append({1, 2}), 15);
    RecordFixture<GroupExample> fixture;
    fixture.feed(Record(0x5002).append({1, 2}));
    EXPECT_EQ(fixture.lines, Lines());
    EXPECT_TRUE(fixture.keys().empty());
}

TEST(FieldGroup, ACodeWithoutAGroupIsUnknownWhateverTheLength) {
    RecordFixture<GroupExample> fixture;
    fixture.feed(Record(0x5003));
    EXPECT_EQ(fixture.lines, (Lines{{3, "Received an unknown log message: 20483"}}));
    EXPECT_TRUE(fixture.keys().empty());
}

} // namespace
} // namespace pallax
