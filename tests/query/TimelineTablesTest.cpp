#include "query/SectionTable.h"
#include "tests/query/QueryFixture.h"

#include <map>

namespace pallax {
namespace {

using Lines = std::vector<std::string>;
constexpr std::chrono::seconds kDrive{30};

class TimelineTablesTest : public testing::TestWithParam<const char*> {
protected:
    QueryFixture _fixture{GetParam(), 7, kDrive};
};

INSTANTIATE_TEST_SUITE_P(All, TimelineTablesTest, testing::ValuesIn(technologyNames()));

/// Counts samples as they come.
class Counter final : public SampleSink {
public:
    explicit Counter(Timeline& timeline) : _timeline(timeline) {}
    void sample(const Sample& sample) override {
        for (const FieldIndex field : _timeline.fieldTable().of(sample)) {
            ++counts[_timeline.fields()[field].name];
        }
    }
    void keyRemoved(std::string_view /*key*/) override {}
    void beginList(const SampleList& /*list*/) override {}
    void endList() override {}
    void beginEntry(std::size_t /*index*/, std::int64_t /*name*/) override {}
    void endEntry() override {}

    std::map<std::string, int> counts;

private:
    Timeline& _timeline;
};

TEST_P(TimelineTablesTest, HasARowForEachPacketAndEachSample) {
    Timeline& timeline = *_fixture.timeline;
    EXPECT_EQ(_fixture.ask("select count(*), max(packet) from packet"),
              Lines{std::to_string(timeline.packets()) + "|" + std::to_string(timeline.packets())});
    Counter counter(timeline);
    EXPECT_TRUE(timeline.read(1, timeline.packets(), counter));
    Lines expected;
    for (const auto& [name, count] : counter.counts) {
        expected.push_back(name + "|" + std::to_string(count));
    }
    ASSERT_FALSE(expected.empty());
    EXPECT_EQ(_fixture.ask("select field, count(*) from sample group by field order by field"),
              expected);
}

TEST_P(TimelineTablesTest, EachTickOfDecodingIsARowOfTheState) {
    // Each value of a row is the one after the row's packet.
    const Lines rows = _fixture.ask("select packet from state");
    ASSERT_GE(rows.size(), 12U);
    const FieldTable& fields = _fixture.timeline->fields();
    auto query = _fixture.database.prepare("select * from state").value();
    std::map<std::string, FieldIndex> byColumn;
    for (FieldIndex index = 0; index < fields.size(); ++index) {
        std::string name = fields[index].name.substr(fields[index].name.find('.') + 1);
        byColumn.emplace(lastWordOf(name), index);
        std::replace(name.begin(), name.end(), '.', '_');
        byColumn.emplace(name, index);
    }
    while (const auto row = query.next().value()) {
        const auto packet = static_cast<std::uint64_t>(std::get<std::int64_t>((*row)[1]));
        const CurrentValues values = _fixture.timeline->valuesAt(packet);
        for (std::size_t column = 3; column < row->size(); ++column) {
            const std::string& name = query.columns()[column];
            ASSERT_TRUE(byColumn.contains(name)) << name;
            const FieldValue* value = values.value(byColumn[name]);
            const bool isNull = std::holds_alternative<std::monostate>((*row)[column]);
            if (value == nullptr) {
                EXPECT_TRUE(isNull) << name;
            } else if (const auto* text = std::get_if<std::string>(&(*row)[column])) {
                EXPECT_EQ(*text, value->text()) << name;
            }
        }
    }
}

TEST_P(TimelineTablesTest, SpansOfAFieldCoverItsTimeWithoutGapsOrOverlaps) {
    EXPECT_EQ(_fixture.ask("select count(*) from span where hold < 0"), Lines{"0"});
    // Two spans in a row of one field and entry never overlap.
    EXPECT_EQ(_fixture.ask("select count(*) from (select start, hold, lead(start) over (partition "
                           "by field, entry order by start, packet) as after from span) where "
                           "start + hold > after"),
              Lines{"0"});
    // Outside lists no two neighbours have the same value, unless the field was gone in between.
    EXPECT_EQ(_fixture.ask("select count(*) from (select start + hold as ended, text, lead(start) "
                           "over w as after, lead(text) over w as other from span where entry is "
                           "null window w as (partition by field order by start, packet)) "
                           "where text = other and ended = after"),
              Lines{"0"});
}

TEST_P(TimelineTablesTest, EveryTableOfASectionCanBeAsked) {
    std::size_t rows = 0;
    for (const FieldGroup& group : fieldGroups(_fixture.timeline->fields())) {
        const Lines count = _fixture.ask("select count(*) from " + std::string(GetParam()) + ".\"" +
                                         group.name + "\"");
        ASSERT_EQ(count.size(), 1U);
        ASSERT_LT(count[0].find_first_of("0123456789"), 1U) << count[0];
        rows += std::stoul(count[0]);
    }
    EXPECT_GT(rows, 100U);
}

TEST_P(TimelineTablesTest, ALabelIsThatOfItsRawNumber) {
    const bool hasRaw = _fixture.ask("select count(raw) from sample") != Lines{"0"};
    EXPECT_EQ(hasRaw, std::string(GetParam()) != "ifx");
    // Each combination once: a join of all samples takes a minute under sanitizers.
    const std::string samples =
        "(select distinct field, raw, text, number from sample where raw is not null) s";
    EXPECT_EQ(_fixture.ask("select s.field, s.raw, s.text, label(s.field, s.raw) from " + samples +
                           " join field f on f.name = s.field where "
                           "label(s.field, s.raw) is not iif(f.kind = 'label', s.text, null) and "
                           "not (f.kind = 'number' and s.number is null)"),
              Lines{});
    EXPECT_EQ(_fixture.ask("select count(distinct s.field) > 2 from " + samples +
                           " join field f on f.name = s.field where f.kind = 'label'"),
              Lines{hasRaw ? "1" : "0"});
}

TEST_P(TimelineTablesTest, AllTablesAndColumnsAreListed) {
    const std::size_t sections = fieldGroups(_fixture.timeline->fields()).size();
    EXPECT_EQ(_fixture.ask("select count(*) from tables where schema = '" +
                           std::string(GetParam()) + "'"),
              Lines{std::to_string(sections)});
    EXPECT_EQ(_fixture.ask("select name from tables where schema = 'main'"),
              (Lines{"packet", "sample", "series", "span", "state", "cell", "event", "field",
                     "tables", "columns"}));
    for (const Database::Table& table : _fixture.database.tables()) {
        const std::string name = table.schema + ".\"" + table.name + "\"";
        const std::string limit = table.name == "series" ? "('sample') limit 0" : " limit 0";
        const auto query = _fixture.database.prepare("select * from " + name + limit);
        ASSERT_TRUE(query) << name;
        Lines shown;
        for (const std::string& column : query->columns()) {
            shown.push_back(column);
        }
        EXPECT_EQ(_fixture.ask("select name from columns where schema = '" + table.schema +
                               "' and table_name = '" + table.name + "' and not hidden"),
                  shown);
    }
    EXPECT_EQ(_fixture.ask("select count(*) from tables t where columns <> (select "
                           "group_concat(name, ' ') from columns where schema = t.schema and "
                           "table_name = t.name and not hidden)"),
              Lines{"0"});
    EXPECT_NE(_fixture.ask("select count(*) from columns where hidden and name like '%_age'"),
              Lines{"0"});
}

TEST_P(TimelineTablesTest, EventsAndFieldsAreTables) {
    EXPECT_EQ(_fixture.ask("select count(*) from event"),
              Lines{std::to_string(_fixture.timeline->events().size())});
    EXPECT_EQ(_fixture.ask("select count(distinct name) from field"),
              Lines{std::to_string(_fixture.timeline->fields().size())});
    Lines hidden;
    for (FieldIndex index = 0; index < _fixture.timeline->fields().size(); ++index) {
        const FieldInfo& field = _fixture.timeline->fields()[index];
        if (!field.isShown) {
            hidden.push_back(field.name);
        }
    }
    EXPECT_EQ(_fixture.ask("select name from field where not shown"), hidden);
    EXPECT_EQ(hidden.empty(),
              std::string(GetParam()) != "utran" && std::string(GetParam()) != "gsm");
}

class LteTablesTest : public testing::Test {
protected:
    QueryFixture _fixture{"lte", 7, kDrive};
};

TEST_F(LteTablesTest, TheNameOfAFieldIsAnExpression) {
    EXPECT_EQ(_fixture.ask("select count(*) = (select count(*) from sample where field = "
                           "'lte.serving_cell_measurements.measured_rsrp') from "
                           "serving_cell_measurements where "
                           "lte.serving_cell_measurements.measured_rsrp is not null"),
              Lines{"1"});
}

TEST_F(LteTablesTest, ARowOfAListIsAnEntryWithItsIdentityAndPlace) {
    const Lines rows = _fixture.ask("select entry, place, physical_cell_id from "
                                    "neighbor_cells_list limit 2");
    ASSERT_EQ(rows.size(), 2U);
    EXPECT_EQ(rows[0].find("Physical Cell ID "), 0U) << rows[0];
    EXPECT_NE(rows[0].find("|1|"), std::string::npos) << rows[0];
    EXPECT_EQ(_fixture.ask("select count(*) from neighbor_cells_list where entry not like "
                           "'%Physical Cell ID ' || physical_cell_id || '%'"),
              Lines{"0"});
    EXPECT_EQ(_fixture.ask("select min(place), max(place) > 1 from neighbor_cells_list"),
              Lines{"1|1"});
}

TEST_F(LteTablesTest, ASampleHasItsRawNumberItsValueAndItsUnit) {
    EXPECT_EQ(_fixture.ask("select count(*) from sample where field like '%.measured_rsrp' and not "
                           "(abs(number - cast(text as real)) < 1e-9 and unit = 'dBm' and "
                           "raw is not null)"),
              Lines{"0"});
}

TEST_F(LteTablesTest, AgesCountFromTheLatestReading) {
    EXPECT_EQ(_fixture.ask("select count(*) from state where measured_rsrp_age < 0"), Lines{"0"});
    EXPECT_EQ(_fixture.ask("select count(*) from state s where measured_rsrp_age is not null and "
                           "abs(measured_rsrp_age - (s.time - (select max(time) from sample where "
                           "packet <= s.packet and field = "
                           "'lte.serving_cell_measurements.measured_rsrp')) / 1e6) > 1e-5"),
              Lines{"0"});
}

TEST(QueriesWithoutRows, CanBeStoppedToo) {
    QueryFixture fixture("lte", 7, std::chrono::seconds(60));
    ASSERT_GT(fixture.timeline->packets(), 2048U);
    int asked = 0;
    fixture.database.setMayContinue([&] { return ++asked < 2; });
    for (const char* table :
         {"cell", "sample where field = 'lte.serving_cell_info.cell_identity' and number < 0",
          "span where field = 'lte.serving_cell_info.cell_identity' and number < 0", "sim_info"}) {
        asked = 0;
        EXPECT_EQ(fixture.ask(std::string("select count(*) from ") + table),
                  Lines{"The query was stopped."})
            << table;
        EXPECT_EQ(asked, 2) << table;
    }
    fixture.database.setMayContinue({});
    EXPECT_NE(fixture.ask("select count(*) from cell"), Lines{"0"});
}

TEST(QuestionsOfAnEmptyRecording, HaveNoRows) {
    QueryFixture fixture("lte", 1, std::chrono::seconds(0));
    for (const char* table : {"packet", "sample", "span", "state", "event"}) {
        EXPECT_EQ(fixture.ask(std::string("select * from ") + table), Lines{}) << table;
    }
    EXPECT_NE(fixture.ask("select count(*) from field"), Lines{"0"});
}

} // namespace
} // namespace pallax
