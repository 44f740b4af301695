#pragma once

#include <array>
#include <bit>
#include <cstdint>

namespace pallax {

/// Pseudo-random numbers that depend only on the seed, on every machine: xoshiro256**, its state
/// filled by splitmix64. It has its own distributions because those of the standard library differ
/// between implementations.
class Random {
public:
    explicit Random(std::uint64_t seed) {
        for (std::uint64_t& word : _state) {
            word = splitmix(seed);
        }
    }

    std::uint64_t next() {
        const std::uint64_t result = std::rotl(_state[1] * 5, 7) * 9;
        const std::uint64_t shifted = _state[1] << 17U;
        _state[2] ^= _state[0];
        _state[3] ^= _state[1];
        _state[1] ^= _state[2];
        _state[0] ^= _state[3];
        _state[2] ^= shifted;
        _state[3] = std::rotl(_state[3], 45);
        return result;
    }

    /// From 0 to 1, excluding 1.
    double unit() {
        constexpr double kStep = 0x1p-53;
        return static_cast<double>(next() >> 11U) * kStep;
    }
    /// From `least` to `bound`, excluding `bound`.
    double between(double least, double bound) { return least + (bound - least) * unit(); }
    /// From 0 to `bound` - 1; `bound` must not be 0.
    unsigned below(unsigned bound) { return static_cast<unsigned>((next() >> 32U) * bound >> 32U); }
    /// Approximately normal, with mean 0 and deviation 1, and never beyond 3.5: the sum of four
    /// uniform numbers from one draw.
    double normal() {
        constexpr double kMean = 2.0 * 65535.0;
        constexpr double kDeviation = 37837.2; // of the sum: 65536 / sqrt(3)
        const std::uint64_t bits = next();
        const std::uint64_t sum =
            (bits & 0xFFFFU) + (bits >> 16U & 0xFFFFU) + (bits >> 32U & 0xFFFFU) + (bits >> 48U);
        return (static_cast<double>(sum) - kMean) / kDeviation;
    }

private:
    static std::uint64_t splitmix(std::uint64_t& state) {
        state += 0x9E3779B97F4A7C15U;
        std::uint64_t mixed = state;
        mixed = (mixed ^ mixed >> 30U) * 0xBF58476D1CE4E5B9U;
        mixed = (mixed ^ mixed >> 27U) * 0x94D049BB133111EBU;
        return mixed ^ mixed >> 31U;
    }

    std::array<std::uint64_t, 4> _state{};
};

} // namespace pallax
