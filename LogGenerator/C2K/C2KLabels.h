#pragma once

#include "LogGenerator/Records/Conversion.h"

#include <array>
#include <string_view>

/// The tables of labels, each with the format for numbers beyond the table.
namespace pallax {

inline constexpr NumberFormat kReserved{"[Reserved %d]", ""};
inline constexpr NumberFormat kBadValue{"[Bad Value %d]", ""};
inline constexpr NumberFormat kOtherRoamingIndicator{"ERI - %d", ""};

inline constexpr auto kEVDODeviceStateLabels = std::to_array<std::string_view>({
    "Inactive [0]",
    "Acquisition [1]",
    "Sync [2]",
    "Idle [3]",
    "Access [4]",
    "Connected [5]",
});
static_assert(kEVDODeviceStateLabels.size() == 6);
inline constexpr Conversion kEVDODeviceStates =
    Conversion::label(kEVDODeviceStateLabels, kReserved);

inline constexpr auto kEVDOSessionStateLabels = std::to_array<std::string_view>({
    "Closed [0]",
    "AMP setup [1]",
    "AT-initiated neg [2]",
    "Initiated neg [3]",
    "Open [4]",
});
static_assert(kEVDOSessionStateLabels.size() == 5);
inline constexpr Conversion kEVDOSessionStates =
    Conversion::label(kEVDOSessionStateLabels, kReserved);

inline constexpr auto kBandClassLabels = std::to_array<std::string_view>({
    "800 MHz cellular band [0]",
    "1.8 to 2.0GHz PCS band [1]",
    "872 to 960MHz TACS band [2]",
    "832 to 925MHz JTACS band [3]",
    "1.75 to 1.87GHz Korean PCS band [4]",
    "450MHz band [5]",
    "2GHz band [6]",
    "700MHz band [7]",
    "1800 MHz band [8]",
    "900 MHzband [9]",
    "Secondary 800 MHz band [10]",
    "400 MHz European PAMR band [11]",
    "800 MHz European PAMR band [12]",
});
static_assert(kBandClassLabels.size() == 13);
inline constexpr Conversion kBandClasses = Conversion::label(kBandClassLabels, kBadValue);

inline constexpr auto kOneXDeviceStateLabels = std::to_array<std::string_view>({
    "Inactive [0]",
    "Deep sleep in start state [1]",
    "Initial state for CDMA operation [2]",
    "Acquisition [3]",
    "Sync [4]",
    "Slew [5]",
    "Paging [6]",
    "Slotted mode sleep state [7]",
    "Traffic [8]",
    "UnSlew [9]",
    "Operation in PCG state [10]",
    "Powerup state [11]",
});
static_assert(kOneXDeviceStateLabels.size() == 12);
inline constexpr Conversion kOneXDeviceStates =
    Conversion::label(kOneXDeviceStateLabels, kBadValue);

/// The enhanced roaming indicator.
inline constexpr auto kRoamingIndicatorLabels = std::to_array<std::string_view>({
    "OFF [0]",
    "ON [1]",
    "Flashing [2]",
    "Out of Neighborhood [3]",
    "Out of Building [4]",
    "Preferred system [5]",
    "Available system [6]",
    "Alliance partner [7]",
    "Premium partner [8]",
    "Full service functionality [9]",
    "Partial service functionality [10]",
    "Banner ON [11]",
    "Banner OFF [12]",
});
static_assert(kRoamingIndicatorLabels.size() == 13);
inline constexpr Conversion kRoamingIndicators =
    Conversion::label(kRoamingIndicatorLabels, kOtherRoamingIndicator);

} // namespace pallax
