#include "fields/PlaceFields.h"

#include <array>

namespace pallax {

namespace {

constexpr auto kPlaces = std::to_array<std::string_view>({
    "ifx.serving_cell.area",
    "ifx.serving_cell.lac",
    "ifx.serving_cell.tac",
    "ifx.serving_cell.cell_id",
    "ifx.serving_cell.base_station_id",
    "ifx.serving_cell.sid",
    "ifx.serving_cell.nid",
    "ifx.further_serving_cells.lac",
    "ifx.further_serving_cells.tac",
    "ifx.further_serving_cells.cell_id",
    "ifx.further_serving_cells.base_station_id",
    "ifx.further_serving_cells.sid",
    "ifx.further_serving_cells.nid",
    "ifx.neighbour_cells.lac",
    "ifx.neighbour_cells.tac",
    "ifx.neighbour_cells.cell_id",
    "ifx.neighbour_cells.base_station_id",
    "ifx.neighbour_cells.sid",
    "ifx.neighbour_cells.nid",
    "ifx.registration.lac",
    "ifx.registration.tac",
    "ifx.registration.cell_id",
    "ifx.registration.sid",
    "ifx.registration.nid",
    "gsm.serving_plmn.location_area_code",
    "gsm.serving_plmn.routing_area_code",
    "gsm.gsm_serving_cell.cell_id",
    "gsm.umts_rr_info.cell_id",
    "gsm.umts_rr_info.ura_id",
    "cdma.system_identity.system_id",
    "cdma.system_identity.network_id",
    "cdma.system_identity.packet_zone_id",
    "cdma.system_identity.base_station_id",
    "lte.serving_cell_info.cell_identity",
    "lte.serving_cell_info.tracking_area_code",
    "utran.serving_cell_info.cell_id",
    "utran.serving_cell_info.ura_id",
    "utran.serving_cell_info.local_area_code",
});

} // namespace

std::span<const std::string_view> placeFields() {
    return kPlaces;
}

} // namespace pallax
