#pragma once

#include <cstddef>
#include <string>
#include <string_view>
#include <vector>

namespace pallax {

/// How many letters must be put in, left out, replaced or swapped with their neighbour to make
/// one word of the other.
std::size_t editDistance(std::string_view one, std::string_view other);

/// The first of the names that `word` is closest to, if it can be a slip of the hand: at most one
/// letter in three is wrong. Empty when there is none.
std::string nearestName(std::string_view word, const std::vector<std::string>& names);

/// ". Did you mean "decode"?", or nothing: the end of a sentence about a word that is unknown.
std::string suggestion(std::string_view word, const std::vector<std::string>& names);

} // namespace pallax
