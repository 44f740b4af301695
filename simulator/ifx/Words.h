#pragma once

#include <array>
#include <cstdint>
#include <string_view>

namespace pallax::ifx {

/// The texts that stand in many messages just the same: all keys, and the names of states. Each
/// binary message begins with all of them in this order.
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

/// One of them. A text that is none does not compile.
class Word {
public:
    consteval Word(const char* text) {
        while (kWords.at(_number) != text) {
            ++_number;
        }
    }

    std::uint32_t number() const { return _number; } ///< from 0
    operator std::string_view() const { return kWords[_number]; }

private:
    std::uint32_t _number = 0;
};

} // namespace pallax::ifx
