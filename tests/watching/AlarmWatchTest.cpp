#include "watching/AlarmWatch.h"

#include "host/DirectoryResources.h"
#include "platform/RecordedTechnology.h"
#include "timeline/CurrentValues.h"

#include <gtest/gtest.h>

#include <algorithm>

namespace pallax {
namespace {

using namespace std::chrono_literals;

constexpr Time kAlarmStart{std::chrono::hours(480000)};

const RecordedTechnology& technologyNamed(std::string_view name) {
    const auto all = recordedTechnologies();
    return *std::find_if(all.begin(), all.end(),
                         [name](const auto& each) { return each.commandName == name; });
}

/// The values of a technology without any packet; conditions here are about the tick alone.
class AlarmWatchTest : public testing::Test {
protected:
    struct Values {
        explicit Values(std::string_view technology)
            : fields(technologyNamed(technology), resources), values(fields, entries) {}
        DirectoryResources resources{PALLAX_SOURCE_DIR "/resources"};
        FieldTable fields;
        EntryTable entries;
        CurrentValues values;
    };

    void make(std::vector<AlarmRule> rules) {
        watch.emplace(AlarmWatch::Setup{
            std::move(rules), {}, [this](const std::string& text) { told.push_back(text); }});
        watch->begin(&lte.values);
    }
    /// "+weak" for a rule that became true, "-weak 4" for one that ended.
    std::string tick(std::uint64_t number) {
        std::string text;
        for (const auto& change : watch->tick({kAlarmStart + number * 2s, 0, number})) {
            text += (change.isTrue ? "+" : "-") + change.rule->name;
            text += change.isTrue ? "" : " " + std::to_string(change.held / 1s);
        }
        return text;
    }

    Values lte{"lte"};
    Values gsm{"gsm"};
    std::optional<AlarmWatch> watch;
    std::vector<std::string> told;
};

TEST_F(AlarmWatchTest, ARuleBecomesTrueAndEnds) {
    make({{"late", "tick >= 2 and tick < 5", 2s}, {"odd", "tick % 2"}});
    EXPECT_EQ(tick(1), "+odd");
    EXPECT_EQ(tick(2), "-odd 2");
    EXPECT_EQ(watch->holding(), std::vector<std::string>{});
    EXPECT_EQ(tick(3), "+late+odd");
    EXPECT_EQ(watch->holding(), (std::vector<std::string>{"late", "odd"}));
    EXPECT_EQ(tick(4), "-odd 2");
    EXPECT_EQ(watch->holding(), std::vector<std::string>{"late"});
    EXPECT_EQ(tick(5), "-late 6+odd");
    EXPECT_TRUE(told.empty());
}

TEST_F(AlarmWatchTest, ARuleWithoutItsFieldIsSilentAndToldOnce) {
    make({{"a", "rrc_stat = 1"}, {"b", "tick = 1"}, {"c", "late > 1"}});
    ASSERT_EQ(told.size(), 1U) << "in one text";
    EXPECT_EQ(told[0], "a: no such column: rrc_stat (line 1, column 1 of the condition). "
                       "c: no such column: late (line 1, column 1 of the condition).");
    EXPECT_EQ(tick(1), "+b");
    watch->begin(&lte.values);
    EXPECT_EQ(told.size(), 1U);
}

TEST_F(AlarmWatchTest, AnotherTechnologyBeginsWithoutAlarms) {
    make({{"lte", "measured_rsrp is null"}, {"any", "tick > 0"}});
    EXPECT_EQ(tick(1), "+lte+any");
    watch->begin(&gsm.values);
    EXPECT_EQ(watch->holding(), std::vector<std::string>{});
    ASSERT_EQ(told.size(), 1U);
    EXPECT_EQ(told[0], "lte: no such column: measured_rsrp (line 1, column 1 of the condition).");
    EXPECT_EQ(tick(2), "+any");
    watch->begin(nullptr);
    EXPECT_EQ(tick(3), "");
    EXPECT_EQ(told.size(), 1U);
}

TEST_F(AlarmWatchTest, AValueThatCannotBeComputedIsFalseAndToldOnce) {
    make({{"a", "quality('rsrp', -90, 'unknown') = 'poor'"}});
    EXPECT_EQ(tick(1), "");
    EXPECT_EQ(tick(2), "");
    EXPECT_EQ(told.size(), 1U);
}

} // namespace
} // namespace pallax
