#include "LogGenerator/Records/LayoutRecord.h"

#include "tests/LogGenerator/Records/SampleLines.h"
#include "tests/doubles/RecordFixture.h"

#include <gtest/gtest.h>

#include <array>

namespace pallax {
namespace {

using doubles::RecordingLog;
using Lines = std::vector<RecordingLog::Line>;

constexpr auto kSpeedFields = std::to_array<Field>({{"Speed", u8At(0), Conversion::number()}});
constexpr auto kHeightFields = std::to_array<Field>({{"Height", u8At(0), Conversion::number()}});

constexpr auto kTwoCodes = std::to_array<CodeLayout>({
    {.logCode = 100, .minimumLength = 1, .fields = kSpeedFields},
    {.logCode = 200, .minimumLength = 2, .fields = kHeightFields},
});
constexpr RecordLayout kReports{.section = "Flight", .logLine = "A flight", .codes = kTwoCodes};
constexpr RecordLayout kSilent{.section = "Flight",
                               .logLine = "A flight",
                               .codes = kTwoCodes,
                               .priority = LogPriority::Error,
                               .reportsOtherCodes = false};
constexpr RecordLayout kReadsAll{
    .section = "Flight", .logLine = "A flight", .codes = kTwoCodes, .readsOtherCodes = true};

/// A record with its section, in a class index or as if.
class LayoutFixture {
public:
    explicit LayoutFixture(const RecordLayout& layout) : record(layout) {
        section =
            layout.kind == SectionKind::List ? PropertyList(Array()) : PropertyList(Dictionary());
        record.updateSectionRef(section);
    }
    Lines feed(const ByteBuffer& bytes, LogCode logCode) {
        RecordingLog log;
        record.updateWithData(LogRecord(bytes), logCode);
        return log.take();
    }

