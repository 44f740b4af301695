#include "LogGenerator/Records/ClassIndex.h"

#include "tests/doubles/FakeStandardOutput.h"
#include "tests/doubles/RecordingLog.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <array>

namespace pallax {
namespace {

using doubles::FakeStandardOutput;
using doubles::RecordingLog;
using Lines = std::vector<RecordingLog::Line>;

class Wanting final : public Base {
public:
    static constexpr auto kCodes = std::to_array<LogCode>({0x4116, 0xFF0020});
    std::string_view getSectionName() const override { return "Wanting"; }
    std::span<const LogCode> getLogCodeArray() const override { return kCodes; }
};

class Silent final : public Base {
public:
    std::string_view getSectionName() const override { return "Silent"; }
    std::span<const LogCode> getLogCodeArray() const override { return {}; }
};

class ExampleIndex final : public ClassIndex {
public:
    using ClassIndex::ClassIndex;
    std::unique_ptr<Wanting> objWanting = create<Wanting>();
    std::unique_ptr<Silent> objSilent = create<Silent>();
};

class ClassIndexTest : public testing::Test {
protected:
    FakeStandardOutput _output;
    ExampleIndex _index{_output};
};

TEST_F(ClassIndexTest, ARecordSubscribedTo0x4116IsFoundWith16662AndItsCodeKeyIs16662) {
    ASSERT_NE(_index.getSubscribers(16662), nullptr);
    EXPECT_EQ(*_index.getSubscribers(16662), (std::vector<Base*>{_index.objWanting.get()}));
    const auto codes = _index.getAllLogCodes();
    EXPECT_NE(std::find(codes.begin(), codes.end(), "16662"), codes.end());
}

TEST_F(ClassIndexTest, AnExtendedCode0xFF0020IsKept16711712) {
    EXPECT_EQ(_index.getAllLogCodes(), (std::vector<std::string>{"16662", "16711712"}));
    EXPECT_NE(_index.getSubscribers(0xFF0020), nullptr);
}

TEST_F(ClassIndexTest, ACodeNobodyWantsHasNoSubscribers) {
    EXPECT_EQ(_index.getSubscribers(0x4117), nullptr);
}

TEST_F(ClassIndexTest, RecordsAreFoundBySectionName) {
    EXPECT_EQ(_index.getClass("Silent"), _index.objSilent.get());
    EXPECT_EQ(_index.getClass("silent"), nullptr);
}

TEST_F(ClassIndexTest, StatusTellsWhatTheSectionDictionaryIs) {
    RecordingLog log;
    _index.status();
    EXPECT_EQ(log.lines(), (Lines{{4, "Dictionary = 1"}, {4, "String = 0"}}));
}

TEST(ClassIndex, ItsEndIsPrintedOnStandardOutput) {
    FakeStandardOutput output;
    {
        const ExampleIndex index(output);
        EXPECT_TRUE(output.lines.empty());
    }
    EXPECT_EQ(output.lines, (std::vector<std::string>{"Deallocing ClassIndex"}));
}

} // namespace
} // namespace pallax
