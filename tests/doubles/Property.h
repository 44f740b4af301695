#pragma once

#include "text/Bytes.h"

#include <cstddef>
#include <cstdint>
#include <functional>

/// Properties at the price of a function call: the templates of the property library take
/// longer to compile than most tests, so what many tests draw is compiled once, behind these.
namespace pallax::doubles {

/// True when `property` holds for whatever it draws: it draws with the functions below or with
/// *rc::gen::…, and says what must hold with RC_ASSERT. A counterexample is made small and printed.
bool holds(const std::function<void()>& property);

/// Draws, for a property that is being checked.
namespace any {

bool boolean();
std::uint8_t byte();
std::int64_t integer();
double real();
/// From `low` up to, not including, `high`.
int between(int low, int high);
/// As many bytes as `length` says, each below `bound` (any byte with 256).
ByteBuffer bytesBelow(unsigned bound, std::size_t length);

} // namespace any

} // namespace pallax::doubles
