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

    using Base::sectionRef;
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
    EXPECT_EQ(record.sectionRef().dictionary(), section.dictionary()) << "shared, not copied";
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

} // namespace
} // namespace pallax
