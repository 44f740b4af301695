#include "fields/EventFields.h"

#include "fields/ServingCells.h"

#include <algorithm>
#include <array>
#include <cstddef>

namespace pallax {

namespace {

using Watch = EventFields::Watch;
using Names = std::string_view;

constexpr std::array<Names, 1> kNoPilot{"Invalid Value"};

// The state machines.
constexpr std::array<Names, 1> kIfxRr{"ifx.rr"};
constexpr std::array<Names, 1> kIfxTechnology{"ifx.serving_cell.technology"};
constexpr std::array<Names, 1> kIfxModem{"ifx.modem.state"};
constexpr std::array<Names, 1> kMm{"gsm.process_cs.mm_state"};
constexpr std::array<Names, 1> kGmm{"gsm.process_ps.mm_state"};
constexpr std::array<Names, 1> kRr{"gsm.gsm_rr_info.rr_state"};
constexpr std::array<Names, 1> kRrc{"gsm.umts_rr_info.rrc_state"};
constexpr std::array<Names, 1> kOneXState{"cdma.1x.device_state"};
constexpr std::array<Names, 1> kEvdoState{"cdma.ev_do.device_state"};
constexpr std::array<Names, 1> kEvdoSession{"cdma.ev_do.session_state"};
constexpr std::array<Names, 1> kUtranRrc{"utran.rrc_info.state"};

constexpr std::array<Names, 2> kToUmts{"RR_G2W_INTERRAT_RESELECTION_PROGRESS",
                                       "RR_G2W_INTERRAT_HANDOVER_ PROGRESS"};
constexpr std::array<Names, 3> kToGsm{"RR_W2G_INTERRAT_RESELECTION_PROGRESS",
                                      "RR_W2G_INTERRAT_HANDOVER_ PROGRESS",
                                      "RR_W2G_INTERRAT_CC_ORDER_ PROGRESS"};

// Service and registration.
constexpr std::array<Names, 1> kNoTechnology{"unknown"};
constexpr std::array<Names, 1> kIfxNetwork{"ifx.network.mcc"};
constexpr std::array<Names, 1> kIfxRegistration{"ifx.registration.state"};
constexpr std::array<Names, 7> kIfxRegistered{"home",
                                              "roaming",
                                              "registered",
                                              "home, SMS only",
                                              "roaming, SMS only",
                                              "home, CSFB not preferred",
                                              "roaming, CSFB not preferred"};
constexpr std::array<Names, 9> kIfxUnregistered{"idle",
                                                "searching",
                                                "denied",
                                                "unknown",
                                                "no modem",
                                                "unplugged",
                                                "no system bus",
                                                "ModemManager is not running",
                                                "ModemManager does not answer"};
constexpr std::array<Names, 1> kServiceType{"gsm.serving_plmn.service_type"};
constexpr std::array<Names, 3> kService{"CS_ONLY", "PS_ONLY", "CS_PS_SERVICE"};
constexpr std::array<Names, 2> kNoService{"NO_SERVICE", "LIMITED_SERVICE"};
constexpr std::array<Names, 1> kMmSubState{"gsm.process_cs.mm_sub_state"};
constexpr std::array<Names, 1> kMmService{"MM_NORMAL_SERVICE"};
constexpr std::array<Names, 5> kMmNoService{"MM_NULL_SUBSTATE", "MM_NO_IMSI", "MM_PLMN_SEARCH",
                                            "MM_LIMITED_SERVICE", "MM_NO_CELL_AVAILABLE"};
constexpr std::array<Names, 3> kGmmRegistered{"GMM_REGISTERED", "GMM_ROUTING_AREA_UPDATE_INITIATED",
                                              "GMM_SERVICE_REQUEST_INITIATED"};
constexpr std::array<Names, 2> kGmmLost{"GMM_NULL", "GMM_DEREGISTERED"};
constexpr std::array<Names, 2> kOneXIdle{"Paging [6]", "Slotted mode sleep state [7]"};
constexpr std::array<Names, 3> kOneXService{"Paging [6]", "Slotted mode sleep state [7]",
                                            "Traffic [8]"};
constexpr std::array<Names, 3> kOneXLost{"Inactive [0]", "Initial state for CDMA operation [2]",
                                         "Acquisition [3]"};
constexpr std::array<Names, 3> kEvdoService{"Idle [3]", "Access [4]", "Connected [5]"};
constexpr std::array<Names, 2> kEvdoLost{"Inactive [0]", "Acquisition [1]"};

// Contexts.
constexpr std::array<Names, 1> kIfxConnections{"ifx.data_connections.apn"};
constexpr std::array<Names, 1> kGsmContexts{"gsm.pdp_context_info"};
constexpr std::array<Names, 1> kLteContexts{"lte.pdp_context_info"};
constexpr std::array<Names, 1> kUtranContexts{"utran.pdp_context_info"};

constexpr std::string_view kCell = "serving cell";

constexpr auto kRows = std::to_array<EventFields>({
    {"ifx", Watch::Cell, kCell, serving_cells::kIfx},
    {"ifx", Watch::Cell, kCell, serving_cells::kIfxTdScdma},
    {"ifx", Watch::Cell, kCell, serving_cells::kIfxUmts},
    {"ifx", Watch::Cell, kCell, serving_cells::kIfxLte},
    {"ifx", Watch::Cell, kCell, serving_cells::kIfxNr},
    {"ifx", Watch::Cell, kCell, serving_cells::kIfxCdma},
    {"ifx", Watch::Cell, kCell, serving_cells::kIfxLocated},
    {"ifx", Watch::State, "RR", kIfxRr},
    {"ifx", Watch::State, "modem", kIfxModem},
    {"ifx", Watch::State, "technology", kIfxTechnology, {}, kNoTechnology},
    {"ifx", Watch::Service, "service", kIfxNetwork},
    {"ifx", Watch::Service, "registration", kIfxRegistration, kIfxRegistered, kIfxUnregistered},
    {"ifx", Watch::Contexts, "connection", kIfxConnections},

    {"gsm", Watch::Technology, "GSM → UMTS", kRr, kToUmts},
    {"gsm", Watch::Technology, "UMTS → GSM", kRr, kToGsm},
    {"gsm", Watch::Cell, "GSM serving cell", serving_cells::kGsm},
    {"gsm", Watch::Cell, "UMTS serving cell", serving_cells::kUmts},
    {"gsm", Watch::State, "MM", kMm},
    {"gsm", Watch::State, "GMM", kGmm},
    {"gsm", Watch::State, "RR", kRr},
    {"gsm", Watch::State, "RRC", kRrc},
    {"gsm", Watch::Service, "service", kServiceType, kService, kNoService},
    {"gsm", Watch::Service, "registration", kMmSubState, kMmService, kMmNoService},
    {"gsm", Watch::Service, "GPRS registration", kGmm, kGmmRegistered, kGmmLost},
    {"gsm", Watch::Contexts, "context", kGsmContexts},

    {"cdma", Watch::Cell, "1x serving cell", serving_cells::kOneX},
    {"cdma", Watch::Cell, "EV-DO serving cell", serving_cells::kEvdo, {}, kNoPilot},
    {"cdma", Watch::State, "1x", kOneXState, kOneXIdle},
    {"cdma", Watch::State, "EV-DO", kEvdoState},
    {"cdma", Watch::State, "EV-DO session", kEvdoSession},
    {"cdma", Watch::Service, "1x service", kOneXState, kOneXService, kOneXLost},
    {"cdma", Watch::Service, "EV-DO service", kEvdoState, kEvdoService, kEvdoLost},

    {"lte", Watch::Cell, kCell, serving_cells::kLte},
    {"lte", Watch::Cell, kCell, serving_cells::kLteMeasured},
    {"lte", Watch::Contexts, "context", kLteContexts},

    {"utran", Watch::Cell, kCell, serving_cells::kUtran},
    {"utran", Watch::State, "RRC", kUtranRrc},
    {"utran", Watch::Contexts, "context", kUtranContexts},
});

constexpr std::array<std::string_view, 12> kWords{
    "cell-change",  "ping-pong",        "state-change", "technology-change",
    "service-lost", "service-regained", "context-up",   "context-down",
    "gap",          "time-step",        "fatal-record", "alarm",
};

} // namespace

std::string_view wordOf(EventKind kind) {
    return kWords.at(static_cast<std::size_t>(kind));
}

std::optional<EventKind> eventKindNamed(std::string_view word) {
    const auto found = std::find(kWords.begin(), kWords.end(), word);
    return found != kWords.end() ? std::optional(static_cast<EventKind>(found - kWords.begin()))
                                 : std::nullopt;
}

std::span<const EventFields> eventFields() {
    return kRows;
}

} // namespace pallax
