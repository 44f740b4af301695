#include "fields/CellFields.h"
#include "fields/EventFields.h"
#include "fields/Measures.h"
#include "tests/query/QueryFixture.h"

#include <algorithm>
#include <set>

namespace pallax {
namespace {

using Lines = std::vector<std::string>;
constexpr std::chrono::minutes kMinute{1};

class CellTableTest : public testing::TestWithParam<const char*> {
protected:
    QueryFixture _fixture{GetParam(), 1, kMinute};
};

INSTANTIATE_TEST_SUITE_P(All, CellTableTest, testing::ValuesIn(technologyNames()));

TEST_P(CellTableTest, HasOneRowForEachCellAndRole) {
    EXPECT_NE(_fixture.ask("select count(*) from cell where role = 'serving'"), Lines{"0"});
    EXPECT_EQ(_fixture.ask("select role, system, identity, count(*) from cell group by 1, 2, 3 "
                           "having count(*) > 1"),
              Lines{});
    EXPECT_EQ(_fixture.ask("select * from cell where first_time > last_time or readings < 1 or "
                           "best_level < last_level or identity = ''"),
              Lines{});
    EXPECT_EQ(_fixture.ask("select count(*) from cell c join packet p on p.packet = c.packet where "
                           "p.time <> c.first_time"),
              Lines{"0"});
}

TEST_P(CellTableTest, NamesOnlyFieldsOfTheRegistry) {
    const FieldTable& fields = _fixture.timeline->fields();
    for (const CellFields& cell : cellFields()) {
        if (cell.technology != GetParam()) {
            continue;
        }
        std::vector<std::string_view> names{cell.code};
        names.insert(names.end(), cell.area.begin(), cell.area.end());
        for (const std::string_view name : {cell.channel, cell.networkColour}) {
            if (!name.empty()) {
                names.push_back(name);
            }
        }
        for (const std::string_view name : names) {
            EXPECT_TRUE(fields.named(name)) << name;
        }
    }
}

TEST_P(CellTableTest, EveryListOfCellsHasARole) {
    // What identifies the entries of a list is told for the table, except in lists of other things.
    const std::set<std::string> others{
        "cdma.ev_do.finger_c2i", // the pilots of fingers are those of the active set
        "gsm.bler.transport_channels.transport_channel_id",
        "gsm.equivalent_plmn_list.mobile_country_code",
        "gsm.equivalent_plmn_list.mobile_network_code",
        "gsm.hsdpa_info.primary_harq_process.process_id",
        "gsm.hsdpa_info.secondary_harq_process.process_id",
        "gsm.mobile_allocation.arfcns",
        "ifx.barred_cells",                     // a channel alone
        "lte.reselection_candidates_list.band", // as are the channel and the technology, ...
        "lte.reselection_candidates_list.candidate_rat_type",
        "utran.cctrch_sir.cctrch_id",
        "utran.gsm_neighbor_cell_list.band_indicator", // of the channel
        "utran.trch_bler.trch_id",
    };
    std::set<std::string_view> told;
    for (const CellFields& cell : cellFields()) {
        told.insert({cell.code, cell.channel, cell.networkColour});
    }
    for (FieldIndex index = 0; index < _fixture.timeline->fields().size(); ++index) {
        const FieldInfo& field = _fixture.timeline->fields()[index];
        const bool isNamed = !field.identity.empty() && field.identity.front() == kEntryName;
        if (field.identifies || isNamed) {
            EXPECT_NE(told.contains(field.name), others.contains(field.name)) << field.name;
        }
    }
}

/// "lte.serving_cell_info" of one of its fields.
std::string_view sectionOf(std::string_view field) {
    return field.substr(0, field.rfind('.'));
}

TEST_P(CellTableTest, EverySectionWhoseServingCellMakesEventsIsThere) {
    for (const EventFields& events : eventFields()) {
        if (events.technology == GetParam() && events.watch == EventFields::Watch::Cell) {
            EXPECT_TRUE(std::any_of(cellFields().begin(), cellFields().end(),
                                    [&](const CellFields& cell) {
                                        return cell.role == CellRole::Serving &&
                                               sectionOf(cell.code) == sectionOf(events.fields[0]);
                                    }))
                << events.fields[0];
        }
    }
}

TEST(CellTable, OfLteHasWhatTheSectionsSay) {
    QueryFixture fixture("lte", 1, kMinute);
    // Each reading of a serving cell, with the level, from four sections.
    const std::string readings =
        "select physical_cell_id p, e_arfcn f, time, packet, measured_rsrp l from "
        "serving_cell_measurements union all "
        "select physical_cell_id, coalesce(download_frequency, uarfcn) as f, time, packet, null "
        "from serving_cell_info where f is not null union all "
        "select serving_physical_cell_id, e_arfcn, time, packet, serving_filtered_rsrp from "
        "connected_mode_lte_intra_frequency_measurement union all "
        "select serving_cell_id, serving_earfcn, time, packet, null from reselection_candidates";
    const Lines expected =
        fixture.ask("select 'PCI ' || p || ', EARFCN ' || f, p, f, min(time), max(time), "
                    "min(packet), count(*), 'rsrp', max(l) from (" +
                    readings + ") group by p, f order by 1");
    ASSERT_GE(expected.size(), 2U);
    EXPECT_EQ(fixture.ask("select identity, code, channel, first_time, last_time, packet, "
                          "readings, measure, best_level from cell where role = 'serving' "
                          "order by 1"),
              expected);
}

TEST(CellTable, TheChannelOfAListCanBeInAnotherSection) {
    QueryFixture fixture("lte", 1, kMinute);
    const Lines expected = fixture.ask(
        "select p, f, min(t), max(t), count(*), max(l) from (select n.physical_cell_id p, "
        "m.e_arfcn f, n.time t, n.measured_rsrp l from neighbor_cells_list n join "
        "neighbor_measurements m using (packet) union all select n.physical_cell_id, m.e_arfcn, "
        "n.time, n.filtered_rsrp from measured_neighbor_cells n join "
        "connected_mode_lte_intra_frequency_measurement m using (packet)) group by 1, 2 order by "
        "1, 2");
    ASSERT_GE(expected.size(), 3U);
    EXPECT_EQ(fixture.ask("select code, channel, first_time, last_time, readings, best_level from "
                          "cell where role = 'neighbour' order by 1, 2"),
              expected);
}

TEST(CellTable, ACellOfGsmIsKnownBeforeItsCodeIs) {
    QueryFixture fixture("gsm", 1, kMinute);
    EXPECT_EQ(fixture.ask("select code, channel, readings from cell where role = 'neighbour' order "
                          "by 1, 2"),
              fixture.ask("select bsic, arfcn, count(*) from neighboring_cells group by 1, 2 order "
                          "by 1, 2"));
    EXPECT_NE(fixture.ask("select identity from cell where code is null and identity = 'ARFCN ' || "
                          "channel"),
              Lines{});
}

TEST(CellTable, TheColoursOfACellMakeItsCode) {
    QueryFixture fixture("utran", 1, kMinute);
    EXPECT_EQ(fixture.ask("select code, channel, readings from cell where system = 'gsm' order by "
                          "1, 2"),
              fixture.ask("select ncc * 8 + bcc, arfcn, count(*) from gsm_neighbor_cell_list group "
                          "by 1, 2 order by 1, 2"));
}

TEST(CellTable, PilotsAreNamedByTheirOffset) {
    QueryFixture fixture("cdma", 1, kMinute);
    EXPECT_EQ(fixture.ask("select 'PN ' || code, readings, measure from cell where role = 'active' "
                          "and measure is not null and channel is not null order by 1"),
              fixture.ask("select entry, count(*), 'ecio' from sample where field = "
                          "'cdma.1x.active_set' group by 1 order by 1"));
    EXPECT_EQ(fixture.ask("select count(*) from cell where identity like '%Invalid%'"), Lines{"0"});
    EXPECT_NE(fixture.ask("select identity from cell where identity like 'Base Station ID %, "
                          "Network ID %, System ID %'"),
              Lines{});
}

TEST(CellTable, AnObjectStreamHasTheCellsOfItsPaths) {
    QueryFixture fixture("ifx", 1, kMinute);
    EXPECT_EQ(fixture.ask("select 'ARFCN ' || channel || ', BSIC ' || code, readings from cell "
                          "where role = 'neighbour' order by 1"),
              fixture.ask("select entry, count(*) from sample where field = "
                          "'ifx.neighbour_cells.arfcn' group by 1 order by 1"));
}

TEST(CellTable, GrowsWithItsTimeline) {
    QueryFixture fixture("lte", 1, std::chrono::seconds(10));
    const Lines before = fixture.ask("select sum(readings) from cell");
    fixture.drive(1, std::chrono::seconds(10));
    EXPECT_TRUE(fixture.timeline->index());
    EXPECT_GT(std::stoi(fixture.ask("select sum(readings) from cell")[0]), std::stoi(before[0]));
}

TEST(CellTable, WordsAndSystemsAreTold) {
    EXPECT_EQ(wordOf(CellRole::Serving), "serving");
    EXPECT_EQ(wordOf(CellRole::Candidate), "candidate");
    EXPECT_EQ(cellTermsOf(RadioSystem::Nr).channel, "NR-ARFCN");
}

} // namespace
} // namespace pallax
