#include "sources/modem/ModemLevels.h"

#include "text/Format.h"

#include <array>
#include <cstddef>

namespace pallax {

namespace {

struct Range {
    double least;
    double most;
    const char* format;
};

/// By LevelKind: what the reports of 3GPP and 3GPP2 can express. No RSRQ is above that of a cell
/// which fills the whole carrier, whatever a report could express.
constexpr auto kRanges = std::to_array<Range>({
    {-140, -10, "%.1f dBm"},
    {-121, -24, "%.1f dBm"},
    {-156, -31, "%.1f dBm"},
    {-43, 2.5, "%.1f dB"},
    {-23, 40, "%.1f dB"},
    {-31.5, 0, "%.1f dB"},
    {0, 200, "%.1f dB"},
});

} // namespace

std::optional<std::string> levelText(LevelKind kind, double value) {
    const Range& range = kRanges.at(static_cast<std::size_t>(kind));
    if (!(value >= range.least && value <= range.most)) {
        return std::nullopt;
    }
    return formatText(range.format, {value});
}

} // namespace pallax
