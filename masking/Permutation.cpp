#include "masking/Permutation.h"

#include "masking/BitField.h"
#include "text/Bytes.h"

#include <algorithm>
#include <array>
#include <bit>
#include <limits>

namespace pallax {

namespace {

constexpr unsigned kMostBits = 64;

std::uint64_t lowBits(unsigned width) {
    return width >= kMostBits ? std::numeric_limits<std::uint64_t>::max()
                              : (std::uint64_t{1} << width) - 1;
}

} // namespace

/// A Feistel network over two parts of nearly the same width: a permutation whatever the function.
std::uint64_t Permutation::once(std::uint64_t number, unsigned width) const {
    constexpr unsigned kRounds = 10;
    unsigned lowWidth = width / 2;
    for (unsigned round = 0; round < kRounds; ++round) {
        const unsigned highWidth = width - lowWidth;
        const std::uint64_t low = number & lowBits(lowWidth);
        const std::uint64_t high = number >> lowWidth;
        std::array<std::uint8_t, 2 + sizeof(low)> input{static_cast<std::uint8_t>(round),
                                                        static_cast<std::uint8_t>(width)};
        for (std::size_t byte = 0; byte < sizeof(low); ++byte) {
            input.at(2 + byte) = static_cast<std::uint8_t>(low >> (byte * kByteBits));
        }
        const std::uint64_t mixed = high ^ _keyed.bits(input, highWidth);
        number = low << highWidth | mixed; // the parts change places
        lowWidth = highWidth;
    }
    return number;
}

/// Applied until the result is in the range, which keeps it a permutation.
std::uint64_t Permutation::between(std::uint64_t number, std::uint64_t least,
                                   std::uint64_t most) const {
    const auto width =
        static_cast<unsigned>(std::max<int>(static_cast<int>(std::bit_width(most)), 2));
    do {
        number = once(number, width);
    } while (number < least || number > most);
    return number;
}

std::uint64_t Permutation::of(std::uint64_t number, unsigned width) const {
    constexpr auto kClasses = std::to_array<unsigned>({8, 16, 28, 32, kMostBits});
    std::uint64_t least = 1;
    for (const unsigned bits : kClasses) {
        const std::uint64_t most = lowBits(std::min(bits, width));
        if (number <= most) {
            return number < least ? number : between(number, least, most);
        }
        least = most + 1;
    }
    return number;
}

std::uint64_t Permutation::ofDecimal(std::uint64_t number) const {
    constexpr std::uint64_t kTen = 10;
    constexpr std::uint64_t kLargest = std::numeric_limits<std::uint64_t>::max();
    std::uint64_t least = 1;
    while (number / kTen >= least) {
        least *= kTen;
    }
    const std::uint64_t most = least > kLargest / kTen ? kLargest : least * kTen - 1;
    return number < least ? number : between(number, least, most);
}

} // namespace pallax
