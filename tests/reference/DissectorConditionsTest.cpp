#include "tests/doubles/Files.h"
#include "tests/doubles/Pattern.h"
#include "tests/doubles/Shell.h"

#include <gtest/gtest.h>

#include <map>
#include <set>
#include <sstream>

// The protocol analyser with the dissector and pallax sql find the same packets by the same
// conditions.

namespace pallax {
namespace {

using doubles::replaced;
using doubles::runCommand;

struct Asked {
    std::string recording;
    /// Each on one section; no two of a recording begin with the same field.
    std::vector<std::string> conditions;
};

const std::vector<Asked>& asked() {
    static const std::vector<Asked> all{
        {"lte-drive",
         {"lte.serving_cell_measurements.measured_rsrp < -97",
          "lte.serving_cell_measurements.srxlev >= 40",
          "lte.serving_cell_measurements.measured_rsrq < -9.5",
          "lte.serving_cell_measurements.physical_cell_id == 182",
          "lte.connected_mode_lte_intra_frequency_measurement.serving_filtered_rsrp > -85",
          "lte.connected_mode_lte_intra_frequency_measurement.subframe_number < 1000 and "
          "lte.connected_mode_lte_intra_frequency_measurement.serving_filtered_rsrq > -9",
          "lte.serving_cell_info.physical_cell_id != 182",
          "lte.neighbor_cells_list.measured_rsrp < -102",
          "lte.measured_neighbor_cells.filtered_rsrq > -8"}},
        {"umts-drive",
         {"gsm.active_set.rscp < -100", "gsm.active_set.energy_per_chip >= -6",
          "gsm.umts_set.scrambling_code == 212 or gsm.umts_set.rscp < -110",
          "gsm.umts_rr_info.transmit_power > 0", "gsm.neighboring_cells.bsic == 17"}},
        {"gsm-attach",
         {"gsm.process_cs.mm_state == \"MM_IDLE\"",
          "gsm.process_ps.mm_sub_state == \"GMM_ATTACH_NEEDED\""}},
        {"cdma-drive",
         {"cdma.ev_do.color_code == 63", "cdma.ev_do.channel > 400",
          "cdma.system_identity.system_id == 4139"}},
        {"utran-drive",
         {"utran.gsm_neighbor_cell_list.rssi < -100", "utran.neighbor_cell_list.uarfcn == 10104",
          "utran.serving_cell_info.cell_id > 10940000", "utran.cctrch_sir.tsnum == 5",
          "utran.trch_bler.trch_bler_measurement > 20", "utran.rrc_info.state == \"Cell DCH\""}},
    };
    return all;
}

/// The first field that a condition names.
std::string firstFieldOf(const std::string& condition) {
    return condition.substr(0, condition.find(' '));
}

std::string pathOf(const std::string& recording) {
    return PALLAX_SOURCE_DIR "/samples/" + recording + ".pcap";
}

using FoundPackets = std::map<std::string, std::set<int>>; ///< by condition

/// What the analyser appends to the description of each packet for which a condition holds.
FoundPackets filtered(const Asked& asked) {
    std::string command = "LC_ALL=C.UTF-8 tshark -X lua_script:" PALLAX_SOURCE_DIR
                          "/extras/wireshark/pallax.lua -r " +
                          pathOf(asked.recording) + " -T fields -e frame.number -e _ws.col.Info";
    for (const std::string& condition : asked.conditions) {
        command += " -z 'proto,colinfo," +
                   replaced(condition, R"((^|and |or )([a-z]+\.))", "$1pallax_$2") + ",pallax_" +
                   firstFieldOf(condition) + "'";
    }
    const auto run = runCommand(command + " 2>/dev/null");
    EXPECT_EQ(run.status, 0) << command;
    FoundPackets packets;
    std::istringstream lines(run.out);
    for (std::string line; std::getline(lines, line);) {
        for (const std::string& condition : asked.conditions) {
            if (line.find("  pallax_" + firstFieldOf(condition) + " ==") != std::string::npos) {
                packets[condition].insert(std::stoi(line));
            }
        }
    }
    return packets;
}

FoundPackets queried(const Asked& asked) {
    std::string queries;
    for (const std::string& condition : asked.conditions) {
        const std::string field = firstFieldOf(condition);
        queries += "select distinct packet as '" + field + "' from " +
                   field.substr(0, field.rfind('.')) + " where " + condition + ";\n";
    }
    const doubles::TemporaryFolder folder;
    const auto run =
        runCommand(PALLAX_BINARY_DIR "/pallax sql --format csv " + pathOf(asked.recording) + " < " +
                   folder.write("queries.sql", replaced(queries, "\"", "'")));
    EXPECT_EQ(run.status, 0) << run.out << queries;
    FoundPackets packets;
    std::istringstream lines(run.out);
    std::size_t next = 0;
    for (std::string line; std::getline(lines, line);) {
        if (next < asked.conditions.size() && line == firstFieldOf(asked.conditions[next])) {
            ++next;
        } else if (next > 0) {
            packets[asked.conditions[next - 1]].insert(std::stoi(line));
        }
    }
    EXPECT_EQ(next, asked.conditions.size()) << run.out;
    return packets;
}

TEST(DissectorConditions, FindThePacketsThatAQueryFinds) {
    if (!doubles::isInstalled("tshark")) {
        GTEST_SKIP() << "tshark is not installed";
    }
    std::size_t conditions = 0;
    for (const Asked& each : asked()) {
        SCOPED_TRACE(each.recording);
        const FoundPackets filter = filtered(each);
        const FoundPackets query = queried(each);
        for (const std::string& condition : each.conditions) {
            ++conditions;
            const auto found = filter.find(condition);
            ASSERT_NE(found, filter.end()) << "no packet: " << condition;
            ASSERT_TRUE(query.contains(condition)) << condition;
            EXPECT_EQ(found->second, query.at(condition)) << condition;
        }
    }
    EXPECT_GE(conditions, 20U);
}

} // namespace
} // namespace pallax