    LayoutRecord record;
    PropertyList section;
};

TEST(LayoutRecord, ReadsEachCodeByItsLayout) {
    LayoutFixture fixture(kReports);
    EXPECT_EQ(fixture.record.getSectionName(), "Flight");
    EXPECT_EQ(std::vector<LogCode>(fixture.record.getLogCodeArray().begin(),
                                   fixture.record.getLogCodeArray().end()),
              (std::vector<LogCode>{100, 200}));
    EXPECT_EQ(fixture.feed({7}, 100), (Lines{{4, "A flight"}}));
    EXPECT_EQ(fixture.section, PropertyList(Dictionary{{"Speed", "7"}}));
    EXPECT_EQ(fixture.feed({8}, 200), (Lines{{4, "A flight"}})) << "too short, without a word";
    EXPECT_EQ(fixture.section, PropertyList(Dictionary{{"Speed", "7"}}));
    EXPECT_EQ(fixture.feed({8, 0}, 200), (Lines{{4, "A flight"}}));
    EXPECT_EQ(fixture.section, PropertyList(Dictionary{{"Speed", "7"}, {"Height", "8"}}));
}

TEST(LayoutRecord, AnUnknownCodeIsLoggedOrNot) {
    LayoutFixture reports(kReports);
    EXPECT_EQ(reports.feed({7, 7}, 300),
              (Lines{{4, "A flight"}, {3, "Received an unknown log message: 300"}}));
    EXPECT_EQ(reports.section, PropertyList(Dictionary()));
    LayoutFixture silent(kSilent);
    EXPECT_EQ(silent.feed({7, 7}, 300), (Lines{{3, "A flight"}})) << "at the layout's priority";
    EXPECT_EQ(silent.section, PropertyList(Dictionary()));
}

TEST(LayoutRecord, OtherCodesMayBeReadAsTheFirst) {
    LayoutFixture fixture(kReadsAll);
    EXPECT_EQ(fixture.feed({7, 7}, 300), (Lines{{4, "A flight"}}));
    EXPECT_EQ(fixture.section, PropertyList(Dictionary{{"Speed", "7"}}));
    (void)fixture.feed({8, 0}, 200);
    EXPECT_EQ(fixture.section, PropertyList(Dictionary{{"Speed", "7"}, {"Height", "8"}}));
}

bool acceptsFives(const CodeLayout& code, const LogRecord& record) {
    if (record.u8(0) != 5) {
        systemLog(LogPriority::Error, "%d of code %d", record.u8(0), code.logCode);
    }
    return record.u8(0) == 5;
}
void logsLength(const CodeLayout& code, const LogRecord& record) {
    systemLog(LogPriority::Informational, "%d bytes of code %d", record.length(), code.logCode);
}
void logsShown(const LogRecord& record, const PropertyList& section) {
    systemLog(LogPriority::Informational, "%d: %s", record.u8(0), section.description());
}
constexpr auto kHookedCodes = std::to_array<CodeLayout>({
    {.logCode = 100,
     .minimumLength = 9,
     .fields = kSpeedFields,
     .accepts = acceptsFives,
     .logs = logsLength},
    {.logCode = 200, .fields = kHeightFields, .logsSection = logsShown},
});
constexpr RecordLayout kHooked{.section = "Flight", .logLine = "A flight", .codes = kHookedCodes};

TEST(LayoutRecord, AsksItsHookInPlaceOfTheLengthAndLogsOnlyWhatIsAccepted) {
    LayoutFixture fixture(kHooked);
    EXPECT_EQ(fixture.feed({6}, 100), (Lines{{4, "A flight"}, {3, "6 of code 100"}}));
    EXPECT_EQ(fixture.section, PropertyList(Dictionary()));
    EXPECT_EQ(fixture.feed({5}, 100), (Lines{{4, "A flight"}, {6, "1 bytes of code 100"}}));
    EXPECT_EQ(fixture.section, PropertyList(Dictionary{{"Speed", "5"}}));
}

TEST(LayoutRecord, LogsTheSectionAsItIsAfterTheRecord) {
    LayoutFixture fixture(kHooked);
    fixture.record.display().setLate(true);
    (void)fixture.feed({5}, 100);
    EXPECT_EQ(fixture.section, PropertyList(Dictionary())) << "read late";
    EXPECT_EQ(fixture.feed({9}, 200),
              (Lines{{4, "A flight"}, {6, "9: { Speed = 5; Height = 9; }"}}))
        << "with the record before it";
}

constexpr Condition kFirstIsFive{u8At(0), 5, 5};
/// Each with one reason to look at a record twice.
constexpr auto kPickyCodes = std::to_array<CodeLayout>({
    {.logCode = 100, .minimumLength = 1, .exactLength = true, .fields = kSpeedFields},
    {.logCode = 200, .condition = &kFirstIsFive, .fields = kSpeedFields},
    {.logCode = 300, .fields = kSpeedFields, .accepts = acceptsFives},
    {.logCode = 400, .fields = kSpeedFields, .logs = logsLength},
});
constexpr RecordLayout kPicky{.section = "Flight", .logLine = "A flight", .codes = kPickyCodes};

TEST(LayoutRecord, ReadsOnlyWhatItsCodeAllows) {
    const Lines silence = {{4, "A flight"}};
    LayoutFixture fixture(kPicky);
    EXPECT_EQ(fixture.feed({5, 6}, 100), silence);
    EXPECT_EQ(fixture.feed({6}, 200), silence);
    EXPECT_EQ(fixture.feed({6}, 300), (Lines{{4, "A flight"}, {3, "6 of code 300"}}));
    EXPECT_EQ(fixture.section, PropertyList(Dictionary()));
    EXPECT_EQ(fixture.feed({1}, 100), silence);
    EXPECT_EQ(fixture.section, PropertyList(Dictionary{{"Speed", "1"}}));
    for (const LogCode logCode : std::vector<LogCode>{200, 300}) {
        EXPECT_EQ(fixture.feed({5, 6}, logCode), silence);
        EXPECT_EQ(fixture.section, PropertyList(Dictionary{{"Speed", "5"}}));
    }
    EXPECT_EQ(fixture.feed({6}, 400), (Lines{{4, "A flight"}, {6, "1 bytes of code 400"}}));
    EXPECT_EQ(fixture.section, PropertyList(Dictionary{{"Speed", "6"}}));
}

constexpr auto kCheckedLists = std::to_array<ListLayout>({{
    .entries = {{.start = 2, .stride = 3, .bytesRead = 1}},
    .count = u8At(0),
    .fields = kSpeedFields,
    .sizeCheck = SizeCheck{u8At(1), 2},
}});
constexpr auto kCheckedCodes =
    std::to_array<CodeLayout>({{.logCode = 100, .minimumLength = 2, .lists = kCheckedLists}});
constexpr RecordLayout kCheckedLayout{
    .section = "Flights", .logLine = "Flights", .kind = SectionKind::List, .codes = kCheckedCodes};

TEST(LayoutRecord, ARecordThatFailsTheSizeCheckIsLoggedAndEmptiesTheList) {
    LayoutFixture fixture(kCheckedLayout);
    const ByteBuffer good = {1, 0, 42, 0, 0};
    EXPECT_EQ(fixture.feed(good, 100), (Lines{{4, "Flights"}}));
    EXPECT_EQ(fixture.section, PropertyList(Array{Dictionary{{"Speed", "42"}}}));
    EXPECT_EQ(
        fixture.feed({2, 1, 42, 0, 0}, 100),
        (Lines{{4, "Flights"}, {3, "Unexpected log packet bytes size: expected=6 actual=3"}}));
    EXPECT_EQ(fixture.section, PropertyList(Array()));
    (void)fixture.feed(good, 100);
    EXPECT_EQ(
        fixture.feed({0, 0, 42}, 100),
        (Lines{{4, "Flights"}, {3, "Unexpected log packet bytes size: expected=0 actual=3"}}));
    EXPECT_EQ(fixture.section, PropertyList(Array()));
    EXPECT_EQ(fixture.feed({9}, 100), (Lines{{4, "Flights"}})) << "not accepted, so not checked";
}

TEST(LayoutRecord, ANewSectionGetsNothingOfARecordBeforeIt) {
    LayoutFixture fixture(kReports);
    fixture.record.display().setLate(true);
    (void)fixture.feed({7}, 100);
    const PropertyList later{Dictionary()};
    fixture.record.updateSectionRef(later);
    fixture.record.display().bringUpToDate();
    EXPECT_EQ(later, PropertyList(Dictionary()));
    EXPECT_EQ(fixture.section, PropertyList(Dictionary{{"Speed", "7"}}));
    (void)fixture.feed({8, 0}, 200);
    fixture.record.display().bringUpToDate();
    EXPECT_EQ(later, PropertyList(Dictionary{{"Height", "8"}}));
    EXPECT_EQ(fixture.section, PropertyList(Dictionary{{"Speed", "7"}}));
}

TEST(LayoutRecord, TheDisplayIsTheSameWhateverTheLogTakes) {
    for (const int threshold : {SystemLog::kEverything, 0}) {
        LayoutFixture fixture(kHooked);
        fixture.record.display().setLate(true);
        const RecordingLog log(threshold);
        for (const std::uint8_t byte : std::array<std::uint8_t, 2>{5, 6}) {
            for (const LogCode logCode : {100U, 200U, 300U}) {
                const ByteBuffer bytes = {byte};
                fixture.record.updateWithData(LogRecord(bytes), logCode);
            }
        }
        fixture.record.display().bringUpToDate();
        EXPECT_EQ(log.lines().empty(), threshold == 0);
        EXPECT_EQ(fixture.section, PropertyList(Dictionary{{"Speed", "5"}, {"Height", "6"}}))
            << threshold;
    }
}

constexpr auto kShapedFields = std::to_array<Field>({
    kSpeedFields[0],
    Field{"Climb", u8At(1), Conversion::number()}.when(kFirstIsFive),
});
constexpr auto kShapedCodes =
    std::to_array<CodeLayout>({{.logCode = 100, .fields = kShapedFields}});
constexpr RecordLayout kShaped{.section = "Flight", .logLine = "A flight", .codes = kShapedCodes};

TEST(LayoutRecord, ALateRecordLosesNothingOfOneThatSetOtherKeys) {
    LayoutFixture fixture(kShaped);
    fixture.record.display().setLate(true);
    (void)fixture.feed({5, 9}, 100);
    (void)fixture.feed({6, 8}, 100);
    fixture.record.display().bringUpToDate();
    EXPECT_EQ(fixture.section, PropertyList(Dictionary{{"Speed", "6"}, {"Climb", "9"}}));
}

constexpr auto kPairFields = std::to_array<Field>(
    {{"Speed", u8At(0), Conversion::number()}, {"Height", u8At(1), Conversion::number()}});
PropertyList heightOfSpeed(const Place& place) {
    const auto found = place.memory->remembered.find(place.here.u8(0));
    return found != place.memory->remembered.end() ? DisplayNumber(found->second, kDecimal)
                                                   : PropertyList();
}
constexpr Computation kHeightOfSpeed{
    .name = "", .formula = "", .read = {}, .compute = heightOfSpeed};
constexpr auto kRememberedFields = std::to_array<Field>({computed("Height", kHeightOfSpeed)});
constexpr auto kRememberedLists = std::to_array<ListLayout>({{
    .entries = {{.start = 0, .stride = 2, .bytesRead = 2}},
    .fields = kPairFields,
    .plus = 1,
    .isShown = false,
    .rememberedAs = "it",
}});
constexpr auto kRememberedCodes = std::to_array<CodeLayout>({
    {.logCode = 100, .lists = kRememberedLists},
    {.logCode = 200, .fields = kRememberedFields},
});
constexpr RecordLayout kRemembered{
    .section = "Flight", .logLine = "A flight", .codes = kRememberedCodes};

TEST(LayoutRecord, ALateRecordLooksUpWhatWasRememberedWhenItArrived) {
    LayoutFixture fixture(kRemembered);
    fixture.record.display().setLate(true);
    (void)fixture.feed({7, 80}, 100);
    (void)fixture.feed({7}, 200);
    (void)fixture.feed({7, 90}, 100);
    EXPECT_EQ(fixture.section, PropertyList(Dictionary{{"Height", "80"}}));
    (void)fixture.feed({7}, 200);
    fixture.record.display().bringUpToDate();
    EXPECT_EQ(fixture.section, PropertyList(Dictionary{{"Height", "90"}}));
}

constexpr auto kHiddenLists = std::to_array<ListLayout>({
    {.entries = {{.start = 1, .stride = 2, .bytesRead = 1}},
     .count = u8At(0),
     .fields = kSpeedFields},
    {.entries = {{.start = 1, .stride = 2, .bytesRead = 2}},
     .count = u8At(0),
     .fields = kPairFields,
     .isShown = false,
     .rememberedAs = "it"},
});
constexpr auto kHiddenCodes = std::to_array<CodeLayout>({
    {.logCode = 100, .minimumLength = 1, .lists = kHiddenLists},
    {.logCode = 200, .minimumLength = 1, .lists = std::span(kHiddenLists).first(1)},
});
constexpr RecordLayout kHidden{
    .section = "Flights", .logLine = "Flights", .kind = SectionKind::List, .codes = kHiddenCodes};

constexpr Time kNow{};

TEST(LayoutRecord, ItsSinkGetsWhatTheDisplayDoesNotShow) {
    LayoutFixture fixture(kHidden);
    SampleLines sink;
    fixture.record.setPlace(50, kNow);
    fixture.record.setSink(&sink);
    (void)fixture.feed({1, 7, 8}, 100);
    EXPECT_EQ(sink.lines,
              (std::vector<std::string>{"[ 1", "{0 0", "50 Speed 7 raw 7", "}", "]", "[ 1", "{0 0",
                                        "51 Speed 7 raw 7", "52 Height 8 raw 8", "}", "]"}));
    EXPECT_EQ(fixture.section, PropertyList(Array{Dictionary{{"Speed", "7"}}}));
}

TEST(LayoutRecord, ItsSinkGetsARecordAtOnceThatTheDisplayTakesLater) {
    LayoutFixture fixture(kHidden);
    fixture.record.display().setLate(true);
    SampleLines sink;
    fixture.record.setPlace(50, kNow);
    fixture.record.setSink(&sink);
    const std::vector<std::string> samples = {"[ 1", "{0 0", "53 Speed 9 raw 9", "}", "]"};
    (void)fixture.feed({1, 9}, 200);
    EXPECT_EQ(sink.lines, samples) << "after the three rows of the code before";
    EXPECT_EQ(fixture.section, PropertyList(Array()));
    fixture.record.display().bringUpToDate();
    EXPECT_EQ(sink.lines, samples) << "once";
    EXPECT_EQ(fixture.section, PropertyList(Array{Dictionary{{"Speed", "9"}}}));
    fixture.record.setSink(nullptr);
    (void)fixture.feed({1, 9}, 200);
    EXPECT_EQ(sink.lines, samples) << "taken away";
}

} // namespace
} // namespace pallax
