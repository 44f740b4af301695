#include "fields/StatusFields.h"

#include <algorithm>
#include <array>

namespace pallax {

namespace {

using Kind = StatusField::Role;

constexpr auto kLte = std::to_array<StatusField>({
    {Kind::Site, "cell", "lte.serving_cell_info.cell_identity"},
    {Kind::Identity, "PCI", "lte.serving_cell_info.physical_cell_id"},
    {Kind::Identity, "PCI", "lte.serving_cell_measurements.physical_cell_id"},
    {Kind::Identity, "TAC", "lte.serving_cell_info.tracking_area_code"},
    {Kind::Channel, "EARFCN", "lte.serving_cell_info.download_frequency"},
    {Kind::Channel, "EARFCN", "lte.serving_cell_measurements.e_arfcn"},
    {Kind::Uplink, "uplink", "lte.serving_cell_info.upload_frequency"},
    {Kind::Band, "band", "lte.serving_cell_info.freq_band_indicator"},
    {Kind::Detail, "bandwidth", "lte.serving_cell_info.download_bandwidth"},
    {Kind::Detail, "antenna ports", "lte.serving_cell_info.num_tx_antennas"},
    {Kind::Level, "RSRP", "lte.serving_cell_measurements.measured_rsrp"},
    {Kind::Level, "RSRP",
     "lte.connected_mode_lte_intra_frequency_measurement.serving_filtered_rsrp"},
    {Kind::Level, "RSRQ", "lte.serving_cell_measurements.measured_rsrq"},
    {Kind::Level, "RSRQ",
     "lte.connected_mode_lte_intra_frequency_measurement.serving_filtered_rsrq"},
});
constexpr auto kLteIdle = std::to_array<StatusField>({
    {Kind::Identity, "PCI", "lte.neighbor_cells_list.physical_cell_id"},
});
constexpr auto kLteConnected = std::to_array<StatusField>({
    {Kind::Identity, "PCI", "lte.measured_neighbor_cells.physical_cell_id"},
});
constexpr auto kLteLists = std::to_array<StatusList>({
    {"RSRP", "lte.neighbor_cells_list.measured_rsrp", kLteIdle},
    {"RSRP", "lte.measured_neighbor_cells.filtered_rsrp", kLteConnected},
});

constexpr auto kGsm = std::to_array<StatusField>({
    {Kind::Site, "cell", "gsm.gsm_serving_cell.cell_id"},
    {Kind::Identity, "BSIC", "gsm.gsm_serving_cell.bsic"},
    {Kind::Channel, "ARFCN", "gsm.gsm_serving_cell.arfcn"},
});
constexpr auto kGsmSet = std::to_array<StatusField>({
    {Kind::Identity, "ARFCN", "gsm.gsm_set.arfcn"},
    {Kind::Identity, "BSIC", "gsm.gsm_set.bsic"},
});
constexpr auto kGsmLists = std::to_array<StatusList>({
    {"RSSI", "gsm.gsm_set.rssi", kGsmSet},
});
constexpr auto kUmts = std::to_array<StatusField>({
    {Kind::Site, "cell", "gsm.umts_rr_info.cell_id"},
    {Kind::Identity, "PSC", "gsm.umts_rr_info.scrambling_code"},
    {Kind::Channel, "UARFCN", "gsm.umts_rr_info.uarfcn"},
    {Kind::Channel, "UARFCN", "gsm.umts_rr_info.downlink_frequency"},
    {Kind::Uplink, "uplink", "gsm.umts_rr_info.uplink_frequency"},
});
constexpr auto kActiveSet = std::to_array<StatusField>({
    {Kind::Identity, "PSC", "gsm.active_set.scrambling_code"},
});
constexpr auto kUmtsSet = std::to_array<StatusField>({
    {Kind::Identity, "PSC", "gsm.umts_set.scrambling_code"},
    {Kind::Identity, "UARFCN", "gsm.umts_set.uarfcn"},
    {Kind::Identity, "UARFCN", "gsm.umts_set.downlink_frequency"},
});
constexpr auto kUmtsLists = std::to_array<StatusList>({
    {"RSCP", "gsm.active_set.rscp", kActiveSet},
    {"Ec/Io", "gsm.active_set.energy_per_chip", kActiveSet},
    {"RSCP", "gsm.umts_set.rscp", kUmtsSet},
    {"RSCP", "gsm.umts_set.rank_cell_rscp", kUmtsSet},
});

constexpr auto kUtran = std::to_array<StatusField>({
    {Kind::Site, "cell", "utran.serving_cell_info.cell_id"},
    {Kind::Identity, "PSC", "utran.serving_cell_info.cell_scrambling_code"},
    {Kind::Identity, "LAC", "utran.serving_cell_info.local_area_code"},
    {Kind::Channel, "UARFCN", "utran.serving_cell_info.downlink_uarfcn"},
    {Kind::Uplink, "uplink", "utran.serving_cell_info.uplink_uarfcn"},
    {Kind::Band, "band", "utran.serving_cell_info.freq_band_indicator"},
});
constexpr auto kUtranSet = std::to_array<StatusField>({
    {Kind::Identity, "PSC", "utran.neighbor_cell_list.cell_id"},
    {Kind::Identity, "UARFCN", "utran.neighbor_cell_list.uarfcn"},
});
constexpr auto kUtranLists = std::to_array<StatusList>({
    {"RSCP", "utran.neighbor_cell_list.filter_rscp", kUtranSet},
});

constexpr auto kOneX = std::to_array<StatusField>({
    {Kind::Identity, "SID", "cdma.system_identity.system_id"},
    {Kind::Identity, "NID", "cdma.system_identity.network_id"},
    {Kind::Identity, "base station", "cdma.system_identity.base_station_id"},
    {Kind::Channel, "channel", "cdma.1x_receiver_0.channel"},
    {Kind::Band, "band class", "cdma.1x_receiver_0.band_class"},
    {Kind::Level, "AGC", "cdma.1x_receiver_0.agc"},
});
constexpr auto kOneXLists = std::to_array<StatusList>({
    {"Ec/Io", "cdma.1x.active_set", {}, "(ref pilot)"},
});
constexpr auto kEvdo = std::to_array<StatusField>({
    {Kind::Identity, "PN", "cdma.ev_do.serving_pn_offset"},
    {Kind::Channel, "channel", "cdma.ev_do.channel"},
    {Kind::Band, "band class", "cdma.ev_do.band_class"},
    {Kind::Level, "AGC", "cdma.ev_do.receive_agc_0"},
});
constexpr auto kEvdoLists = std::to_array<StatusList>({
    {"Ec/Io", "cdma.ev_do.active_set", {}},
});

constexpr auto kIfx = std::to_array<StatusField>({
    {Kind::Site, "cell", "ifx.serving_cell.area.cell_id"},
    {Kind::Site, "cell", "ifx.serving_cell.cell_id"},
    {Kind::Identity, "BSIC", "ifx.serving_cell.bsic"},
    {Kind::Identity, "LAC", "ifx.serving_cell.area.lac"},
    {Kind::Identity, "LAC", "ifx.serving_cell.lac"},
    {Kind::Channel, "ARFCN", "ifx.serving_cell.arfcn"},
    {Kind::Level, "RxLev", "ifx.serving_cell.rx_level"},
});
constexpr auto kIfxUmts = std::to_array<StatusField>({
    {Kind::Site, "cell", "ifx.serving_cell.cell_id"},
    {Kind::Identity, "PSC", "ifx.serving_cell.scrambling_code"},
    {Kind::Identity, "LAC", "ifx.serving_cell.lac"},
    {Kind::Channel, "UARFCN", "ifx.serving_cell.uarfcn"},
    {Kind::Level, "RSCP", "ifx.serving_cell.rscp"},
    {Kind::Level, "Ec/Io", "ifx.serving_cell.ec_io"},
});
constexpr auto kIfxTdScdma = std::to_array<StatusField>({
    {Kind::Site, "cell", "ifx.serving_cell.cell_id"},
    {Kind::Identity, "CPID", "ifx.serving_cell.cell_parameter_id"},
    {Kind::Identity, "LAC", "ifx.serving_cell.lac"},
    {Kind::Channel, "UARFCN", "ifx.serving_cell.uarfcn"},
    {Kind::Level, "RSCP", "ifx.serving_cell.rscp"},
});
constexpr auto kIfxLte = std::to_array<StatusField>({
    {Kind::Site, "cell", "ifx.serving_cell.cell_id"},
    {Kind::Identity, "PCI", "ifx.serving_cell.physical_cell_id"},
    {Kind::Identity, "TAC", "ifx.serving_cell.tac"},
    {Kind::Channel, "EARFCN", "ifx.serving_cell.earfcn"},
    {Kind::Level, "RSRP", "ifx.serving_cell.rsrp"},
    {Kind::Level, "RSRQ", "ifx.serving_cell.rsrq"},
    {Kind::Level, "SINR", "ifx.serving_cell.sinr"},
});
constexpr auto kIfxNr = std::to_array<StatusField>({
    {Kind::Site, "cell", "ifx.serving_cell.cell_id"},
    {Kind::Identity, "PCI", "ifx.serving_cell.physical_cell_id"},
    {Kind::Identity, "TAC", "ifx.serving_cell.tac"},
    {Kind::Channel, "NR-ARFCN", "ifx.serving_cell.nr_arfcn"},
    {Kind::Level, "RSRP", "ifx.serving_cell.rsrp"},
    {Kind::Level, "RSRQ", "ifx.serving_cell.rsrq"},
    {Kind::Level, "SINR", "ifx.serving_cell.sinr"},
});
constexpr auto kIfxCdma = std::to_array<StatusField>({
    {Kind::Site, "cell", "ifx.serving_cell.base_station_id"},
    {Kind::Identity, "PN", "ifx.serving_cell.pn"},
    {Kind::Identity, "NID", "ifx.serving_cell.nid"},
    {Kind::Identity, "SID", "ifx.serving_cell.sid"},
    {Kind::Level, "RSSI", "ifx.serving_cell.rssi"},
    {Kind::Level, "Ec/Io", "ifx.serving_cell.ec_io"},
});

// Cells that serve beside the serving cell.
constexpr auto kIfxFurtherGsm = std::to_array<StatusField>({
    {Kind::Site, "cell", "ifx.further_serving_cells.cell_id"},
    {Kind::Identity, "BSIC", "ifx.further_serving_cells.bsic"},
    {Kind::Identity, "LAC", "ifx.further_serving_cells.lac"},
    {Kind::Channel, "ARFCN", "ifx.further_serving_cells.arfcn"},
    {Kind::Level, "RxLev", "ifx.further_serving_cells.rx_level"},
});
constexpr auto kIfxFurtherUmts = std::to_array<StatusField>({
    {Kind::Site, "cell", "ifx.further_serving_cells.cell_id"},
    {Kind::Identity, "PSC", "ifx.further_serving_cells.scrambling_code"},
    {Kind::Identity, "LAC", "ifx.further_serving_cells.lac"},
    {Kind::Channel, "UARFCN", "ifx.further_serving_cells.uarfcn"},
    {Kind::Level, "RSCP", "ifx.further_serving_cells.rscp"},
    {Kind::Level, "Ec/Io", "ifx.further_serving_cells.ec_io"},
});
constexpr auto kIfxFurtherTdScdma = std::to_array<StatusField>({
    {Kind::Site, "cell", "ifx.further_serving_cells.cell_id"},
    {Kind::Identity, "CPID", "ifx.further_serving_cells.cell_parameter_id"},
    {Kind::Identity, "LAC", "ifx.further_serving_cells.lac"},
    {Kind::Channel, "UARFCN", "ifx.further_serving_cells.uarfcn"},
    {Kind::Level, "RSCP", "ifx.further_serving_cells.rscp"},
});
constexpr auto kIfxFurtherLte = std::to_array<StatusField>({
    {Kind::Site, "cell", "ifx.further_serving_cells.cell_id"},
    {Kind::Identity, "PCI", "ifx.further_serving_cells.physical_cell_id"},
    {Kind::Identity, "TAC", "ifx.further_serving_cells.tac"},
    {Kind::Channel, "EARFCN", "ifx.further_serving_cells.earfcn"},
    {Kind::Level, "RSRP", "ifx.further_serving_cells.rsrp"},
    {Kind::Level, "RSRQ", "ifx.further_serving_cells.rsrq"},
    {Kind::Level, "SINR", "ifx.further_serving_cells.sinr"},
});
constexpr auto kIfxFurtherNr = std::to_array<StatusField>({
    {Kind::Site, "cell", "ifx.further_serving_cells.cell_id"},
    {Kind::Identity, "PCI", "ifx.further_serving_cells.physical_cell_id"},
    {Kind::Identity, "TAC", "ifx.further_serving_cells.tac"},
    {Kind::Channel, "NR-ARFCN", "ifx.further_serving_cells.nr_arfcn"},
    {Kind::Level, "RSRP", "ifx.further_serving_cells.rsrp"},
    {Kind::Level, "RSRQ", "ifx.further_serving_cells.rsrq"},
    {Kind::Level, "SINR", "ifx.further_serving_cells.sinr"},
});
constexpr auto kIfxFurtherCdma = std::to_array<StatusField>({
    {Kind::Site, "cell", "ifx.further_serving_cells.base_station_id"},
    {Kind::Identity, "PN", "ifx.further_serving_cells.pn"},
    {Kind::Identity, "NID", "ifx.further_serving_cells.nid"},
    {Kind::Identity, "SID", "ifx.further_serving_cells.sid"},
    {Kind::Level, "RSSI", "ifx.further_serving_cells.rssi"},
    {Kind::Level, "Ec/Io", "ifx.further_serving_cells.ec_io"},
});

constexpr auto kIfxNeighbours = std::to_array<StatusField>({
    {Kind::Identity, "ARFCN", "ifx.neighbour_cells.arfcn"},
    {Kind::Identity, "BSIC", "ifx.neighbour_cells.bsic"},
});
constexpr auto kIfxUmtsNeighbours = std::to_array<StatusField>({
    {Kind::Identity, "UARFCN", "ifx.neighbour_cells.uarfcn"},
    {Kind::Identity, "PSC", "ifx.neighbour_cells.scrambling_code"},
});
constexpr auto kIfxTdScdmaNeighbours = std::to_array<StatusField>({
    {Kind::Identity, "UARFCN", "ifx.neighbour_cells.uarfcn"},
    {Kind::Identity, "CPID", "ifx.neighbour_cells.cell_parameter_id"},
});
constexpr auto kIfxLteNeighbours = std::to_array<StatusField>({
    {Kind::Identity, "EARFCN", "ifx.neighbour_cells.earfcn"},
    {Kind::Identity, "PCI", "ifx.neighbour_cells.physical_cell_id"},
});
constexpr auto kIfxNrNeighbours = std::to_array<StatusField>({
    {Kind::Identity, "NR-ARFCN", "ifx.neighbour_cells.nr_arfcn"},
    {Kind::Identity, "PCI", "ifx.neighbour_cells.physical_cell_id"},
});
constexpr auto kIfxCdmaNeighbours = std::to_array<StatusField>({
    {Kind::Identity, "PN", "ifx.neighbour_cells.pn"},
});
constexpr std::string_view kIfxSystem = "ifx.serving_cell.technology";
constexpr std::string_view kIfxFurtherSystem = "ifx.further_serving_cells.technology";
constexpr std::string_view kIfxNeighbourSystem = "ifx.neighbour_cells.technology";
constexpr auto kIfxLists = std::to_array<StatusList>({
    {"RxLev", "ifx.neighbour_cells.rx_level", kIfxNeighbours},
});
constexpr auto kIfxUmtsLists = std::to_array<StatusList>({
    {"RSCP", "ifx.neighbour_cells.rscp", kIfxUmtsNeighbours, {}, {kIfxNeighbourSystem, "UMTS"}},
});
constexpr auto kIfxTdScdmaLists = std::to_array<StatusList>({
    {"RSCP",
     "ifx.neighbour_cells.rscp",
     kIfxTdScdmaNeighbours,
     {},
     {kIfxNeighbourSystem, "TD-SCDMA"}},
});
constexpr auto kIfxLteLists = std::to_array<StatusList>({
    {"RSRP", "ifx.neighbour_cells.rsrp", kIfxLteNeighbours, {}, {kIfxNeighbourSystem, "LTE"}},
});
constexpr auto kIfxNrLists = std::to_array<StatusList>({
    {"RSRP", "ifx.neighbour_cells.rsrp", kIfxNrNeighbours, {}, {kIfxNeighbourSystem, "NR"}},
});
constexpr auto kIfxCdmaLists = std::to_array<StatusList>({
    {"Ec/Io", "ifx.neighbour_cells.ec_io", kIfxCdmaNeighbours, {}, {kIfxNeighbourSystem, "CDMA"}},
});

constexpr auto kStatusCells = std::to_array<StatusCellFields>({
    {"ifx", "GSM", RadioSystem::Gsm, kIfx, kIfxLists, {kIfxSystem, ""}},
    {"ifx", "GSM", RadioSystem::Gsm, kIfx, {}, {kIfxSystem, "GSM"}},
    {"ifx", "UMTS", RadioSystem::UmtsFdd, kIfxUmts, kIfxUmtsLists, {kIfxSystem, "UMTS"}},
    {"ifx",
     "TD-SCDMA",
     RadioSystem::UtraTdd,
     kIfxTdScdma,
     kIfxTdScdmaLists,
     {kIfxSystem, "TD-SCDMA"}},
    {"ifx", "LTE", RadioSystem::Lte, kIfxLte, kIfxLteLists, {kIfxSystem, "LTE"}},
    {"ifx", "NR", RadioSystem::Nr, kIfxNr, kIfxNrLists, {kIfxSystem, "NR"}},
    {"ifx", "CDMA", RadioSystem::Cdma, kIfxCdma, kIfxCdmaLists, {kIfxSystem, "CDMA"}},
    {"ifx", "GSM", RadioSystem::Gsm, kIfxFurtherGsm, {}, {kIfxFurtherSystem, "GSM"}, true},
    {"ifx", "UMTS", RadioSystem::UmtsFdd, kIfxFurtherUmts, {}, {kIfxFurtherSystem, "UMTS"}, true},
    {"ifx",
     "TD-SCDMA",
     RadioSystem::UtraTdd,
     kIfxFurtherTdScdma,
     {},
     {kIfxFurtherSystem, "TD-SCDMA"},
     true},
    {"ifx", "LTE", RadioSystem::Lte, kIfxFurtherLte, {}, {kIfxFurtherSystem, "LTE"}, true},
    {"ifx", "NR", RadioSystem::Nr, kIfxFurtherNr, {}, {kIfxFurtherSystem, "NR"}, true},
    {"ifx", "CDMA", RadioSystem::Cdma, kIfxFurtherCdma, {}, {kIfxFurtherSystem, "CDMA"}, true},
    {"gsm", "GSM", RadioSystem::Gsm, kGsm, kGsmLists},
    {"gsm", "UMTS", RadioSystem::UmtsFdd, kUmts, kUmtsLists},
    {"cdma", "1x", RadioSystem::Cdma, kOneX, kOneXLists},
    {"cdma", "EV-DO", RadioSystem::Cdma, kEvdo, kEvdoLists},
    {"lte", "LTE", RadioSystem::Lte, kLte, kLteLists},
    {"utran", "UTRAN", RadioSystem::UtraTdd, kUtran, kUtranLists},
});

constexpr auto kNetworks = std::to_array<StatusNetworkFields>({
    {.technology = "ifx",
     .name = "ifx.network.name",
     .mcc = "ifx.network.mcc",
     .mnc = "ifx.network.mnc"},
    {.technology = "ifx",
     .name = "ifx.registration.operator",
     .code = "ifx.registration.operator_code",
     .simName = "ifx.sim.operator",
     .simNetwork = "ifx.sim.operator_code"},
    {.technology = "gsm",
     .mcc = "gsm.serving_plmn.mobile_country_code",
     .mnc = "gsm.serving_plmn.mobile_network_code",
     .simName = "gsm.sim_info.ef_plmn_network_name",
     .simNetwork = "gsm.sim_info.ef_acting_hplmn"},
    {.technology = "lte",
     .simName = "lte.sim_info.ef_plmn_network_name",
     .simNetwork = "lte.sim_info.ef_acting_hplmn"},
    {.technology = "utran",
     .simName = "utran.sim_info.ef_plmn_network_name",
     .simNetwork = "utran.sim_info.ef_acting_hplmn"},
});

constexpr auto kRunning = std::to_array<std::string_view>({
    "ifx.data_connections.duration",
    "ifx.data_connections.received",
    "ifx.data_connections.sent",
    "lte.connected_mode_lte_intra_frequency_measurement.subframe_number",
    "lte.neighbor_cells_list.ant_0_frame_offset",
    "lte.neighbor_cells_list.ant_0_sample_offset",
    "lte.neighbor_cells_list.ant_1_frame_offset",
    "lte.neighbor_cells_list.ant_1_sample_offset",
    "gsm.bler.transport_channels.crc_received",
    "gsm.bler.transport_channels.crc_received_in_error",
    "gsm.hsdpa_info.sub_frames",
    "gsm.hsdpa_info.primary_harq_process.no_rx_bits",
    "gsm.hsdpa_info.primary_harq_process.new_tx",
    "gsm.hsdpa_info.primary_harq_process.block_errors",
    "gsm.hsdpa_info.secondary_harq_process.no_rx_bits",
    "gsm.hsdpa_info.secondary_harq_process.new_tx",
    "gsm.hsdpa_info.secondary_harq_process.block_errors",
});

} // namespace

std::span<const StatusCellFields> statusCells() {
    return kStatusCells;
}

std::span<const StatusNetworkFields> statusNetworks() {
    return kNetworks;
}

std::span<const std::string_view> runningFields() {
    return kRunning;
}

bool isRunning(std::string_view field) {
    return std::find(kRunning.begin(), kRunning.end(), field) != kRunning.end();
}

} // namespace pallax
