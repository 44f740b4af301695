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

/// Properties that compile quickly: the templates of the property library take longer to compile
/// than most tests, so they are used only in one source.
namespace pallax::doubles {

/// True when `property` holds in all cases. It draws values with the functions below and checks
/// with RC_ASSERT. A counterexample is made small and printed.
bool holds(const std::function<void()>& property);

/// Ends a case without counting it, unless `condition` is true.
void require(bool condition);

/// Draws values for the property that is being checked. Ranges include `low` but not `high`. Unless
/// stated otherwise, numbers and containers are small at first and grow from case to case.
namespace any {

bool boolean();
std::uint8_t byte();
std::int64_t integer();
double real();
int between(int low, int high);
inline unsigned below(unsigned bound) {
    return static_cast<unsigned>(between(0, static_cast<int>(bound)));
}
/// Draws from the whole range from the first case on.
std::int64_t longBetween(std::int64_t low, std::int64_t high);
/// Any 64 bits from the first case on.
std::uint64_t bits();

ByteBuffer bytes();
/// `length` bytes, each below `bound` (256 for any byte).
ByteBuffer bytesBelow(unsigned bound, std::size_t length);
std::vector<ByteBuffer> buffers();
/// Any bytes.
std::string text();
/// A text of these characters.
std::string textOf(std::string_view characters);
std::vector<std::string> texts();
std::vector<int> integers(int low, int high);

/// The index of an element in a container of that size, which must not be 0.
inline std::size_t index(std::size_t size) {
    return static_cast<std::size_t>(between(0, static_cast<int>(size)));
}
template <class Container>
auto elementOf(const Container& container) {
    return *(std::begin(container) + static_cast<std::ptrdiff_t>(index(std::size(container))));
}

} // namespace any

} // namespace pallax::doubles
