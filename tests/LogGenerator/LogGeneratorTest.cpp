#include "LogGenerator/LogGenerator.h"

#include "LogGenerator/Records/Exceptions.h"
#include "tests/doubles/FakeGenerator.h"
#include "tests/doubles/GeneratorFixture.h"
#include "tests/doubles/InOrder.h"
#include "tests/doubles/Property.h"
#include "tests/doubles/RecordingLog.h"

#include <gtest/gtest.h>

namespace pallax {
namespace {

using doubles::FakeGenerator;
using doubles::MuteGenerator;
using doubles::RecordingLog;
using doubles::sameInOrder;
using Lines = std::vector<RecordingLog::Line>;

class LogGeneratorTest : public testing::Test {
protected:
    std::unique_ptr<LogGenerator> generatorFor(const PropertyList& technology) const {
        return LogGenerator::generatorFromTechnology(technology, doubles::kFakeTechnologies,
                                                     environment);
    }
    void updateHistory() { LogGenerator::updateHistoryInState(state, clock); }
    Array history() const { return *state.find("History")->array(); }
    Dictionary newestEntry() const { return *history().back().dictionary(); }

    doubles::GeneratorFixture fixture;
    doubles::ManualClock& clock = fixture.clock;
    GeneratorEnvironment environment = fixture.environment();
    Dictionary state;
};

/// A state with all values that a history entry copies.
Dictionary fullState() {
    return Dictionary{
        {"Template", Dictionary{{"GSM", "x"}}},
        {"Display", Dictionary{{"GSM", Dictionary{{"ARFCN", "12"}}}}},
        {"ExtraInfo", Dictionary{{"Extra", "1"}}},
        {"DisplayState", PropertyList::data({1, 2, 3})},
    };
}

TEST_F(LogGeneratorTest, CreationLogsTheObject) {
    RecordingLog log;
    const LogGenerator generator(environment);
    const auto* address = static_cast<const void*>(&generator);
    EXPECT_EQ(log.lines(), (Lines{{4, formatText("Creating Log object: %p", {address})}}));
}

TEST_F(LogGeneratorTest, AnAbstractOperationCalledOnTheBaseIsAnUnrecognisedOperation) {
    LogGenerator generator(environment);
    const auto refusalOf = [](auto operation) -> std::string {
        try {
            operation();
        } catch (const UnrecognisedOperation& refusal) {
            return refusal.what();
        }
        return "none";
    };
    EXPECT_EQ(refusalOf([&] { generator.updateState(state, {}); }),
              "unrecognised operation: updateState:withData:");
    EXPECT_EQ(refusalOf([&] { generator.generateLogUsingState(state); }),
              "unrecognised operation: generateLogUsingState:");
    EXPECT_EQ(refusalOf([&] { static_cast<void>(generator.getStartCommand()); }),
              "unrecognised operation: getStartCommand");
    EXPECT_EQ(refusalOf([&] { static_cast<void>(generator.getSaveContentsFromState(state)); }),
              "unrecognised operation: getSaveContentsFromState:");
    EXPECT_TRUE(state.empty());
}

TEST_F(LogGeneratorTest, AnUnknownTechnologyIdentifierYieldsNil) {
    EXPECT_EQ(generatorFor("fake"), nullptr);
    EXPECT_EQ(generatorFor("Fake "), nullptr);
    EXPECT_EQ(generatorFor(""), nullptr);
    EXPECT_EQ(generatorFor(PropertyList()), nullptr);
    EXPECT_EQ(generatorFor(PropertyList::integer(1)), nullptr);
    EXPECT_EQ(generatorFor(Array{"Fake"}), nullptr);
}

TEST_F(LogGeneratorTest, AKnownTechnologyYieldsANewInstanceOfItsClass) {
    const auto first = generatorFor("Fake");
    const auto second = generatorFor("Fake");
    EXPECT_NE(dynamic_cast<FakeGenerator*>(first.get()), nullptr);
    EXPECT_EQ(dynamic_cast<MuteGenerator*>(first.get()), nullptr);
    EXPECT_NE(first, second);
    EXPECT_NE(dynamic_cast<MuteGenerator*>(generatorFor("Mute").get()), nullptr);
}

TEST_F(LogGeneratorTest, TheFirstTechnologyThatMatchesIsTaken) {
    const Technology table[] = {{"Other", &FakeGenerator::generator},
                                {"Same", &MuteGenerator::generator},
                                {"Same", &FakeGenerator::generator}};
    const auto generator = LogGenerator::generatorFromTechnology("Same", table, environment);
    EXPECT_NE(dynamic_cast<MuteGenerator*>(generator.get()), nullptr);
}

TEST_F(LogGeneratorTest, FirstCallOnAStateWithoutHistoryCreatesItAndLeavesOneEntry) {
    state = fullState();
    updateHistory();
    EXPECT_EQ(PropertyList(history()),
              PropertyList(Array{Dictionary{
                  {"DisplayState", PropertyList::data({1, 2, 3})},
                  {"Display", Dictionary{{"GSM", Dictionary{{"ARFCN", "12"}}}}},
                  {"ExtraInfo", Dictionary{{"Extra", "1"}}},
                  {"Date", "2023-11-14 22:13:20 +0000"},
                  {"Description", "Snapshot (2023-11-14 22:13:20 +0000)"},
              }}));
}

TEST_F(LogGeneratorTest, EntriesAreAppendedOldestFirstAndTheNewest5Stay) {
    for (int minute = 0; minute < 7; ++minute) {
        state = [&] {
            Dictionary next = fullState();
            if (const PropertyList* kept = state.find("History")) {
                next.set("History", *kept);
            }
            return next;
        }();
        clock.set(doubles::ManualClock::kStart + std::chrono::minutes(minute));
        updateHistory();
        EXPECT_EQ(history().size(), static_cast<std::size_t>(std::min(minute + 1, 5)));
    }
    std::vector<std::string> dates;
    for (const PropertyList& entry : history()) {
        dates.push_back(entry.dictionary()->find("Date")->string().value());
    }
    EXPECT_EQ(dates,
              (std::vector<std::string>{"2023-11-14 22:15:20 +0000", "2023-11-14 22:16:20 +0000",
                                        "2023-11-14 22:17:20 +0000", "2023-11-14 22:18:20 +0000",
                                        "2023-11-14 22:19:20 +0000"}));
}

TEST_F(LogGeneratorTest, With7EntriesAlreadyPresentOneCallLeavesTheNewest4AndTheNewOne) {
    state = fullState();
    state.set("History", Array{"1", "2", "3", "4", "5", "6", "7"});
    updateHistory();
    Array kept = history();
    ASSERT_EQ(kept.size(), 5U);
    EXPECT_EQ(*kept.back().dictionary()->find("Date"), PropertyList("2023-11-14 22:13:20 +0000"));
    kept.pop_back();
    EXPECT_EQ(PropertyList(kept), PropertyList(Array{"4", "5", "6", "7"}));
}

TEST_F(LogGeneratorTest, AnyHistoryKeepsItsNewestEntriesInOrder) {
    EXPECT_TRUE(doubles::holds([&] {
        const std::vector<std::string> before = doubles::any::texts();
        state = Dictionary{{"History", Array(before.begin(), before.end())}};
        updateHistory();
        Array expected(before.begin(), before.end());
        if (expected.size() > 4) {
            expected.erase(expected.begin(), expected.end() - 4);
        }
        expected.emplace_back(Dictionary{});
        RC_ASSERT(PropertyList(history()) == PropertyList(expected));
    }));
}

TEST_F(LogGeneratorTest, TheHistoryArrayStaysTheSameObject) {
    state = fullState();
    updateHistory();
    const ArrayRef kept = state.find("History")->array();
    for (int call = 0; call < 6; ++call) {
        updateHistory();
    }
    EXPECT_EQ(state.find("History")->array(), kept);
    EXPECT_EQ(kept->size(), 5U);
}

TEST_F(LogGeneratorTest, WithoutDisplayStateTheEntryIsEmpty) {
    state = fullState();
    state.remove("DisplayState");
    updateHistory();
    EXPECT_TRUE(newestEntry().empty());
}

TEST_F(LogGeneratorTest, WithoutDisplayTheEntryHoldsOnlyDisplayState) {
    state = fullState();
    state.remove("Display");
    updateHistory();
    EXPECT_TRUE(
        sameInOrder(newestEntry(), Dictionary{{"DisplayState", PropertyList::data({1, 2, 3})}}));
}

TEST_F(LogGeneratorTest, WithoutExtraInfoTheEntryEndsBehindTheDisplay) {
    state = fullState();
    state.set("ExtraInfo", PropertyList());
    updateHistory();
    EXPECT_TRUE(sameInOrder(
        newestEntry(), Dictionary{{"DisplayState", PropertyList::data({1, 2, 3})},
                                  {"Display", Dictionary{{"GSM", Dictionary{{"ARFCN", "12"}}}}}}));
}

TEST_F(LogGeneratorTest, TheDisplayOfAnEntryIsAOneLevelCopyThatSharesItsSections) {
    state = fullState();
    updateHistory();
    const DictionaryRef live = state.find("Display")->dictionary();
    live->find("GSM")->dictionary()->set("ARFCN", "13");
    live->set("LTE", Dictionary{});
    state.find("ExtraInfo")->dictionary()->set("Extra", "2");
    EXPECT_EQ(*newestEntry().find("Display"),
              PropertyList(Dictionary{{"GSM", Dictionary{{"ARFCN", "13"}}}}));
    EXPECT_EQ(*newestEntry().find("ExtraInfo"), PropertyList(Dictionary{{"Extra", "1"}}));
}

} // namespace
} // namespace pallax
