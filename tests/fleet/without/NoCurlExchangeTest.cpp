#include "fleet/HttpExchange.h"
#include "store/MeasurementStore.h"

#include <gtest/gtest.h>

namespace pallax {
namespace {

TEST(NoCurlExchange, SaysThatItIsMissing) {
    try {
        const HttpExchange exchange({"db1", 8123, "fleet"}, {});
        ADD_FAILURE();
    } catch (const StoreFailure& failure) {
        EXPECT_STREQ(failure.what(),
                     "This build of Pallax cannot reach clickhouse://db1:8123/fleet: "
                     "it was made without libcurl.");
    }
}

} // namespace
} // namespace pallax
