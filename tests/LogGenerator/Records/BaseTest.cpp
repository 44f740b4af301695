#include "LogGenerator/Records/Base.h"

#include "LogGenerator/Records/ArrayLock.h"
#include "LogGenerator/Records/Exceptions.h"
#include "tests/doubles/ArrayLockHolder.h"
#include "tests/doubles/RecordBuilder.h"
#include "tests/doubles/RecordingLog.h"

#include <gtest/gtest.h>

#include <array>

namespace pallax {
namespace {

using doubles::RecordingLog;
using Lines = std::vector<RecordingLog::Line>;

constexpr auto kCodes = std::to_array<LogCode>({0x4116, 0xFF0020});

class Example : public Base {
public:
    std::string_view getSectionName() const override { return "Example Section"; }
    std::span<const LogCode> getLogCodeArray() const override { return kCodes; }

    using Base::clearList;
    using Base::logUnknown;
    using Base::removeKey;
    using Base::replaceList;
    using Base::sectionRef;
    using Base::show;
};

TEST(Base, RegistersUnderItsSectionNameAndEachOfItsCodes) {
    RecordingLog log;
    ClassDict classes;
    CodeDict codes;
    Example first;
    Example second;
    first.initWithDict(classes, codes);
    second.initWithDict(classes, codes);
    EXPECT_EQ(log.lines(), (Lines{{4, "Array Count: 2"}, {4, "Array Count: 2"}}));
    EXPECT_EQ(classes.at("Example Section"), &second) << "the later record of a name stays";
    EXPECT_EQ(codes.at(0x4116), (std::vector<Base*>{&first, &second}));
    EXPECT_EQ(codes.at(0xFF0020), (std::vector<Base*>{&first, &second}));
    EXPECT_EQ(codes.size(), 2U);
}

TEST(Base, ASectionIsStoredAndItsNameLogged) {
    Example record;
    EXPECT_TRUE(record.sectionRef().isNull()) << "nil until the template has been processed";
    RecordingLog log;
    const PropertyList section = Dictionary();
    record.updateSectionRef(section);
    EXPECT_EQ(log.lines(), (Lines{{4, "Example Section"}}));
    record.show("Key", "value");
    EXPECT_EQ(section, PropertyList(Dictionary{{"Key", "value"}}));
    record.removeKey("Key");
    EXPECT_TRUE(section.dictionary()->empty());
}

TEST(Base, ARecordWithoutASectionOfItsKindWritesNothing) {
    Example record;
    record.show("Key", "value");
    record.replaceList({"a"});
    const PropertyList list = Array{"kept"};
    record.updateSectionRef(list);
    record.show("Key", "value");
    EXPECT_EQ(list, PropertyList(Array{"kept"}));
    const PropertyList keys = Dictionary{{"Key", "kept"}};
    record.updateSectionRef(keys);
    record.clearList();
    record.replaceList({"a"});
    EXPECT_EQ(keys, PropertyList(Dictionary{{"Key", "kept"}}));
}

TEST(Base, ListsAreEmptiedAndRefilledInPlace) {
    Example record;
    const PropertyList list = Array{"old", "older"};
    record.updateSectionRef(list);
    record.replaceList({"new"});
    EXPECT_EQ(list, PropertyList(Array{"new"})) << "the display shares the array";
    record.clearList();
    EXPECT_EQ(list, PropertyList(Array{}));
}

/// The operation waits for the array lock and changes the list only then.
template <class Operation>
void expectToWaitForTheLock(const Operation& operation, const PropertyList& list,
                            const Array& afterwards) {
    const PropertyList before = list.shallowCopy();
    EXPECT_FALSE(doubles::finishesUnderHeldArrayLock(doubles::kExpectedToWait, operation, [&] {
        EXPECT_EQ(list, before) << "nothing changes while another holds the lock";
    }));
    EXPECT_EQ(list, PropertyList(afterwards));
    EXPECT_EQ(ArrayLock::depth(), 0) << "the lock is given back";
}

TEST(Base, ListsAreEmptiedAndRefilledUnderTheArrayLock) {
    Example record;
    const PropertyList list = Array{"old", "older"};
    record.updateSectionRef(list);
    expectToWaitForTheLock([&record] { record.replaceList({"new"}); }, list, {"new"});
    expectToWaitForTheLock([&record] { record.clearList(); }, list, {});
}

TEST(Base, AnArrayIsEmptiedOrReplacedUnderTheArrayLock) {
    const PropertyList list = Array{"old", "older"};
    Array& array = *list.array();
    expectToWaitForTheLock(
        [&array] {
            Base::replaceArray(array, {"new", "newer"});
        },
        list, {"new", "newer"});
    expectToWaitForTheLock([&array] { Base::clearElementsInArray(array); }, list, {});
}

TEST(Base, AnUnknownCodeIsLoggedInDecimal) {
    RecordingLog log;
    Example::logUnknown(0x7131);
    EXPECT_EQ(log.lines(), (Lines{{3, "Received an unknown log message: 28977"}}));
}

TEST(Base, AbstractOperationsAreUnrecognised) {
    Base base;
    EXPECT_THROW(base.updateWithData(LogRecord(), 0), UnrecognisedOperation);
    EXPECT_THROW((void)base.getSectionName(), UnrecognisedOperation);
    EXPECT_THROW((void)base.getLogCodeArray(), UnrecognisedOperation);
}

TEST(LookUpECNO, EdgeValues) {
    EXPECT_EQ(Base::lookUpECNO(524288), 0);
    EXPECT_EQ(Base::lookUpECNO(705), 0);
    EXPECT_EQ(Base::lookUpECNO(706), -31);
    EXPECT_EQ(Base::lookUpECNO(813), -31);
    EXPECT_EQ(Base::lookUpECNO(814), -30);
    EXPECT_EQ(Base::lookUpECNO(417648), -1);
    EXPECT_EQ(Base::lookUpECNO(0), 0);
    EXPECT_EQ(Base::lookUpECNO(0xFFFFFFFF), 0);
}

TEST(LookUpECNO, EveryBandBeginsAndEndsAsTabled) {
    struct Row {
        std::uint32_t least;
        std::uint32_t largest;
        int decibels;
    };
    constexpr Row kRows[] = {
        {417648, 524287, -1}, {331809, 417647, -2}, {263625, 331808, -3}, {209464, 263624, -4},
        {166442, 209463, -5}, {132269, 166441, -6}, {105124, 132268, -7}, {83563, 105123, -8},
        {66436, 83562, -9},   {52831, 66435, -10},  {42024, 52830, -11},  {33441, 42023, -12},
        {26622, 33440, -13},  {21206, 26621, -14},  {16904, 21205, -15},  {13487, 16903, -16},
        {10772, 13486, -17},  {8616, 10771, -18},   {6903, 8615, -19},    {5543, 6902, -20},
        {4462, 5542, -21},    {3604, 4461, -22},    {2922, 3603, -23},    {2241, 2921, -24},
        {1950, 2240, -25},    {1608, 1949, -26},    {1337, 1607, -27},    {1121, 1336, -28},
        {950, 1120, -29},     {814, 949, -30},      {706, 813, -31},      {0, 705, 0},
    };
    for (const Row& row : kRows) {
        EXPECT_EQ(Base::lookUpECNO(row.least), row.decibels) << row.least;
        EXPECT_EQ(Base::lookUpECNO(row.largest), row.decibels) << row.largest;
    }
}

/// Shows each record that it reads; one whose first payload byte is 0 replaces nothing.
class KeepingRecord final : public Example {
public:
    void updateWithData(const LogRecord& record, LogCode logCode) override {
        read.push_back(record.u8(LogRecord::kHeaderLength));
        systemLog(LogPriority::Warning, "Read %d", read.back());
        show("Code", DisplayNumber(std::int64_t{logCode}, kDecimal));
        show("Value", DisplayNumber(std::int64_t{read.back()}, kDecimal));
    }
    bool replacesShown(const LogRecord& record, LogCode /*logCode*/) const override {
        return record.u8(LogRecord::kHeaderLength) != 0;
    }
    unsigned kindOf(const LogRecord& record) const override {
        return record.u8(LogRecord::kHeaderLength) / 100;
    }

