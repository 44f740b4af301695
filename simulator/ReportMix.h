#pragma once

#include <array>
#include <cstddef>

namespace pallax {

/// Chooses the kind of the next report so that each kind is evenly spaced and as frequent as its
/// share; a kind with share 0 never comes.
template <std::size_t kKinds>
class ReportMix {
public:
    using Shares = std::array<int, kKinds>;

    /// The kind of the next report; at least one share must be above 0.
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
