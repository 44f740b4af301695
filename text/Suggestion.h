#pragma once

#include <cstddef>
#include <string>
#include <string_view>
#include <vector>

namespace pallax {

/// How many letters must be inserted, deleted, replaced or swapped with their neighbour to turn one
/// word into the other.
std::size_t editDistance(std::string_view one, std::string_view other);

/// The first of the names closest to `word`, if it can be a typing error: at most one letter in
/// three is wrong. Otherwise empty.
std::string nearestName(std::string_view word, const std::vector<std::string>& names);

/// ". Did you mean "decode"?", or empty: the end of a sentence about an unknown word.
std::string suggestion(std::string_view word, const std::vector<std::string>& names);

} // namespace pallax
