#include "tests/query/QueryFixture.h"

namespace pallax {
namespace {

/// What a query finds with bounds that a table uses is what it finds with the same conditions in a
/// form that no table knows (+column).
class BoundsTest : public testing::TestWithParam<const char*> {
protected:
    QueryFixture _fixture{GetParam(), 3, std::chrono::seconds(6)};

    void holdsFor(const std::string& table, const std::string& columns) {
        namespace any = doubles::any;
        EXPECT_TRUE(doubles::holds([&] {
            const std::int64_t start = microseconds(Simulation::kStart);
            const std::int64_t from = start + any::longBetween(-2'000'000, 8'000'000);
            const std::int64_t to = from + any::longBetween(-1'000'000, 8'000'000);
            const std::string first = std::to_string(any::between(0, 270));
            const std::string last = std::to_string(any::between(0, 270));
            const auto ask = [&](const std::string& sign) {
                std::string text = "select " + columns + " from " + table + " where 1";
                text += " and " + sign + "time >= " + std::to_string(from);
                text += " and " + sign + "time < " + std::to_string(to);
                if (_withPackets) {
                    text += " and " + sign + "packet > " + first;
                    text += " and " + sign + "packet <= " + last;
                }
                return _fixture.ask(text);
            };
            _withPackets = any::boolean();
            RC_ASSERT(ask("") == ask("+"));
        }));
    }

    bool _withPackets = false;
};

INSTANTIATE_TEST_SUITE_P(All, BoundsTest, testing::ValuesIn(technologyNames()));

TEST_P(BoundsTest, OfPacketsLeaveNothingOut) {
    holdsFor("packet", "time, packet, length, code");
}

TEST_P(BoundsTest, OfSamplesLeaveNothingOut) {
    holdsFor("sample", "count(*), sum(packet), sum(number), min(time), max(time), sum(raw)");
}

TEST_P(BoundsTest, OfTheStateLeaveNothingOut) {
    holdsFor("state", "*");
}

TEST_P(BoundsTest, AFieldIsLookedForByItsName) {
    const auto fields = _fixture.ask("select distinct field from sample limit 20");
    ASSERT_FALSE(fields.empty());
    for (const std::string& field : fields) {
        for (const char* table : {"sample", "span"}) {
            const std::string select = std::string("select count(*), sum(packet) from ") + table;
            EXPECT_EQ(_fixture.ask(select + " where field = '" + field + "'"),
                      _fixture.ask(select + " where +field = '" + field + "'"));
        }
    }
    // Spans end with packets that have other fields.
    const std::string ends = "select field, count(*), sum(start + hold) from span where ";
    for (const std::string& field : fields) {
        EXPECT_EQ(_fixture.ask(ends + "field = '" + field + "'"),
                  _fixture.ask(ends + "+field = '" + field + "'"));
    }
    EXPECT_EQ(_fixture.ask("select count(*) from sample where field = 'nothing'"),
              std::vector<std::string>{"0"});
}

TEST_P(BoundsTest, JoinedByOrLeaveNothingOut) {
    EXPECT_EQ(_fixture.ask("select packet from packet where packet = 3 or packet = 5 or packet "
                           "between 7 and 8"),
              (std::vector<std::string>{"3", "5", "7", "8"}));
    for (const char* table : {"sample", "state"}) {
        const std::string select = std::string("select count(*) from ") + table + " where ";
        EXPECT_EQ(_fixture.ask(select + "packet < 50 or packet > 60"),
                  _fixture.ask(select + "+packet < 50 or +packet > 60"))
            << table;
    }
}

TEST(TimesThatComeTwice, AreFoundInBothStretches) {
    QueryFixture fixture("lte", 3, std::chrono::seconds(10));
    TimelineFixture twice("lte");
    twice.drive(3, std::chrono::seconds(10));
    twice.drive(3, std::chrono::seconds(10));
    const auto timeline = twice.indexed();
    Database database;
    addTimelineTables(database, *timeline);
    ASSERT_EQ(timeline->stretches().size(), 2U);
    EXPECT_EQ(linesOf(database, "select count(*) from span where hold < 0"),
              std::vector<std::string>{"0"});
    EXPECT_EQ(linesOf(database, "select count(*) from span where hold > 10500000"),
              std::vector<std::string>{"0"})
        << "no value holds from one stretch to the next";
    const std::string from = std::to_string(microseconds(Simulation::kStart) + 4'000'000);
    const std::string select =
        "select count(*) from packet where time between " + from + " and " + from + " + 2000000";
    const auto once = fixture.ask(select);
    ASSERT_NE(once, std::vector<std::string>{"0"});
    EXPECT_EQ(linesOf(database, select),
              std::vector<std::string>{std::to_string(2 * std::stoi(once[0]))});
}

} // namespace
} // namespace pallax
