#pragma once

#include "text/Bytes.h"

#include <rapidcheck/Assertions.h>
#include <rapidcheck/Classify.h>

#include <cstddef>
#include <cstdint>
#include <functional>
#include <string>
#include <string_view>
#include <vector>

/// Properties at the price of a function call: the templates of the property library take
/// longer to compile than most tests, so what tests draw is compiled once, behind these.
namespace pallax::doubles {

/// True when `property` holds for whatever it draws: it draws with the functions below and says
/// what must hold with RC_ASSERT. A counterexample is made small and printed.
bool holds(const std::function<void()>& property);

/// The rest of a case is passed over, and the case does not count, unless `condition` is true.
void require(bool condition);

/// Draws, for a property that is being checked. Ranges include `low` but not `high`; numbers and
/// containers are small at first and grow from case to case, where nothing else is said.
namespace any {

bool boolean();
std::uint8_t byte();
std::int64_t integer();
double real();
int between(int low, int high);
inline unsigned below(unsigned bound) {
    return static_cast<unsigned>(between(0, static_cast<int>(bound)));
}
/// Of the whole range from the first case on.
std::int64_t longBetween(std::int64_t low, std::int64_t high);
/// Any 64 bits, from the first case on.
std::uint64_t bits();

ByteBuffer bytes();
/// As many bytes as `length` says, each below `bound` (any byte with 256).
ByteBuffer bytesBelow(unsigned bound, std::size_t length);
std::vector<ByteBuffer> buffers();
/// Any bytes.
std::string text();
/// Of these characters.
std::string textOf(std::string_view characters);
std::vector<std::string> texts();
std::vector<int> integers(int low, int high);

/// The place of an element in a container of that size, which is not empty.
inline std::size_t index(std::size_t size) {
    return static_cast<std::size_t>(between(0, static_cast<int>(size)));
}
template <class Container>
auto elementOf(const Container& container) {
    return *(std::begin(container) + static_cast<std::ptrdiff_t>(index(std::size(container))));
}

} // namespace any

} // namespace pallax::doubles
