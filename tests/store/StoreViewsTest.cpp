#include "tests/store/StoreFixture.h"

// The views of a store are the tables of pallax sql.

namespace pallax {
namespace {

class StoreViewsTest : public StoreFixture {
protected:
    explicit StoreViewsTest(std::string_view technologyName = "lte")
        : StoreFixture(technologyName) {}

    /// Loads the journal and expects the same answers of the store and of the recording.
    void expectSame() {
        LoadRequest all = request();
        all.resolution = Resolution::Packet;
        all.keepsPseudonyms = true; // everything
        ASSERT_EQ(load(write("drive.pcap"), all).kind, LoadOutcome::Kind::Loaded);
        const auto timeline = indexed();
        Database recorded;
        addTimelineTables(recorded, *timeline);
        addFunctions(recorded, {}, &timeline->fields());
        // A store has whole milliseconds.
        for (const char* query :
             {"SELECT start / 1000, packet, field, entry, (start + hold) / 1000 - start / 1000, "
              "number, typeof(number), text, unit FROM span "
              "ORDER BY 3, 4, 2, 1, 5, 8",
              "SELECT time, packet, kind, words, fields FROM event ORDER BY 1, 2, 3, 4",
              "SELECT role, system, identity, code, channel, first_time, last_time, packet, "
              "readings, measure, best_level, last_level FROM cell ORDER BY 1, 2, 3",
              "SELECT name, path, kind, unit, least, most, in_list, identifies, personal, meaning, "
              "shown FROM field ORDER BY 1",
              "SELECT substr(time_text(start), 1, 19) AS since, sum(hold) > 0 FROM span "
              "GROUP BY since ORDER BY since"}) {
            const auto expected = linesOf(recorded, query);
            EXPECT_FALSE(expected.empty()) << query;
            EXPECT_EQ(ask(query), expected) << query;
        }
    }
};

class GsmStoreViewsTest : public StoreViewsTest {
protected:
    GsmStoreViewsTest() : StoreViewsTest("gsm") {}
};
class CdmaStoreViewsTest : public StoreViewsTest {
protected:
    CdmaStoreViewsTest() : StoreViewsTest("cdma") {}
};
class IfxStoreViewsTest : public StoreViewsTest {
protected:
    IfxStoreViewsTest() : StoreViewsTest("ifx") {}
};
class UtranStoreViewsTest : public StoreViewsTest {
protected:
    UtranStoreViewsTest() : StoreViewsTest("utran") {}
};

TEST_F(StoreViewsTest, AreThoseOfTheRecording) {
    drive(1, std::chrono::seconds(120));
    expectSame();
}
TEST_F(GsmStoreViewsTest, AreThoseOfTheRecording) {
    drive(1, std::chrono::seconds(120));
    expectSame();
}
TEST_F(CdmaStoreViewsTest, AreThoseOfTheRecording) {
    drive(1, std::chrono::seconds(120));
    expectSame();
}
TEST_F(IfxStoreViewsTest, AreThoseOfTheRecording) {
    drive(1, std::chrono::seconds(120));
    expectSame();
}
TEST_F(UtranStoreViewsTest, AreThoseOfTheRecording) {
    drive(1, std::chrono::seconds(120));
    expectSame();
}

TEST_F(StoreViewsTest, TellTheServingCellOfEachValue) {
    drive(1, std::chrono::seconds(200));
    (void)load(write("drive.pcap"));
    EXPECT_EQ(ask("SELECT DISTINCT system, cell FROM measurement WHERE cell IS NOT NULL "
                  "ORDER BY start"),
              (std::vector<std::string>{"lte|PCI 48, EARFCN 1850", "lte|PCI 150, EARFCN 1850",
                                        "lte|PCI 252, EARFCN 1850", "lte|PCI 151, EARFCN 1850"}));
    EXPECT_EQ(ask("SELECT DISTINCT device, recording, technology, decoder FROM measurement"),
              (std::vector<std::string>{"car1|drive.pcap|lte|1.0"}));
}

TEST_F(CdmaStoreViewsTest, AnAbsentValueHasAReasonAndALabelItsNumber) {
    drive(1, std::chrono::seconds(60));
    (void)load(write("drive.pcap"));
    EXPECT_EQ(ask("SELECT DISTINCT text, number, reason FROM measurement WHERE field = "
                  "'cdma.1x_receiver_1.agc' AND reason IS NOT NULL"),
              std::vector<std::string>{"N/A|NULL|not applicable"});
    EXPECT_EQ(ask("SELECT DISTINCT text, number, raw, reason FROM measurement WHERE text LIKE "
                  "'Paging%'"),
              std::vector<std::string>{"Paging [6]|NULL|6|NULL"});
}

} // namespace
} // namespace pallax
