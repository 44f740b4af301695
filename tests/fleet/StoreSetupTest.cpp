#include "fleet/StoreSetup.h"

#include "store/MeasurementStore.h"

#include <gtest/gtest.h>

namespace pallax {
namespace {

/// The statement that makes this table or view.
std::string making(const std::string& name, const StoreLayout& layout) {
    for (const std::string& statement : storeSetup(layout, "fleet1")) {
        for (const char* kind : {"TABLE", "VIEW", "MATERIALIZED VIEW"}) {
            if (statement.starts_with(std::string("CREATE ") + kind + " IF NOT EXISTS " + name +
                                      " ")) {
                return statement;
            }
        }
    }
    return "";
}

std::string engineOf(const std::string& statement) {
    const std::size_t at = statement.find("ENGINE = ");
    return at != std::string::npos ? statement.substr(at, statement.find('\n', at) - at) : "";
}

TEST(StoreSetupTest, OneServerRunsTheFileAsItIs) {
    const auto statements = storeSetup({}, "fleet1");
    EXPECT_GT(statements.size(), 30U);
    for (const std::string& statement : statements) {
        EXPECT_TRUE(statement.starts_with("CREATE ")) << statement;
        EXPECT_EQ(statement.find("--"), std::string::npos) << statement;
        EXPECT_NE(statement.find(" IF NOT EXISTS "), std::string::npos) << statement;
    }
    EXPECT_EQ(engineOf(making("loads_local", {})), "ENGINE = MergeTree() ORDER BY (digest, load)");
    EXPECT_EQ(making("span", {}), "CREATE VIEW IF NOT EXISTS span AS SELECT * FROM span_local");
    EXPECT_EQ(statements.back(),
              "CREATE VIEW IF NOT EXISTS store AS SELECT toUInt32(1) AS version, "
              "'' AS cluster, toUInt32(1) AS copies");
}

TEST(StoreSetupTest, ShardsAreOfDevices) {
    const StoreLayout shards{"fleet", ""};
    EXPECT_EQ(engineOf(making("loads_local", shards)),
              "ENGINE = MergeTree() ORDER BY (digest, load)");
    EXPECT_EQ(making("span", shards),
              "CREATE TABLE IF NOT EXISTS span AS span_local ENGINE = Distributed(fleet, fleet1, "
              "span_local, cityHash64(device))");
    EXPECT_EQ(making("fields", shards),
              "CREATE TABLE IF NOT EXISTS fields AS fields_local ENGINE = Distributed(fleet, "
              "fleet1, fields_local, cityHash64(name))");
    EXPECT_EQ(making("intervals_everywhere", shards), "");
    EXPECT_EQ(storeSetup(shards, "fleet1").back(),
              "CREATE VIEW IF NOT EXISTS store AS SELECT toUInt32(1) AS version, 'fleet' AS "
              "cluster, toUInt32(1) AS copies");
}

TEST(StoreSetupTest, ReplicasHaveCopies) {
    const StoreLayout replicas{"fleet", "servers"};
    EXPECT_EQ(engineOf(making("loads_local", replicas)),
              "ENGINE = ReplicatedMergeTree('/clickhouse/tables/{shard}/fleet1/loads_local', "
              "'{replica}') ORDER BY (digest, load)");
    EXPECT_EQ(engineOf(making("hours_local", replicas)),
              "ENGINE = ReplicatedAggregatingMergeTree('/clickhouse/tables/{shard}/fleet1/"
              "hours_local', '{replica}') PARTITION BY month");
    EXPECT_EQ(making("intervals_everywhere", replicas),
              "CREATE TABLE IF NOT EXISTS intervals_everywhere AS intervals_local ENGINE = "
              "Distributed(servers, fleet1, intervals_local, cityHash64(device))");
    EXPECT_EQ(storeSetup(replicas, "fleet1").back(),
              "CREATE VIEW IF NOT EXISTS store AS SELECT toUInt32(1) AS version, 'fleet' AS "
              "cluster, max(replica_num) AS copies FROM system.clusters WHERE cluster = 'fleet'");
}

TEST(StoreSetupTest, AClusterHasAName) {
    for (const StoreLayout& layout : {StoreLayout{"a'b", ""}, StoreLayout{"a", "b) --"}}) {
        try {
            setUpStore({"127.0.0.1", 1, "d"}, layout);
            ADD_FAILURE();
        } catch (const StoreFailure& failure) {
            EXPECT_TRUE(std::string(failure.what())
                            .ends_with("\" is not the name of a cluster: it has letters, digits "
                                       "and _."))
                << failure.what();
        }
    }
}

} // namespace
} // namespace pallax
