#include "storing/Questions.h"

#include "tests/store/StoreFixture.h"

#include <gtest/gtest.h>

#include <cstdint>
#include <limits>

namespace pallax {
namespace {

constexpr std::int64_t kStart = 1'700'000'000'000; // of every simulation, in milliseconds

const QualityProfile& android() {
    static const QualityProfile profile = *builtInProfile("android");
    return profile;
}

class QuestionsTest : public StoreFixture {
protected:
    /// Of another device in the same cells an hour later.
    void loadAnother() {
        MemoryJournal later;
        for (std::uint64_t number = 1; number <= journal.size(); ++number) {
            const JournalPacket packet = journal.packet(number);
            later.add(packet.time + std::chrono::hours(1),
                      ByteBuffer(packet.data.begin(), packet.data.end()));
        }
        journal = later;
        LoadRequest other = request();
        other.device = "car2";
        ASSERT_EQ(load(write("two.pcap"), other).kind, LoadOutcome::Kind::Loaded);
    }
    std::vector<std::string> answer(StoreQuestion question, const AskedTime& time = {},
                                    std::vector<std::string> words = {}) const {
        StoreAskOptions options;
        options.question = question;
        options.words = std::move(words);
        auto levels = judgedLevels("", {}, android());
        if (question == StoreQuestion::Series) {
            levels = {{"", {"lte.serving_cell_measurements.measured_rsrp"}, {}, {}}};
            options.every = std::chrono::minutes(1);
        }
        return ask(queryOf(options, levels, time));
    }
};

TEST(JudgedLevels, AreThoseOfTheStatusWithTheBordersOfTheProfile) {
    const auto all = judgedLevels("", {}, android());
    const auto rsrp = std::find_if(
        all.begin(), all.end(), [](const JudgedLevel& level) { return level.name == "LTE RSRP"; });
    ASSERT_NE(rsrp, all.end());
    EXPECT_EQ(rsrp->fields,
              (std::vector<std::string>{
                  "ifx.serving_cell.rsrp", "ifx.further_serving_cells.rsrp",
                  "lte.serving_cell_measurements.measured_rsrp",
                  "lte.connected_mode_lte_intra_frequency_measurement.serving_filtered_rsrp"}));
    EXPECT_EQ(rsrp->border, -118);
    EXPECT_FALSE(rsrp->borders.isSmallerBetter());
}

TEST(JudgedLevels, AreThoseOfAMeasureOrOfAFieldOrNone) {
    const auto measured = judgedLevels("rsrq", -12.5, android());
    ASSERT_EQ(measured.size(), 2U);
    EXPECT_EQ(measured[0].name, "LTE RSRQ");
    EXPECT_EQ(measured[1].name, "NR RSRQ");
    EXPECT_EQ(measured[0].border, -12.5);
    const auto field = judgedLevels("neighbor_cells_list.average_rsrp", {}, android());
    ASSERT_EQ(field.size(), 1U);
    EXPECT_EQ(field[0].name, "lte.neighbor_cells_list.average_rsrp");
    EXPECT_EQ(field[0].fields, std::vector<std::string>{field[0].name});
    EXPECT_TRUE(judgedLevels("colour", {}, android()).empty());
}

TEST(SectionQuery, HasTheFieldsBetweenTimeAndOrigin) {
    StoreAskOptions options;
    AskedSection section;
    section.table = "lte.cells";
    section.fields = {"pci", "rsrp"};
    EXPECT_EQ(sectionQuery(options, section, {}),
              "SELECT time_text(time) AS time, device, recording, system, cell, round(hold / 1e6, "
              "3) AS seconds, \"pci\", \"rsrp\" FROM lte.cells WHERE true");
    options.device = "it's";
    options.entry = "PCI 1";
    section.isList = true;
    section.fields = {"pci"};
    EXPECT_EQ(
        sectionQuery(options, section, {5, 7}),
        "SELECT time_text(time) AS time, device, recording, system, cell, entry, round(hold / "
        "1e6, 3) AS seconds, \"pci\" FROM lte.cells WHERE true AND time >= 5000 AND time <= "
        "7000 AND device = 'it''s' AND entry = 'PCI 1'");
}

TEST_F(QuestionsTest, TotalsAnswerAsTheIntervalsDo) {
    drive(1, std::chrono::seconds(400));
    (void)load(write("one.pcap"));
    loadAnother();
    // All times as limits, so that every interval is looked at.
    const AskedTime all{0, std::int64_t{4'000'000'000'000}};
    for (const StoreQuestion question : {StoreQuestion::Cells, StoreQuestion::Coverage}) {
        const auto expected = answer(question, all);
        EXPECT_GT(expected.size(), 1U);
        EXPECT_EQ(answer(question), expected);
    }
}

TEST_F(QuestionsTest, CountTheDevicesOfACell) {
    drive(1, std::chrono::seconds(100));
    (void)load(write("one.pcap"));
    loadAnother();
    const auto cells = answer(StoreQuestion::Cells);
    ASSERT_FALSE(cells.empty());
    EXPECT_NE(cells[0].find("|LTE RSRP|2|"), std::string::npos) << cells[0];
}

TEST_F(QuestionsTest, ATimeDividesWhatIsCounted) {
    drive(1, std::chrono::seconds(400));
    (void)load(write("drive.pcap"));
    const auto hoursOf = [&](const AskedTime& time) {
        // The sum of the time of all cells, in milliseconds, as nothing is rounded there.
        StoreAskOptions options;
        options.question = StoreQuestion::Coverage;
        const auto lines = ask("SELECT total(hours) FROM (" +
                               queryOf(options, judgedLevels("rsrp", {}, android()), time) + ")");
        return std::stod(lines.at(0));
    };
    const double whole = hoursOf({});
    EXPECT_GT(whole, 0.1);
    for (const std::int64_t second : {1, 77, 200, 399}) {
        const std::int64_t middle = kStart + second * 1000 + 123;
        EXPECT_NEAR(hoursOf({{}, middle}) + hoursOf({middle, {}}), whole, 0.0011) << second;
    }
    EXPECT_NEAR(hoursOf({kStart + 100'000, kStart + 172'000}), 0.02, 0.001);
}

TEST_F(QuestionsTest, ASeriesBeginsAndEndsWithTheTime) {
    drive(1, std::chrono::seconds(100));
    (void)load(write("drive.pcap"));
    const std::int64_t from = kStart + 51'500; // within the second minute of the clock
    const std::int64_t to = kStart + 70'300;
    std::int64_t known = 0;
    for (const std::string& line :
         ask("SELECT max(0, min(start + hold, " + std::to_string(to * 1000) + ") - max(start, " +
             std::to_string(from * 1000) +
             ")) FROM measurement WHERE field = 'lte.serving_cell_measurements.measured_rsrp'")) {
        known += std::stoll(line);
    }
    ASSERT_GT(known, 1'000'000);
    const auto steps = answer(StoreQuestion::Series, {from, to});
    ASSERT_EQ(steps.size(), 1U);
    EXPECT_EQ(steps[0].substr(0, 24), "2023-11-14T22:14:00.000Z");
    EXPECT_NEAR(std::stod(steps[0].substr(steps[0].rfind('|') + 1)),
                static_cast<double>(known) / 600'000, 0.051);
    EXPECT_GT(answer(StoreQuestion::Series).size(), 1U);
    EXPECT_TRUE(answer(StoreQuestion::Series, {kStart + 500'000, {}}).empty());
    EXPECT_TRUE(answer(StoreQuestion::Series, {{}, kStart - 1}).empty());
}

TEST_F(QuestionsTest, AComparisonCountsEventsOfTheTime) {
    drive(1, std::chrono::seconds(400));
    (void)load(write("drive.pcap"));
    const auto kinds = [&](const AskedTime& time) {
        StoreAskOptions options;
        options.question = StoreQuestion::Compare;
        options.words = {"car1", "car1"};
        return ask("SELECT what FROM (" +
                   queryOf(options, judgedLevels("rsrp", {}, android()), time) +
                   ") WHERE per_hour IS NOT NULL");
    };
    EXPECT_FALSE(kinds({}).empty());
    EXPECT_TRUE(kinds({kStart + 1, kStart + 2000}).empty()) << "before the first event";
}

} // namespace
} // namespace pallax
