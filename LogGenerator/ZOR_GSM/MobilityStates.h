#pragma once

#include "LogGenerator/Records/Layout.h"

#include <array>
#include <cstddef>
#include <string_view>

/// Shared by the mobility-management records: their log codes, their least length, and the labels
/// that more than one of them shows.
namespace pallax {

inline constexpr LogCode kGMMStateLogCode = 0x7130;
inline constexpr LogCode kMMStateLogCode = 0x7131;
inline constexpr LogCode kRegistrationLogCode = 0x7132;

/// Required of every state record, even if fewer bytes are read.
inline constexpr std::size_t kStateRecordLength = 16;

inline constexpr std::string_view kMMStateKey = "MM State";
inline constexpr std::string_view kMMSubStateKey = "MM Sub State";

inline constexpr auto kRegistrationStates = std::to_array<std::string_view>({
    "REG_STATE_INACTIVE",
    "REG_STATE_IDLE",
    "REG_STATE_REGISTERING",
    "REG_STATE_DEREGISTERING",
    "REG_STATE_MANUAL_SEARCH",
    "REG_STATE_AUTOMATIC_SEARCH",
    "REG_STATE_OFFLINE",
});
static_assert(kRegistrationStates.size() == 7);

/// The modem does not use the "Unknown" states; two labels contain a blank.
inline constexpr auto kMMStates = std::to_array<std::string_view>({
    "MM_NULL",
    "Unknown",
    "Unknown",
    "MM_LOCATION_UPDATE_INITIATED",
    "Unknown",
    "MM_WAIT_FOR_OUTGOING_MM_CONNECTION",
    "MM_CONNECTION_ACTIVE",
    "MM_IMSI_DETACH_INITIATED",
    "MM_PROCESS_CM_SERVICE_PROMPT",
    "MM_WAIT_FOR_NETWORK_COMMAND",
    "MM_LOCATION_UPDATE_REJECTED",
    "Unknown",
    "Unknown",
    "MM_WAIT_FOR_RR_CONNECTION_LU",
    "MM_WAIT_FOR_RR_CONNECTION_MM",
    "MM_WAIT_FOR_RR_CONNECTION_IMSI_DETACH",
    "Unknown",
    "MM_REESTABLISHMENT_INITIATED",
    "MM_WAIT_FOR_RR_ACTIVE",
    "MM_IDLE",
    "MM_WAIT_FOR_ADDITIONAL_OUTGOING_MM_ CONNECTION",
    "MM_WAIT_FOR_RR_CONNECTION_ REESTABLISHMENT",
    "MM_WAIT_FOR_REESTABLISH_DECISION",
    "MM_LOCATION_UPDATING_PENDING",
    "Unknown",
    "MM_RR_CONNECTION_RELEASE_NOT_ALLOWED",
});
static_assert(kMMStates.size() == 26);

/// Shown by two of the records.
inline constexpr Field kMMStateField{kMMStateKey, u8At(13), Conversion::label(kMMStates),
                                     "State of the mobility management entity (MM)."};

inline constexpr auto kRegistrationFields = std::to_array<Field>({
    {"MM Service State", u8At(13), Conversion::label(kRegistrationStates),
     "State of the registration."},
});
inline constexpr CodeLayout kRegistrationCode{
    .logCode = kRegistrationLogCode,
    .minimumLength = kStateRecordLength,
    .fields = kRegistrationFields,
};

} // namespace pallax
