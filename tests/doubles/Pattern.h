#pragma once

#include <string>
#include <vector>

/// Regular expressions at the price of a function call: what the standard library's are made of
/// takes a second to compile, in each source that uses them.
namespace pallax::doubles {

/// True when `pattern` matches the whole text.
bool isMatch(const std::string& text, const std::string& pattern);

/// Each match in the text: the match itself, then its groups.
std::vector<std::vector<std::string>> matchesIn(const std::string& text,
                                                const std::string& pattern);

/// The text with every match replaced; `by` may name groups ("$1").
std::string replaced(const std::string& text, const std::string& pattern, const std::string& by);

} // namespace pallax::doubles
