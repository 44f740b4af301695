#include "fields/StatusFields.h"

#include <algorithm>
#include <array>

namespace pallax {

namespace {

using Role = StatusField::Role;

constexpr auto kLte = std::to_array<StatusField>({
    {Role::Site, "cell", "lte.serving_cell_info.cell_identity"},
    {Role::Identity, "PCI", "lte.serving_cell_info.physical_cell_id"},
    {Role::Identity, "PCI", "lte.serving_cell_measurements.physical_cell_id"},
    {Role::Identity, "TAC", "lte.serving_cell_info.tracking_area_code"},
    {Role::Channel, "EARFCN", "lte.serving_cell_info.download_frequency"},
    {Role::Channel, "EARFCN", "lte.serving_cell_measurements.e_arfcn"},
    {Role::Band, "band", "lte.serving_cell_info.freq_band_indicator"},
    {Role::Level, "RSRP", "lte.serving_cell_measurements.measured_rsrp"},
    {Role::Level, "RSRP",
     "lte.connected_mode_lte_intra_frequency_measurement.serving_filtered_rsrp"},
    {Role::Level, "RSRQ", "lte.serving_cell_measurements.measured_rsrq"},
    {Role::Level, "RSRQ",
     "lte.connected_mode_lte_intra_frequency_measurement.serving_filtered_rsrq"},
});
constexpr auto kLteIdle = std::to_array<StatusField>({
    {Role::Identity, "PCI", "lte.neighbor_cells_list.physical_cell_id"},
});
constexpr auto kLteConnected = std::to_array<StatusField>({
    {Role::Identity, "PCI", "lte.measured_neighbor_cells.physical_cell_id"},
});
constexpr auto kLteLists = std::to_array<StatusList>({
    {"RSRP", "lte.neighbor_cells_list.measured_rsrp", kLteIdle},
    {"RSRP", "lte.measured_neighbor_cells.filtered_rsrp", kLteConnected},
});

constexpr auto kGsm = std::to_array<StatusField>({
    {Role::Site, "cell", "gsm.gsm_serving_cell.cell_id"},
    {Role::Identity, "BSIC", "gsm.gsm_serving_cell.bsic"},
    {Role::Channel, "ARFCN", "gsm.gsm_serving_cell.arfcn"},
});
constexpr auto kGsmSet = std::to_array<StatusField>({
    {Role::Identity, "ARFCN", "gsm.gsm_set.arfcn"},
    {Role::Identity, "BSIC", "gsm.gsm_set.bsic"},
});
constexpr auto kGsmLists = std::to_array<StatusList>({
    {"RSSI", "gsm.gsm_set.rssi", kGsmSet},
});
constexpr auto kUmts = std::to_array<StatusField>({
    {Role::Site, "cell", "gsm.umts_rr_info.cell_id"},
    {Role::Identity, "PSC", "gsm.umts_rr_info.scrambling_code"},
    {Role::Channel, "UARFCN", "gsm.umts_rr_info.uarfcn"},
    {Role::Channel, "UARFCN", "gsm.umts_rr_info.downlink_frequency"},
});
constexpr auto kActiveSet = std::to_array<StatusField>({
    {Role::Identity, "PSC", "gsm.active_set.scrambling_code"},
});
constexpr auto kUmtsSet = std::to_array<StatusField>({
    {Role::Identity, "PSC", "gsm.umts_set.scrambling_code"},
    {Role::Identity, "UARFCN", "gsm.umts_set.uarfcn"},
    {Role::Identity, "UARFCN", "gsm.umts_set.downlink_frequency"},
});
constexpr auto kUmtsLists = std::to_array<StatusList>({
    {"RSCP", "gsm.active_set.rscp", kActiveSet},
    {"Ec/Io", "gsm.active_set.energy_per_chip", kActiveSet},
    {"RSCP", "gsm.umts_set.rscp", kUmtsSet},
    {"RSCP", "gsm.umts_set.rank_cell_rscp", kUmtsSet},
});

constexpr auto kUtran = std::to_array<StatusField>({
    {Role::Site, "cell", "utran.serving_cell_info.cell_id"},
    {Role::Identity, "PSC", "utran.serving_cell_info.cell_scrambling_code"},
    {Role::Identity, "LAC", "utran.serving_cell_info.local_area_code"},
    {Role::Channel, "UARFCN", "utran.serving_cell_info.downlink_uarfcn"},
    {Role::Band, "band", "utran.serving_cell_info.freq_band_indicator"},
});
constexpr auto kUtranSet = std::to_array<StatusField>({
    {Role::Identity, "PSC", "utran.neighbor_cell_list.cell_id"},
    {Role::Identity, "UARFCN", "utran.neighbor_cell_list.uarfcn"},
});
constexpr auto kUtranLists = std::to_array<StatusList>({
    {"RSCP", "utran.neighbor_cell_list.filter_rscp", kUtranSet},
});

constexpr auto kOneX = std::to_array<StatusField>({
    {Role::Identity, "SID", "cdma.system_identity.system_id"},
    {Role::Identity, "NID", "cdma.system_identity.network_id"},
    {Role::Identity, "base station", "cdma.system_identity.base_station_id"},
    {Role::Channel, "channel", "cdma.1x_receiver_0.channel"},
    {Role::Band, "band class", "cdma.1x_receiver_0.band_class"},
    {Role::Level, "AGC", "cdma.1x_receiver_0.agc"},
});
constexpr auto kOneXLists = std::to_array<StatusList>({
    {"Ec/Io", "cdma.1x.active_set", {}, "(ref pilot)"},
});
constexpr auto kEvdo = std::to_array<StatusField>({
    {Role::Identity, "PN", "cdma.ev_do.serving_pn_offset"},
    {Role::Channel, "channel", "cdma.ev_do.channel"},
    {Role::Band, "band class", "cdma.ev_do.band_class"},
    {Role::Level, "AGC", "cdma.ev_do.receive_agc_0"},
});
constexpr auto kEvdoLists = std::to_array<StatusList>({
    {"Ec/Io", "cdma.ev_do.active_set", {}},
});

constexpr auto kIfx = std::to_array<StatusField>({
    {Role::Site, "cell", "ifx.serving_cell.area.cell_id"},
    {Role::Site, "cell", "ifx.serving_cell.cell_id"},
    {Role::Identity, "BSIC", "ifx.serving_cell.bsic"},
    {Role::Identity, "LAC", "ifx.serving_cell.area.lac"},
    {Role::Identity, "LAC", "ifx.serving_cell.lac"},
    {Role::Channel, "ARFCN", "ifx.serving_cell.arfcn"},
    {Role::Level, "RxLev", "ifx.serving_cell.rx_level"},
});
constexpr auto kIfxNeighbours = std::to_array<StatusField>({
    {Role::Identity, "ARFCN", "ifx.neighbour_cells.arfcn"},
    {Role::Identity, "BSIC", "ifx.neighbour_cells.bsic"},
});
constexpr auto kIfxLists = std::to_array<StatusList>({
    {"RxLev", "ifx.neighbour_cells.rx_level", kIfxNeighbours},
});

constexpr auto kCells = std::to_array<StatusCellFields>({
    {"ifx", "GSM", RadioSystem::Gsm, kIfx, kIfxLists},
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
    return kCells;
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
