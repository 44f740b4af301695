#include "fields/Measures.h"

#include <algorithm>
#include <array>

namespace pallax {

namespace {

// Levels that the modem counts in its own way are missing: the GSM cells that show a level without
// a sign (gsm.gsm_serving_cell.rssi), or sometimes in dBm and sometimes not
// (gsm.neighboring_cells.rssi), and the measurements of UTRA TDD.
constexpr auto kFields = std::to_array<MeasuredField>({
    {"ifx.serving_cell.rx_level", Measure::RxLev},
    {"ifx.neighbour_cells.rx_level", Measure::RxLev},
    {"ifx.serving_cell.rscp", Measure::Rscp},
    {"ifx.serving_cell.rsrp", Measure::Rsrp},
    {"ifx.serving_cell.rsrq", Measure::Rsrq},
    {"ifx.serving_cell.sinr", Measure::Sinr},
    {"ifx.further_serving_cells.rsrp", Measure::Rsrp},
    {"ifx.further_serving_cells.rsrq", Measure::Rsrq},
    {"ifx.further_serving_cells.sinr", Measure::Sinr},
    {"ifx.neighbour_cells.rscp", Measure::Rscp},
    {"ifx.neighbour_cells.rsrp", Measure::Rsrp},
    {"ifx.neighbour_cells.rsrq", Measure::Rsrq},
    {"ifx.signal.lte_rsrp", Measure::Rsrp},
    {"ifx.signal.lte_rsrq", Measure::Rsrq},
    {"ifx.signal.lte_sinr", Measure::Sinr},
    {"ifx.signal.nr_rsrp", Measure::Rsrp},
    {"ifx.signal.nr_rsrq", Measure::Rsrq},
    {"ifx.signal.nr_sinr", Measure::Sinr},
    {"ifx.signal.umts_rscp", Measure::Rscp},
    {"ifx.signal.gsm_rssi", Measure::RxLev},
    {"ifx.signal.lte_rssi", Measure::Rssi},
    {"ifx.signal.umts_ec_io", Measure::EcNo},
    {"ifx.signal.1x_rssi", Measure::CdmaRssi},
    {"ifx.signal.1x_ec_io", Measure::EcIo},
    {"ifx.signal.ev_do_rssi", Measure::EvdoRssi},
    {"ifx.signal.ev_do_ec_io", Measure::EcIo},
    {"ifx.serving_cell.ec_io", Measure::EcNo},
    {"ifx.further_serving_cells.rscp", Measure::Rscp},
    {"ifx.further_serving_cells.ec_io", Measure::EcNo},
    {"ifx.neighbour_cells.ec_io", Measure::EcNo},
    {"ifx.neighbour_cells.sinr", Measure::Sinr},
    {"gsm.gsm_set.rssi", Measure::RxLev},
    {"gsm.active_set.rscp", Measure::Rscp},
    {"gsm.active_set.energy_per_chip", Measure::EcNo},
    {"gsm.umts_set.rscp", Measure::Rscp},
    {"gsm.umts_set.energy_per_chip", Measure::EcNo},
    {"gsm.umts_set.rank_cell_rscp", Measure::Rscp},
    {"cdma.1x.active_set", Measure::EcIo},
    {"cdma.1x_receiver_0.agc", Measure::CdmaRssi},
    {"cdma.1x_receiver_1.agc", Measure::CdmaRssi},
    {"cdma.ev_do.receive_agc_0", Measure::EvdoRssi},
    {"cdma.ev_do.receive_agc_1", Measure::EvdoRssi},
    {"lte.serving_cell_measurements.measured_rsrp", Measure::Rsrp},
    {"lte.serving_cell_measurements.average_rsrp", Measure::Rsrp},
    {"lte.serving_cell_measurements.measured_rsrq", Measure::Rsrq},
    {"lte.serving_cell_measurements.average_rsrq", Measure::Rsrq},
    {"lte.serving_cell_measurements.measured_rssi", Measure::Rssi},
    {"lte.connected_mode_lte_intra_frequency_measurement.serving_filtered_rsrp", Measure::Rsrp},
    {"lte.connected_mode_lte_intra_frequency_measurement.serving_filtered_rsrq", Measure::Rsrq},
    {"lte.measured_neighbor_cells.filtered_rsrp", Measure::Rsrp},
    {"lte.measured_neighbor_cells.filtered_rsrq", Measure::Rsrq},
    {"lte.neighbor_cells_list.measured_rssi", Measure::Rssi},
    {"lte.neighbor_cells_list.measured_rsrp", Measure::Rsrp},
    {"lte.neighbor_cells_list.average_rsrp", Measure::Rsrp},
    {"lte.neighbor_cells_list.measured_rsrq", Measure::Rsrq},
    {"lte.neighbor_cells_list.average_rsrq", Measure::Rsrq},
});

} // namespace

std::span<const MeasuredField> measuredFields() {
    return kFields;
}

std::optional<Measure> measureOf(std::string_view field) {
    const auto* found = std::find_if(kFields.begin(), kFields.end(),
                                     [field](const auto& each) { return each.name == field; });
    return found != kFields.end() ? std::optional(found->measure) : std::nullopt;
}

std::optional<Grade> qualityOf(const QualityProfile& profile, std::string_view field,
                               double value) {
    const auto measure = measureOf(field);
    return measure ? profile.gradeOf(*measure, value) : std::nullopt;
}

} // namespace pallax
