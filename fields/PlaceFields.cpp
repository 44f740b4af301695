#include "fields/PlaceFields.h"

#include <array>

namespace pallax {

namespace {

constexpr auto kPlaces = std::to_array<std::string_view>({
    "ifx.serving_cell.area",
    "ifx.serving_cell.lac",
    "ifx.serving_cell.cell_id",
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
