#include "store/StoredSections.h"

#include "query/SectionTable.h"
#include "tests/doubles/Property.h"
#include "tests/store/StoreFixture.h"
#include "timeline/FieldTable.h"

#include <gtest/gtest.h>

namespace pallax {
namespace {

namespace any = doubles::any;

class StoredSectionsTest : public StoreFixture {
protected:
    explicit StoredSectionsTest(std::string_view technologyName = "lte")
        : StoreFixture(technologyName) {}

    void loadAll(Resolution resolution) {
        LoadRequest all = request();
        all.resolution = resolution;
        all.keepsPseudonyms = true; // everything
        ASSERT_EQ(load(write("drive.pcap"), all).kind, LoadOutcome::Kind::Loaded);
    }
    std::vector<std::string> ask(const std::string& query) {
        if (!_database) {
            _database.emplace(file);
            addFunctions(*_database, {});
            addStoredSections(*_database, file, fields);
        }
        return linesOf(*_database, query);
    }

    FieldTable fields{technology, resources};

private:
    std::optional<Database> _database;
};

/// At any instant, a section of the store has the values that the spans of the recording have.
class StoredSectionsOf : public StoredSectionsTest,
                         public testing::WithParamInterface<const char*> {
protected:
    StoredSectionsOf() : StoredSectionsTest(GetParam()) {}
};

TEST_P(StoredSectionsOf, HaveTheValuesOfTheRecordingAtAnyInstant) {
    drive(1, std::chrono::seconds(60));
    loadAll(Resolution::Packet);
    const auto timeline = indexed();
    Database recorded;
    addTimelineTables(recorded, *timeline);
    addFunctions(recorded, {}, &timeline->fields());
    const std::vector<FieldGroup> groups = fieldGroups(fields);
    const std::int64_t start = microseconds(Simulation::kStart) / 1000;
    std::size_t compared = 0;
    EXPECT_TRUE(doubles::holds([&] {
        const FieldGroup& group = any::elementOf(groups);
        const auto& [index, column] = any::elementOf(group.fields);
        // In whole milliseconds, as the store has times.
        const std::string time = std::to_string(start + any::longBetween(0, 61'000));
        const bool isLabel = fields[index].kind == FieldInfo::Kind::Label;
        const char* text = fields[index].kind == FieldInfo::Kind::Number ? "NULL" : "text";
        const std::string value = isLabel ? "text" : std::string("coalesce(number, ") + text + ")";
        const auto expected =
            linesOf(recorded, "SELECT entry, " + value + " FROM span WHERE field = '" +
                                  fields[index].name + "' AND start / 1000 <= " + time +
                                  " AND (start + hold) / 1000 > " + time + " ORDER BY 1, 2");
        auto shown =
            ask("SELECT entry, \"" + column + "\" FROM " + fields.technology() + ".\"" +
                group.name + "\" WHERE time / 1000 <= " + time + " AND (time + hold) / 1000 > " +
                time + " AND \"" + column + "\" IS NOT NULL ORDER BY 1, 2");
        std::vector<std::string> known;
        for (const std::string& line : expected) {
            if (!line.ends_with("|NULL")) {
                known.push_back(line);
            }
        }
        compared += known.size();
        RC_ASSERT(shown == known);
    }));
    EXPECT_GT(compared, 10U);
}

INSTANTIATE_TEST_SUITE_P(Technologies, StoredSectionsOf,
                         testing::Values("gsm", "cdma", "ifx", "lte", "utran"));

TEST_F(StoredSectionsTest, HaveARowForEachTimeInWhichNothingChanges) {
    drive(1, std::chrono::seconds(120));
    loadAll(Resolution::Tick);
    EXPECT_EQ(
        ask("SELECT (time - 1700000000000000) / 1000 AS after, hold / 1000, physical_cell_id, "
            "download_bandwidth, freq_band_indicator, system, cell, device, recording FROM "
            "lte.serving_cell_info"),
        (std::vector<std::string>{
            "2006|32000|48|20 MHz|3|lte|PCI 48, EARFCN 1850|car1|drive.pcap",
            "34006|2000|150|20 MHz|3|lte|PCI 150, EARFCN 1850|car1|drive.pcap",
            "36006|62000|150|20 MHz|3|lte|PCI 150, EARFCN 1850|car1|drive.pcap",
            "98006|22000|252|20 MHz|3|lte|PCI 252, EARFCN 1850|car1|drive.pcap"}));
}

TEST_F(StoredSectionsTest, OfAListHaveRowsForEachEntry) {
    drive(1, std::chrono::seconds(60));
    loadAll(Resolution::Tick);
    EXPECT_EQ(
        ask("SELECT entry, count(*), sum(hold) / 1000 FROM lte.neighbor_cells_list GROUP BY "
            "entry"),
        (std::vector<std::string>{"Physical Cell ID 150|1|2000", "Physical Cell ID 251|6|12000",
                                  "Physical Cell ID 252|5|18000", "Physical Cell ID 450|2|28000",
                                  "Physical Cell ID 48|9|26000"}));
}

TEST_F(StoredSectionsTest, NoRowsOfAnEntryOverlap) {
    drive(1, std::chrono::seconds(120));
    loadAll(Resolution::Packet);
    for (const FieldGroup& group : fieldGroups(fields)) {
        EXPECT_EQ(
            ask("SELECT count(*) FROM (SELECT time, lag(time + hold) OVER (PARTITION BY entry "
                "ORDER BY time) AS before, hold FROM lte." +
                group.name + ") WHERE before > time OR hold <= 0"),
            std::vector<std::string>{"0"})
            << group.name;
    }
}

TEST_F(StoredSectionsTest, GiveOnlyTheDeviceThatIsAskedFor) {
    drive(1, std::chrono::seconds(30));
    loadAll(Resolution::Tick);
    const char* counted = "SELECT count(*) > 0 FROM lte.serving_cell_info WHERE device ";
    EXPECT_EQ(ask(counted + std::string("= 'car1'")), std::vector<std::string>{"1"});
    EXPECT_EQ(ask(counted + std::string("= 'car2'")), std::vector<std::string>{"0"});
    EXPECT_EQ(ask(counted + std::string("= 'CAR1' COLLATE NOCASE")), std::vector<std::string>{"1"});
    EXPECT_EQ(ask("SELECT count(*) FROM lte.serving_cell_info WHERE time > 2000000000000000"),
              std::vector<std::string>{"0"});
}

} // namespace
} // namespace pallax
