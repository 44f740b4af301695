#include "fields/CellFields.h"

#include "fields/ServingCells.h"

#include <array>

namespace pallax {

namespace {

using Role = CellRole;
using System = RadioSystem;

constexpr std::string_view kLteNeighbourChannel = "lte.neighbor_measurements.e_arfcn";
constexpr std::string_view kLteConnectedChannel =
    "lte.connected_mode_lte_intra_frequency_measurement.e_arfcn";
constexpr std::span<const std::string_view> kOneXArea =
    std::span(serving_cells::kOneX).subspan<1>();

constexpr auto kCells = std::to_array<CellFields>({
    {"ifx", Role::Serving, System::Gsm, serving_cells::kIfx[1], serving_cells::kIfx[0]},
    {"ifx", Role::Neighbour, System::Gsm, "ifx.neighbour_cells.bsic", "ifx.neighbour_cells.arfcn"},

    {"ifx", Role::Serving, System::UmtsFdd, serving_cells::kIfxUmts[1], serving_cells::kIfxUmts[0]},
    {"ifx", Role::Serving, System::UtraTdd, serving_cells::kIfxTdScdma[0],
     serving_cells::kIfxTdScdma[1]},
    {"ifx", Role::Serving, System::Lte, serving_cells::kIfxLte[1], serving_cells::kIfxLte[0]},
    {"ifx", Role::Serving, System::Nr, serving_cells::kIfxNr[1], serving_cells::kIfxNr[0]},
    {"ifx", Role::Serving, System::Cdma, serving_cells::kIfxCdma[0], {}},
    {"ifx", Role::Active, System::Gsm, "ifx.further_serving_cells.bsic",
     "ifx.further_serving_cells.arfcn"},
    {"ifx", Role::Active, System::UmtsFdd, "ifx.further_serving_cells.scrambling_code",
     "ifx.further_serving_cells.uarfcn"},
    {"ifx", Role::Active, System::UtraTdd, "ifx.further_serving_cells.cell_parameter_id",
     "ifx.further_serving_cells.uarfcn"},
    {"ifx", Role::Active, System::Lte, "ifx.further_serving_cells.physical_cell_id",
     "ifx.further_serving_cells.earfcn"},
    {"ifx", Role::Active, System::Nr, "ifx.further_serving_cells.physical_cell_id",
     "ifx.further_serving_cells.nr_arfcn"},
    {"ifx", Role::Active, System::Cdma, "ifx.further_serving_cells.pn", {}},
    {"ifx", Role::Neighbour, System::UmtsFdd, "ifx.neighbour_cells.scrambling_code",
     "ifx.neighbour_cells.uarfcn"},
    {"ifx", Role::Neighbour, System::UtraTdd, "ifx.neighbour_cells.cell_parameter_id",
     "ifx.neighbour_cells.uarfcn"},
    {"ifx", Role::Neighbour, System::Lte, "ifx.neighbour_cells.physical_cell_id",
     "ifx.neighbour_cells.earfcn"},
    {"ifx", Role::Neighbour, System::Nr, "ifx.neighbour_cells.physical_cell_id",
     "ifx.neighbour_cells.nr_arfcn"},
    {"ifx", Role::Neighbour, System::Cdma, "ifx.neighbour_cells.pn", {}},

    {"gsm", Role::Serving, System::Gsm, serving_cells::kGsm[1], serving_cells::kGsm[0]},
    {"gsm", Role::Serving, System::UmtsFdd, serving_cells::kUmts[0], serving_cells::kUmts[1]},
    {"gsm", Role::Active, System::UmtsFdd, "gsm.active_set.scrambling_code",
     serving_cells::kUmts[1]},
    {"gsm", Role::Neighbour, System::Gsm, "gsm.neighboring_cells.bsic",
     "gsm.neighboring_cells.arfcn"},
    {"gsm", Role::Candidate, System::UmtsFdd, "gsm.umts_set.scrambling_code",
     "gsm.umts_set.downlink_frequency"},
    {"gsm", Role::Candidate, System::UmtsFdd, "gsm.umts_set.scrambling_code",
     "gsm.umts_set.uarfcn"},
    {"gsm", Role::Candidate, System::Gsm, "gsm.gsm_set.bsic", "gsm.gsm_set.arfcn"},

    {"cdma", Role::Serving, System::Cdma, serving_cells::kOneX[0], {}, kOneXArea},
    {"cdma", Role::Serving, System::Cdma, serving_cells::kEvdo[0], serving_cells::kEvdo[1]},
    {"cdma", Role::Active, System::Cdma, "cdma.1x.active_set", "cdma.1x_receiver_0.channel"},
    {"cdma", Role::Active, System::Cdma, "cdma.ev_do.active_set", serving_cells::kEvdo[1]},

    {"lte", Role::Serving, System::Lte, serving_cells::kLte[0], serving_cells::kLte[1]},
    {"lte", Role::Serving, System::Lte, serving_cells::kLte[0], "lte.serving_cell_info.uarfcn"},
    {"lte", Role::Serving, System::Lte, serving_cells::kLteMeasured[0],
     serving_cells::kLteMeasured[1]},
    {"lte", Role::Serving, System::Lte,
     "lte.connected_mode_lte_intra_frequency_measurement.serving_physical_cell_id",
     kLteConnectedChannel},
    {"lte", Role::Serving, System::Lte, "lte.reselection_candidates.serving_cell_id",
     "lte.reselection_candidates.serving_earfcn"},
    {"lte", Role::Neighbour, System::Lte, "lte.measured_neighbor_cells.physical_cell_id",
     kLteConnectedChannel},
    {"lte", Role::Detected, System::Lte, "lte.detected_cells.physical_cell_id",
     kLteConnectedChannel},
    {"lte", Role::Neighbour, System::Lte, "lte.neighbor_cells_list.physical_cell_id",
     kLteNeighbourChannel},
    {"lte", Role::Candidate, System::Lte, "lte.reselection_candidates_list.cell_id",
     "lte.reselection_candidates_list.e_arfcn"},
    {"lte", Role::Candidate, System::UmtsFdd, "lte.reselection_candidates_list.psc",
     "lte.reselection_candidates_list.u_arfcn"},
    {"lte", Role::Candidate, System::Gsm, "lte.reselection_candidates_list.bsic_id",
     "lte.reselection_candidates_list.arfcn"},
    {"lte", Role::Candidate, System::Cdma, "lte.reselection_candidates_list.pilot",
     "lte.reselection_candidates_list.channel"},

    {"utran", Role::Serving, System::UtraTdd, "utran.serving_cell_info.cell_scrambling_code",
     "utran.serving_cell_info.downlink_uarfcn"},
    {"utran", Role::Neighbour, System::UtraTdd, "utran.neighbor_cell_list.cell_id",
     "utran.neighbor_cell_list.uarfcn"},
    {"utran",
     Role::Neighbour,
     System::Gsm,
     "utran.gsm_neighbor_cell_list.bcc",
     "utran.gsm_neighbor_cell_list.arfcn",
     {},
     "utran.gsm_neighbor_cell_list.ncc"},
});

constexpr std::array<std::string_view, 5> kRoles{"serving", "active", "neighbour", "detected",
                                                 "candidate"};

} // namespace

std::string_view wordOf(CellRole role) {
    return kRoles.at(static_cast<std::size_t>(role));
}

std::span<const CellFields> cellFields() {
    return kCells;
}

CellTerms cellTermsOf(RadioSystem system) {
    switch (system) {
    case System::Gsm:
        return {"BSIC", "ARFCN", Measure::RxLev};
    case System::UmtsFdd:
        return {"Scrambling Code", "UARFCN", Measure::Rscp};
    case System::UtraTdd:
        return {"Cell ID", "UARFCN", Measure::Rscp};
    case System::Lte:
        return {"PCI", "EARFCN", Measure::Rsrp};
    case System::Nr:
        return {"PCI", "NR-ARFCN", Measure::Rsrp};
    case System::Cdma:
        break;
    }
    return {"PN", "Channel", Measure::EcIo};
}

} // namespace pallax
