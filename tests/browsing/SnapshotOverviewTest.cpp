#include "browsing/SnapshotOverview.h"

#include "host/DirectoryResources.h"
#include "host/Snapshot.h"
#include "plist/PropertyListCodec.h"

#include <gtest/gtest.h>

#include <string>

namespace pallax {
namespace {

class SnapshotOverviewTest : public testing::Test {
protected:
    static ByteBuffer message(const std::string& cell) {
        return serializeBinary(
                   Dictionary{
                       {kSnapshotTitle, "Snapshot"},
                       {kSnapshotDisplay,
                        Dictionary{{"Serving Cell Info", Dictionary{{"Physical Cell ID", cell}}},
                                   {"Serving Cell Measurements",
                                    Dictionary{{"Measured RSRP", "-94.50 dBm"}}}}}})
            .value();
    }
    Overview overviewOf() const {
        return overview.overview(NetworkNames(), *builtInProfile(kDefaultProfile));
    }

    DirectoryResources resources{PALLAX_SOURCE_DIR "/resources"};
    SnapshotOverview overview{resources};
    const Time saved = kEarliestTime + std::chrono::hours(9);
};

TEST_F(SnapshotOverviewTest, IsEmptyBeforeADisplayHasCome) {
    EXPECT_TRUE(overviewOf().status.isEmpty());
}

TEST_F(SnapshotOverviewTest, IsOfTheLatestDisplay) {
    overview.take(message("183"), saved);
    overview.take(message("184"), saved + std::chrono::seconds(2));
    const Overview shown = overviewOf();
    ASSERT_EQ(shown.status.cells.size(), 1U);
    const StatusCell& cell = shown.status.cells[0];
    EXPECT_EQ(cell.system, "LTE");
    EXPECT_EQ(cell.identity.at(0).text, "184");
    EXPECT_EQ(cell.levels.at(0).text, "-94.50 dBm");
    EXPECT_EQ(shown.status.time, saved + std::chrono::seconds(2));
}

TEST_F(SnapshotOverviewTest, NothingTellsHowOldTheValuesAre) {
    overview.take(message("183"), saved);
    EXPECT_FALSE(overviewOf().knowsAges);
}

TEST_F(SnapshotOverviewTest, OfAMessageWithoutADisplayIsEmpty) {
    overview.take(message("183"), saved);
    overview.take({}, saved);
    EXPECT_TRUE(overviewOf().status.isEmpty());
}

} // namespace
} // namespace pallax
