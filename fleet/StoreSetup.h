#pragma once

#include "fleet/ClickHouse.h"

#include <string>
#include <string_view>
#include <vector>

namespace pallax {

/// The version of the tables on a server. A program refuses a store with a later one.
inline constexpr std::uint32_t kServerStoreVersion = 1;

/// Over which servers a store is spread.
struct StoreLayout {
    std::string cluster = {}; ///< as the servers' configuration names it; empty: one server
    /// A cluster that has each of these servers as a shard, if shards have replicas; else empty.
    std::string servers = {};
};

/// clickhouse.sql.
std::string_view storeSetupText();

/// The statements that make a store on one server of the layout.
std::vector<std::string> storeSetup(const StoreLayout& layout, const std::string& database);

/// Runs them. What is there already stays. Throws StoreFailure, also for a name that is none.
void setUpStore(const StoreAddress& address, const StoreLayout& layout);

} // namespace pallax
