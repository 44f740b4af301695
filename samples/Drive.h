#pragma once

#include "samples/Sample.h"

#include <algorithm>
#include <cstdlib>
#include <utility>

namespace pallax {

/// Rises from `least` to `largest` and falls back, once in `period` seconds.
inline int wave(int second, int period, int least, int largest) {
    const int half = period / 2;
    const int place = std::abs(second % period - half);
    return least + (largest - least) * (half - place) / half;
}

/// The packets of a drive in any order; sorted by time at the end.
class Drive {
public:
    void add(int milliseconds, ByteBuffer data) {
        _packets.push_back(
            {kSampleStart + std::chrono::milliseconds(milliseconds), std::move(data)});
    }
    std::vector<TimedPacket> inOrder() {
        std::stable_sort(
            _packets.begin(), _packets.end(),
            [](const TimedPacket& a, const TimedPacket& b) { return a.time < b.time; });
        return std::move(_packets);
    }

private:
    std::vector<TimedPacket> _packets;
};

} // namespace pallax
