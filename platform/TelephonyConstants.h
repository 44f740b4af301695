#pragma once

#include <string_view>

/// The telephony service's constants: names of technologies, keys and values of a cell-monitor
/// dictionary.
namespace pallax {

inline constexpr std::string_view kHXLogChannelTechnology_IFX = "IFX";
inline constexpr std::string_view kHXLogChannelTechnology_Zorell_GSM = "Zorell_GSM";
inline constexpr std::string_view kHXLogChannelTechnology_Zorell_CDMA = "Zorell_CDMA";
inline constexpr std::string_view kHXLogChannelTechnology_Zorell_LTE = "Zorell_LTE";
inline constexpr std::string_view kHXLogChannelTechnology_Zorell_UTRAN2 = "Zorell_UTRAN2";

// The string of each cell-monitor constant is its own name.
inline constexpr std::string_view kHXCellMonitorCellRadioAccessTechnology =
    "kHXCellMonitorCellRadioAccessTechnology";
inline constexpr std::string_view kHXCellMonitorRadioAccessTechnologyGSM =
    "kHXCellMonitorRadioAccessTechnologyGSM";
inline constexpr std::string_view kHXCellMonitorRadioAccessTechnologyUMTS =
    "kHXCellMonitorRadioAccessTechnologyUMTS";
inline constexpr std::string_view kHXCellMonitorRadioAccessTechnologyLTE =
    "kHXCellMonitorRadioAccessTechnologyLTE";
inline constexpr std::string_view kHXCellMonitorRadioAccessTechnologyUTRAN2 =
    "kHXCellMonitorRadioAccessTechnologyUTRAN2";
inline constexpr std::string_view kHXCellMonitorCellType = "kHXCellMonitorCellType";
inline constexpr std::string_view kHXCellMonitorCellTypeServing = "kHXCellMonitorCellTypeServing";
inline constexpr std::string_view kHXCellMonitorCellTypeNeighbor = "kHXCellMonitorCellTypeNeighbor";
inline constexpr std::string_view kHXCellMonitorMCC = "kHXCellMonitorMCC";
inline constexpr std::string_view kHXCellMonitorMNC = "kHXCellMonitorMNC";
inline constexpr std::string_view kHXCellMonitorLAC = "kHXCellMonitorLAC";
inline constexpr std::string_view kHXCellMonitorTAC = "kHXCellMonitorTAC";
inline constexpr std::string_view kHXCellMonitorCellId = "kHXCellMonitorCellId";
inline constexpr std::string_view kHXCellMonitorPID = "kHXCellMonitorPID";
inline constexpr std::string_view kHXCellMonitorBandInfo = "kHXCellMonitorBandInfo";
inline constexpr std::string_view kHXCellMonitorARFCN = "kHXCellMonitorARFCN";
inline constexpr std::string_view kHXCellMonitorUARFCN = "kHXCellMonitorUARFCN";
inline constexpr std::string_view kHXCellMonitorRSSI = "kHXCellMonitorRSSI";
inline constexpr std::string_view kHXCellMonitorSCN = "kHXCellMonitorSCN";
inline constexpr std::string_view kHXCellMonitorRSCP = "kHXCellMonitorRSCP";
inline constexpr std::string_view kHXCellMonitorECN0 = "kHXCellMonitorECN0";

} // namespace pallax
