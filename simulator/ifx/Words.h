#pragma once

#include <array>
#include <cstddef>
#include <cstdint>
#include <string_view>

namespace pallax::ifx {

/// The texts that stand in many messages just the same: all keys, and the names of states.
enum class Word : std::uint8_t {
    Network,
    Registered,
    Name,
    Mcc,
    Mnc,
    Rr,
    State,
    ServingCell,
    Arfcn,
    Bsic,
    RxLevel,
    Value,
    C1,
    Area,
    Lac,
    CellId,
    NeighbourCells,
    NeighbourHeader,
    DedicatedChannel,
    Channel,
    Type,
    TimeSlot,
    TimingAdvance,
    RxQuality,
    TxPower,
    Hopping,
    HoppingHeader,
    SampleNet,
    Mcc262,
    Mnc42,
    No,
    Off,
    CellSelection,
    ConnectionEstablishment,
    Idle,
    Dedicated,
    ConnectionRelease,
    TchF,
    Sdcch8,
    Count
};

inline constexpr auto kWords = std::to_array<std::string_view>({
    "Network",
    "Registered",
    "Name",
    "MCC",
    "MNC",
    "RR",
    "State",
    "Serving Cell",
    "ARFCN",
    "BSIC",
    "Rx Level",
    "Value",
    "C1",
    "Area",
    "LAC",
    "Cell ID",
    "Neighbour Cells",
    "ARFCN, BSIC, Rx Level",
    "Dedicated Channel",
    "Channel",
    "Type",
    "Time Slot",
    "Timing Advance",
    "Rx Quality",
    "Tx Power",
    "Hopping",
    "MAIO 3, HSN 17",
    "Sample Net",
    "262",
    "42",
    "No",
    "Off",
    "Cell Selection",
    "Connection Establishment",
    "Idle",
    "Dedicated",
    "Connection Release",
    "TCH/F",
    "SDCCH/8",
});
static_assert(kWords.size() == static_cast<std::size_t>(Word::Count));

constexpr std::string_view textOf(Word word) {
    return kWords[static_cast<std::size_t>(word)];
}

} // namespace pallax::ifx