    void receiveValue(unsigned value, LogCode logCode = kCodes[0]) {
        const ByteBuffer bytes = doubles::Record(logCode).u8(value).bytes();
        receive(LogRecord(bytes), logCode);
    }

    std::vector<int> read; ///< the values, in the order of reading
};

using Values = std::vector<int>;

TEST(Base, OfRecordsThatReplaceEachOtherOnlyTheLatestIsRead) {
    KeepingRecord record;
    const PropertyList section = Dictionary();
    record.updateSectionRef(section);
    record.receiveValue(1);
    record.receiveValue(2);
    record.receiveValue(3);
    EXPECT_EQ(record.read, Values());
    EXPECT_TRUE(section.dictionary()->empty()) << "nobody has looked yet";
    record.catchUp();
    record.catchUp();
    EXPECT_EQ(record.read, (Values{3}));
    EXPECT_EQ(section, PropertyList(Dictionary{{"Code", "16662"}, {"Value", "3"}}));
}

TEST(Base, AnotherCodeHasTheKeptRecordReadBeforeIt) {
    KeepingRecord record;
    record.receiveValue(1);
    record.receiveValue(2, kCodes[1]);
    EXPECT_EQ(record.read, (Values{1}));
    record.receiveValue(3, kCodes[1]);
    record.receiveValue(4);
    EXPECT_EQ(record.read, (Values{1, 3}));
    record.catchUp();
    EXPECT_EQ(record.read, (Values{1, 3, 4}));
}

TEST(Base, ARecordOfAnotherKindHasTheKeptRecordReadBeforeIt) {
    KeepingRecord record;
    record.receiveValue(1);
    record.receiveValue(101);
    EXPECT_EQ(record.read, (Values{1}));
    record.receiveValue(102);
    EXPECT_EQ(record.read, (Values{1}));
    record.catchUp();
    EXPECT_EQ(record.read, (Values{1, 102}));
}

TEST(Base, ARecordThatReplacesNothingIsReadAtOnceBehindTheKeptOne) {
    KeepingRecord record;
    record.receiveValue(1);
    record.receiveValue(0);
    EXPECT_EQ(record.read, (Values{1, 0}));
    record.catchUp();
    EXPECT_EQ(record.read, (Values{1, 0}));
}

TEST(Base, ARecordIsReadAtOnceForThoseWhoReadItsLogLines) {
    KeepingRecord record;
    {
        const RecordingLog log(static_cast<int>(LogPriority::Error));
        record.receiveValue(1);
        EXPECT_EQ(record.read, Values()) << "its line is no error";
    }
    const RecordingLog log(static_cast<int>(LogPriority::Warning));
    record.receiveValue(2);
    EXPECT_EQ(record.read, (Values{1, 2}));
    EXPECT_EQ(log.lines(), (Lines{{4, "Read 1"}, {4, "Read 2"}}));
}

TEST(Base, ANewSectionGetsNothingOfARecordThatCameBeforeIt) {
    KeepingRecord record;
    const PropertyList before = Dictionary();
    const PropertyList after = Dictionary();
    record.updateSectionRef(before);
    record.receiveValue(1);
    record.updateSectionRef(after);
    record.catchUp();
    EXPECT_EQ(before, PropertyList(Dictionary{{"Code", "16662"}, {"Value", "1"}}));
    EXPECT_TRUE(after.dictionary()->empty());
}

TEST(Base, ARecordClassKeepsNothingUnlessItSaysSo) {
    const ByteBuffer bytes = doubles::Record(kCodes[0]).bytes();
    EXPECT_FALSE(Example().replacesShown(LogRecord(bytes), kCodes[0]));
}

} // namespace
} // namespace pallax
