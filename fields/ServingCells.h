#pragma once

#include <array>
#include <string_view>

/// The fields that identify the serving cell, by the record that tells it; first the one that the
/// words of events give when it alone tells two cells apart.
namespace pallax::serving_cells {

inline constexpr std::array<std::string_view, 2> kIfx{"ifx.serving_cell.arfcn",
                                                      "ifx.serving_cell.bsic"};
inline constexpr std::array<std::string_view, 2> kIfxUmts{"ifx.serving_cell.uarfcn",
                                                          "ifx.serving_cell.scrambling_code"};
inline constexpr std::array<std::string_view, 2> kIfxTdScdma{"ifx.serving_cell.cell_parameter_id",
                                                             "ifx.serving_cell.uarfcn"};
inline constexpr std::array<std::string_view, 2> kIfxLte{"ifx.serving_cell.earfcn",
                                                         "ifx.serving_cell.physical_cell_id"};
inline constexpr std::array<std::string_view, 2> kIfxNr{"ifx.serving_cell.nr_arfcn",
                                                        "ifx.serving_cell.physical_cell_id"};
inline constexpr std::array<std::string_view, 1> kIfxCdma{"ifx.serving_cell.pn"};
/// Where only the location tells of the cell.
inline constexpr std::array<std::string_view, 1> kIfxLocated{"ifx.serving_cell.cell_id"};
inline constexpr std::array<std::string_view, 2> kGsm{"gsm.gsm_serving_cell.arfcn",
                                                      "gsm.gsm_serving_cell.bsic"};
inline constexpr std::array<std::string_view, 2> kUmts{"gsm.umts_rr_info.scrambling_code",
                                                       "gsm.umts_rr_info.uarfcn"};
inline constexpr std::array<std::string_view, 3> kOneX{"cdma.system_identity.base_station_id",
                                                       "cdma.system_identity.network_id",
                                                       "cdma.system_identity.system_id"};
inline constexpr std::array<std::string_view, 2> kEvdo{"cdma.ev_do.serving_pn_offset",
                                                       "cdma.ev_do.channel"};
inline constexpr std::array<std::string_view, 2> kLte{"lte.serving_cell_info.physical_cell_id",
                                                      "lte.serving_cell_info.download_frequency"};
inline constexpr std::array<std::string_view, 2> kLteMeasured{
    "lte.serving_cell_measurements.physical_cell_id", "lte.serving_cell_measurements.e_arfcn"};
/// Not the scrambling code: it can come seconds after the channel of the new cell.
inline constexpr std::array<std::string_view, 1> kUtran{"utran.serving_cell_info.cell_id"};

} // namespace pallax::serving_cells
