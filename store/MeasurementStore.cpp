#include "store/MeasurementStore.h"

#include <algorithm>
#include <bit>

namespace pallax {

bool haveSameBeginning(const LoadedRecording& one, const LoadedRecording& other) {
    const auto packets = static_cast<std::uint64_t>(std::min(one.packets, other.packets));
    const std::string mark = " " + std::to_string(std::bit_floor(packets)) + ":";
    const auto digestOf = [&mark](const LoadedRecording& recording) {
        const std::size_t at = recording.beginnings.find(mark);
        return at == std::string::npos
                   ? std::string()
                   : recording.beginnings.substr(at, recording.beginnings.find(' ', at + 1) - at);
    };
    return !digestOf(one).empty() && digestOf(one) == digestOf(other);
}

} // namespace pallax
