#pragma once

#include <array>
#include <cstddef>

namespace pallax {

/// Chooses among kinds of reports so that, in the long run, each comes as often as its share
/// says, and evenly; a kind with the share 0 does not come.
template <std::size_t kKinds>
class ReportMix {
public:
    using Shares = std::array<int, kKinds>;

    /// The kind of the next report; at least one share is above 0.
    std::size_t next(const Shares& shares) {
        int sum = 0;
        std::size_t chosen = 0;
        int most = -1;
        for (std::size_t kind = 0; kind < kKinds; ++kind) {
            if (shares[kind] <= 0) {
                continue;
            }
            sum += shares[kind];
            _credits[kind] += shares[kind];
            if (most < 0 || _credits[kind] > _credits[chosen]) {
                chosen = kind;
                most = shares[kind];
            }
        }
        _credits[chosen] -= sum;
        return chosen;
    }

private:
    std::array<int, kKinds> _credits{};
};

} // namespace pallax
