#include "web/Metrics.h"

#include "fields/FieldRegistry.h"
#include "fields/StatusFields.h"
#include "tests/overview/ValuesFixture.h"

#include <gtest/gtest.h>

namespace pallax {
namespace {

using namespace std::chrono_literals;

constexpr Time kNow = Time(1700000020s);

StatusValue value(const std::string& name, const std::string& text, double number = 0,
                  std::optional<Grade> grade = std::nullopt) {
    return {name, "", text, number, grade, kNow};
}

Status statusOfCell() {
    Status status;
    status.time = kNow;
    status.profile = "field";
    StatusCell cell;
    cell.system = "LTE";
    cell.site = "eNodeB 104470 sector 1";
    cell.identity = {value("Cell", "26744321"), value("PCI", "150")};
    cell.channel = value("EARFCN", "1850");
    cell.band = "3";
    cell.levels = {value("RSRP", "-94.50 dBm", -94.5, Grade::Good), value("Ec/No", "-6 dB", -6),
                   value("RxQual", "3", 3), value("RSRQ", "-9 dB", -9)};
    cell.levels.back().read = kNow - 11s;
    status.cells.push_back(cell);
    status.states.push_back(value("RRC", "Idle \"\\\n"));
    status.neighbours.push_back({"LTE", "PCI 7", value("RSRP", "-100 dBm")});
    status.neighbours.push_back({"LTE", "PCI 8", value("RSRP", "-101 dBm")});
    status.neighbours.back().level.read = kNow - 11s;
    return status;
}

const SessionCounts kCounts{.isConnected = true,
                            .packets = 120,
                            .forgotten = 20,
                            .viewers = 2,
                            .latest = Time(1700000020500ms)};

constexpr const char* kText =
    R"(# HELP pallax_cell_info The serving cell.
# TYPE pallax_cell_info gauge
pallax_cell_info{system="LTE",cell="26744321",pci="150",earfcn="1850",band="3"} 1
# HELP pallax_connected Whether packets of the modem can come: 1 or 0.
# TYPE pallax_connected gauge
pallax_connected 1
# HELP pallax_ec_no_db Ec/No of the serving cell.
# TYPE pallax_ec_no_db gauge
pallax_ec_no_db{system="LTE"} -6
# HELP pallax_latest_packet_timestamp_seconds Time of the latest packet, since 1970.
# TYPE pallax_latest_packet_timestamp_seconds gauge
pallax_latest_packet_timestamp_seconds 1700000020.5
# HELP pallax_level_grade Quality of a level: 0 none, 1 poor, 2 fair, 3 good, 4 excellent.
# TYPE pallax_level_grade gauge
pallax_level_grade{system="LTE",level="RSRP",profile="field"} 3
# HELP pallax_neighbours Neighbour cells with a current level.
# TYPE pallax_neighbours gauge
pallax_neighbours 1
# HELP pallax_packets_total Packets that have come.
# TYPE pallax_packets_total counter
pallax_packets_total 120
# HELP pallax_packets_dropped_total Packets that are no longer kept, to bound memory and disk.
# TYPE pallax_packets_dropped_total counter
pallax_packets_dropped_total 20
# HELP pallax_rsrp_dbm RSRP of the serving cell.
# TYPE pallax_rsrp_dbm gauge
pallax_rsrp_dbm{system="LTE"} -94.5
# HELP pallax_rxqual RxQual of the serving cell.
# TYPE pallax_rxqual gauge
pallax_rxqual{system="LTE"} 3
# HELP pallax_state_info A state of the protocols.
# TYPE pallax_state_info gauge
pallax_state_info{name="RRC",state="Idle \"\\\n"} 1
# HELP pallax_viewers Pages that follow the session.
# TYPE pallax_viewers gauge
pallax_viewers 2
)";

TEST(Metrics, HaveLevelsGradesStatesTheCellAndCounts) {
    EXPECT_EQ(metricsText(statusOfCell(), kCounts, MetricsForm::Prometheus), kText);
}

TEST(Metrics, OfOpenMetricsNameUnitsAndAnEnd) {
    const std::string text = metricsText(statusOfCell(), kCounts, MetricsForm::OpenMetrics);
    for (const char* line : {"# TYPE pallax_packets counter\npallax_packets_total 120\n",
                             "# TYPE pallax_rsrp_dbm gauge\n# UNIT pallax_rsrp_dbm dbm\n"
                             "pallax_rsrp_dbm{system=\"LTE\"} -94.5\n",
                             "# UNIT pallax_latest_packet_timestamp_seconds seconds\n"}) {
        EXPECT_NE(text.find(line), std::string::npos) << line << text;
    }
    EXPECT_TRUE(text.ends_with("pallax_viewers 2\n# EOF\n")) << text;
}

TEST(Metrics, BeforeAnyPacketAreCounts) {
    EXPECT_EQ(metricsText(std::nullopt, {}, MetricsForm::OpenMetrics),
              R"(# HELP pallax_connected Whether packets of the modem can come: 1 or 0.
# TYPE pallax_connected gauge
pallax_connected 0
# HELP pallax_packets Packets that have come.
# TYPE pallax_packets counter
pallax_packets_total 0
# HELP pallax_packets_dropped Packets that are no longer kept, to bound memory and disk.
# TYPE pallax_packets_dropped counter
pallax_packets_dropped_total 0
# HELP pallax_viewers Pages that follow the session.
# TYPE pallax_viewers gauge
pallax_viewers 0
# EOF
)");
}

TEST(Metrics, TheScraperChoosesTheForm) {
    EXPECT_EQ(metricsFormFor(""), MetricsForm::Prometheus);
    EXPECT_EQ(metricsFormFor("text/plain;version=0.0.4;q=0.5,*/*;q=0.1"), MetricsForm::Prometheus);
    EXPECT_EQ(metricsFormFor("application/openmetrics-text;version=1.0.0,text/plain;q=0.5"),
              MetricsForm::OpenMetrics);
    EXPECT_EQ(metricsType(MetricsForm::OpenMetrics),
              "application/openmetrics-text; version=1.0.0; charset=utf-8");
    EXPECT_EQ(metricsType(MetricsForm::Prometheus), "text/plain; version=0.0.4; charset=utf-8");
}

/// Metrics are made of a status, and its cells of these fields.
TEST(Metrics, NoFieldOfACellIdentifiesAPerson) {
    std::size_t looked = 0;
    for (const RecordedTechnology& technology : recordedTechnologies()) {
        const ValuesFixture fixture(technology.commandName);
        for (const StatusCellFields& cell : statusCells()) {
            for (const StatusField& field : cell.fields) {
                const auto index = fixture.fields.named(field.field);
                if (cell.technology == technology.commandName && index) {
                    EXPECT_FALSE(fixture.fields[*index].isPersonal) << field.field;
                    ++looked;
                }
            }
        }
    }
    EXPECT_GT(looked, 20U);
}

} // namespace
} // namespace pallax
