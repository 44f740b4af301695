#include "console/Progress.h"

#include "text/Format.h"

#include <algorithm>

namespace pallax {

bool ProgressPace::look() {
    constexpr std::chrono::milliseconds kQuick{1};
    constexpr unsigned kMostPieces = 64; // as many slow pieces after quick ones go unnoticed
    const Time now = _clock.now();
    _piecesPerLook = now - _look < kQuick ? std::min(2 * _piecesPerLook, kMostPieces) : 1;
    _look = now;
    const bool isDue = now - _begin >= kPatience && (!_told || now - *_told >= kInterval);
    if (isDue) {
        _told = now;
    }
    return isDue;
}

std::string progressBar(double share) {
    constexpr int kWidth = 30;
    constexpr int kPercent = 100;
    const double whole = std::clamp(share, 0.0, 1.0);
    const int filled = static_cast<int>(whole * kWidth);
    std::string bar = "[";
    bar.append(static_cast<std::size_t>(filled), '#');
    bar.append(static_cast<std::size_t>(kWidth - filled), ' ');
    return bar + formatText("] %3d %%", {static_cast<int>(whole * kPercent)});
}

std::string packetCount(std::uint64_t packets) {
    return formatText(packets == 1 ? "%llu packet" : "%llu packets", {packets});
}

} // namespace pallax
