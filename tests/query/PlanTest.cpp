#include "tests/query/QueryFixture.h"

namespace pallax {
namespace {

using Lines = std::vector<std::string>;

/// What the planner asks of a table: 't' time, 'p' packet, 'f' field, 'c' number of buckets, each
/// with '=', '<' or '>'.
class PlanTest : public testing::Test {
protected:
    Lines planOf(const std::string& query) {
        Lines details;
        for (const std::string& line : _fixture.ask("explain query plan " + query)) {
            details.push_back(line.substr(line.rfind('|') + 1));
        }
        return details;
    }
    std::uint64_t packetsReadFor(const std::string& query) {
        const std::uint64_t before = _fixture.journal.given();
        (void)_fixture.ask(query);
        return _fixture.journal.given() - before;
    }

    QueryFixture _fixture{"lte", 7, std::chrono::seconds(60)};
};

TEST_F(PlanTest, ConditionsOnTimePacketAndFieldReachTheTables) {
    const std::string time = " where time > 5 and time <= 7";
    const std::string packet = " where packet >= 5 and packet < 7";
    for (const std::string table :
         {"packet", "sample", "state", "serving_cell_measurements", "neighbor_cells_list"}) {
        const std::string select = "select * from " + table;
        const std::string scan = "SCAN " + table + " VIRTUAL TABLE INDEX 0:";
        EXPECT_EQ(planOf(select), Lines{scan});
        EXPECT_EQ(planOf(select + time), Lines{scan + "t>t<"});
        EXPECT_EQ(planOf(select + packet), Lines{scan + "p>p<"});
        EXPECT_EQ(planOf(select + " where time = 5 and packet = 7"), Lines{scan + "t=p="});
        EXPECT_EQ(planOf(select + " where time between 5 and 7"), Lines{scan + "t>t<"});
        EXPECT_EQ(planOf(select + " where +time = 5"), Lines{scan}) << "an expression";
        EXPECT_EQ(planOf(select + " where time <> 5"), Lines{scan});
    }
    for (const std::string table : {"sample", "span"}) {
        const std::string select = "select * from " + table + " where field ";
        const std::string scan = "SCAN " + table + " VIRTUAL TABLE INDEX 0:";
        EXPECT_EQ(planOf(select + "= 'x'"), Lines{scan + "f="});
        EXPECT_EQ(planOf(select + "> 'x'"), Lines{scan});
        EXPECT_EQ(planOf(select + "= 'x' collate nocase"), Lines{scan});
    }
    EXPECT_EQ(planOf("select * from sample where field = 'x' and time > 5 and packet = 7"),
              Lines{"SCAN sample VIRTUAL TABLE INDEX 0:f=t>p="});
    EXPECT_EQ(planOf("select * from series('p_max', 5)"),
              Lines{"SCAN series VIRTUAL TABLE INDEX 0:f=c="});
}

TEST_F(PlanTest, TablesInMemoryAreScanned) {
    for (const std::string table : {"event", "cell", "field", "tables", "columns"}) {
        EXPECT_EQ(planOf("select * from " + table),
                  Lines{"SCAN " + table + " VIRTUAL TABLE INDEX 0:"});
    }
    EXPECT_EQ(planOf("select * from event where time > 5 and packet = 7"),
              Lines{"SCAN event VIRTUAL TABLE INDEX 0:"});
    EXPECT_EQ(planOf("select * from span where start > 5 and packet = 7"),
              Lines{"SCAN span VIRTUAL TABLE INDEX 0:"})
        << "a span may have begun long before";
}

TEST_F(PlanTest, AJoinAsksTheStateForTheTimeOfEachEvent) {
    EXPECT_EQ(
        planOf("select e.words, s.measured_rsrp from event e join state s on s.time >= e.time "
               "and s.time < e.time + 2000000"),
        (Lines{"SCAN e VIRTUAL TABLE INDEX 0:", "SCAN s VIRTUAL TABLE INDEX 0:t>t<"}));
}

TEST_F(PlanTest, ABoundedQueryReadsFewPackets) {
    const std::uint64_t all = _fixture.timeline->packets();
    ASSERT_GE(all, 2000U);
    const std::string middle = std::to_string(microseconds(Simulation::kStart) + 30'000'000);
    for (const std::string table :
         {"packet", "sample", "state", "connected_mode_lte_intra_frequency_measurement",
          "detected_cells"}) {
        const std::string select = "select count(*) from " + table + " where ";
        // Key frames are 50 packets apart; a tick is a second, a stamp may be a second late.
        EXPECT_GE(packetsReadFor(select + "1"), all) << table;
        EXPECT_LE(packetsReadFor(select + "packet between 1000 and 1100"), 350U) << table;
        EXPECT_LE(
            packetsReadFor(select + "time between " + middle + " and " + middle + " + 2000000"),
            800U)
            << table;
        EXPECT_GE(packetsReadFor(select + "+packet between 1000 and 1100"), all) << table;
    }
}

} // namespace
} // namespace pallax
