#pragma once

#include "masking/Replacement.h"

#include <cstdint>

namespace pallax {

/// Keyed pseudonyms for the identities of cells and areas: within a range, each number has one of
/// its own, so the same cell has the same one and two cells never share it. Numbers of 8, 16, 28
/// and 32 bits remain such. Zero remains zero.
class Permutation {
public:
    /// Needs a keyed replacement.
    explicit Permutation(Replacement keyed) : _keyed(std::move(keyed)) {}

    /// `number` has at most `width` bits (1 to 64), and so has the result.
    std::uint64_t of(std::uint64_t number, unsigned width) const;
    /// The result has as many decimal digits.
    std::uint64_t ofDecimal(std::uint64_t number) const;

private:
    std::uint64_t between(std::uint64_t number, std::uint64_t least, std::uint64_t most) const;
    std::uint64_t once(std::uint64_t number, unsigned width) const;

    Replacement _keyed;
};

} // namespace pallax
